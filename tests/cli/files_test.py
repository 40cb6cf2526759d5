"""Motion files that are broken, strange or enormous: a sentence with the place, and nothing else."""
import json
import os
import subprocess

from harness import ASSETS, DONE, FAILED, PROGRAM, SECONDS, CliTest, main, posix_only
from made import BVH, bvh, profile

def nested(depth):
    joint = "JOINT n%d\n{\nOFFSET 0 1 0\nCHANNELS 3 Zrotation Xrotation Yrotation\n"
    inner = "".join(joint % i for i in range(depth)) + "}\n" * depth
    return bvh("  JOINT Chest", inner + "  JOINT Chest")


# The readers' own tests and the pages on formats have every cause.
BROKEN = [  # what, content, beginning of the line, word of the sentence
    ("no number in a row", bvh("1 90 0 0 0 0 90", "1 90 nan 0 0 0 90"), "take.bvh:20: ", '"nan"'),
    ("a hundred thousand levels", nested(100000), "take.bvh:", "deep"),
]


class Files(CliTest):
    def setUp(self):
        super().setUp()
        self.write("small.prf", profile("Small", [("Hips", "LowerTorso")]))
        self.write("out.htr", "old")

    def test_a_broken_file_is_refused_by_every_command(self):
        commands = [["convert", "take.bvh", "-o", "out.htr", "--force", "--profile", "small.prf"],
                    ["transcode", "take.bvh", "out.bvh"], ["info", "take.bvh"], ["pose", "take.bvh", "--frame", 1]]
        for what, content, *words in BROKEN:
            self.write("take.bvh", content)
            for command in commands:
                with self.subTest(what, command=command[0]):
                    result = self.with_assets(*command)
                    self.assertEqual((result.code, result.out), (FAILED, ""), result.err)
                    self.assert_words(result, words)
                    self.assertEqual(self.files(), ["out.htr", "small.prf", "take.bvh"])
                    self.assertEqual(self.read("out.htr"), b"old")

    @posix_only("the emulator opens closed streams")
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

    @posix_only("the emulator shows no links")
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
        rows = [("first", 0, 0), ("last", 2, 2), ("behind", 3, 2), ("far", 10**15, 2)]
        for what, frame, x in rows:
            with self.subTest(what):
                pose = json.loads(self.run_program("pose", "take.bvh", "--frame=%d" % frame).out)
                self.assertEqual(pose["frame"], frame)
                self.assertEqual(pose["nodes"][0]["local"][12:15], [x, 90, 0])

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
