#!/usr/bin/env python3
"""How good kernels and results are, over a folder of pictures with known blur.

  bench/quality.py --data DIR [--group G,G] [--noise low|auto] [--whole] [--binary PATH] [--json]

DIR/index.json lists the cases (bench/README.md has its format). Of each case with a true kernel, `stillmark estimate`
looks for the blur in the whole picture, allowed 4 pixels more than it has; similarity is the largest normalised
cross-correlation of the two kernels over all whole-pixel shifts. Each colour case with a sharp picture also goes
through the main job, and gain is by how many dB the result is nearer to the sharp picture than the blurred one was,
both aligned to 1/8 pixel first. A picture that the job leaves as it is gains 0. A kernel that is not found counts as a
similarity of 0.

Quality comes from DIR/score.py where there is one (it needs what it imports); without it, or with --own-score, it is
computed here. Needs numpy. The exit status is 1 when a run failed that should have worked.
"""
import argparse
import json
import os
import re
import subprocess
import sys
import tempfile

try:
    import numpy as np
except ImportError:
    sys.exit('quality.py: needs numpy for ' + sys.executable + ' (Debian: python3-numpy)')

DEFAULT_BINARY = os.path.join(os.path.dirname(os.path.abspath(__file__)), '..', 'build', 'release', 'cli', 'stillmark')


class RunFailed(Exception):
    pass


# ---------------------------------------------------------------- files
def read_pfm(path):
    """Samples of a portable float map, (rows, cols) or (rows, cols, 3), the top row first."""
    with open(path, 'rb') as f:
        data = f.read()
    head = re.match(rb'(P[fF])\s+(\d+)\s+(\d+)\s+([-+.\deE]+)\s', data)
    if not head:
        raise RunFailed(path + ': no portable float map')
    cols, rows = int(head[2]), int(head[3])
    planes = 3 if head[1] == b'PF' else 1
    kind = '<f4' if float(head[4]) < 0 else '>f4'
    samples = np.frombuffer(data, kind, rows * cols * planes, head.end()).astype(float)
    return samples.reshape((rows, cols, 3) if planes == 3 else (rows, cols))[::-1]


def write_pfm(path, samples):
    with open(path, 'wb') as f:
        f.write(b'Pf\n%d %d\n-1.0\n' % (samples.shape[1], samples.shape[0]))
        f.write(samples[::-1].astype('<f4').tobytes())


class Program:
    """The stillmark command, its files in a scratch folder."""

    def __init__(self, binary, scratch, threads):
        self.binary, self.scratch = binary, scratch
        self.common = ['--json', '--quiet'] + (['--threads', str(threads)] if threads else [])

    def path(self, name):
        return os.path.join(self.scratch, name)

    def run(self, arguments):
        """The program's JSON answer; RunFailed with its message."""
        done = subprocess.run([self.binary] + arguments + self.common, capture_output=True, text=True)
        if done.returncode != 0:
            raise RunFailed((done.stderr.strip() or 'exit status %d' % done.returncode).splitlines()[-1])
        return json.loads(done.stdout)

    def pixels(self, photo):
        """A photo as floats: a kernel of one point takes nothing away, and the result is saved as a float map."""
        point, out = self.path('point.pfm'), self.path('pixels.pfm')
        samples = np.zeros((3, 3))
        samples[1, 1] = 1
        write_pfm(point, samples)
        self.run(['deconvolve', photo, '--kernel', point, '-o', out])
        return read_pfm(out)


# ---------------------------------------------------------------- measures
def kernel_similarity(a, b):
    """Largest normalised cross-correlation over all whole-pixel shifts: 1 for kernels of the same shape."""
    size = [a.shape[i] + b.shape[i] for i in (0, 1)]
    correlation = np.fft.irfft2(np.fft.rfft2(a, size) * np.conj(np.fft.rfft2(b, size)), size)
    power = np.sqrt((a * a).sum() * (b * b).sum())
    return float(min(1.0, correlation.max() / power)) if power > 0 else 0.0


def luma(picture):
    return picture if picture.ndim == 2 else picture @ np.array([0.299, 0.587, 0.114])


def cubic_weights(t):
    """Keys' cubic convolution: weights of samples -1, 0, 1, 2 for a position t in 0..1 after sample 0."""
    return [((-0.5 * t + 1) * t - 0.5) * t, (1.5 * t - 2.5) * t * t + 1, ((-1.5 * t + 2) * t + 0.5) * t,
            (0.5 * t - 0.5) * t * t]


def window(picture, dy, dx, border):
    """picture[y + dy, x + dx] for the pixels (y, x) at least `border` from the edges; shifts need not be whole."""
    y0, x0 = int(np.floor(dy)), int(np.floor(dx))
    h, w = picture.shape[0] - 2 * border, picture.shape[1] - 2 * border
    top, left = border + y0, border + x0
    rows = sum(k * picture[top + i - 1:top + i - 1 + h, left - 1:left + w + 2]
               for i, k in enumerate(cubic_weights(dy - y0)))
    return sum(k * rows[:, i:i + w] for i, k in enumerate(cubic_weights(dx - x0)))


def aligned_psnr(sharp, picture, kernel_size):
    """PSNR in dB of a picture against the sharp one, after the best shift of up to half a kernel; the border (a kernel
    wide, at least 8 pixels) does not count."""
    reach = (kernel_size + 1) // 2
    border = max(8, kernel_size) + reach + 3  # a kernel, and room for the shift and the cubic weights
    a, b = luma(sharp), luma(picture)
    target = a[border:-border, border:-border]
    size = [a.shape[i] + 2 * reach + 1 for i in (0, 1)]
    masked = np.zeros_like(a)
    masked[border:-border, border:-border] = target
    mask = (masked * 0)
    mask[border:-border, border:-border] = 1
    cross = np.fft.irfft2(np.fft.rfft2(b, size) * np.conj(np.fft.rfft2(masked, size)), size)
    power = np.fft.irfft2(np.fft.rfft2(b * b, size) * np.conj(np.fft.rfft2(mask, size)), size)
    shifts = [(y, x) for y in range(-reach, reach + 1) for x in range(-reach, reach + 1)]
    best = min(shifts, key=lambda s: power[s] - 2 * cross[s])

    def error(shift):
        return float(np.mean((window(b, shift[0], shift[1], border) - target) ** 2))

    best = (error(best), best)
    for step in (0.5, 0.25, 0.125):
        best = min((error(s), s) for s in [(best[1][0] + i * step, best[1][1] + j * step)
                                           for i in (-1, 0, 1) for j in (-1, 0, 1)]
                   if max(abs(s[0]), abs(s[1])) <= reach + 1)
    fitted = np.clip(window(picture, best[1][0], best[1][1], border), 0, 1)
    mse = float(np.mean((fitted - sharp[border:-border, border:-border]) ** 2))
    return 10 * np.log10(1 / max(mse, 1e-12))


def scored_gain(score, case, result):
    """The gain by the folder's own score.py."""
    done = subprocess.run([sys.executable, score, '--sharp', case.sharp, '--result', result, '--blurred', case.blurred,
                           '--ksize', str(case.size), '--border', str(max(8, case.size))],
                          capture_output=True, text=True)
    if done.returncode != 0:
        raise RunFailed('score.py: ' + (done.stderr.strip().splitlines() or ['failed'])[-1])
    answer = json.loads(done.stdout)
    return answer['psnr_blurred'], answer['psnr'] - answer['psnr_blurred']


def own_gain(program, case, result):
    sharp = program.pixels(case.sharp)
    before = aligned_psnr(sharp, program.pixels(case.blurred), case.size)
    return before, aligned_psnr(sharp, program.pixels(result), case.size) - before


# ---------------------------------------------------------------- cases
class Case:
    def __init__(self, entry, folder):
        def beside(key):
            return os.path.join(folder, entry[key]) if entry.get(key) else None

        self.id, self.group = entry['id'], entry.get('group', '')
        self.blurred, self.sharp, self.kernel = beside('blurred'), beside('sharp'), beside('kernel')
        self.colour = entry.get('channels') == 3
        self.true_kernel = np.load(self.kernel) if self.kernel else None
        self.size = int(entry.get('kernel_size') or (max(self.true_kernel.shape) if self.kernel else 0))
        self.region = '0,0,%d,%d' % (entry['width'], entry['height'])

    @property
    def search_size(self):
        return (self.size + 4) | 1


def read_cases(folder, groups):
    with open(os.path.join(folder, 'index.json')) as f:
        entries = json.load(f)['cases']
    return [Case(e, folder) for e in entries if e.get('kernel') and (not groups or e.get('group') in groups)]


def examine_kernel(program, case, noise, row):
    out = program.path('kernel.pfm')
    answer = program.run(['estimate', case.blurred, '-o', out, '--size', str(case.search_size), '--noise', noise,
                          '--region', case.region])
    row['similarity'] = round(kernel_similarity(case.true_kernel, np.maximum(read_pfm(out), 0)), 4)
    row['good'], row['seconds'] = answer.get('good'), answer.get('seconds')


def examine_result(program, case, noise, whole, score, row):
    out = program.path('result.png')
    answer = program.run([case.blurred, '-o', out, '--noise', noise] + (['--region', case.region] if whole else []))
    row['size'] = [t.get('size') for t in answer.get('traces', [])]
    before, gain = scored_gain(score, case, out) if score else own_gain(program, case, out)
    row['psnr_blurred'], row['gain'] = round(before, 2), round(gain, 2)


def examine(program, case, noise, whole, score):
    """What is measured of a case, as a dictionary; a failure under "error"."""
    row = {'id': case.id, 'group': case.group, 'kernel_size': case.size, 'similarity': 0.0}
    errors = []
    try:
        examine_kernel(program, case, noise, row)
    except RunFailed as e:
        errors.append(str(e))
    if case.colour and case.sharp:
        try:
            examine_result(program, case, noise, whole, score, row)
        except RunFailed as e:
            errors.append(str(e))
    if errors:
        row['error'] = '; '.join(errors)
    return row


def means(rows):
    result = {}
    for group in dict.fromkeys(r['group'] for r in rows):
        mine = [r for r in rows if r['group'] == group]
        gains = [r['gain'] for r in mine if 'gain' in r]
        result[group] = {'cases': len(mine), 'similarity': round(float(np.mean([r['similarity'] for r in mine])), 4)}
        if gains:
            result[group].update(gain=round(float(np.mean(gains)), 2), better=sum(g > 0 for g in gains))
    return result


# ---------------------------------------------------------------- output
COLUMNS = '%-18s %6s %10s %6s %8s %8s %s'


def print_row(row):
    def text(key, form):
        return form % row[key] if row.get(key) is not None else ''

    print(COLUMNS % (row['id'], row['kernel_size'], text('similarity', '%.4f'),
                     {True: 'yes', False: 'no'}.get(row.get('good'), ''), text('psnr_blurred', '%.2f'),
                     text('gain', '%+.2f'), row.get('error', '')), flush=True)


def main():
    p = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    p.add_argument('--data', required=True, help='folder with index.json')
    p.add_argument('--group', help='groups of cases, with commas (default: all with a true kernel)')
    p.add_argument('--noise', choices=['auto', 'low', 'medium', 'high'], default='auto')
    p.add_argument('--whole', action='store_true', help='the main job, too, looks at the whole picture (default: where '
                   'it finds a region)')
    p.add_argument('--binary', default=DEFAULT_BINARY, help='the stillmark program (default: the release build)')
    p.add_argument('--threads', type=int, default=0, help='passed on')
    p.add_argument('--own-score', action='store_true', help='do not use score.py of the folder')
    p.add_argument('--kernels-only', action='store_true', help='leave the main job out')
    p.add_argument('--json', action='store_true', help='one JSON object in place of the table')
    a = p.parse_args()
    if not os.access(a.binary, os.X_OK):
        p.error('no program ' + a.binary)

    try:
        cases = read_cases(a.data, a.group.split(',') if a.group else None)
    except (OSError, ValueError, KeyError, TypeError) as e:
        p.error('%s holds no cases: %r' % (a.data, e))
    if not cases:
        p.error('no case with a true kernel in ' + a.data)
    score = os.path.join(a.data, 'score.py')
    if a.own_score or not os.path.exists(score):
        score = None
    rows = []
    if not a.json:
        print(COLUMNS % ('case', 'kernel', 'similarity', 'good', 'blurred', 'gain dB', ''))
    with tempfile.TemporaryDirectory() as scratch:
        program = Program(os.path.abspath(a.binary), scratch, a.threads)
        for case in cases:
            if a.kernels_only:
                case.sharp = None
            rows.append(examine(program, case, a.noise, a.whole, score))
            if not a.json:
                print_row(rows[-1])

    summary = means(rows)
    if a.json:
        print(json.dumps({'noise': a.noise, 'cases': rows, 'means': summary}))
    else:
        for group, m in summary.items():
            line = '%s: mean similarity %.4f of %d' % (group, m['similarity'], m['cases'])
            if 'gain' in m:
                line += ', mean gain %+.2f dB, %d better than the input' % (m['gain'], m['better'])
            print(line)
    sys.exit(1 if any('error' in r for r in rows) else 0)


if __name__ == '__main__':
    main()
