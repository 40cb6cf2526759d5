#!/usr/bin/env python3
"""Measures whole processes in turns, so that a noisy machine slows both sides alike, and prints ratios of CPU time.

    bench/whole_process.py BIN_FOLDER [--runs N] [--mb 100]

Converts a made motion of 75 joints (profile rate 120, so that every frame is written once) and lets another library
only load the same file. Prints the median of each, their ratio, and the peak memory as a multiple of the file.
"""
import argparse
import math
import os
import statistics
import subprocess
import sys
import tempfile

SIDES = ("Left", "Right")


def joints():
    """Name, parent and offset of 75 joints: a body of 25, four helpers a limb, and hands of 15."""
    out = [("Hips", None, (0, 95, 0)), ("Spine", "Hips", (0, 11, 0)), ("Chest", "Spine", (0, 16, 0)),
           ("Neck", "Chest", (0, 25, 0)), ("Head", "Neck", (0, 10, 1))]
    for side, sign in zip(SIDES, (1, -1)):
        arm = [("Collar", (3, 22, 0)), ("Shoulder", (14, 0, 0)), ("Elbow", (28, 0, 0)), ("Wrist", (25, 0, 0))]
        leg = [("Hip", (9, -4, 0)), ("Knee", (0, -43, 0)), ("Ankle", (0, -40, 0)), ("Toe", (0, -7, 14))]
        for parent, chain in (("Chest", arm), ("Hips", leg)):
            for name, (x, y, z) in chain:
                out.append((side + name, parent, (sign * x, y, z)))
                parent = side + name
        for finger in range(5):
            parent = side + "Wrist"
            for link in range(4):
                out.append(("%sFinger%d%d" % (side, finger, link), parent, (sign * 4, 0, 2 * (finger - 2))))
                parent = out[-1][0]
    while len(out) < 75:
        out.append(("Extra%02d" % len(out), "Head", (0, 5, len(out) - 65)))
    return out


def write_motion(path, megabytes):
    table = joints()
    lines = ["HIERARCHY"]

    def body(name, parent, offset, indent):
        lines.append(indent + ("JOINT " if parent else "ROOT ") + name)
        lines.append(indent + "{")
        lines.append(indent + "  OFFSET %g %g %g" % offset)
        rotations = "Zrotation Xrotation Yrotation"
        lines.append(indent + ("  CHANNELS 3 " if parent else "  CHANNELS 6 Xposition Yposition Zposition ") + rotations)
        below = [j for j in table if j[1] == name]
        for child in below:
            body(*child, indent + "  ")
        if not below:
            lines.append(indent + "  End Site")
            lines.append(indent + "  {\n" + indent + "    OFFSET 0 5 0\n" + indent + "  }")
        lines.append(indent + "}")

    body(*table[0], "")
    row = lambda f: "%.6f %.6f %.6f " % (math.sin(f / 30), math.cos(f / 30), f / 50) + " ".join(
        "%.6f" % (25 * math.sin(f / (20 + i % 17) + i)) for i in range(3 * len(table)))
    frames = max(2, int(megabytes * 1e6 / len(row(7))))
    with open(path, "w") as out:
        out.write("\n".join(lines) + "\nMOTION\nFrames: %d\nFrame Time: 0.0083333\n" % frames)
        for first in range(0, frames, 1000):
            out.write("\n".join(row(f) for f in range(first, min(frames, first + 1000))) + "\n")


PROFILE_ROWS = [("Hips", "LowerTorso", "0,0,0,1,2,3"), ("Chest", "UpperTorso", "0,0,0,1,2,3"), ("Neck", "Neck", "0,0,0,-3,2,1")]


def write_profile(path):
    rows = ["%s <---> %s %s" % row for row in PROFILE_ROWS]
    pairs = [("Collar", "Collar"), ("Shoulder", "UpperArm"), ("Elbow", "Forearm"), ("Hip", "Thigh"), ("Knee", "Calf"),
             ("Ankle", "Foot")]
    for side in SIDES:
        rows += ["%s%s <---> %s%s 0,0,0,1,2,3" % (side, source, side[0], target) for source, target in pairs]
        rows.append("* %sPelvis . .1,2,3" % side[0])
    with open(path, "w") as out:
        out.write("\n".join(["Benchmark", "FrameRate 120", "Position 0 0 0"] + rows) + "\n")


def run(command):
    """CPU seconds and peak kilobytes of one process."""
    with subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL) as process:
        _, status, usage = os.wait4(process.pid, 0)
        process.returncode = os.waitstatus_to_exitcode(status)
    if process.returncode:
        sys.exit("failed: " + " ".join(command))
    return usage.ru_utime + usage.ru_stime, usage.ru_maxrss


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("bin")
    parser.add_argument("--runs", type=int, default=5)
    parser.add_argument("--mb", type=float, nargs="*", default=[0.1, 1.5, 100])
    options = parser.parse_args()
    with tempfile.TemporaryDirectory() as folder:
        profile = os.path.join(folder, "bench.prf")
        write_profile(profile)
        print("%8s %12s %12s %8s %14s" % ("file", "convert", "other load", "ratio", "peak / file"))
        for megabytes in options.mb:
            motion = os.path.join(folder, "motion.bvh")
            write_motion(motion, megabytes)
            convert = [os.path.join(options.bin, "gaitwright"), "convert", motion, "-o",
                       os.path.join(folder, "out.Kinetra"), "--profile", profile, "--force", "--quiet"]
            load = [os.path.join(options.bin, "load_baseline"), motion]
            runs = options.runs if megabytes > 10 else options.runs * 4
            ours, others = zip(*((run(convert), run(load)) for _ in range(runs)))
            a, b = (statistics.median(seconds for seconds, _ in side) for side in (ours, others))
            peak = max(kilobytes for _, kilobytes in ours) * 1024 / os.path.getsize(motion)
            print("%5g MB %10.3f s %10.3f s %8.2f %14.2f" % (megabytes, a, b, a / b, peak))


if __name__ == "__main__":
    main()
