"""Conversions as whole runs: what is written, what is refused, and what stays as it was."""
import json
import os
import shlex
import unittest

from harness import ASSETS, FAILED, WALK, CliTest, main
from made import BVH, bvh, profile

OLD = b"an older result"

# The walk by its own names; "Poser BVH" is the stock profile that fits it.
REFUSED = [  # what, arguments behind "convert", words on standard error
    ("an output that exists", "walk.bvh -o old.Kinetra", ["old.Kinetra", "--force"]),
    ("the default output exists", "old.bvh", ["old.Kinetra", "--force"]),
    ("a folder instead of the result, even by force", "walk.bvh -o folder --force", ["folder/walk.Kinetra", "folder"]),
    ("no such source", "none.bvh -o a.Kinetra", ["none.bvh", "cannot be opened"]),
    ("a source of an unknown kind", "made.prf -o a.Kinetra", ["made.prf", ".bvh"]),
    ("no folder for the output", "walk.bvh -o none/a.Kinetra", ["none/a.Kinetra", "cannot be written"]),
    ("a slip in a profile's name", "walk.bvh -o a.htr --profile \"Poser BHV\"", ["Poser BHV", '"Poser BVH"']),
    ("no such profile file", "walk.bvh -o a.htr --profile none.prf", ["none.prf", "cannot be read"]),
    ("a profile for other bones", "walk.bvh -o a.htr --profile made.prf",
     ["Unable to convert", '"Made": 3 of 5 rows match', 'line 4: the source has no bone "hipp"',
      'the closest is "hip"', 'line 5: the source has no bone "Xyzzy"']),
    ("bones that no profile knows", "strange.bvh -o a.htr", ["strange.bvh", "no installed profile fits", 'no bone "hip"']),
    ("a motion without frames", "still.bvh -o a.htr --profile small.prf", ["no frames"]),
    ("no target skeleton", "walk.bvh -o a.htr --data-dir nothing", ["base.htr"]),
]


class Convert(CliTest):
    def setUp(self):
        super().setUp()
        walk = WALK.read_bytes()
        for name in ("walk.bvh", "old.bvh"):
            self.write(name, walk)
        for name in ("old.Kinetra", "old.htr"):
            self.write(name, OLD)
        (self.folder / "folder/walk.Kinetra").mkdir(parents=True)
        self.write("made.prf", profile("Made", [("hipp", "LowerTorso"), ("Xyzzy", "Waist"), ("neck", "Neck")]))
        self.write("small.prf", profile("Small", [("Hips", "LowerTorso"), ("Chest", "UpperTorso")]))
        self.write("small.bvh", BVH)
        self.write("strange.bvh", bvh("ROOT Hips", "ROOT Alpha").replace("JOINT Chest", "JOINT Beta"))
        self.write("still.bvh", bvh("Frames: 3", "Frames: 0"))
        self.before = self.files()

    def made(self):
        return sorted(set(self.files()) - set(self.before))

    def test_what_cannot_be_done_is_said_and_leaves_everything_as_it_was(self):
        for what, line, words in REFUSED:
            with self.subTest(what):
                arguments = shlex.split(line)
                run = self.run_program if "--data-dir" in arguments else self.with_assets
                result = run("convert", *arguments)
                self.assertEqual((result.code, result.out), (FAILED, ""), result.err)
                self.assert_words(result, words)
                self.assertEqual(self.made(), [])
                self.assertEqual((self.read("old.Kinetra"), self.read("old.htr")), (OLD, OLD))

    def test_the_result_is_a_package_beside_the_source_unless_told_otherwise(self):
        rows = [  # what, arguments, the file that comes of them
            ("beside the source", [], "walk.Kinetra"),
            ("a name without extension", ["-o", "plain"], "plain.Kinetra"),
            ("an .htr by its name", ["-o", "moved.htr"], "moved.htr"),
            ("an .htr in capitals", ["-o", "LOUD.HTR"], "LOUD.htr"),
        ]
        for what, arguments, name in rows:
            with self.subTest(what):
                known = self.files()
                result = self.succeed("convert", "walk.bvh", *arguments)
                self.assertEqual(sorted(set(self.files()) - set(known)), [name])
                self.assertIn(name, result.out)
        self.succeed("extract", "walk.Kinetra", "-o", "inner.htr")
        self.assertEqual(self.read("inner.htr"), self.read("moved.htr"))

    def test_a_dry_run_tells_profile_and_name_and_writes_nothing(self):
        result = self.succeed("convert", "walk.bvh", "--dry-run", "--json")
        plan = json.loads(result.out)
        self.assertEqual((plan["outcome"], plan["output"], plan["profile"]), ("would_convert", "walk.Kinetra", "Poser BVH"))
        self.assertEqual(self.with_assets("convert", "none.bvh", "--dry-run").code, FAILED)
        self.assertEqual(self.made(), [])

    def test_a_profile_file_goes_before_an_installed_one_of_its_name(self):
        text = (ASSETS / "PoserBVH.prf").read_text()
        self.write("mine.prf", text.replace("FrameRate 30", "FrameRate 60"))
        self.succeed("convert", "walk.bvh", "-o", "stock.htr")
        self.succeed("convert", "walk.bvh", "-o", "mine.htr", "--profile", "mine.prf")
        count = [len(self.read(name).splitlines()) for name in ("stock.htr", "mine.htr")]
        self.assertGreater(count[0], 1.5 * count[1])  # 120 / rate frames for each

    def test_a_switch_changes_certain_bones_and_no_others(self):
        legs = {side + bone for side in "LR" for bone in ("Thigh", "Calf", "Foot")}
        arms = {side + bone for side in "LR" for bone in ("Collar", "UpperArm", "Forearm", "Hand")}
        trunk = {"LowerTorso", "Waist", "UpperTorso", "Neck", "LCollar", "RCollar"}
        wave = ["--profile", "Max BVH", "--align", "--faithful"]
        rows = [  # switch, source, other options, bones
            ("--no-legs", "walk.bvh", [], legs),
            ("--faithful", "walk.bvh", [], legs | trunk),
            ("--no-hands", "wave.bvh", wave, arms),
        ]
        for switch, source, options, bones in rows:
            with self.subTest(switch):
                self.write(source, WALK.with_name(source).read_bytes())
                sections = []
                for name, further in (("plain.htr", []), ("other.htr", [switch])):
                    self.succeed("convert", source, "-o", name, "--force", *options, *further)
                    sections.append(dict(part.split("]", 1) for part in self.read(name).decode().split("[")[1:]))
                changed = {name for name in sections[0] if sections[0][name] != sections[1][name]}
                self.assertTrue(changed)
                self.assertLessEqual(changed, bones)

    def test_a_result_that_cannot_fit_is_refused_before_the_work(self):
        self.write("slow.prf", profile("Slow", [("Hips", "LowerTorso")], rate=1))  # 120 rows for each frame
        rows = "0 90 0 0 0 0 0 0 0\n"
        self.write("long.bvh", BVH.split("Frames")[0] + "Frames: 15000\nFrame Time: 0.0333333\n" + 15000 * rows)
        result = self.with_assets("convert", "long.bvh", "--profile", "slow.prf")
        self.assertEqual(result.code, FAILED)
        self.assert_words(result, ["long.bvh: the result would take at least", "split the motion"])

    @unittest.skipIf(os.geteuid() == 0, "root may write everywhere")
    def test_a_folder_that_cannot_be_listed_is_said(self):
        locked = self.folder / "locked"
        locked.mkdir(mode=0o300)
        for command in (["convert", "locked", "--out-dir", "out"], ["batch", "locked", "--job", "htr"]):
            self.assert_words(self.with_assets(*command), ["locked", "the folder cannot be read"])

    def test_nothing_of_the_users_settings_is_written(self):
        self.succeed("convert", "walk.bvh", "-o", "a.htr")
        self.assertFalse((self.folder / "home").exists())


if __name__ == "__main__":
    main()
