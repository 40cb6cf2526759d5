#!/usr/bin/env python3
"""Measures whole processes in turns, so that a noisy machine slows both sides alike, and prints ratios of CPU time.

    bench/whole_process.py BIN_FOLDER [--what convert|info|choose] [--mb 0.1 1.5 100] [--runs N] [--out FOLDER]

convert  a made motion of 75 joints by a profile given as a file whose rate is 120, so that every frame is written once
info     what the motion holds
choose   a conversion without --profile, which judges all installed ones, against one by the name of what it chooses

Against the first two another library only loads the same file. Prints the median of each, the median of the ratios of
neighbours, and the peak memory, also as a multiple of the file. Results go to the folder, or to the temporary one.
"""
import argparse
import os
import statistics
import subprocess
import sys
import tempfile

from made_motion import write_motion, write_profile

CHOSEN = "MotionBuilder / HumanIK (2 spine joints, fingers)"
LEAST_RUNS_BYTES = 10e6  # a smaller file takes so little time that it is run ten times as often


def run(command):
    """CPU seconds of one process."""
    with subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL) as process:
        _, status, usage = os.wait4(process.pid, 0)
        process.returncode = os.waitstatus_to_exitcode(status)
    if process.returncode:
        sys.exit("failed: " + " ".join(command))
    return usage.ru_utime + usage.ru_stime


def peak_of(command):
    """Peak bytes; by a small program, since a process begins with the peak of the one that starts it."""
    done = subprocess.run(["/usr/bin/time", "-f", "%M", *command], stdout=subprocess.DEVNULL, stderr=subprocess.PIPE)
    return int(done.stderr.split()[-1]) * 1024


def compare(name, path, ours, others, runs):
    runs *= 1 if os.path.getsize(path) > LEAST_RUNS_BYTES else 10
    run(ours), run(others)  # from here on both files are in memory
    a, b = zip(*((run(ours), run(others)) for _ in range(runs)))
    ratio = statistics.median(x / y for x, y in zip(a, b))
    peak = peak_of(ours)
    print("%-16s %9.4f s %9.4f s %7.2f %9.1f MB %8.2f" %
          (name, statistics.median(a), statistics.median(b), ratio, peak / 1e6, peak / os.path.getsize(path)), flush=True)


def measure(folder, options):
    tool, motion, profile = os.path.join(options.bin, "gaitwright"), folder + "/motion.bvh", folder + "/bench.prf"
    choose = [tool, "convert", motion, "-o", (options.out or folder) + "/bench.Kinetra", "--force", "--quiet"]
    load = [os.path.join(options.bin, "load_baseline"), motion]
    commands = {"convert": (choose + ["--profile", profile], load), "info": ([tool, "info", motion], load),
                "choose": (choose, choose + ["--profile", CHOSEN])}
    write_profile(profile)
    print("%-16s %11s %11s %7s %12s %8s" % ("", "gaitwright", "other", "ratio", "peak", "/ file"))
    for megabytes in options.mb:
        write_motion(motion, megabytes)
        for what in options.what:
            compare("%s %g MB" % (what, megabytes), motion, *commands[what], options.runs)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("bin")
    parser.add_argument("--what", nargs="*", default=["convert"], choices=["convert", "choose", "info"])
    parser.add_argument("--mb", type=float, nargs="*", default=[0.1, 1.5, 100])
    parser.add_argument("--runs", type=int, default=5)
    parser.add_argument("--out")
    with tempfile.TemporaryDirectory() as folder:
        measure(folder, parser.parse_args())


if __name__ == "__main__":
    main()
