"""A run divided into shards: plan, run, merge-report, against one run over the same sources."""
import json
import re

from harness import DONE, FAILED, USAGE, WALK, CliTest, main
from made import BVH

BROKEN = BVH.replace("Frames: 3", "Frames: 30")
TAKES = 9
DEEP = b'{"x":' + b"[" * 70_000 + b"]" * 70_000 + b"}\n"


def without_time(text):
    """A report as it is for every run: without what its sources took, and in which attempt."""
    return re.sub(rb',"seconds":[0-9.]+(,"resumed":true)?', b"", text)


class Shards(CliTest):
    def setUp(self):
        super().setUp()
        for number in range(TAKES):
            self.write("takes/%s/t%d.bvh" % ("ab"[number % 2], number), WALK.read_bytes())
        self.write("takes/a/t4.bvh", BROKEN)

    def plan(self, *options, shards=3):
        return self.succeed("plan", "takes", "--shards", shards, "-o", "plan.jsonl", "--force", *options)

    def shard(self, number):
        return self.with_assets("run", "plan.jsonl", "--shard", number, "--quiet")

    def results(self, folder):
        return {str(p.relative_to(self.folder / folder)): p.read_bytes()
                for p in (self.folder / folder).rglob("*.Kinetra")}

    def test_shards_in_any_order_make_what_one_run_makes(self):
        one = self.with_assets("convert", "takes", "--out-dir", "one", "--keep-going", "--report", "one.jsonl",
                               "--no-legs", "--profile", "Poser BVH")
        self.plan("--out-dir", "many", "--no-legs", "--profile", "Poser BVH")
        self.assertEqual(sorted(self.shard(number).code for number in (2, 0, 1)), [DONE, DONE, FAILED])
        merged = self.run_program("merge-report", "plan.jsonl", "-o", "many.jsonl")
        self.assertEqual((merged.code, merged.out), (one.code, ""))
        self.assertEqual(merged.err.splitlines()[-1], one.err.splitlines()[-1])
        self.assertIn("takes/a/t4.bvh:", merged.err)
        self.assertEqual(self.results("many"), self.results("one"))
        self.assertEqual(re.sub(rb'"many(/|\\\\)', rb'"one\1', without_time(self.read("many.jsonl"))),
                         without_time(self.read("one.jsonl")))

    def test_a_shard_that_was_not_run_to_its_end_is_named_and_goes_on(self):
        self.plan("--out-dir", "many")
        for number in range(3):
            self.shard(number)
        whole = self.run_program("merge-report", "plan.jsonl")
        self.assertEqual(whole.code, FAILED)
        report = self.read("plan.shard-1.jsonl")
        self.write("plan.shard-1.jsonl", report[:-20])
        cut = self.run_program("merge-report", "plan.jsonl", "--json")
        self.assertEqual((cut.code, json.loads(cut.out.splitlines()[-1])["left"]), (FAILED, 1))
        self.assertIn("shard 1: 1 sources are left", cut.err)
        again = self.with_assets("run", "plan.jsonl", "--shard", 1)
        self.assertIn("0 converted, %d skipped, 0 failed" % report.count(b"\n"), again.err)
        self.assertEqual(without_time(self.run_program("merge-report", "plan.jsonl").out.encode()),
                         without_time(whole.out.encode()))

    def test_nested_lines_of_reports_and_of_what_was_done_are_skipped(self):
        self.plan("--out-dir", "many", shards=1)
        self.shard(0)
        first, rest = self.read("plan.shard-0.jsonl").split(b"\n", 1)
        self.write("plan.shard-0.jsonl", first + b"\n" + DEEP + rest)
        self.write("many/.gaitwright.resume.deep.jsonl", DEEP)
        merged = self.run_program("merge-report", "plan.jsonl", "-o", "all.jsonl")
        self.assertIn("plan.shard-0.jsonl:2: this line is nested too deeply", merged.err)
        self.assertEqual(self.read("all.jsonl").count(b"\n"), TAKES)
        self.assertIn("%d skipped" % (TAKES - 1), self.with_assets("run", "plan.jsonl", "--shard", 0).err)

    def test_another_division_knows_what_was_done(self):
        self.plan("--out-dir", "many")
        self.shard(0)
        done = len(self.results("many"))
        self.plan("--out-dir", "many", shards=1)
        self.assertIn("%d skipped" % done, self.with_assets("run", "plan.jsonl", "--shard", 0).err)

    def test_shards_are_even(self):
        for number, size in enumerate([900, 10, 500, 400, 300, 600, 20]):
            self.write("sizes/s%d.bvh" % number, "x" * 1000 * size)
        self.succeed("plan", "sizes", "--shards", 3, "-o", "plan.jsonl")
        work = [0, 0, 0]
        for line in self.read("plan.jsonl").splitlines()[1:]:
            entry = json.loads(line)
            work[entry["shard"]] += entry["bytes"]
        self.assertLess(max(work) - min(work), 60_000, work)
        self.assertEqual(sum(work), 2_730_000)
        for number in range(20):  # files that are nothing but work of their own
            self.write("small/s%d.bvh" % number, "x" * (100_000 if number == 0 else 1))
        self.succeed("plan", "small", "--shards", 2, "-o", "plan.jsonl", "--force")
        beside = [json.loads(line)["shard"] for line in self.read("plan.jsonl").splitlines()[1:]]
        self.assertGreater(beside.count(beside[0]), 3)

    def test_without_an_output_folder_results_lie_beside_their_sources(self):
        self.plan(shards=2)
        for attempt in ("converted", "skipped"):
            said = "".join(self.with_assets("run", "plan.jsonl", "--shard", number).err for number in (0, 1))
            self.assertEqual(sum(map(int, re.findall(r"(\d+) %s" % attempt, said))), TAKES - 1)
            self.assertEqual(len(self.results("takes")), TAKES - 1)

    def test_what_is_no_plan_is_refused_in_its_line(self):
        self.plan("--out-dir", "many")
        plan = self.read("plan.jsonl")
        head, first, rest = plan.split(b"\n", 2)
        rows = [  # what, plan, words
            ("nothing", b"", "not a plan"),
            ("too many shards", plan.replace(b'"shards":3', b'"shards":99999999999'), "not a plan"),
            ("another version", plan.replace(b'"version":"', b'"version":"9'), "create it again"),
            ("an option that there is not", plan.replace(b'"options":{', b'"options":{"--magic":true'), "--magic"),
            ("a cut line", head + b"\n" + first[:-9] + b"\n" + rest, "wrong.jsonl:2:"),
            ("a shard that there is not", plan.replace(b'"shard":1', b'"shard":3'), "wrong.jsonl:"),
            ("deep", b"[" * 100_000, "wrong.jsonl:1: this line is nested too deeply"),
            ("deep options", plan.replace(b'"options":{', b'"options":{"--x":' + DEEP[5:-2]), "nested too deeply"),
        ]
        for what, text, words in rows:
            with self.subTest(what):
                self.write("wrong.jsonl", text)
                result = self.with_assets("run", "wrong.jsonl", "--shard", 0)
                self.assertEqual((result.code, result.out), (FAILED, ""))
                self.assert_words(result, [words])
                self.assertFalse((self.folder / "many").exists())
        self.assertEqual(self.with_assets("run", "plan.jsonl", "--shard", 3).code, USAGE)
        self.assertEqual(self.with_assets("plan", "takes", "--shards", 0, "-o", "p").code, USAGE)
        self.assertEqual(self.with_assets("run", "none.jsonl", "--shard", 0).code, FAILED)


if __name__ == "__main__":
    main()
