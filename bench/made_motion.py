"""Generates motions of any number of joints and frames, and a matching profile."""
import math

SIDES = ("Left", "Right")


USUAL_JOINTS = 75


def joints(count=USUAL_JOINTS):
    """Returns name, parent and offset: a body of 21 joints, fingers if there are 61 or more, then chains of five."""
    out = [("Hips", None, (0, 95, 0)), ("Spine", "Hips", (0, 11, 0)), ("Spine1", "Spine", (0, 16, 0)),
           ("Neck", "Spine1", (0, 25, 0)), ("Head", "Neck", (0, 10, 1))]
    for side, sign in zip(SIDES, (1, -1)):
        arm = [("Shoulder", (3, 22, 0)), ("Arm", (14, 0, 0)), ("ForeArm", (28, 0, 0)), ("Hand", (25, 0, 0))]
        leg = [("UpLeg", (9, -4, 0)), ("Leg", (0, -43, 0)), ("Foot", (0, -40, 0)), ("ToeBase", (0, -7, 14))]
        for parent, chain in (("Spine1", arm), ("Hips", leg)):
            for name, (x, y, z) in chain:
                out.append((side + name, parent, (sign * x, y, z)))
                parent = side + name
        for finger in range(5 if count >= 61 else 0):
            parent = side + "Hand"
            for link in range(4):
                out.append(("%sFinger%d%d" % (side, finger, link), parent, (sign * 4, 0, 2 * (finger - 2))))
                parent = out[-1][0]
    first = len(out)
    while len(out) < count:
        parent = "Head" if (len(out) - first) % 5 == 0 else out[-1][0]
        out.append(("Extra%02d" % len(out), parent, (0, 5, 1)))
    return out


def write_motion(path, megabytes=0, frames=0, count=USUAL_JOINTS):
    """Writes a motion of a given size or frame count. Every joint rotates about all axes."""
    table = joints(count)
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
    frames = frames or max(2, int(megabytes * 1e6 / len(row(7))))
    with open(path, "w") as out:
        out.write("\n".join(lines) + "\nMOTION\nFrames: %d\nFrame Time: 0.0083333\n" % frames)
        for first in range(0, frames, 1000):
            out.write("\n".join(row(f) for f in range(first, min(frames, first + 1000))) + "\n")


PROFILE_ROWS = [("Hips", "LowerTorso", "0,0,0,1,2,3"), ("Spine1", "UpperTorso", "0,0,0,1,2,3"), ("Neck", "Neck", "0,0,0,-3,2,1")]


def write_profile(path):
    rows = ["%s <---> %s %s" % row for row in PROFILE_ROWS]
    pairs = [("Shoulder", "Collar"), ("Arm", "UpperArm"), ("ForeArm", "Forearm"), ("UpLeg", "Thigh"), ("Leg", "Calf"),
             ("Foot", "Foot")]
    for side in SIDES:
        rows += ["%s%s <---> %s%s 0,0,0,1,2,3" % (side, source, side[0], target) for source, target in pairs]
        rows.append("* %sPelvis . .1,2,3" % side[0])
    with open(path, "w") as out:
        out.write("\n".join(["Benchmark", "FrameRate 120", "Position 0 0 0"] + rows) + "\n")
