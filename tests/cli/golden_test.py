"""Conversions of real and made motions against reference results, where these lie beside the project."""
import json
import re
import struct
import unittest
from pathlib import Path

from harness import DATA, DONE, CliTest, main
from poses import Htr, worst_difference

DATA = Path(DATA) if DATA else None
MILLIMETRES, DEGREES = 0.05, 0.05  # far above rounding, far below any other reading of a rule
LAST_DIGITS = 0.01  # of a number printed with six places, between 32 and 64 bit arithmetic


def numbers(text):
    return [float(word) if re.fullmatch(r"-?\d+(\.\d+)?", word) else word for word in text.split()]


class NumbersTest(CliTest):
    def assert_same_numbers(self, ours, reference, delta):
        self.assertEqual(len(ours), len(reference))
        for x, y in zip(ours, reference):
            if isinstance(y, float):
                self.assertAlmostEqual(x, y, delta=delta)
            else:
                self.assertEqual(x, y)


@unittest.skipUnless(DATA, "no reference data beside the project")
class Golden(NumbersTest):
    def cases(self, folder="golden"):
        for case in json.loads((DATA / folder / "cases.json").read_text()):
            yield case, DATA / folder / case["name"]

    def convert(self, case, folder, output):
        legs = [] if case["legs"] else ["--no-legs"]
        result = self.run_program("convert", folder / "source.bvh", "-o", output, "--profile", folder / "map.prf",
                                  "--data-dir", DATA / "golden" / "skeleton", *legs)
        self.assertEqual(result.code, DONE, result.err)

    def assert_same_motion(self, ours, reference):
        ours, reference = Htr(ours), Htr(reference)
        self.assertEqual(ours.header, reference.header)
        self.assertEqual(ours.parents, reference.parents)
        distance, angle = worst_difference(reference, ours)
        self.assertLess(distance, MILLIMETRES)
        self.assertLess(angle, DEGREES)

    def test_conversions(self):
        for case, folder in [*self.cases(), *self.cases("golden-gaps")]:
            with self.subTest(case["name"]):
                self.convert(case, folder, "%s.htr" % case["name"])
                self.assert_same_motion(self.folder / ("%s.htr" % case["name"]), folder / "expected.htr")

    def test_packages(self):
        def split(package):
            head = bytearray(package[:381])
            for offset in (102, 227, 278, 286, 318, 377):  # link ids and presence words are free
                head[offset:offset + 4] = b"free"
            size = struct.unpack_from("<I", head, 373)[0]
            self.assertEqual(len(package), 381 + size)
            head[373:377] = b"size"
            return bytes(head), numbers(package[381:].decode())

        for case, folder in self.cases():
            if not (folder / "expected.Kinetra").exists():
                continue
            with self.subTest(case["name"]):
                self.convert(case, folder, "%s.Kinetra" % case["name"])
                ours = split(self.read("%s.Kinetra" % case["name"]))
                reference = split((folder / "expected.Kinetra").read_bytes())
                self.assertEqual(ours[0], reference[0])
                self.assert_same_numbers(ours[1], reference[1], LAST_DIGITS)

    def test_poses(self):
        for case, folder in self.cases():
            with self.subTest(case["name"]):
                result = self.run_program("pose", folder / "source.bvh", "--frame", int(case["pose_frame"]))
                reference = json.loads((folder / "pose.json").read_text())
                for ours, node in zip(json.loads(result.out)["nodes"], reference["nodes"], strict=True):
                    self.assertEqual((ours["name"], ours["parent"]), (node["name"], node["parent"]))
                    for space in ("local", "world"):
                        self.assert_same_numbers(ours[space], node[space], 0.001)

    def test_other_forms(self):
        for case, folder in self.cases():
            with self.subTest(case["name"]):
                if (folder / "rescaled.htr").exists():
                    name = "%s.htr" % case["name"]
                    result = self.run_program("transcode", folder / "expected.htr", name, "--frame-scale",
                                              case["frame_scale"])
                    self.assertEqual(result.code, DONE, result.err)
                    self.assert_same_motion(self.folder / name, folder / "rescaled.htr")
                if (folder / "transcoded.bvh").exists():
                    name = "%s.bvh" % case["name"]
                    self.assertEqual(self.run_program("transcode", folder / "source.bvh", name).code, DONE)
                    self.assert_same_numbers(numbers((self.folder / name).read_text()),
                                             numbers((folder / "transcoded.bvh").read_text()), 0.001)


@unittest.skipUnless(DATA, "no containers beside the project")
class RealContainers(NumbersTest):

    def test_a_scene_moves_as_its_reference_does(self):
        reference = json.loads((DATA / "containers" / "skeleton_poses.json").read_text())
        source = DATA / "containers" / "skeleton.orn"
        for frame, nodes in reference["frames"].items():
            pose = json.loads(self.run_program("pose", source, "--frame", frame).out)
            ours = {node["name"]: node for node in pose["nodes"]}
            self.assertEqual(set(ours), set(nodes))
            for name, node in nodes.items():
                for space in ("local", "world"):
                    self.assert_same_numbers(ours[name][space], node[space], 0.001)


if __name__ == "__main__":
    main()
