#!/usr/bin/env python3
"""checkFiles.py PROGRAM FOLDER: what PROGRAM says of the sample files in FOLDER (one JSON object a line) is what their
manifest.json says, and for good trace files what readTrace.py makes of their bytes."""
import json
import os
import subprocess
import sys

from readTrace import read_trace_file


def differences(expected, got, place):
    """Where got lacks or contradicts expected. Numbers may differ by single precision; got may say more."""
    if isinstance(expected, dict) and isinstance(got, dict):
        for key, value in expected.items():
            yield from differences(value, got.get(key, "nothing"), f"{place}.{key}")
    elif isinstance(expected, list) and isinstance(got, list) and len(expected) == len(got):
        for i, value in enumerate(expected):
            yield from differences(value, got[i], f"{place}[{i}]")
    elif isinstance(expected, float) and isinstance(got, (int, float)) and not isinstance(got, bool):
        if abs(expected - got) > 2e-7 * max(1.0, abs(expected)):
            yield f"{place}: {expected} expected, {got} found"
    elif isinstance(expected, bool) != isinstance(got, bool) or expected != got:
        yield f"{place}: {expected!r} expected, {got!r} found"


def main(program, folder):
    with open(os.path.join(folder, "manifest.json")) as file:
        manifest = json.load(file)
    names = [entry["file"] for entry in manifest["files"]]
    unknown = set(os.listdir(folder)) - set(names) - {"manifest.json"}
    assert not unknown, f"not in the manifest: {unknown}"
    answer = subprocess.run([program] + [os.path.join(folder, name) for name in names],
                            check=True, capture_output=True, text=True).stdout
    found = [json.loads(line) for line in answer.splitlines()]
    assert len(found) == len(names)

    faults, read_twice = [], 0
    for entry, got in zip(manifest["files"], found):
        for trace in entry["traces"]:
            trace["settings"] = {**manifest["settings"], **trace["settings"]}
            if trace["kernel"]:
                trace["kernel"]["samples"] = [float(v) for v in manifest["kernels"][trace["kernel"]["samples"]]]
        entry["bounds"] = manifest["bounds"]
        faults += differences(entry, got, entry["file"])
        if got["file"].endswith(".knl") and got["result"]:
            with open(os.path.join(folder, got["file"]), "rb") as file:
                version, width, height, trace = read_trace_file(file.read())
            mine = {"version": version, "bounds": [0, 0, width, height], "traces": [trace]}
            faults += differences(mine, got, got["file"] + " by readTrace.py")
            read_twice += 1
    print(f"{len(names)} files, {read_twice} of them read by both readers, {len(faults)} differences", *faults, sep="\n")
    return 1 if faults or read_twice < 5 else 0


sys.exit(main(*sys.argv[1:]))
