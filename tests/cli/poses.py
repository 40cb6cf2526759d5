"""World poses of HTR files, for comparing two of them by what they show and not by their angles."""
import math


def axis_rotation(axis, degrees):
    """Row vectors: a positive turn about Z takes x to y."""
    c, s = math.cos(math.radians(degrees)), math.sin(math.radians(degrees))
    rows = [[1.0, 0.0, 0.0], [0.0, 1.0, 0.0], [0.0, 0.0, 1.0]]
    i, j = (axis + 1) % 3, (axis + 2) % 3
    rows[i][i], rows[i][j], rows[j][i], rows[j][j] = c, s, -s, c
    return rows


def times(a, b):
    columns = list(zip(*b))
    return [[x * c[0] + y * c[1] + z * c[2] for c in columns] for x, y, z in a]


class Htr:
    def __init__(self, path):
        sections = {}
        for line in path.read_text(encoding="latin-1").splitlines():
            if line.startswith("["):
                rows = sections.setdefault(line[1:line.index("]")], [])
            elif line and not line.startswith("#"):
                rows.append(line.split())
        self.header = dict(row[:2] for row in sections.pop("Header"))
        self.parents = dict(sections.pop("SegmentNames&Hierarchy"))
        self.base = {row[0]: [float(x) for x in row[1:7]] for row in sections.pop("BasePosition")}
        self.keys = {name: [[float(x) for x in row[1:8]] for row in rows] for name, rows in sections.items()}
        assert self.header["EulerRotationOrder"] == "ZYX"
        self.frames = min(len(self.keys[name]) for name in self.parents)

    def local(self, name, frame):
        key = [b + k for b, k in zip(self.base[name], self.keys[name][frame])]
        about_x, about_y, about_z = (axis_rotation(axis, key[3 + axis]) for axis in range(3))
        return times(about_x, times(about_y, about_z)), key[:3]

    def world(self, frame):
        """Rotation and place of every bone; parents stand before their children."""
        pose = {}
        for name, parent in self.parents.items():
            rotation, place = self.local(name, frame)
            if parent in pose:
                above, origin = pose[parent]
                place = [x + y for x, y in zip(times([place], above)[0], origin)]
                rotation = times(rotation, above)
            pose[name] = rotation, place
        return pose


def angle_between(a, b):
    """Degrees. By the distance of the matrices, since the trace is blind to small angles."""
    squares = sum((x - y) ** 2 for r, s in zip(a, b) for x, y in zip(r, s))
    return math.degrees(2 * math.asin(min(1.0, math.sqrt(squares / 8))))


def worst_difference(a, b):
    """The largest distance and the largest angle between two motions of one skeleton."""
    distance = angle = 0.0
    for frame in range(a.frames):
        one, two = a.world(frame), b.world(frame)
        for name, (rotation, place) in one.items():
            distance = max(distance, math.dist(place, two[name][1]))
            angle = max(angle, angle_between(rotation, two[name][0]))
    return distance, angle
