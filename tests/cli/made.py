"""Small files that the tests make themselves."""
import struct
import sys
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
PAGES = PROJECT / "docs" / "formats"
sys.path.append(str(PROJECT / "tests" / "docs"))
from page import content_of, read_page  # noqa: E402

# Two joints, three frames: the least that has a tree, rows and an end.
BVH = """HIERARCHY
ROOT Hips
{
  OFFSET 0 0 0
  CHANNELS 6 Xposition Yposition Zposition Zrotation Xrotation Yrotation
  JOINT Chest
  {
    OFFSET 0 10 0
    CHANNELS 3 Zrotation Xrotation Yrotation
    End Site
    {
      OFFSET 0 5 0
    }
  }
}
MOTION
Frames: 3
Frame Time: 0.0333333
0 90 0 0 0 0 0 0 0
1 90 0 0 0 0 90 0 0
2 90 0 0 0 0 0 0 90
"""


def page_file(name):
    """Returns the bytes of the small file that the page on its format shows."""
    parts = read_page(PAGES / (name.split(".")[1] + ".md"))
    return next(content_of(part) for part in parts if getattr(part, "file", "") == name)


HTR = page_file("tiny.htr").decode()


def bvh(old, new):
    """The small motion with one text in it replaced."""
    assert BVH.count(old) >= 1, old
    return BVH.replace(old, new, 1)


def body(prefix="", spine=3, swapped=False, family="Spine"):
    """A human body in a T-pose that looks along z, in cm, by the names that most recorders give. Swapped, the
    left names lie on the right. The other family calls its spine Chest and its limbs by their joints."""
    names = {"Spine": "Shoulder Arm ForeArm Hand UpLeg Leg Foot ToeBase",
             "Chest": "Collar Shoulder Elbow Wrist Hip Knee Ankle Toe"}[family].split()
    limbs = [(4, 14, 0), (14, 0, 0), (28, 0, 0), (26, 0, 0), (9, -4, 0), (0, -42, 0), (0, -42, 0), (0, -7, 13)]

    def joint(name, offset, *below):
        text = "JOINT %s%s\n{\nOFFSET %g %g %g\nCHANNELS 3 Zrotation Xrotation Yrotation\n" % (prefix, name, *offset)
        end = "End Site\n{\nOFFSET %g %g %g\n}\n" % tuple(offset)
        return text + ("".join(below) or end) + "}\n"

    def chain(names, offsets):
        below = ()
        for name, offset in reversed(list(zip(names, offsets))):
            below = (joint(name, offset, *below),)
        return below[0]

    def sides(part):
        for side in (1, -1):
            word = "Left" if (side == 1) != swapped else "Right"
            yield chain([word + name for name in names[part]], [(side * x, y, z) for x, y, z in limbs[part]])

    top = [*sides(slice(4)), chain(["Neck", "Head"], [(0, 20, 0), (0, 9, 0)])]
    for number in reversed(range(spine)):
        name = family + (str(number + (family == "Chest")) if number else "")
        top = [joint(name, (0, 30 / spine, 0), *top)]
    hips = joint("Hips", (0, 0, 0), *sides(slice(4, 8)), *top).replace("JOINT", "ROOT", 1)
    hips = hips.replace("CHANNELS 3", "CHANNELS 6 Xposition Yposition Zposition", 1)
    count = hips.count("CHANNELS")
    row = "0 95 0" + " 0 0 0" * count + "\n"
    return "HIERARCHY\n" + hips + "MOTION\nFrames: 3\nFrame Time: 0.0333333\n" + 3 * row


def profile(name, rows, rate=30):
    lines = [name, "FrameRate %d" % rate, "Position 0 0 0"]
    lines += ["%s <---> %s 0,0,0,1,2,3" % row for row in rows]
    return "\n".join(lines) + "\n"


IDENTITY = [1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1]


def moved(x, y, z):
    return IDENTITY[:12] + [x, y, z, 1]


class Container:
    """Writes scene containers of nodes and tracks, record by record, with ids of the caller's choice."""

    def __init__(self):
        self.bytes = b"TKOrrin Version 1.20\0" + self.string("_OrrinThumbnail")
        self.bytes += struct.pack("<iiiHiiIIIBI", 0, 0, 0, 0, 96, 96, 0, 1, 0, 0, 0)

    @staticmethod
    def string(text):
        text = text if isinstance(text, bytes) else text.encode()
        return struct.pack("<I", len(text)) + text

    @staticmethod
    def floats(values):
        return struct.pack("<%df" % len(values), *values)

    def record(self, kind, number, name, links, body, root):
        self.bytes += self.string("_OrrinRoot") if root else b""
        self.bytes += self.string(kind) + struct.pack("<I", number) + self.string(name)
        self.bytes += struct.pack("<III", *links) + body
        return self

    def node(self, number, name="", matrix=IDENTITY, children=(), control=0, root=False):
        body = self.floats(matrix) + struct.pack("<BIIBBI", 1, 0, 1, 1, 1, len(children))
        body += struct.pack("<%dI" % len(children), *children)
        return self.record("CNode", number, name, (control, 0, 0), body, root)

    def track(self, number, target, positions, frame_seconds=0.5, name="CKeyFrameControl",
              end=None):
        count = len(positions)
        end = count - 1.0 if end is None else end
        body = struct.pack("<IffffBII", 0, 0.0, end, 0.0, frame_seconds, 1, target, 0)
        body += self.floats(IDENTITY) + struct.pack("<BII", 0, 0, count)
        body += b"".join(self.floats(p) for p in positions) + struct.pack("<II", 0, count)
        body += self.floats(range(count)) + struct.pack("<IIII", 0, 0, 0, 0)
        return self.record("CKeyframeControl", number, name, (0, 0, 0), body, False)


def one_bone_scene(frames=3, end=None):
    """A bone that rises, frames of half a second; without frames it ends before it begins."""
    scene = Container().node(1, "hip", control=2, root=True)
    return scene.track(2, 1, [(0, 90 + frame, 0) for frame in range(frames)], end=end).bytes
