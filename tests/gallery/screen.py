"""A screen without hardware, real key and mouse events on it, and the gallery's log."""

import os
import queue
import re
import shutil
import signal
import subprocess
import tempfile
import threading
import time

PATIENCE = 20  # seconds until something that is to happen counts as not happening

TOLD = ("value", "command", "menu", "answer", "file", "drop", "timer", "primes", "ended")


def missing():
    """The programs that these tests need and that are not installed."""
    return [name for name in ("Xvfb", "xdotool") if shutil.which(name) is None]


class Screen:
    def __init__(self, width, height):
        out, into = os.pipe()
        self.server = subprocess.Popen(
            ["Xvfb", "-displayfd", str(into), "-screen", "0", f"{width}x{height}x24", "-nolisten", "tcp"],
            pass_fds=[into], stderr=subprocess.DEVNULL)
        os.close(into)
        with os.fdopen(out) as number:
            name = number.readline().strip()
        if not name:
            raise RuntimeError("Xvfb does not start")
        self.name = ":" + name

    def do(self, *words):
        """One or several commands of xdotool, one after the other."""
        subprocess.run(["xdotool", *map(str, words)], env=dict(os.environ, DISPLAY=self.name), check=True,
                       timeout=PATIENCE, stdout=subprocess.DEVNULL)

    def keyboard(self):
        """The window that has the keyboard; 0 or 1 for none."""
        said = subprocess.run(["xdotool", "getwindowfocus"], env=dict(os.environ, DISPLAY=self.name), text=True,
                              stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, timeout=PATIENCE).stdout.strip()
        return int(said or 0)

    def end(self):
        self.server.send_signal(signal.SIGKILL)
        self.server.wait()


class Gallery:
    """A running gallery. `at` has the places of the views of its front-most window, in pixels of the screen."""

    def __init__(self, binary, screen, scale=1, **environment):
        self.screen, self.scale = screen, scale
        self.folder = tempfile.TemporaryDirectory()
        self.errors = open(os.path.join(self.folder.name, "stderr"), "w+", encoding="utf-8")
        self.process = subprocess.Popen(
            [binary, "--log", "--scale", str(scale)], stdout=subprocess.PIPE, stderr=self.errors, text=True,
            env=dict(os.environ, DISPLAY=screen.name, SDL_VIDEODRIVER="x11", XDG_CONFIG_HOME=self.folder.name,
                     HOME=self.folder.name, **environment))
        self.lines = queue.Queue()
        self.reader = threading.Thread(target=self._read, daemon=True)
        self.reader.start()
        self.at, self.focus, self.drags, self.help, self.scrolled = {}, None, [], "", ""
        self.title, self.window = "", 0

    def _read(self):
        for line in self.process.stdout:
            self.lines.put(line.rstrip("\n"))
        self.lines.put(None)

    def next(self):
        """The next line of the log, taken note of."""
        try:
            line = self.lines.get(timeout=PATIENCE)
        except queue.Empty:
            raise AssertionError("nothing more is told") from None
        if line is None:
            raise AssertionError(f"the gallery has ended: {self.said()}")
        what, _, rest = line.partition(" ")
        if what == "window":
            left, top, _, self.title = rest.split(",", 3)
            self.corner, self.at, self.focus = (int(left), int(top)), {}, None
        elif what == "place":
            name, where = rest.split(" ")
            if where == "-":
                self.at.pop(name, None)
            else:
                x, y = self.corner
                left, top, right, bottom = (int(n) for n in where.split(","))
                self.at[name] = tuple(n * self.scale for n in (left + x, top + y, right + x, bottom + y))
        elif what == "focus":
            self.focus = rest
        elif what == "help":
            self.help = rest
        elif what == "scroll":
            self.scrolled = rest.split(" ")[1]
        return line

    def until(self, true, why):
        """Reads on until it is so."""
        end = time.monotonic() + PATIENCE
        while not true():
            if time.monotonic() > end:
                raise AssertionError(why)
            self.next()

    def told(self):
        """The next line of what the user's doings have led to. Drags on their way are only counted."""
        while True:
            line = self.next()
            if line.split(" ", 1)[0] not in TOLD:
                continue
            way = re.fullmatch(r"value \S+ drag (.*)", line)
            if not way:
                return line
            self.drags.append(way[1])

    def expect(self, *lines):
        """These and no others come next. # is any number."""
        for line in lines:
            pattern = r"-?[\d.]+".join(map(re.escape, line.split("#")))
            got = self.told()
            assert re.fullmatch(pattern, got), f"{got!r} instead of {line!r}"

    def show(self):
        """Waits for the gallery's own window."""
        self.until(lambda: "gallery/ok" in self.at and self.focus, "the gallery does not show")
        self.window = self.window or self.screen.keyboard()

    def rest(self):
        """Waits until menus have gone: without a window manager they take the keyboard, and give it back."""
        end = time.monotonic() + PATIENCE
        while "gallery/ok" in self.at and self.screen.keyboard() != self.window:
            assert time.monotonic() < end, "the keyboard does not come back"
            time.sleep(0.01)

    def point(self, name, x=0.5, y=0.5):
        """A place within a view, by shares of its size."""
        left, top, right, bottom = self.at[name]
        return round(left + (right - left - 1) * x), round(top + (bottom - top - 1) * y)

    def keys(self, *names):
        self.screen.do("key", "--delay", 2, *names)

    def switch(self, *names):
        """Keys that open a window or close one, and so move the keyboard: without a window manager what is pressed
        meanwhile would be lost."""
        before = self.screen.keyboard()
        self.keys(*names)
        end = time.monotonic() + PATIENCE
        while self.screen.keyboard() in (0, 1, before):
            assert time.monotonic() < end, f"the keyboard has not moved by {names}"
            time.sleep(0.01)

    def go(self, name):
        """By the tab key."""
        for _ in range(60):
            if self.focus == name:
                return
            before = self.focus
            self.keys("Tab")
            self.until(lambda: self.focus != before, f"the tab key has not left {before}")
        raise AssertionError(f"the tab key does not come to {name}")

    def type(self, text):
        self.screen.do("type", "--delay", 2, text)

    def click(self, name, x=0.5, y=0.5, button=1, times=1):
        self.rest()
        px, py = self.point(name, x, y)
        self.screen.do("mousemove", px, py, "click", "--repeat", times, "--delay", 10, button)

    def pull(self, name, start, end, held=False):
        """From a place within a view, by shares of its size, to another one or, beyond it, by view units from its left
        bottom corner if it is a list. `held`: without letting go."""
        self.rest()
        ax, ay = self.point(name, *start)
        if isinstance(end, list):
            bx, by = self.at[name][0] + end[0] * self.scale, self.at[name][3] + end[1] * self.scale
        else:
            bx, by = self.point(name, *end)
        words = ["mousemove", ax, ay, "mousedown", 1]
        for i in range(1, 5):
            words += ["mousemove", ax + (bx - ax) * i // 4, ay + (by - ay) * i // 4, "sleep", 0.02]
        self.drags = []
        self.screen.do(*words, *([] if held else ["mouseup", 1]))

    def said(self):
        """On stderr."""
        with open(self.errors.name, encoding="utf-8") as errors:
            return errors.read()

    def status(self):
        """Once it has ended by itself."""
        return self.process.wait(timeout=PATIENCE)

    def end(self):
        self.process.kill()
        self.process.wait()
        self.reader.join()
        self.process.stdout.close()
        self.errors.close()
        self.folder.cleanup()
