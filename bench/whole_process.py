#!/usr/bin/env python3
"""Measures whole processes alternately, so that a noisy machine slows both sides alike, and prints ratios of CPU time.

    bench/whole_process.py BIN_FOLDER [--what LINE ...] [--mb 0.1 1.5 100] [--joints 75] [--frames N] [--runs N] [--out FOLDER]

one       a generated motion of 75 joints, with a bone map given as a file. Its rate is 120: one row per source frame
four      with an installed map given by name. Its rate is 30, as in all installed ones: four rows per source frame
chosen    without --profile: the program chooses the same map among all installed ones
faithful  as "one", with --align --faithful
info      prints facts about the motion
choice    "chosen" compared with "four": the cost of choosing

The other side only loads the same file with another library, except for "choice". Prints the median of each side, the
median of the ratios of neighbors, and the peak memory, also as a multiple of the file. Results go to the folder, by
default a temporary one.
"""
import argparse
import os
import shutil
import statistics
import subprocess
import sys
import tempfile

from made_motion import USUAL_JOINTS, write_motion, write_profile

INSTALLED = "MotionBuilder / HumanIK (2 spine joints, fingers)"  # chosen for the generated motion
LINES = ["one", "four", "chosen", "faithful", "info", "choice"]
LEAST_RUNS_BYTES = 10e6  # a smaller file takes so little time that it is run ten times as often


def run(command):
    """Runs one process and returns its CPU seconds."""
    with subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL) as process:
        _, status, usage = os.wait4(process.pid, 0)
        process.returncode = os.waitstatus_to_exitcode(status)
    if process.returncode:
        sys.exit("failed: " + " ".join(command))
    return usage.ru_utime + usage.ru_stime


def peak_of(command):
    """Returns the peak memory in bytes. Uses a small program, because a process starts with its parent's peak."""
    done = subprocess.run(["/usr/bin/time", "-f", "%M", *command], stdout=subprocess.DEVNULL, stderr=subprocess.PIPE)
    return int(done.stderr.split()[-1]) * 1024


def compare(name, path, ours, others, runs):
    runs *= 1 if os.path.getsize(path) > LEAST_RUNS_BYTES else 10
    run(ours), run(others)  # afterwards, both files are in memory
    a, b = zip(*((run(ours), run(others)) for _ in range(runs)))
    ratio = statistics.median(x / y for x, y in zip(a, b))
    peak = peak_of(ours)
    print("%-16s %9.4f s %9.4f s %7.2f %9.1f MB %8.2f" %
          (name, statistics.median(a), statistics.median(b), ratio, peak / 1e6, peak / os.path.getsize(path)), flush=True)


def installed(build, folder):
    """Copies the built programs and their files to a folder, like an installer, and returns the path of the copy.

    A linker writes a program in many small pieces, and the system keeps it in memory as such until it is read from the
    disk again. Starting it then takes longer, by 0.05 of the time of a small load.
    """
    return shutil.copytree(build, folder + "/bin", ignore=shutil.ignore_patterns("*_tests", "*_bench"))


def commands(folder, options):
    """Returns both sides of every line."""
    programs, motion, profile = installed(options.bin, folder), folder + "/motion.bvh", folder + "/bench.prf"
    write_profile(profile)
    tool, load = programs + "/gaitwright", [programs + "/load_baseline", motion]
    chosen = [tool, "convert", motion, "-o", (options.out or folder) + "/bench.Kinetra", "--force", "--quiet"]
    one, four = chosen + ["--profile", profile], chosen + ["--profile", INSTALLED]
    return {"one": (one, load), "four": (four, load), "chosen": (chosen, load),
            "faithful": (one + ["--align", "--faithful"], load), "info": ([tool, "info", motion], load),
            "choice": (chosen, four)}


def measure(folder, options):
    sides = commands(folder, options)
    print("%-16s %11s %11s %7s %12s %8s" % ("", "gaitwright", "other", "ratio", "peak", "/ file"))
    for megabytes in options.mb:
        motion = folder + "/motion.bvh"
        write_motion(motion, megabytes, options.frames, options.joints)
        for what in options.what:
            compare("%s %.3g MB" % (what, os.path.getsize(motion) / 1e6), motion, *sides[what], options.runs)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("bin")
    parser.add_argument("--what", nargs="*", default=LINES[:4], choices=LINES)
    parser.add_argument("--mb", type=float, nargs="*", default=[0.1, 1.5, 100])
    parser.add_argument("--joints", type=int, default=USUAL_JOINTS)
    parser.add_argument("--frames", type=int, default=0, help="in place of --mb")
    parser.add_argument("--runs", type=int, default=5)
    parser.add_argument("--out")
    options = parser.parse_args()
    options.mb = [0] if options.frames else options.mb
    with tempfile.TemporaryDirectory() as folder:
        measure(folder, options)


if __name__ == "__main__":
    main()
