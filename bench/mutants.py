#!/usr/bin/env python3
"""Plants each fault of a list in a copy of the tree and prints those that no test finds.

    bench/mutants.py [--list bench/mutants.txt] [--copy build/mutants] [--jobs N] [WORD]

A line of the list is: folder | file | text as it is | text with the fault. The text must be in the file exactly once.
For each line, the folder's test program is built and run until its first failure. With a WORD, only lines that contain
it are used. The copy is a git worktree of the current commit with its own build, and is kept for the next run.
GAITWRIGHT_TEST_DATA is passed on. The exit code is 1 if a fault survives.
"""
import argparse
import os
import subprocess
import sys
from pathlib import Path

ROOT = Path(__file__).resolve().parent.parent
SECONDS = 300  # a fault that hangs is found


def faults(path, word):
    """Number of the line, folder, file, text and fault."""
    for number, line in enumerate(path.read_text().splitlines(), 1):
        if line.strip() and not line.startswith("#") and word in line:
            fields = [field.strip() for field in line.split(" | ")]
            if len(fields) != 4:
                sys.exit("%s:%d: four fields are needed, with \" | \" in between" % (path, number))
            yield (number, *fields)


def run(command, folder, seconds=None):
    """Whether a command ends well and in time."""
    try:
        return subprocess.run(command, cwd=folder, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL,
                              timeout=seconds, check=False).returncode == 0
    except subprocess.TimeoutExpired:
        return False


def prepare(copy):
    """The copy at the present commit, with a build beside it."""
    commit = subprocess.run(["git", "rev-parse", "HEAD"], cwd=ROOT, capture_output=True, text=True, check=True).stdout
    if (copy / ".git").exists():
        ready = run(["git", "checkout", "-q", "--force", "--detach", commit.strip()], copy)
    else:
        ready = run(["git", "worktree", "add", "-q", "--detach", str(copy), commit.strip()], ROOT)
    if not ready or not run(["cmake", "--preset", "release"], copy):
        sys.exit("%s: no copy could be made here" % copy)


def outcome(copy, folder, name, text, fault, jobs):
    """What becomes of one fault: found, survives, or why it was not tried."""
    path, target = copy / name, folder + "_tests"
    source = path.read_text() if path.exists() else ""
    if source.count(text) != 1:
        return "not planted: the text is there %d times" % source.count(text)
    try:
        path.write_text(source.replace(text, fault))
        if not run(["ninja", "-j", str(jobs), "-C", "build/release", target], copy):
            return "does not build"
        found = not run([copy / "build/release/bin" / target, "--gtest_fail_fast"], copy, SECONDS)
        return "found" if found else "SURVIVES"
    finally:
        path.write_text(source) if source else None


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--list", type=Path, default=ROOT / "bench" / "mutants.txt")
    parser.add_argument("--copy", type=Path, default=ROOT / "build" / "mutants")
    parser.add_argument("--jobs", type=int, default=os.cpu_count() or 1)
    parser.add_argument("word", nargs="?", default="", metavar="WORD")
    arguments = parser.parse_args()
    prepare(arguments.copy)
    counts = {}
    for number, folder, name, text, fault in faults(arguments.list, arguments.word):
        told = outcome(arguments.copy, folder, name, text, fault, arguments.jobs)
        counts[told.split(":")[0]] = counts.get(told.split(":")[0], 0) + 1
        print("%3d %s: %s -> %s: %s" % (number, name, text, fault, told), flush=True)
    print(", ".join("%d %s" % (count, told) for told, count in counts.items()))
    return 1 if "SURVIVES" in counts else 0


if __name__ == "__main__":
    sys.exit(main())
