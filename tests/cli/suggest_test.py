"""Profiles for skeletons that none fits: what is found, what is told, and that conversions take them."""
import itertools
import json
import re

from harness import DATA, FAILED, WALK, CliTest, main
from made import BVH
from pathlib import Path

THIRTEEN = {"LowerTorso", "UpperTorso", "Head", *(side + bone for side in "LR" for bone in
            ("UpperArm", "Forearm", "Hand", "Thigh", "Calf"))}

# What the rest poses of the real files are, if not T-poses.
REST_POSES = {
    "bandai_walk_normal_002": "none", "rokoko_jesse_dance": "none", "cmu1_jumping_jacks": "arms down",
    "julia_example": "arms down", "mocapbank_lefthip": "arms down", "yxz_lefthip": "arms down",
    "daz3d_genesis": "A-pose", "makehuman_tpose": "A-pose", "geno_stance": "other"}


def scrambled():
    """The walk with names that say nothing."""
    numbers = itertools.count()
    return re.sub(r"(ROOT |JOINT )\w+", lambda match: f"{match[1]}n{next(numbers):02}q", WALK.read_text())


class Suggest(CliTest):

    def test_a_conversion_takes_the_profile(self):
        self.write("strange_walk.bvh", scrambled())
        self.assertEqual(self.with_assets("convert", "strange_walk.bvh", "-o", "a.htr").code, FAILED)
        told = self.succeed("suggest", "strange_walk.bvh", "-o", "new.prf")
        for bone in THIRTEEN:
            self.assertRegex(told.out, rf"(?m)^{bone} .* likely: ")
        self.assertTrue(self.read_text("new.prf").startswith(b"strange walk\n"))
        self.succeed("convert", "strange_walk.bvh", "-o", "a.htr", "--profile", "new.prf", "--no-legs")
        measured = json.loads(self.succeed("compare", "strange_walk.bvh", "a.htr", "--profile", "new.prf", "--json").out)
        bones = {bone["target"]: bone for bone in measured["bones"] if bone["measured"]}
        for bone in ("LUpperArm", "RForearm", "Neck", "UpperTorso"):
            self.assertLess(bones[bone]["meanError"], 1.0, bone)

    def test_rates_that_a_profile_cannot_have(self):
        for seconds, rate in (("0.05", 30), ("0.002", 240), ("0.02", 50)):
            self.write("walk.bvh", re.sub(r"(Frame Time:) .*", rf"\1 {seconds}", WALK.read_text()))
            told = self.succeed("suggest", "walk.bvh", "-o", "new.prf", "--force")
            self.assertIn(b"\nFrameRate %d\n" % rate, self.read_text("new.prf"))
            self.assertEqual("frames per second" in told.err, rate != 50, seconds)
            self.assertNotIn("avaliable", self.succeed("convert", "walk.bvh", "-o", "a.htr", "--force",
                                                      "--profile", "new.prf").err)

    def test_what_is_no_body_is_refused_with_what_is_missing(self):
        self.write("small.bvh", BVH)
        result = self.with_assets("suggest", "small.bvh", "-o", "small.prf")
        self.assertEqual((result.code, result.out), (FAILED, ""))
        self.assert_words(result, ["small.bvh", "missing", "left upper arm", "right shin"])
        self.assertEqual(self.files(), ["small.bvh"])

    def test_a_profile_that_exists_stays_unless_forced(self):
        self.write("walk.bvh", WALK.read_bytes())
        self.write("old.prf", "mine")
        result = self.with_assets("suggest", "walk.bvh", "-o", "old.prf")
        self.assertEqual((result.code, self.read("old.prf")), (FAILED, b"mine"))
        self.assert_words(result, ["old.prf", "--force"])
        self.succeed("suggest", "walk.bvh", "-o", "old.prf", "--force")
        self.assertTrue(self.read_text("old.prf").startswith(b"walk\n"))

    def test_real_files_get_whole_profiles(self):
        for path in sorted(Path(DATA, "bvh").glob("*.bvh")) if DATA else []:
            with self.subTest(path.name):
                result = self.with_assets("suggest", path, "-o", "a.prf", "--force", "--json")
                if result.code == FAILED:  # two are no bodies, one has an empty line where none may stand
                    self.assertRegex(result.err, "missing|empty line")
                    continue
                profile = json.loads(result.out)
                rows = {row["target"]: row for row in profile["rows"]}
                self.assertEqual({rows[bone]["sureness"] for bone in THIRTEEN}, {"sure"})
                told = self.succeed("convert", path, "-o", "a.htr", "--profile", "a.prf", "--force").err
                facts = json.loads(self.run_program("doctor", path, "--json").out)["facts"]
                pose = REST_POSES.get(path.stem, "T-pose")
                self.assertEqual((facts["restPose"], profile["restIsStance"], "the rest pose is not a T-pose" in told),
                                 (pose, pose != "none", pose != "T-pose"))


if __name__ == "__main__":
    main()
