#!/usr/bin/env python3
"""Measures how a conversion grows with joints and with frames, and draws it.

    bench/growth.py BIN_FOLDER [--svg FILE] [--runs N]

Uses the CPU time of whole processes: the minimum of several runs, alternating between all sizes, because other load
can only add time. For both series of sizes, prints each value, the fitted line and the largest deviation from it in
percent of the largest value.
"""
import argparse
import os
import statistics
import tempfile

from made_motion import write_motion, write_profile
from whole_process import run

JOINTS = (25, 50, 75, 100, 125, 150, 175, 200)
FRAMES = (1_000, 10_000, 25_000, 40_000, 55_000, 70_000, 85_000, 100_000)
FRAMES_OF_JOINTS, JOINTS_OF_FRAMES = 4_000, 25

WIDTH, HEIGHT, LEFT, TOP, GAP = 380, 250, 64, 44, 90
# Elements have colors for viewers that ignore styles; the style is for dark pages.
STYLE = """@media (prefers-color-scheme: dark) {
text { fill: #e6edf3 } .axis { stroke: #8b949e } .line { stroke: #58a6ff } .point { fill: #ffa657 } }"""
TEXT = 'font-family="sans-serif" font-size="13" fill="#24292f"'
AXIS = 'class="axis" fill="none" stroke="#57606a" stroke-width="%g"'


def fit(points):
    """Returns the least-squares line: offset, slope."""
    x, y = zip(*points)
    line = statistics.linear_regression(x, y)
    return line.intercept, line.slope


def residual(points):
    """Returns the largest deviation from the line, as a share of the largest value."""
    offset, slope = fit(points)
    return max(abs(y - offset - slope * x) for x, y in points) / max(y for _, y in points)


def steps(largest):
    """Returns round numbers from 0 up to at least the largest value."""
    step = next(s * 10 ** e for e in range(-3, 8) for s in (1, 2, 5) if largest / (s * 10 ** e) <= 6)
    return [step * i for i in range(int(-(-largest // step)) + 1)]


def panel(points, left, title, unit):
    across, up = steps(max(x for x, _ in points)), steps(max(y for _, y in points))
    at_x = lambda x: left + WIDTH * x / across[-1]
    at_y = lambda y: TOP + HEIGHT * (1 - y / up[-1])
    out = ['<text %s x="%d" y="%d">%s</text>' % (TEXT, left, TOP - 20, title)]
    for y in up:
        out.append('<path %s d="M%.1f %.1fh%d"/>' % (AXIS % 0.4, left, at_y(y), WIDTH))
        out.append('<text %s x="%.1f" y="%.1f" text-anchor="end">%g</text>' % (TEXT, left - 8, at_y(y) + 4, y))
    for x in across:
        out.append('<text %s x="%.1f" y="%d" text-anchor="middle">%s</text>' %
                   (TEXT, at_x(x), TOP + HEIGHT + 20, "{:,}".format(x)))
    out.append('<path %s d="M%d %dv%dh%d"/>' % (AXIS % 1, left, TOP, HEIGHT, WIDTH))
    offset, slope = fit(points)
    ends = [(x, offset + slope * x) for x in (0, across[-1])]
    out.append('<path class="line" stroke="#0969da" stroke-width="1.5" d="M%.1f %.1fL%.1f %.1f"/>' %
               tuple(p for x, y in ends for p in (at_x(x), at_y(y))))
    out += ['<circle class="point" fill="#bc4c00" cx="%.1f" cy="%.1f" r="3.5"/>' % (at_x(x), at_y(y)) for x, y in points]
    out.append('<text %s x="%d" y="%d" text-anchor="middle">%s</text>' % (TEXT, left + WIDTH // 2, TOP + HEIGHT + 42, unit))
    return out


def draw(path, panels):
    width, height = LEFT + len(panels) * (WIDTH + GAP) - GAP + 30, TOP + HEIGHT + 56
    out = ['<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 %d %d" role="img">' % (width, height),
           "<title>CPU seconds of a conversion over joints and over frames</title><style>%s</style>" % STYLE]
    for i, (points, title, unit) in enumerate(panels):
        out += panel(points, LEFT + i * (WIDTH + GAP), title, unit)
    with open(path, "w") as file:
        file.write("\n".join(out + ["</svg>"]) + "\n")


def measure(options, folder, sizes):
    """Returns the CPU seconds for sizes (frames, joints)."""
    profile, seconds = folder + "/bench.prf", {size: [] for size in sizes}
    write_profile(profile)
    for frames, joints in sizes:
        write_motion("%s/%d-%d.bvh" % (folder, frames, joints), frames=frames, count=joints)
    for _ in range(options.runs):
        for frames, joints in sizes:
            command = [options.bin + "/gaitwright", "convert", "%s/%d-%d.bvh" % (folder, frames, joints), "-o",
                       folder + "/out.Kinetra", "--profile", profile, "--force", "--quiet"]
            seconds[frames, joints].append(run(command))
    return [min(seconds[size]) for size in sizes]


def report(name, points):
    offset, slope = fit(points)
    print("%s: %s" % (name, ", ".join("%d: %.3f s" % point for point in points)))
    print("  line: %.4f s + %.3f us each; the worst size lies %.1f %% of the largest value off" %
          (offset, slope * 1e6, 100 * residual(points)))


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("bin")
    parser.add_argument("--svg")
    parser.add_argument("--runs", type=int, default=5)
    options = parser.parse_args()
    options.bin = os.path.abspath(options.bin)
    with tempfile.TemporaryDirectory() as folder:
        by_joints = list(zip(JOINTS, measure(options, folder, [(FRAMES_OF_JOINTS, joints) for joints in JOINTS])))
        by_frames = list(zip(FRAMES, measure(options, folder, [(frames, JOINTS_OF_FRAMES) for frames in FRAMES])))
    report("joints", by_joints)
    report("frames", by_frames)
    if options.svg:
        draw(options.svg, [(by_joints, "CPU seconds, %d frames" % FRAMES_OF_JOINTS, "joints"),
                           (by_frames, "CPU seconds, %d joints" % JOINTS_OF_FRAMES, "frames")])


if __name__ == "__main__":
    main()
