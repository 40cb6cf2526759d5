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


def walk(seconds):
    """Degrees about X, Y and Z by joint, and the root's position: one step a second and a tenth."""
    phase = 2 * math.pi * seconds / 1.1
    swing, knee = math.sin(phase), lambda p: max(0.0, math.sin(p)) * 55 + 6
    joints = {
        "abdomen": (2, 4 * swing, 0), "chest": (3, 4 * swing, 0), "neck": (-2, -4 * swing, 0), "head": (2, -3 * swing, 0),
        "lShldr": (0, -22 * swing, -70), "rShldr": (0, -22 * swing, 70),
        "lForeArm": (0, -18 - 8 * swing, 0), "rForeArm": (0, 18 - 8 * swing, 0),
        "lThigh": (-26 * swing, 0, 0), "rThigh": (26 * swing, 0, 0),
        "lShin": (knee(phase + 0.9), 0, 0), "rShin": (knee(phase + 0.9 + math.pi), 0, 0),
        "lFoot": (8 * math.cos(phase), 0, 0), "rFoot": (-8 * math.cos(phase), 0, 0),
        "hip": (0, -5 * swing, 0),
    }
    return joints, (2 * math.cos(phase), 89 + 1.5 * math.cos(2 * phase), 120 * seconds)


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
