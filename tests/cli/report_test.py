"""Results that are measured as they are made, and pages about them."""
import json
import xml.etree.ElementTree as ElementTree

from harness import DONE, FAILED, ROOT, USAGE, WALK, CliTest, main, posix_only
from made import BVH

WAVE = ROOT / "examples" / "wave.bvh"
POSER = ["--profile", "Poser BVH"]
OLD = "a page of somebody's own"


def lines(result):
    return [json.loads(line) for line in result.out.splitlines()]


class ReportTest(CliTest):
    def page(self, name="page.html"):
        """The page as a tree: an HTML page that is well-formed XML besides."""
        text = self.read(name).decode("utf-8")
        self.assertTrue(text.startswith("<!DOCTYPE html>"))
        self.assertNotIn("http", text)
        return ElementTree.fromstring(text)

class Check(ReportTest):
    def test_a_result_is_measured_as_compare_measures_its_file(self):
        hierarchy, motion = WAVE.read_text().split("MOTION")
        head = motion.split("\n")[:3]  # an arm that is turned by a quarter, as an .htr has it wrong
        row = "0 92 0" + " 0 0 0" * 5 + " 0 0 90 0 90 0" + " 0 0 0" * (hierarchy.count("CHANNELS") - 7)
        self.write("quarter.bvh", hierarchy + "MOTION" + "\n".join(head).replace("Frames: 90", "Frames: 9") +
                   ("\n" + row) * 9 + "\n")
        for source, name, *options in ((WALK, "Poser BVH"), ("quarter.bvh", "Max BVH"),
                                       ("quarter.bvh", "Max BVH", "--align")):
            with self.subTest(source, options=options):
                told = lines(self.succeed("convert", source, "-o", "a.htr", "--profile", name, "--force", "--check",
                                          "--json", *options))[0]
                check = told["check"]
                compared = json.loads(self.succeed("compare", source, "a.htr", "--profile", name, "--json",
                                                   *options).out)
                compared.pop("status")
                if source == "quarter.bvh":
                    forearm = next(bone for bone in check["bones"] if bone["target"] == "LForearm")
                    self.assertEqual(forearm["largestError"] < 0.01, bool(options))
                self.assertEqual(check["frameCount"], compared["frameCount"])
                self.assertEqual([foot["target"] for foot in check["feet"]], ["LFoot", "RFoot"])
                for ours, theirs in zip([check, *check["bones"], *check["feet"], *check["hands"]],
                                        [compared, *compared["bones"], *compared["feet"], *compared["hands"]]):
                    self.assert_same_figures(ours, theirs)
                self.assertEqual("plainCheck" in told, bool(options))

    def assert_same_figures(self, ours, theirs):
        for name, figure in theirs.items():
            if name == "frameScale" or isinstance(figure, (list, int)) and name != "measured":
                continue  # of the file, which has more frames; lists come by themselves
            if isinstance(figure, dict):
                self.assert_same_figures(ours[name], figure)
            elif isinstance(figure, float):
                self.assertAlmostEqual(ours[name], figure, delta=0.01 + abs(figure) * 1e-3, msg=name)
            else:
                self.assertEqual(ours[name], figure, name)

    def test_the_figures_stand_under_each_result(self):
        for name in ("a", "b"):
            self.write("takes/%s.bvh" % name, WALK.read_bytes())
        plain = self.succeed("convert", "takes", "--out-dir", "plain", "--verbose").out
        told = self.succeed("convert", "takes", "--out-dir", "out", "--check", "--verbose").out
        kept = [line for line in told.splitlines() if not line.startswith("  ")]
        self.assertEqual([line.replace("out/", "plain/") for line in kept], plain.splitlines())
        for word in ("parts: upper arm ", "contacts F1 ", "worst: frame "):
            self.assertGreaterEqual(told.count(word), 2, word)
        self.assertEqual(self.read("out/a.Kinetra"), self.read("plain/a.Kinetra"))
        self.assertEqual(self.succeed("convert", WALK, "-o", "q.htr", "--check", "--quiet").out, "")


class Page(ReportTest):

    def test_a_page_that_cannot_be_is_refused_before_the_work(self):
        self.write("page.html", OLD)
        rows = [  # what, page, code, words
            ("a page that exists", "page.html", FAILED, ["page.html", "--force"]),
            ("a motion by a slip", "walk.bvh", USAGE, ["walk.bvh", ".html"]),
            ("a folder that is not there", "none/page.html", FAILED, ["none/page.html", "folder"]),
        ]
        for what, name, code, words in rows:
            with self.subTest(what):
                before = self.files()
                result = self.with_assets("convert", WALK, "-o", "a.htr", "--html", name)
                self.assertEqual((result.code, result.out), (code, ""))
                self.assert_words(result, words)
                self.assertEqual(self.files(), before)
        self.succeed("convert", WALK, "-o", "a.htr", "--html", "page.html", "--force")
        self.page()

    @posix_only("the emulator needs the folder for temporary files")
    def test_a_page_is_whole_or_not_there(self):
        self.write("page.html", OLD)
        self.succeed("convert", WALK, "-o", "a.htr", *POSER)
        before = self.files()
        self.environment["TMPDIR"] = str(self.folder / "none")  # where a page's parts wait
        result = self.with_assets("compare", WALK, "a.htr", *POSER, "--html", "page.html", "--force")
        self.assert_words(result, ["page.html", "temporary files"])
        self.assertEqual((result.code, self.files(), self.read("page.html")), (FAILED, before, OLD.encode()))

    def test_nothing_is_written_for_nothing(self):
        self.write("broken.bvh", BVH.replace("Frames: 3", "Frames: 30"))
        self.with_assets("convert", "broken.bvh", "-o", "b.htr", "--html", "page.html")
        self.assertEqual(self.with_assets("convert", WALK, "--dry-run", "--check", "--html", "page.html").code, DONE)
        self.assertEqual(self.files(), ["broken.bvh"])


if __name__ == "__main__":
    main()
