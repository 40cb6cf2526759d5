#!/usr/bin/env python3
"""Plants each fault of a list in a copy of the tree and prints those that no test finds.

    bench/mutants.py [--list bench/mutants.txt] [--copy build/mutants] [--jobs N] [WORD]

A line of the list is: tests | file | text as it is | text with the fault. The text must be in the file exactly once; where
it is there more often, the file is given as NAME:LINE and the occurrence nearest to that line counts. The tests are names
of folders with commas in between ("motion,app"), or of a script of the shell program ("cli.many"). Only what they need
is built, and each runs until its first failure; they must pass without a fault. With a WORD, only lines that contain it
are used. The copy is a git worktree of the current commit with its own build, and is kept for the next run.
GAITWRIGHT_TEST_DATA is passed on. The exit code is 1 if a fault survives.
"""
import argparse
import os
import re
import signal
import subprocess
import sys
from pathlib import Path

ROOT = Path(__file__).resolve().parent.parent
SECONDS = 300  # a fault that causes a hang counts as found


def faults(path, word):
    """Number of the line, tests, file, text and fault."""
    for number, line in enumerate(path.read_text().splitlines(), 1):
        if line.strip() and not line.startswith("#") and word in line:
            fields = [field.strip().replace("\\|", "|") for field in line.split(" | ")]
            if len(fields) != 4:
                sys.exit("%s:%d: four fields are needed, with \" | \" in between (\\| within one)" % (path, number))
            yield (number, *fields)


def run(command, folder, seconds=None):
    """Returns whether a command succeeds in time."""
    try:
        return subprocess.run(command, cwd=folder, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL,
                              timeout=seconds, check=False).returncode == 0
    except subprocess.TimeoutExpired:
        return False


def prepare(copy):
    """Prepares the copy at the current commit, with its own build."""
    commit = subprocess.run(["git", "rev-parse", "HEAD"], cwd=ROOT, capture_output=True, text=True, check=True).stdout
    if (copy / ".git").exists():
        ready = run(["git", "checkout", "-q", "--force", "--detach", commit.strip()], copy)
    else:
        ready = run(["git", "worktree", "add", "-q", "--detach", str(copy), commit.strip()], ROOT)
    if not ready or not run(["cmake", "--preset", "release", "-DGAITWRIGHT_UNITY=OFF"], copy):
        sys.exit("%s: no copy could be made here" % copy)


def position(source, text, line):
    """Where a text is in a source: the only place, or the one nearest to a line; -1 if that is no place."""
    places = [match.start() for match in re.finditer(re.escape(text), source)]
    if line and places:
        return min(places, key=lambda place: abs(source.count("\n", 0, place) + 1 - int(line)))
    return places[0] if len(places) == 1 else -1


def passes(copy, tests, jobs):
    """Whether tests pass; None if they cannot be built."""
    script = tests.startswith("cli.")
    targets = ["gaitwright", "assets"] if script else [tests + "_tests"]
    if not run(["ninja", "-j", str(jobs), "-C", "build/release", *targets], copy):
        return None
    if script:
        return run(["ctest", "--test-dir", "build/release", "--no-tests=error", "-R", "^%s_test$" % re.escape(tests)],
                   copy, SECONDS)
    return run([copy / "build/release/bin" / targets[0], "--gtest_fail_fast"], copy, SECONDS)


def outcome(copy, tests, name, text, fault, jobs):
    """Returns the result of one fault: found, survives, or why it was not tried."""
    name, _, line = name.partition(":")
    path = copy / name
    source = path.read_text() if path.exists() else ""
    place = position(source, text, line)
    if place < 0:
        return "not planted: the text is there %d times" % source.count(text)
    try:
        path.write_text(source[:place] + fault + source[place + len(text):])
        for folder in tests.split(","):
            passed = passes(copy, folder, jobs)
            if passed is None:
                return "does not build"
            if not passed:
                return "found"
        return "SURVIVES"
    finally:
        path.write_text(source)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--list", type=Path, default=ROOT / "bench" / "mutants.txt")
    parser.add_argument("--copy", type=Path, default=ROOT / "build" / "mutants")
    parser.add_argument("--jobs", type=int, default=os.cpu_count() or 1)
    parser.add_argument("word", nargs="?", default="", metavar="WORD")
    arguments = parser.parse_args()
    # A shell ignores interrupts for what it starts in the background; tests of interrupts need them.
    signal.signal(signal.SIGINT, signal.default_int_handler)
    prepare(arguments.copy)
    listed = list(faults(arguments.list, arguments.word))
    for tests in sorted({tests for fields in listed for tests in fields[1].split(",")}):
        if not passes(arguments.copy, tests, arguments.jobs):
            sys.exit("%s: these tests fail without a fault" % tests)
    counts = {}
    for number, tests, name, text, fault in listed:
        told = outcome(arguments.copy, tests, name, text, fault, arguments.jobs)
        counts[told.split(":")[0]] = counts.get(told.split(":")[0], 0) + 1
        print("%3d %s: %s -> %s: %s" % (number, name, text, fault, told), flush=True)
    print(", ".join("%d %s" % (count, told) for told, count in counts.items()))
    return 1 if "SURVIVES" in counts else 0


if __name__ == "__main__":
    sys.exit(main())
