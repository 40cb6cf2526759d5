"""Whole scenes as an update leaves them: meshes, cameras and lights beside nodes."""
import json
import math
import struct
import unittest
from pathlib import Path

from harness import DATA, DONE, CliTest, main
from made import IDENTITY, Container, moved


def spatial(matrix):
    return struct.pack("<16fBI", *matrix, 1, 0)


def points(*rows):
    """A geometry's fields: these points, and nothing else."""
    block = b"".join(struct.pack("<3f", *row) for row in rows)
    return struct.pack("<I", len(rows)) + block + struct.pack("<10IB", *[0] * 10, 0)


def scene():
    """A node that moves by 1 each half second; on it a mesh and its copy, a camera and a light."""
    made = Container().node(1, "mover", IDENTITY, children=(3, 0, 4, 5), control=2, root=True)
    made.track(2, 1, [(0, 0, 0), (1, 0, 0), (2, 0, 0)])
    mesh = spatial(moved(0, 5, 0)) + points((1, 0, 0), (-1, 0, 0)) + struct.pack("<9I", *[0] * 9)
    made.record("CTriMesh", 3, "mesh", (6, 0, 0), mesh, False)
    camera = spatial(IDENTITY) + struct.pack("<16fBBI", *[0] * 7, 1, 2, 3, 0, 1, 0, 0, 0, -1, 1, 1, 0)
    made.record("CCamera", 4, "camera", (0, 0, 0), camera, False)
    light = spatial(IDENTITY) + struct.pack("<3ffB3f", 0.25, 0.5, 0.75, 1, 1, 7, 8, 9)
    made.record("CPointLight", 5, "light", (0, 0, 0), light, False)
    control = struct.pack("<I4fBII", 0, 0.0, 10.0, 0.0, 1.0, 1, 3, 0)
    morph = control + struct.pack("<I3fI2fI2f", 1, 0, 0, 10, 2, 0.0, 1.0, 2, 0.0, 2.0)
    return made.record("CMorphControl", 6, "", (0, 0, 0), morph, False).bytes


def differences(got, want, where=""):
    """Where two results differ, row by row, by the largest number of the row."""
    if want is None:
        return
    if isinstance(want, dict):
        for key, value in want.items():
            yield from differences(got.get(key), value, where + "/" + key)
    elif isinstance(want, list) and want and all(isinstance(x, (int, float)) for x in want):
        limit = 1e-4 * max([1.0] + [abs(x) for x in want])
        if len(got) != len(want) or any(not abs(a - b) <= limit for a, b in zip(got, want)):
            yield where, got, want
    elif isinstance(want, list):
        if len(got) != len(want):
            yield where, len(got), len(want)
        for i, (a, b) in enumerate(zip(got, want)):
            yield from differences(a, b, where + "[%d]" % i)
    elif got != want and not (isinstance(want, float) and math.isclose(got, want, rel_tol=1e-6)):
        yield where, got, want


class Objects(CliTest):
    def pose(self, name, time):
        result = self.run_program("pose", name, "--time=%r" % time, "--objects")
        self.assertEqual(result.code, DONE, result.err)
        return json.loads(result.out)

    def test_every_object_tells_what_its_class_has(self):
        self.write("scene.orn", scene())
        told = self.pose("scene.orn", 2.0)
        self.assertEqual(told["time"], 2)
        mover, mesh, camera, light = told["objects"]
        self.assertEqual([o["class"] for o in told["objects"]], ["CNode", "CTriMesh", "CCamera", "CPointLight"])
        self.assertEqual(set(mover), {"class", "name", "local", "world", "bound"})
        self.assertEqual(mover["world"], moved(1, 0, 0))
        self.assertEqual((mesh["local"], mesh["world"]), (moved(0, 5, 0), moved(1, 5, 0)))
        self.assertEqual(mesh["points"], [[2, 5, 10], [0, 5, 0]])
        self.assertEqual((mesh["normals"], mesh["uvw"]), ([], []))
        self.assertEqual(mesh["bound"][:3], [1, 5, 5])
        self.assertEqual((camera["eye"], camera["control"]), ([2, 2, 3], [0, 0, 0]))
        self.assertEqual((light["location"], light["rgb"]), ([8, 8, 9], [0.25, 0.5, 0.75]))

    def test_a_time_may_be_below_nothing_and_needs_no_objects(self):
        self.write("scene.orn", scene())
        self.assertEqual(self.pose("scene.orn", -1.0)["objects"][1]["points"], [[1, 5, 0], [-1, 5, 0]])
        told = json.loads(self.run_program("pose", "scene.orn", "--time", "4").out)
        self.assertEqual(told["nodes"][0]["world"], moved(2, 0, 0))

    @unittest.skipUnless(DATA and (Path(DATA) / "scenes").is_dir(), "no shared data here")
    def test_scenes_agree_with_another_evaluation(self):
        folder = Path(DATA) / "scenes"
        for case in json.loads((folder / "cases.json").read_text())["cases"]:
            for time, expected in zip(case["times"], case["expected"]):
                with self.subTest(expected):
                    told = self.pose(folder / case["file"], time)
                    wanted = json.loads((folder / expected).read_text())
                    self.assertEqual(list(differences(told, wanted))[:3], [])


if __name__ == "__main__":
    main()
