"""Which profile a conversion takes when none is named, and what is told of it."""
import json
import os
import shutil

from harness import ASSETS, DONE, FAILED, CliTest, main
from made import body

STRAIGHT = "MotionBuilder / HumanIK (3 spine joints)"


class Choice(CliTest):
    def test_a_prefix_is_told_and_gives_the_same_bytes(self):
        self.write("plain.bvh", body())
        self.succeed("convert", "plain.bvh", "-o", "plain.htr", "--profile", STRAIGHT)
        for prefix in ("", "Model_", "Skeleton:", "mixamorig5:", "DEF-"):
            with self.subTest(prefix):
                self.write("a.bvh", body(prefix))
                told = json.loads(self.succeed("convert", "a.bvh", "-o", "a.htr", "--force", "--json").out)
                self.assertEqual(told["profile"], STRAIGHT + (", prefix %s" % prefix if prefix else ""))
                self.assertEqual(told["profilePath"], str(ASSETS / "HumanIK03.prf"))
                self.assertEqual((told["sureness"], told["doubts"], told["warnings"]), ("sure", [], []))
                self.assertEqual(self.read("a.htr"), self.read("plain.htr"))

    def test_an_older_map_of_the_same_size_is_read_itself(self):
        data = self.folder / "data"
        shutil.copytree(ASSETS, data)
        installed = data / "HumanIK03.prf"
        text = installed.read_bytes()
        self.write("data/profiles.pack", b"HumanIK03.prf %d\n" % len(text) + text)
        installed.write_bytes(text.replace(b"FrameRate 30", b"FrameRate 60"))
        os.utime(installed, (1, 1))
        self.write("a.bvh", body())
        for choice in ((), ("--profile", STRAIGHT)):
            done = self.run_program("convert", "a.bvh", "-o", "a.htr", "--force", "--data-dir", data, *choice)
            self.assertEqual(done.code, DONE, done.err)
            self.assertIn(b"NumFrames 6", self.read("a.htr").splitlines()[:8], "half as many as with the packed rate")

    def test_a_doubtful_profile_is_taken_only_by_name(self):
        self.write("a.bvh", body(swapped=True))
        result = self.with_assets("convert", "a.bvh", "-o", "a.htr")
        self.assertEqual((result.code, result.out), (FAILED, ""))
        self.assert_words(result, ["doubtful", "left and right", '"LeftUpLeg"', "--profile", "gaitwright suggest"])
        self.assertNotIn("a.htr", self.files())
        self.assertIn("LaFAN1", self.succeed("convert", "a.bvh", "-o", "a.htr", "--profile", "LaFAN1 (3 spine joints)").out)

    def test_a_doubt_about_a_profile_of_old_is_a_warning(self):
        self.write("a.bvh", body(family="Chest", swapped=True))
        result = self.succeed("convert", "a.bvh", "-o", "a.htr")
        self.assert_words(result, ["warning", "Max BVH", "left and right"])
        self.assertTrue(result.out.endswith('by profile "Max BVH"\n'), result.out)

    def test_profiles_are_listed_as_they_are_taken(self):
        rows = [  # source, the first profile's name, its sureness
            (body(spine=2), "MotionBuilder / HumanIK (2 spine joints)", "sure"),
            (body("Model_"), STRAIGHT + ", prefix Model_", "sure"),
            (body(swapped=True), "LaFAN1 (3 spine joints)", "doubtful"),
        ]
        for source, name, sureness in rows:
            with self.subTest(name):
                self.write("a.bvh", source)
                told = json.loads(self.succeed("profiles", "a.bvh", "--json").out)["profiles"]
                self.assertEqual((told[0]["name"], told[0]["sureness"]), (name, sureness))
                fits = [row["fits"] for row in told]
                self.assertEqual(fits, sorted(fits, reverse=True))

    def test_a_batch_takes_the_adapted_profile_for_every_file(self):
        for name in ("one", "two"):
            self.write("takes/%s.bvh" % name, body("Model_"))
        self.succeed("batch", "takes", "--job", "htr")
        self.assertEqual(self.read("takes/one.htr"), self.read("takes/two.htr"))


if __name__ == "__main__":
    main()
