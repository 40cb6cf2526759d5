"""Small glTF models of a walking body, and where its joints must be: computed here, not by any library."""
import json
import math
import struct

SIDES = (("Left", 1), ("Right", -1))
# Name, parent and offset in meters; Y is up, the body faces Z.
BODY = [("Hips", None, (0, 1, 0)), ("Spine", "Hips", (0, .2, 0)), ("Neck", "Spine", (0, .3, 0)),
        ("Head", "Neck", (0, .1, .02))]
for side, x in SIDES:
    BODY += [(side + name, side + above if above in ("Arm", "ForeArm", "UpLeg", "Leg", "Foot") else above, offset)
             for name, above, offset in (
                 ("Arm", "Spine", (.17 * x, .25, 0)), ("ForeArm", "Arm", (.28 * x, 0, 0)), ("Hand", "ForeArm", (.25 * x, 0, 0)),
                 ("UpLeg", "Hips", (.1 * x, -.05, 0)), ("Leg", "UpLeg", (0, -.42, 0)), ("Foot", "Leg", (0, -.42, 0)),
                 ("ToeBase", "Foot", (0, -.08, .13)))]
SWINGS = {"Spine": (1, 5), "LeftArm": (2, -60), "RightArm": (2, 60), "LeftUpLeg": (0, 30), "RightUpLeg": (0, -30),
          "LeftLeg": (0, 25), "RightLeg": (0, 25)}  # axis and degrees
FRAMES, RATE = 31, 30


def turn(axis, degrees):
    half = math.radians(degrees) / 2
    return [math.sin(half) * (i == axis) for i in range(3)] + [math.cos(half)]


def matrix(translation, rotation, scale):
    x, y, z, w = rotation
    rows = [[1 - 2 * (y * y + z * z), 2 * (x * y - z * w), 2 * (x * z + y * w)],
            [2 * (x * y + z * w), 1 - 2 * (x * x + z * z), 2 * (y * z - x * w)],
            [2 * (x * z - y * w), 2 * (y * z + x * w), 1 - 2 * (x * x + y * y)]]
    return [[rows[i][j] * scale[j] for j in range(3)] + [translation[i]] for i in range(3)] + [[0, 0, 0, 1]]


def product(a, b):
    return [[sum(a[i][k] * b[k][j] for k in range(4)) for j in range(4)] for i in range(4)]


def inverse(m):
    """Of a matrix without shear: its columns are perpendicular."""
    squares = [sum(m[i][j] ** 2 for i in range(3)) for j in range(3)]
    rows = [[m[i][j] / squares[j] for i in range(3)] for j in range(3)]
    return [row + [-sum(row[i] * m[i][3] for i in range(3))] for row in rows] + [[0, 0, 0, 1]]


class Model:
    """Nodes, clips and skins as glTF has them. A body hangs below an armature, whose placement is given."""

    def __init__(self, rotation=(0, 0, 0, 1), scale=(1, 1, 1), size=1, names=lambda name: name):
        self.nodes, self.parents, self.bytes, self.tree = [], [], b"", {"bufferViews": [], "accessors": []}
        self.keys, self.joints = {}, {}
        self.add("Armature", None, rotation=list(rotation), scale=list(scale))
        for name, above, offset in BODY:
            self.joints[name] = self.add(names(name), self.joints.get(above, 0), [size * v for v in offset])

    def add(self, name, parent, translation=(0, 0, 0), **placement):
        node = {"translation": list(translation), "rotation": [0, 0, 0, 1], "scale": [1, 1, 1], **placement}
        self.nodes.append(node | ({} if name is None else {"name": name}))
        self.parents.append(parent)
        if parent is not None:
            self.nodes[parent].setdefault("children", []).append(len(self.nodes) - 1)
        return len(self.nodes) - 1

    def array(self, values, kind, code="f", component=5126):
        flat = [number for value in values for number in value]
        self.tree["bufferViews"].append({"buffer": 0, "byteOffset": len(self.bytes), "byteLength": 4 * len(flat)})
        bounds = {"min": list(map(min, *values, values[0])), "max": list(map(max, *values, values[0]))}
        self.bytes += struct.pack("<%d%s" % (len(flat), code), *flat)
        self.tree["accessors"].append({"bufferView": len(self.tree["bufferViews"]) - 1, "componentType": component,
                                       "count": len(values), "type": kind, **bounds})
        return len(self.tree["accessors"]) - 1

    def walk(self, name="walk", frames=FRAMES, rate=RATE, interpolation="LINEAR", **more):
        """Adds a clip: swinging limbs, and the functions of time that `more` has for paths of nodes."""
        keys = {(self.joints[joint], "rotation"): lambda t, a=axis, d=most: turn(a, d * math.sin(6 * t))
                for joint, (axis, most) in SWINGS.items()} | more.get("keys", {})
        times = [(frame / rate,) for frame in range(frames)]
        clip = {"name": name, "channels": [], "samplers": []}
        start = self.array(times, "SCALAR")
        for (node, path), at in keys.items():
            values = [list(at(t)) for (t,) in times]
            if interpolation == "CUBICSPLINE":
                values = [v for value in values for v in ([0] * len(value), value, [0] * len(value))]
            output = self.array(values, "VEC4" if path == "rotation" else "VEC3")
            clip["channels"].append({"sampler": len(clip["samplers"]), "target": {"node": node, "path": path}})
            clip["samplers"].append({"input": start, "output": output, "interpolation": interpolation})
        self.tree.setdefault("animations", []).append(clip)
        self.keys = keys
        return self

    def skin(self, joints=None):
        """Binds a mesh with a point per joint to the body as it is placed now."""
        joints = list(joints or self.joints.values())
        worlds = self.worlds()
        inverses = [[m[i][j] for j in range(4) for i in range(4)] for m in (inverse(worlds[j]) for j in joints)]
        self.tree.setdefault("skins", []).append({"joints": joints, "inverseBindMatrices": self.array(inverses, "MAT4")})
        points = [[worlds[j][i][3] for i in range(3)] for j in joints]
        attributes = {"POSITION": self.array(points, "VEC3"), "WEIGHTS_0": self.array([(1, 0, 0, 0)] * len(joints), "VEC4"),
                      "JOINTS_0": self.array([(j, 0) for j in range(len(joints))], "VEC4", "I", 5123)}
        self.nodes[self.mesh("Body %d" % len(self.nodes), None, attributes)]["skin"] = len(self.tree["skins"]) - 1
        return self

    def mesh(self, name, parent, attributes=None):
        attributes = attributes or {"POSITION": self.array([(0, 0, 0), (1, 0, 0), (0, 1, 0)], "VEC3")}
        self.tree.setdefault("meshes", []).append({"primitives": [{"attributes": attributes}]})
        return self.add(name, parent, mesh=len(self.tree["meshes"]) - 1)

    def worlds(self, frame=None):
        """World matrices of all nodes, for column vectors: as placed, or in a frame of the last clip."""
        worlds = []
        for index, node in enumerate(self.nodes):
            parts = [self.keys[index, path](frame / RATE) if frame is not None and (index, path) in self.keys else node[path]
                     for path in ("translation", "rotation", "scale")]
            local = matrix(*parts)
            parent = self.parents[index]
            worlds.append(local if parent is None else product(worlds[parent], local))
        return worlds

    def gltf(self, uri=None):
        roots = [index for index, parent in enumerate(self.parents) if parent is None]
        buffer = {"byteLength": len(self.bytes)} | ({"uri": uri} if uri else {})
        return json.dumps({"asset": {"version": "2.0"}, "scene": 0, "scenes": [{"nodes": roots}], "nodes": self.nodes,
                           "buffers": [buffer], **self.tree}).encode()

    def glb(self):
        text = self.gltf()
        text += b" " * (-len(text) % 4)
        chunks = struct.pack("<I4s", len(text), b"JSON") + text + struct.pack("<I4s", len(self.bytes), b"BIN\0") + self.bytes
        return struct.pack("<4sII", b"glTF", 2, 12 + len(chunks)) + chunks
