#!/usr/bin/env python3
"""Reads a .knl by docs/files/traces.md alone. It knows nothing of the program: what both say must agree."""
import struct


class Reader:
    def __init__(self, data):
        self.data = data
        self.at = 0

    def take(self, layout):
        """The values of a struct layout, little-endian."""
        layout = "<" + layout
        size = struct.calcsize(layout)
        if len(self.data) - self.at < size:
            raise ValueError("the file ends too early")
        values = struct.unpack_from(layout, self.data, self.at)
        self.at += size
        return values if len(values) > 1 else values[0]

    def flag(self):
        return self.take("B") != 0


def share(value):
    return min(max(value, 0.0), 1.0)


def read_settings(r, version):
    code = r.take("I")
    s = {"mode": code - 1 if code in (1, 2, 3) else 3, "anchorX": 0, "anchorY": 0, "suppression": 0.3}
    s["size"], s["estimatorOptions"] = r.take("iI")
    s["estimatorTuningA"], s["estimatorTuningB"], s["threadWeight"] = r.take("3f")
    for name in ("threadFlag", "deconvFlagA", "deconvFlagB"):
        s[name] = r.flag()
    s["deconvWeight"] = r.take("f")
    s["smoothing"] = share(r.take("f"))
    s["deconvIterations"], s["noiseLevel"] = r.take("II")
    if version < 3:
        r.take("2s")
    s["forcedApply"] = r.flag()
    s["maskThreshold"] = r.take("B")
    if version >= 2:
        s["anchorX"], s["anchorY"] = r.take("ii")
    if version >= 3:
        s["suppression"] = share(r.take("f"))
    return s


def read_trace_file(data):
    """(version, width, height, trace); the trace as `traces` in JSON has it, without `reliable`."""
    r = Reader(data)
    if r.take("8s") != b"SWBDsreV":
        raise ValueError("this is no trace file")
    version, width, height = r.take("Hii")
    kind = r.take("I") if version >= 5 else None
    region = list(r.take("4i"))
    settings = read_settings(r, version)
    size = r.take("I")
    if size * size * 4 > len(data):
        raise ValueError("the kernel is larger than the file")
    samples = [r.take("f") for _ in range(size * size)]
    read_only, line = False, (0.0, 0.0, 0.0, 0.0)
    if 2 <= version <= 4:
        read_only = r.flag()
    if version == 4 or kind == 2:
        line = r.take("4f")
    if kind is None:
        kind = 2 if line[:2] != line[2:] else 3 if read_only else 1
    return version, width, height, {
        "class": {1: "PEstimatedKernel", 2: "PManualKernel", 3: "PReadOnlyKernel"}[kind],
        "region": region,
        "settings": settings,
        "kernel": {"size": size, "sum": sum(samples), "samples": samples} if size else None,
        "line": list(line) if kind == 2 else None,
    }
