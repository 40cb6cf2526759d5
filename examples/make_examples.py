#!/usr/bin/env python3
"""Writes the example motions of this folder: a walk and a wave, made up from a few sines.

    python3 examples/make_examples.py
"""
import math
import os

HERE = os.path.dirname(os.path.abspath(__file__))

# name, offset in centimetres, children; None is an end site
POSER = ("hip", (0, 92, 0), [
    ("abdomen", (0, 9, 0), [("chest", (0, 15, 0), [
        ("neck", (0, 27, 0), [("head", (0, 9, 0.9), [(None, (0, 18, 1.8), [])])]),
        ("lCollar", (3, 22, 0), [("lShldr", (14, 0, 0), [("lForeArm", (28, 0, 0), [("lHand", (25, 0, 0), [
            (None, (16, 0, 0), [])])])])]),
        ("rCollar", (-3, 22, 0), [("rShldr", (-14, 0, 0), [("rForeArm", (-28, 0, 0), [("rHand", (-25, 0, 0), [
            (None, (-16, 0, 0), [])])])])])])]),
    ("lThigh", (9, -2, 0), [("lShin", (0, -43, 0), [("lFoot", (0, -40, 0), [(None, (0, -7, 15), [])])])]),
    ("rThigh", (-9, -2, 0), [("rShin", (0, -43, 0), [("rFoot", (0, -40, 0), [(None, (0, -7, 15), [])])])])])

MAX = ("Hips", (0, 92, 0), [
    ("Chest", (0, 12, 0), [
        ("Neck", (0, 40, 0), [("Head", (0, 9, 0.9), [(None, (0, 18, 1.8), [])])]),
        ("LeftCollar", (3, 34, 0), [("LeftShoulder", (14, 0, 0), [("LeftElbow", (0, -28, 0), [
            ("LeftWrist", (0, -25, 0), [(None, (0, -16, 0), [])])])])]),
        ("RightCollar", (-3, 34, 0), [("RightShoulder", (-14, 0, 0), [("RightElbow", (0, -28, 0), [
            ("RightWrist", (0, -25, 0), [(None, (0, -16, 0), [])])])])])]),
    ("LeftHip", (9, -2, 0), [("LeftKnee", (0, -43, 0), [("LeftAnkle", (0, -40, 0), [(None, (0, -7, 15), [])])])]),
    ("RightHip", (-9, -2, 0), [("RightKnee", (0, -43, 0), [("RightAnkle", (0, -40, 0), [(None, (0, -7, 15), [])])])])])


STEP_SECONDS, STRIDE = 1.1, 112.0  # of two steps
ANKLE, TOE, HEEL = 7.0, 15.0, 4.0  # height of the ankle; the sole's ends ahead of it and behind
THIGH, SHIN = 43.0, 40.0
FLAT, LIFT, SWING = 0.07, 0.40, 0.62  # parts of a foot's cycle, which begins as the heel strikes


def rotation(z, x, y):
    """Return the matrix of a joint's three rotation channels, in degrees; it multiplies column vectors."""
    (sz, cz), (sx, cx), (sy, cy) = ((math.sin(math.radians(a)), math.cos(math.radians(a))) for a in (z, x, y))
    return ((cz * cy - sz * sx * sy, -sz * cx, cz * sy + sz * sx * cy),
            (sz * cy + cz * sx * sy, cz * cx, sz * sy - cz * sx * cy), (-cx * sy, sx, cx * cy))


def angles(m):
    """The degrees about X, Y and Z of such a matrix."""
    return tuple(math.degrees(a) for a in (math.asin(max(-1.0, min(1.0, m[2][1]))), math.atan2(-m[2][0], m[2][2]),
                                           math.atan2(-m[0][1], m[1][1])))


def times(a, b):
    return tuple(tuple(sum(a[i][k] * b[k][j] for k in range(3)) for j in range(3)) for i in range(3))


def turned(m, v):
    return [sum(row[k] * v[k] for k in range(3)) for row in m]


def transposed(m):
    return tuple(zip(*m))


def smooth(x):
    return x * x * (3 - 2 * x)


def rolled(ball, lever, pitch):
    """Height and depth of the ankle when the foot is pitched about a point of its sole."""
    sine, cosine = math.sin(math.radians(pitch)), math.cos(math.radians(pitch))
    return ANKLE * cosine + lever * sine, ball - lever * cosine + ANKLE * sine


def ankle(cycles):
    """Height, depth and pitch of an ankle: the foot rolls over heel and toe, and in between it does not move."""
    step, part = math.floor(cycles), cycles % 1
    at = step * STRIDE + 30
    if part < FLAT:
        pitch = -18 * (1 - smooth(part / FLAT))
        return (*rolled(at - HEEL, -HEEL, pitch), pitch)
    if part < LIFT:
        return ANKLE, at, 0.0
    if part < SWING:
        pitch = 42 * smooth((part - LIFT) / (SWING - LIFT))
        return (*rolled(at + TOE, TOE, pitch), pitch)
    share = (part - SWING) / (1 - SWING)
    (high, behind), (low, ahead) = rolled(at + TOE, TOE, 42), rolled(at + STRIDE - HEEL, -HEEL, -18)
    return (high + (low - high) * smooth(share) + 6 * math.sin(math.pi * share) ** 2,
            behind + (ahead - behind) * smooth(share), 42 - 60 * smooth(min(1.0, 1.15 * share)))


def leg(cycles, late, side, position, pelvis):
    """Degrees of thigh, shin and foot that put the ankle in its place; `late` is when the cycles of the foot begin."""
    height, depth, pitch = ankle(cycles - late)
    depth += late * STRIDE
    hip = [p + o for p, o in zip(position, turned(pelvis, (9 * side, -2, 0)))]
    x, y, z = turned(transposed(pelvis), (7 * side - hip[0], height - hip[1], depth - hip[2]))
    sideways, down = math.degrees(math.atan2(x, -y)), math.hypot(x, y)
    reach = min(math.hypot(down, z), 0.999 * (THIGH + SHIN))
    bend = lambda a, b, c: math.degrees(math.acos((a * a + b * b - c * c) / (2 * a * b)))
    thigh = -math.degrees(math.atan2(z, down)) - bend(THIGH, reach, SHIN)
    shin = 180 - bend(THIGH, SHIN, reach)
    above = times(pelvis, rotation(sideways, thigh + shin, 0))
    return (thigh, 0, sideways), (shin, 0, 0), angles(times(transposed(above), rotation(0, pitch, 0)))


def walk(seconds):
    """Degrees about X, Y and Z by joint, and the root's position: one step in half a second and a bit. The feet
    stay where they are planted."""
    cycles = seconds / STEP_SECONDS
    phase = 2 * math.pi * cycles
    swing = math.sin(phase)
    position = (1.5 * math.cos(phase), 88.2 + 1.2 * math.cos(2 * phase), STRIDE * cycles)
    pelvis = rotation(0, 0, -5 * swing)
    joints = {
        "abdomen": (2, 4 * swing, 0), "chest": (3, 4 * swing, 0), "neck": (-2, -4 * swing, 0), "head": (2, -3 * swing, 0),
        "lShldr": (0, 22 * swing, -70), "rShldr": (0, 22 * swing, 70),
        "lForeArm": (0, -18 + 8 * swing, 0), "rForeArm": (0, 18 + 8 * swing, 0),
        "hip": (0, -5 * swing, 0),
    }
    for name, side, late in (("l", 1, 0.25), ("r", -1, 0.75)):
        bones = leg(cycles, late, side, position, pelvis)
        joints.update(zip((name + "Thigh", name + "Shin", name + "Foot"), bones))
    return joints, position


def wave(seconds):
    """Standing, the right arm up and waving."""
    beat, up = math.sin(2 * math.pi * 1.5 * seconds), min(1.0, seconds / 0.5)
    joints = {
        "Chest": (0, 3 * beat * up, 2 * beat * up), "Neck": (0, -6 * up, 0), "Head": (4 * up, -8 * up, 0),
        "LeftShoulder": (0, 0, 5), "LeftElbow": (-12, 0, 0),
        "RightShoulder": (-10 * up, 0, -120 * up), "RightElbow": (0, 0, (-35 + 25 * beat) * up),
        "RightWrist": (0, 0, 12 * beat * up),
        "LeftHip": (-2, 0, 2), "RightHip": (-2, 0, -2), "LeftKnee": (4, 0, 0), "RightKnee": (4, 0, 0),
        "LeftAnkle": (-2, 0, -2), "RightAnkle": (-2, 0, 2),
    }
    return joints, (0.8 * beat * up, 91.6, 0)


def number(x):
    return "%.4f" % (x + 0.0)


def hierarchy(joint, lines, order, indent=""):
    name, offset, children = joint
    word = "End Site" if name is None else ("ROOT " if not indent else "JOINT ") + name
    lines += [indent + word, indent + "{", indent + "    OFFSET " + " ".join(number(x) for x in offset)]
    if name is not None:
        channels = "Zrotation Xrotation Yrotation"
        lines.append(indent + ("    CHANNELS 3 " + channels if indent else
                               "    CHANNELS 6 Xposition Yposition Zposition " + channels))
        order.append(name)
    for child in children:
        hierarchy(child, lines, order, indent + "    ")
    lines.append(indent + "}")


def write(file_name, skeleton, motion, frames, rate):
    lines, order = ["HIERARCHY"], []
    hierarchy(skeleton, lines, order)
    lines += ["MOTION", "Frames: %d" % frames, "Frame Time: %.7f" % (1.0 / rate)]
    rest = skeleton[1]
    for frame in range(frames):
        joints, position = motion(frame / rate)
        row = [number(p - r) for p, r in zip(position, rest)]
        for name in order:
            x, y, z = joints.get(name, (0, 0, 0))
            row += [number(z), number(x), number(y)]
        lines.append(" ".join(row))
    with open(os.path.join(HERE, file_name), "w", newline="\n") as out:
        out.write("\n".join(lines) + "\n")


write("walk.bvh", POSER, walk, 67, 30)
write("wave.bvh", MAX, wave, 90, 30)
