"""Conversions of real and made motions against reference results, where these lie beside the project."""
import json
import re
import struct
import unittest
from pathlib import Path

from harness import ASSETS, DATA, DONE, FAILED, CliTest, main
from poses import Htr, worst_difference

DATA = Path(DATA) if DATA else None
MILLIMETRES, DEGREES = 0.05, 0.05  # far above rounding, far below any other reading of a rule
LAST_DIGITS = 0.01  # of a number printed with six places, between 32 and 64 bit arithmetic
MADE_LATER = re.compile(r'class that is not known here: "(\w+)"')


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


@unittest.skipUnless(DATA, "no real motions beside the project")
class Real(CliTest):
    def test_every_real_motion_is_read_or_refused_with_line_and_cause(self):
        for source in sorted((DATA / "bvh").glob("*.bvh")):
            with self.subTest(source.name):
                result = self.run_program("info", source, "--json")
                if result.code == FAILED:
                    self.assertRegex(result.err, re.escape(source.name) + r":\d+: \w+")
                else:
                    told = json.loads(result.out)
                    text = source.read_text(encoding="latin-1")
                    self.assertEqual(told["frames"], int(re.search(r"Frames:\s*(\d+)", text)[1]))
                    self.assertEqual(len(told["bones"]), len(re.findall(r"\b(?:ROOT|JOINT)\s", text)))

    def test_what_a_stock_profile_fits_is_converted_without_a_word_from_the_user(self):
        fitting = {"poser_boxing": "Poser BVH", "mocapbank_lefthip": "Max BVH"}
        for stem, profile in fitting.items():
            with self.subTest(stem):
                result = self.run_program("convert", DATA / "bvh" / (stem + ".bvh"), "-o", stem + ".htr",
                                          "--data-dir", ASSETS, "--json")
                self.assertEqual(json.loads(result.out)["profile"], profile)


@unittest.skipUnless(DATA, "no containers beside the project")
class RealContainers(NumbersTest):
    def test_containers_are_read_or_refused_as_they_must_be(self):
        later = set()
        for row in json.loads((DATA / "containers" / "expect.json").read_text())["files"]:
            source = DATA / "containers" / row["file"]
            with self.subTest(row["file"]):
                (self.folder / "out.orn").unlink(missing_ok=True)
                result = self.run_program("resave", source, "out.orn")
                unknown = MADE_LATER.search(result.err)
                if unknown and row["status"] == "ok":
                    later.add(unknown[1])
                    continue
                if row["must"] == "read":
                    self.assertEqual(result.code, DONE, result.err)
                if row["must"] == "refuse":
                    self.assertEqual(result.code, FAILED)
                    self.assertFalse((self.folder / "out.orn").exists())
                if result.code == DONE:
                    self.assert_same_scene(source, "out.orn")
                self.run_program("pose", source, "--frame", "3")
        if later:
            print("classes that are not made yet:", *sorted(later))

    def assert_same_scene(self, one, two):
        told = [json.loads(self.run_program("info", path, "--json").out) for path in (one, two)]
        for info in told:
            for member in ("file", "version", "warnings"):
                del info[member]
        self.assertEqual(told[0], told[1])

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
