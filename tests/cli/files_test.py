"""Motion files that are broken, strange or enormous: a sentence with the place, and nothing else."""
import json
import os
import subprocess

from harness import ASSETS, DONE, FAILED, PROGRAM, SECONDS, CliTest, main
from made import BVH, CHA, bvh, cha, chb, htr, profile

ROW = "1 90 0 0 0 0 90 0 0"
DOUBLED = bvh("CHANNELS 3 Z", "CHANNELS 6 Xposition Yposition Zposition Z")
for number in range(3):
    DOUBLED = DOUBLED.replace("\n%d 90 0 0 0 0" % number, "\n%d 90 0 0 0 0 0 10 0" % number)


def nested(depth):
    joint = "JOINT n%d\n{\nOFFSET 0 1 0\nCHANNELS 3 Zrotation Xrotation Yrotation\n"
    inner = "".join(joint % i for i in range(depth)) + "}\n" * depth
    return bvh("  JOINT Chest", inner + "  JOINT Chest")


# A row for each form of a place; the readers' own tests have every cause.
BROKEN = [  # what, content, line or 0, word of the sentence
    ("an empty file", "", 0, '"HIERARCHY"'),
    ("no BVH at all", "\x00\x01\x02" * 100, 1, '"HIERARCHY"'),
    ("a name that a zero byte ends", bvh("Chest", "\0Chest"), 6, "zero byte"),
    ("more channels than words", bvh("CHANNELS 3 Z", "CHANNELS 999999999 Z"), 9, "too few values"),
    ("no number in a row", bvh(ROW, "1 90 nan 0 0 0 90 0 0"), 20, '"nan"'),
    ("a hundred thousand levels", nested(100000), 0, "deep"),
]

BROKEN_HTR = [
    ("a ring of bones", htr("Hips GLOBAL", "Hips Chest"), 22, '"Hips"'),
    ("an infinity in the rest pose", htr("Hips 0 90 0", "Hips 0 inf 0"), 20, '"inf"'),
]

BROKEN_CHA = [
    ("more segments than there can be", cha("Segments 2", "Segments 101"), 6, "limit"),
    ("a file that is cut", CHA[:-60], 25, "fewer rows"),
]

CHB_END = len(chb())
BROKEN_CHB = [  # what, content, byte or 0, words
    ("an empty file", b"", 0, "middle of a record"),
    ("a version to come", chb(version=722), 25, "version"),
    ("an infinity", chb()[:-4] + b"\0\0\x80\x7f", CHB_END, "number"),
]


WARNED = [  # what, content, code of the warning, line
    ("a short row", bvh(ROW, "1 90 0 0 0 0 90"), "short-row", 20),
    ("a number with something stuck to it", bvh(ROW, "1 90 0.0-7.5 0 0 0 90 0 0"), "stuck-number", 20),
    ("positions that repeat the offsets", DOUBLED, "doubled-offsets", None),
    ("a channel that there is not", bvh("CHANNELS 3 Zrotation", "CHANNELS 3 Wrotation"), "unknown-channel", 9),
]


class Files(CliTest):
    def setUp(self):
        super().setUp()
        self.write("small.prf", profile("Small", [("Hips", "LowerTorso")]))
        self.write("out.htr", "old")

    def assert_refused(self, name, rows, place="%s:%d: "):
        commands = [["convert", name, "-o", "out.htr", "--force", "--profile", "small.prf"],
                    ["transcode", name, "out.bvh"], ["info", name], ["pose", name, "--frame", 1]]
        for what, content, line, word in rows:
            self.write(name, content)
            for command in commands:
                with self.subTest(what, command=command[0]):
                    result = self.with_assets(*command)
                    self.assertEqual((result.code, result.out), (FAILED, ""), result.err)
                    self.assert_words(result, [place % (name, line) if line else name + ":", word])
                    self.assertEqual(self.files(), sorted(["out.htr", "small.prf", name]))
                    self.assertEqual(self.read("out.htr"), b"old")

    def test_a_broken_file_is_refused_with_its_place_and_cause(self):
        self.assert_refused("take.bvh", BROKEN)

    def test_so_is_a_broken_htr(self):
        self.assert_refused("take.htr", BROKEN_HTR)

    def test_so_is_a_broken_cha(self):
        self.assert_refused("take.cha", BROKEN_CHA)

    def test_so_is_a_broken_chb(self):
        self.assert_refused("take.chb", BROKEN_CHB, place="%s: byte %d: ")

    def test_what_an_author_did_not_mean_is_told(self):
        for what, content, code, line in WARNED:
            with self.subTest(what):
                self.write("take.bvh", content)
                result = self.run_program("info", "take.bvh", "--json")
                self.assertEqual(result.code, DONE, result.err)
                warnings = {w["code"]: w["where"] for w in json.loads(result.out)["warnings"]}
                self.assertIn(code, warnings)
                if line is not None:
                    self.assertEqual(warnings[code], line)
                self.assertIn("warning: take.bvh", result.err)
                self.assertEqual(self.run_program("info", "take.bvh", "--quiet").err, "")

    def test_a_folder_or_a_device_is_no_motion(self):
        (self.folder / "folder.bvh").mkdir()
        (self.folder / "device.bvh").symlink_to("/dev/zero")
        for name in ("folder.bvh", "device.bvh"):
            result = self.run_program("info", name)
            self.assertEqual(result.code, FAILED)
            self.assert_words(result, [name, "folder or a device"])

    def test_a_closed_stream_leaves_its_number_to_no_result(self):
        self.write("take.bvh", BVH)
        expected = self.with_assets("convert", "take.bvh", "-o", "out.htr", "--force", "--profile", "small.prf")
        good = self.read("out.htr")
        self.assertEqual(expected.code, DONE)
        for closed in ((1,), (2,), (0, 1, 2)):
            with self.subTest(closed):
                command = [PROGRAM, "convert", "take.bvh", "-o", "out.htr", "--force", "--profile", "small.prf",
                           "--data-dir", str(ASSETS)]
                done = subprocess.run(command, cwd=self.folder, env=self.environment, timeout=SECONDS,
                                      preexec_fn=lambda: [os.close(stream) for stream in closed])
                self.assertEqual((done.returncode, self.read("out.htr")), (DONE, good))

    def test_a_link_to_nothing_is_written_through_only_when_forced(self):
        self.write("take.bvh", BVH)
        (self.folder / "link.htr").symlink_to("made.htr")
        command = ["convert", "take.bvh", "-o", "link.htr", "--profile", "small.prf"]
        result = self.with_assets(*command)
        self.assertEqual(result.code, FAILED)
        self.assert_words(result, ["link.htr", "link to a file that does not exist", "--force"])
        self.assertFalse((self.folder / "made.htr").exists())
        self.succeed(*command, "--force")
        self.assertTrue((self.folder / "made.htr").exists() and (self.folder / "link.htr").is_symlink())


class Poses(CliTest):
    def test_frames_outside_the_motion_take_its_ends(self):
        self.write("take.bvh", BVH)
        rows = [("before", -5, 0), ("first", 0, 0), ("last", 2, 2), ("behind", 3, 2), ("far", 10**15, 2)]
        for what, frame, x in rows:
            with self.subTest(what):
                pose = json.loads(self.run_program("pose", "take.bvh", "--frame=%d" % frame).out)
                self.assertEqual(pose["frame"], frame)
                self.assertEqual(pose["nodes"][0]["local"][12:15], [x, 90, 0])

    def test_matrices_are_of_row_vectors(self):
        self.write("take.bvh", BVH)
        hips, chest = json.loads(self.run_program("pose", "take.bvh", "--frame", 1).out)["nodes"]
        quarter = [0, 1, 0, -1, 0, 0, 0, 0, 1]  # 90 degrees about Z: x goes to y, row by row
        rotation = [chest["local"][4 * row + column] for row in range(3) for column in range(3)]
        for value, expected in zip(rotation, quarter):
            self.assertAlmostEqual(value, expected, places=5)
        self.assertEqual(chest["local"][12:], [0, 10, 0, 1])
        self.assertEqual(hips["parent"], None)

    def test_motions_of_matrices_go_the_ways_of_a_bvh(self):
        self.write("take.bvh", BVH)
        expected = [self.poses("take.bvh", frame) for frame in range(3)]
        self.write("small.prf", profile("Small", [("Hips", "LowerTorso")]))
        for name, content, rate in (("take.cha", CHA, 30), ("take.chb", chb(), 1 / 0.06)):
            with self.subTest(name):
                self.write(name, content)
                for frame in range(3):
                    self.assert_same(self.poses(name, frame), expected[frame])
                facts = json.loads(self.succeed("info", name, "--json").out)
                self.assertEqual((facts["format"], facts["frames"]), (name[-3:], 4))
                self.assertAlmostEqual(facts["rate"], rate, places=3)
                self.succeed("transcode", name, name + ".bvh")
                self.assert_same(self.poses(name + ".bvh", 1), expected[1])
                self.succeed("convert", name, "-o", name + ".htr", "--profile", "small.prf")
                self.assertGreater(json.loads(self.succeed("info", name + ".htr", "--json").out)["frames"], 1)
                self.succeed("render", name, "-o", name + ".png", "--size", "32x32")
                self.assertEqual(self.read(name + ".png")[:4], b"\x89PNG")

    def poses(self, name, frame):
        nodes = json.loads(self.succeed("pose", name, "--frame", frame).out)["nodes"]
        return [(node["name"], node["parent"], node["world"]) for node in nodes]

    def assert_same(self, found, expected):
        for (*names, world), (*others, wanted) in zip(found, expected, strict=True):
            self.assertEqual(names, others)
            for a, b in zip(world, wanted, strict=True):
                self.assertAlmostEqual(a, b, places=4)

    def test_a_motion_survives_being_written_as_bvh(self):
        self.write("take.bvh", BVH)
        self.assertEqual(self.run_program("transcode", "take.bvh", "again.bvh").code, DONE)
        for frame in (0, 1):  # the writer leaves out the last frame
            one, two = (json.loads(self.run_program("pose", name, "--frame", frame).out)["nodes"]
                        for name in ("take.bvh", "again.bvh"))
            for a, b in zip(one, two, strict=True):
                for x, y in zip(a["world"], b["world"]):
                    self.assertAlmostEqual(x, y, places=4)
        self.assertEqual(self.run_program("transcode", "take.bvh", "again.bvh").code, FAILED)

    def test_no_bvh_is_written_that_no_program_could_play(self):
        head, _ = BVH.split("Frames: 3")
        rows = [("no frames", head + "Frames: 0\nFrame Time: 0.1\n"),
                ("no time", BVH.replace("0.0333333", "0")),
                ("a time of less than six digits", BVH.replace("0.0333333", "1e-7"))]
        for what, text in rows:
            with self.subTest(what):
                self.write("take.bvh", text)
                result = self.run_program("transcode", "take.bvh", "again.bvh")
                self.assertEqual((result.code, self.files()), (FAILED, ["take.bvh"]))
                self.assertIn("take.bvh:", result.err)


if __name__ == "__main__":
    main()
