"""Files that convert only with help: drafted profiles, repaired sources, and what a run says in the end."""
import json
import re
import shutil

from harness import DONE, FAILED, WALK, CliTest, main
from made import BVH

# Names that no installed profile has, but that tell which joint is which.
ODD = re.sub(r"(ROOT |JOINT )(\w+)", r"\1\2_jnt", WALK.read_text())
OTHER = ODD.replace("_jnt", "_bone")
# Faults that a reader refuses and that can be repaired.
GAP = WALK.read_text().replace("MOTION\n", "MOTION\n\n")
TORN = WALK.read_text()[:-3000]


def slower(text):
    """The same skeleton in another motion."""
    return "\n".join(line.replace("1", "2") if line[:1] in "-0123456789" else line for line in text.splitlines())


class Helped(CliTest):
    def run_takes(self, *options):
        return self.with_assets("convert", "takes", "--out-dir", "out", "--keep-going", *options)

    def results(self):
        return {p.name: p.read_bytes() for p in (self.folder / "out").rglob("*.Kinetra")}

    def drafts(self, folder):
        return sorted(p.name for p in (self.folder / folder).glob("*.prf"))


class Draft(Helped):
    def test_a_draft_is_the_profile_that_suggest_makes(self):
        self.write("odd.bvh", ODD)
        result = self.with_assets("convert", "odd.bvh", "-o", "a.htr")
        self.assertEqual(result.code, FAILED)
        self.assert_words(result, ["more, see 'gaitwright profiles odd.bvh'", "  --draft",
                                   "gaitwright suggest odd.bvh -o odd.prf"])
        self.assertEqual(result.err.count("the source has no bone"), 3)
        self.assertIn('by drafted profile "odd"', self.succeed("convert", "odd.bvh", "-o", "a.htr", "--draft").out)
        self.succeed("suggest", "odd.bvh", "-o", "odd.prf")
        self.succeed("convert", "odd.bvh", "-o", "b.htr", "--profile", "odd.prf")
        self.assertEqual(self.read("a.htr"), self.read("b.htr"))
        self.assertEqual(self.files(), ["a.htr", "b.htr", "odd.bvh", "odd.prf"])

    def test_what_is_not_sure_is_not_used(self):
        strange = re.sub(r"(ROOT |JOINT )(\w+)", lambda m: m.group(1) + "n" + str(m.start()), WALK.read_text())
        for what, text, words in (("by shape only", strange, ["are not sure: hip", "gaitwright suggest a.bvh"]),
                                  ("no body", BVH.replace("Hips", "x"), ["no complete body", "missing: hip"])):
            with self.subTest(what):
                self.write("a.bvh", text)
                result = self.with_assets("convert", "a.bvh", "-o", "a.htr", "--drafts", "maps")
                self.assertEqual((result.code, self.files()), (FAILED, ["a.bvh"]))
                self.assert_words(result, words)
                self.assertEqual("suggest" in result.err, what != "no body")

    def test_one_draft_serves_a_skeleton_whoever_is_faster(self):
        self.write("takes/a/first.bvh", slower(ODD))
        for number in range(6):
            self.write("takes/b/t%d.bvh" % number, (ODD, OTHER)[number % 2])
        told = []
        for jobs in (1, 4):
            result = self.run_takes("--drafts", "maps", "--jobs", jobs, "--report", "r.jsonl", "--force")
            lines = [json.loads(line) for line in self.read("r.jsonl").splitlines()]
            told.append((result.err, self.results(), [(line["profile"], line["profilePath"]) for line in lines]))
            names = self.drafts("maps")
            self.assertEqual([re.sub(r"\.\w{12}\.", ".", name) for name in names], ["first.prf", "t1.prf"])
            for name in names:
                (self.folder / "maps" / name).unlink()
        self.assertEqual(told[0], told[1])
        self.assertIn("7 converted, 0 skipped, 0 failed, 0 left, 7 by drafted profiles", told[0][0])

    def test_a_corrected_draft_outdates_what_it_made(self):
        for name, text in (("a", ODD), ("b", slower(ODD)), ("c", OTHER), ("d", WALK.read_text())):
            self.write("takes/%s.bvh" % name, text)
        for drafts, options in (("out/.gaitwright.drafts", ["--draft"]), ("maps", ["--drafts", "maps"])):
            with self.subTest(drafts):
                shutil.rmtree(self.folder / "out", ignore_errors=True)
                self.run_takes("--resume", *options)
                self.assertIn("0 converted, 4 skipped", self.run_takes("--resume", *options).err)
                path = self.folder / drafts / self.drafts(drafts)[0]
                path.write_text(path.read_text().replace("FrameRate 30", "FrameRate 60"))
                self.assertIn("2 converted, 2 skipped", self.run_takes("--resume", *options).err)

    def test_shards_draft_too(self):
        for number in range(4):
            self.write("takes/t%d.bvh" % number, ODD)
        self.succeed("plan", "takes", "--shards", 2, "-o", "plan.jsonl", "--out-dir", "out", "--drafts", "maps")
        for shard in (0, 1):
            self.succeed("run", "plan.jsonl", "--shard", shard)
        self.assertEqual((len(self.results()), len(self.drafts("maps"))), (4, 1))
        self.assertIn("4 by drafted", self.succeed("merge-report", "plan.jsonl", "-o", "all.jsonl").err)


class Mend(Helped):
    def test_a_file_is_read_as_doctor_would_repair_it(self):
        for what, text, words in (("a gap", GAP, "an empty line between MOTION"), ("torn", TORN, "fewer rows")):
            with self.subTest(what):
                self.write("a.bvh", text)
                result = self.with_assets("convert", "a.bvh", "-o", "a.htr", "--force")
                self.assertEqual(result.code, FAILED)
                self.assert_words(result, ["--mend", "gaitwright doctor a.bvh --fix a-fixed.bvh"])
                self.run_program("doctor", "a.bvh", "--fix", "fixed.bvh", "--force")
                self.succeed("convert", "fixed.bvh", "-o", "b.htr", "--force")
                told = self.succeed("convert", "a.bvh", "-o", "a.htr", "--mend", "--force", "--check").out
                self.assertRegex(told, r"mended \(.*line \d+: " + words)
                self.assertEqual((self.read("a.htr"), self.read("a.bvh")), (self.read("b.htr"), text.encode()))
        self.succeed("convert", WALK, "-o", "a.htr", "--force")
        self.assertNotIn("mended", self.succeed("convert", WALK, "-o", "b.htr", "--mend", "--force").out)
        self.assertEqual(self.read("a.htr"), self.read("b.htr"))
        self.environment["TMPDIR"] = "nowhere"
        self.write("a.bvh", GAP)
        result = self.with_assets("convert", "a.bvh", "-o", "c.htr", "--mend")
        self.assertEqual((result.code, "temporary files" in result.err), (FAILED, True))


class Run(Helped):
    def test_a_run_over_everything_ends_with_one_screen(self):
        for number in range(30):
            self.write("takes/bad/b%02d.bvh" % number, "no motion")
        walk = WALK.read_bytes()
        for name in ("a.bvh", "gap.bvh", "odd.bvh", ".hidden.bvh", ".git/x.bvh", "notes.txt"):
            self.write("takes/" + name, {"gap.bvh": GAP.encode(), "odd.bvh": ODD.encode()}.get(name, walk))
        self.succeed("convert", WALK, "-o", "takes/a.htr")
        (self.folder / "takes/dead.bvh").symlink_to("gone.bvh")
        (self.folder / "takes/moved").symlink_to("/gone")
        result = self.run_takes("--mend", "--draft", "--align", "--faithful")
        self.assertEqual((result.code, result.out), (FAILED, ""))
        self.assertEqual(sorted(self.results()), ["a.Kinetra", "a.htr.Kinetra", "gap.Kinetra", "odd.Kinetra"])
        self.assert_words(result, ["4 converted, 0 skipped, 32 failed, 0 left, 2 by drafted profiles, 1 mended",
                                   "  takes/bad/b19.bvh:1: a section or keyword is missing", "  12 more;", "    30  ", "     2  a link to a file that does not exist"])
        self.assertLess(len(result.err.splitlines()), 45)
        lines = [json.loads(line) for line in self.run_takes("--json", "--force").out.splitlines()]
        self.assertEqual([line["failures"][0]["words"] for line in lines[-3:-1]],
                         ["a link to a file that does not exist: \"%s\"" % name for name in ("gone.bvh", "/gone")])
        causes = {"missing-section": 30, "dead-link": 2, "blank-line": 1, "misfit": 2}
        self.assertEqual((lines[-1]["failed"], lines[-1]["causes"]), (35, causes))
        each = self.run_takes("--verbose", "--force")
        self.assertEqual((each.err.count("gaitwright: takes/bad/"), each.out.count(" -> ")), (30, 1))
        first = self.with_assets("convert", "takes/bad", "takes/odd.bvh", "--out-dir", "x")
        self.assertEqual((first.code, first.err.count("gaitwright: takes/bad/"), "30 left" in first.err), (FAILED, 1, True))

    def test_the_better_options_are_measured(self):
        self.write("walk.bvh", ODD)
        self.succeed("suggest", "walk.bvh", "-o", "m.prf")
        self.write("m.prf", re.sub(r"(arm|Calf|Torso) 0,\d,0", r"\1 40,40,40", self.read("m.prf").decode()))
        run = ("convert", "walk.bvh", "-o", "a.htr", "--profile", "m.prf", "--check", "--json", "--force")
        plain = json.loads(self.succeed(*run).out)
        best = json.loads(self.succeed(*run, "--align", "--faithful", "--report", "r.jsonl").out.splitlines()[0])
        self.assertNotIn("betterFigures", best)
        self.assertEqual(plain["betterFigures"], json.loads(self.read("r.jsonl"))["figures"])
        self.assertIn("--align --faithful would give (measured): ", self.succeed(*run[:-2], "--force").out)

    def test_a_batch_takes_the_same_help(self):
        self.write("takes/gap.bvh", GAP)
        self.succeed("batch", "takes", "--job", "htr", "--mend")
        plain = self.read("takes/gap.htr")
        told = self.succeed("batch", "takes", "--job", "htr", "--mend", "--align", "--faithful", "--check", "--verbose",
                            "--report", "r.jsonl")
        self.assertIn("directions: ", told.out)
        self.assertIn("directionError", json.loads(self.read("r.jsonl"))["figures"])
        self.assertNotEqual(self.read("takes/gap.htr"), plain)
        self.write("takes/gap.bvh", ODD)
        self.assertEqual(self.with_assets("batch", "takes", "--job", "htr").code, FAILED)
        self.assertEqual(self.with_assets("batch", "takes", "--job", "htr", "--draft").code, DONE)


if __name__ == "__main__":
    main()
