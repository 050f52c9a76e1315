"""Compiles headers of src alone, so that none leans on another's includes.

    checkheaders.py ROOT STAMP COMPILER FLAG...

A header that a source of its own name includes first is proved by that source, but for rooms whose
sources have precompiled headers; the others are parsed here.
Prints what does not parse, and writes STAMP when all do.
"""
import concurrent.futures
import os
import pathlib
import re
import subprocess
import sys

root, stamp, compiler, *flags = sys.argv[1:]
flags = [f for f in flags if f != "-isystem/usr/include"]  # the compiler's own order finds it
src = pathlib.Path(root) / "src"
PRECOMPILED = {"qm_ui"}


def proved_by_its_source(header):
    source = header.with_suffix(".cpp")
    if header.relative_to(src).parts[0] in PRECOMPILED or not source.exists():
        return False
    first = re.search(r'^#include ["<]([^">]+)', source.read_text(), re.M)
    return first is not None and first.group(1) == header.relative_to(src).as_posix()


def parse(header):
    command = [compiler, *flags, "-fsyntax-only", "-x", "c++", "-include", str(header), os.devnull]
    return subprocess.run(command, capture_output=True, text=True)


headers = [h for h in sorted(src.rglob("*.h")) if not proved_by_its_source(h)]
if "-DQM_UI" not in flags:
    headers = [h for h in headers if h.relative_to(src).parts[0] != "qm_ui"]
with concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
    failed = [r.stderr for r in pool.map(parse, headers) if r.returncode]
if failed:
    sys.exit("".join(failed))
pathlib.Path(stamp).write_text(f"{len(headers)} headers parsed alone\n")
