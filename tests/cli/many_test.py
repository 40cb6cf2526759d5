"""Folders and several sources, the batch run, and what is told of profiles and results."""
import json

from harness import FAILED, ROOT, WALK, CliTest, main, posix_only
from made import BVH, one_bone_scene, profile

WAVE = ROOT / "examples" / "wave.bvh"
BROKEN = BVH.replace("Frames: 3", "Frames: 30")


def lines(result):
    return [json.loads(line) for line in result.out.splitlines()]


class Many(CliTest):
    def setUp(self):
        super().setUp()
        self.write("takes/a.bvh", WALK.read_bytes())
        self.write("takes/b.bvh", BROKEN)
        self.write("takes/c.BVH", WALK.read_bytes())
        self.write("takes/notes.txt", "no motion")

    def test_a_failure_ends_the_run_unless_it_is_to_go_on(self):
        rows = [  # what, further options, outcomes, files, sources left
            ("ends", [], ["converted", "failed"], ["a"], 1),
            ("goes on", ["--keep-going"], ["converted", "failed", "converted"], ["a", "c"], 0),
        ]
        for what, options, outcomes, stems, left in rows:
            with self.subTest(what):
                out = self.folder / what
                result = self.with_assets("convert", "takes", "--out-dir", out, "--json", *options)
                *told, summary = lines(result)
                self.assertEqual(result.code, FAILED)
                self.assertEqual([row["outcome"] for row in told], outcomes)
                self.assertEqual(told[1]["failures"][0]["code"], "too-few-rows")
                self.assertEqual((summary["converted"], summary["failed"], summary["left"]), (len(stems), 1, left))
                self.assertEqual([p.name for p in sorted(out.iterdir())], [s + ".Kinetra" for s in stems])

    def test_a_summary_has_the_reason_and_the_source_of_each_failure(self):
        (self.folder / "out").mkdir()
        for stem in "ac":
            (self.folder / "out" / (stem + ".Kinetra")).mkdir()
        result = self.with_assets("convert", "takes", "--out-dir", "out", "--keep-going", "--force")
        self.assertEqual(result.code, FAILED)
        self.assert_words(result, ["\n  takes/a.bvh: out/a.Kinetra: ", "\n  takes/b.bvh:17: ", "0 converted"])
        nothing = self.run_program("convert", "takes", "--out-dir", "new", "--keep-going", "--data-dir", "takes")
        self.assert_words(nothing, ["2  the file cannot be opened: No such file or directory"])
        refused = self.with_assets("convert", "takes", "--out-dir", "new", "--drafts", "takes/a.bvh")
        self.assert_words(refused, ["takes/a.bvh: the folder cannot be created: Not a directory"])

    def test_a_second_run_does_only_what_is_missing(self):
        self.succeed("convert", "takes/a.bvh", "--out-dir", "out")
        first = self.read("out/a.Kinetra")
        result = self.succeed("convert", "takes/a.bvh", "takes/c.BVH", "--out-dir", "out", "--skip-existing", "--json")
        self.assertEqual([row["outcome"] for row in lines(result)[:-1]], ["skipped", "converted"])
        self.assertEqual(self.read("out/a.Kinetra"), first)

    def test_a_source_gives_the_same_result_alone_and_behind_others(self):
        self.write("scene.orn", one_bone_scene())
        self.with_assets("convert", "scene.orn", WAVE, "takes/a.bvh", "--out-dir", "out", "--keep-going")
        self.succeed("convert", "takes/a.bvh", "-o", "alone.Kinetra")
        self.assertEqual(self.read("out/a.Kinetra"), self.read("alone.Kinetra"))

    def test_words_of_success_can_be_silenced_and_those_of_failure_not(self):
        result = self.succeed("convert", WAVE, "-o", "a.htr", "--quiet")
        self.assertEqual((result.out, result.err), ("", ""))
        result = self.with_assets("convert", "takes/b.bvh", "-o", "b.htr", "--quiet")
        self.assertIn("takes/b.bvh:", result.err)


class Batch(CliTest):
    def setUp(self):
        super().setUp()
        for name in ("takes/a.bvh", "takes/b.bvh", "takes/c.bvh"):
            self.write(name, WALK.read_bytes())

    def test_every_source_of_a_folder_becomes_an_htr_beside_it(self):
        self.write("takes/b.htr", "replaced without a question")
        result = self.succeed("batch", "takes", "--job", "htr")
        self.assertIn("3 BVH files are successful convert to HTR.", result.err)
        made = {self.read("takes/%s.htr" % stem) for stem in "abc"}
        self.assertEqual(len(made), 1)
        self.assertEqual(len(self.files()), 6)

    def test_a_run_that_cannot_begin_says_why(self):
        self.write("empty/notes.txt", "")
        rows = [
            ("no such folder", ["none", "--job", "htr"], ["none", "no such folder"]),
            ("nothing of the kind", ["empty", "--job", "orn"], ["empty", ".htr"]),
            ("a profile that is not there", ["takes", "--job", "htr", "--profile", "Nobody"], ["Nobody"]),
            ("a profile that does not fit", ["takes", "--job", "htr", "--profile", "Max BVH"], ["Unable to convert"]),
        ]
        before = self.files()
        for what, arguments, words in rows:
            with self.subTest(what):
                result = self.with_assets("batch", *arguments)
                self.assertEqual(result.code, FAILED)
                self.assert_words(result, words)
                self.assertEqual(self.files(), before)


class Told(CliTest):

    def install(self, name, rows):
        self.environment["XDG_CONFIG_HOME"] = str(self.folder / "home" / ".config")
        self.write("home/.config/user-dirs.dirs", 'XDG_DOCUMENTS_DIR="$HOME/Papers"\n')
        self.write("home/Papers/BVH Profile/%s.prf" % name, profile(name, rows))

    @posix_only("the registry has the folder; see CRegistryPlatform")
    def test_a_users_own_profile_is_found_by_its_name(self):
        self.install("Mine", [("hip", "LowerTorso")])
        self.assertIn("Mine (own", self.succeed("profiles").out)
        result = self.succeed("convert", WALK, "-o", "a.htr", "--profile", "mine", "--json")
        self.assertEqual(json.loads(result.out)["profile"], "Mine")

    def test_a_result_is_measured_in_either_form(self):
        self.succeed("convert", WALK, "-o", "a.htr")
        self.succeed("convert", WALK, "-o", "a.Kinetra")
        figures = [json.loads(self.succeed("compare", WALK, name, "--profile", "Poser BVH", "--json").out)
                   for name in ("a.htr", "a.Kinetra")]
        self.assertEqual(figures[0], figures[1])
        self.assertEqual(figures[0]["frameScale"], 4)
        self.assertEqual({foot["target"] for foot in figures[0]["feet"]}, {"LFoot", "RFoot"})
        self.assertIn("LForearm", self.succeed("compare", WALK, "a.htr", "--profile", "Poser BVH").out)

    def test_a_comparison_that_cannot_be_made_says_why(self):
        self.succeed("convert", WALK, "-o", "a.htr")
        self.write("scene.Kinetra", one_bone_scene())
        for what, arguments, words in [
                ("no source", ["none.bvh", "a.htr", "--profile", "Poser BVH"], ["none.bvh"]),
                ("no result", [WALK, "none.htr", "--profile", "Poser BVH"], ["none.htr"]),
                ("a result that is no package", [WALK, "scene.Kinetra", "--profile", "Poser BVH"], ["scene.Kinetra"]),
                ("a profile for other bones", [WALK, "a.htr", "--profile", "Max BVH"], ['no bone "Hips"'])]:
            with self.subTest(what):
                result = self.with_assets("compare", *arguments)
                self.assertEqual((result.code, result.out), (FAILED, ""))
                self.assert_words(result, words)


if __name__ == "__main__":
    main()
