#!/usr/bin/env python3
"""Converts an archive of many files with several processes, and checks speed, completeness and equality of results.

    bench/many_files.py BIN_FOLDER [--count 10000] [--loop]

Every hundredth file is broken. Prints the time and rate of a first run, the time of a second one that finds everything
done, whether one process and eight produce the same bytes, and the share of the workers' time that went into
conversions. With --loop, two of the programs that convert a folder in their own process (convert_loop), each on half
of the archive and on a core of its own, are measured alternately with --jobs 2 on the whole.
"""
import argparse
import hashlib
import json
import os
import shutil
import subprocess
import sys
import tempfile
import time
from pathlib import Path

ROOT = Path(__file__).resolve().parent.parent
FILE_BYTES = 50_000


def source(number):
    """Returns a unique walk of about 50 KB: its rows begin at a different frame."""
    head, rows = (ROOT / "examples" / "walk.bvh").read_text().split("Frames: 67\n")
    frame_time, *frames = rows.splitlines()
    frames = (frames[number % len(frames):] + frames * 2)[:(FILE_BYTES - len(head)) // (len(frames[0]) + 1)]
    count = len(frames) + (5 if number % 100 == 99 else 0)
    return head + "Frames: %d\n" % count + "\n".join([frame_time] + frames) + "\n"


def make_archive(folder, count):
    for number in range(count):
        path = folder / ("scene%03d" % (number // 100)) / ("take%05d.bvh" % number)
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(source(number))


def digest(folder):
    total = hashlib.sha256()
    for path in sorted(folder.rglob("*.Kinetra")):
        total.update(str(path.relative_to(folder)).encode() + hashlib.sha256(path.read_bytes()).digest())
    return total.hexdigest()


class Bench:
    def __init__(self, bin_folder, work):
        self.program, self.work = Path(bin_folder).resolve() / "gaitwright", work

    def command(self, out, *options):
        return [str(self.program), "convert", "archive", "--out-dir", out, "--keep-going", "--quiet", *options]

    def run(self, out, *options):
        start = time.monotonic()
        done = subprocess.run(self.command(out, *options), cwd=self.work, stderr=subprocess.PIPE, text=True)
        named = {line.split(":")[1].strip() for line in done.stderr.splitlines() if "archive/" in line}
        return time.monotonic() - start, done.returncode, len(named)

    def count(self, out):
        return sum(1 for _ in (self.work / out).rglob("*.Kinetra"))

    def first_and_second(self, total):
        seconds, code, named = self.run("out", "--resume", "--report", "report.jsonl", "--jobs", "2")
        print("first run: exit %d, %d outputs, %d named, %.1f s, %.0f files/s" %
              (code, self.count("out"), named, seconds, total / seconds))
        lines = [json.loads(line) for line in (self.work / "report.jsonl").read_text().splitlines()]
        print("share of two workers' time spent in conversions: %.1f %%" %
              (100 * sum(line["seconds"] for line in lines) / (2 * seconds)))
        seconds, code, named = self.run("out", "--resume", "--report", "report.jsonl", "--jobs", "2")
        lines = [json.loads(line) for line in (self.work / "report.jsonl").read_text().splitlines()]
        again = sum(line["outcome"] == "converted" and not line.get("resumed") for line in lines)
        print("second run: exit %d, %d converted, %d named, %.1f s" % (code, again, named, seconds))

    def equality(self):
        digests = {"2": digest(self.work / "out")}
        shutil.rmtree(self.work / "out")
        for jobs in ("1", "8"):
            seconds, _, _ = self.run("out", "--jobs", jobs)
            digests[jobs] = digest(self.work / "out")
            shutil.rmtree(self.work / "out")
            print("--jobs %s: %.1f s" % (jobs, seconds))
        print("--jobs 1, 2 and 8: " + ("the same bytes" if len(set(digests.values())) == 1 else "OTHER BYTES"))

    def against_loop(self, rounds=5):
        """Measures both alternately, so that a noisy machine slows both alike."""
        profile = str(self.program.parent / "PoserBVH.prf")
        for number, path in enumerate(sorted((self.work / "archive").rglob("*.bvh"))):
            half = self.work / ("half%d" % (number % 2))
            half.mkdir(exist_ok=True)
            os.link(path, half / path.name)
        ratios = []
        for _ in range(rounds):
            start = time.monotonic()
            loops = [subprocess.Popen(["taskset", "-c", str(half), str(self.program.parent / "convert_loop"),
                                       "half%d" % half, profile, "loop%d" % half],
                                      cwd=self.work, stdout=subprocess.DEVNULL) for half in (0, 1)]
            for running in loops:
                running.wait()
            looped = time.monotonic() - start
            seconds, _, _ = self.run("out", "--jobs", "2", "--profile", profile)
            ratios.append(looped / seconds)
            print("two loops %.1f s, --jobs 2 %.1f s: %.0f %%" % (looped, seconds, 100 * ratios[-1]), flush=True)
            for folder in ("loop0", "loop1", "out"):
                shutil.rmtree(self.work / folder)
        print("speed of --jobs 2 against two loops, median: %.0f %%" % (100 * sorted(ratios)[rounds // 2]))


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("bin_folder")
    parser.add_argument("--count", type=int, default=10_000)
    parser.add_argument("--loop", action="store_true")
    arguments = parser.parse_args()
    work = Path(tempfile.mkdtemp(prefix="gaitwright-many-"))
    try:
        make_archive(work / "archive", arguments.count)
        bench = Bench(arguments.bin_folder, work)
        if arguments.loop:
            bench.against_loop()
        else:
            bench.first_and_second(arguments.count)
            bench.equality()
    finally:
        shutil.rmtree(work)


if __name__ == "__main__":
    sys.exit(main())
