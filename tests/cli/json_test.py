"""Every command with --json: each line of standard output is an object with a status, also after a failure."""
import json
import shlex

from harness import DONE, FAILED, USAGE, WALK, CliTest, main
from made import BVH

GOOD = [  # arguments; the files that they need are made below
    "convert walk.bvh --dry-run", "convert walk.bvh", "convert walk.bvh --check -o b.htr",
    "convert takes --out-dir out", "convert walk.bvh -o b.glb --frames 3-9 --mirror --in-place",
    "batch takes --job htr", "plan takes --shards 2 -o p2.jsonl", "run plan.jsonl --shard 0", "merge-report plan.jsonl",
    "merge-report plan.jsonl --html p.html", "info walk.bvh", "info a.Kinetra", "info c.glb --list-clips", "pose walk.bvh --frame 3", "pose a.Kinetra --all -o p.npy",
    "transcode a.htr c.htr", "transcode a.htr d.glb", "resave a.Kinetra b.orn", "extract a.Kinetra -o d.htr", "package a.htr e.Kinetra --rate 30",
    "doctor walk.bvh", "doctor walk.bvh walk.bvh", "profiles", "profiles walk.bvh", "suggest walk.bvh -o s.prf",
    "compare walk.bvh a.htr --profile 'Poser BVH'", "dump a.Kinetra --out-dir pages", "dump a.Kinetra -o d.html",
    "align walk.bvh -o w.bvh", "render walk.bvh -o r.png --size 60x60", "render a.Kinetra --animate m.png --size 60x60",
]
BAD = [  # arguments, exit code, reason, line
    ("convert none.bvh", FAILED, "not-found", None), ("convert ill.bvh", FAILED, "bad-number", 20),
    ("convert ill.bvh walk.bvh --out-dir out --keep-going", FAILED, "bad-number", 20),
    ("convert walk.bvh -o a.htr", FAILED, "exists", None),
    ("convert walk.bvh --frames 900", FAILED, "no-such-frame", None),
    ("convert walk.bvh --jbos 3", USAGE, "usage", None), ("convert walk.bvh -o -", USAGE, "usage", None),
    ("batch none --job htr", FAILED, "not-found", None), ("batch pages --job htr", FAILED, "no-sources", None),
    ("compare walk.bvh a.htr --profile 'Max BVH'", FAILED, "missing-bone", 4),
    ("info c.glb --list-clips --clip none", FAILED, "no-clip", None), ("dump a.Kinetra -o d.txt", USAGE, "usage", None),
    ("merge-report plan.jsonl none.jsonl", FAILED, "unreadable-report", None),
    ("merge-report plan.jsonl --html none/p.html", FAILED, "no-folder", None),
    ("transcode none.bvh x.glb", FAILED, "not-found", None), ("plan none --shards 2 -o p.jsonl", FAILED, "not-found", None),
    ("run none.jsonl --shard 0", FAILED, "unreadable-plan", None), ("run plan.jsonl --shard 9", USAGE, "usage", None),
    ("merge-report none.jsonl", FAILED, "unreadable-plan", None), ("info ill.bvh", FAILED, "bad-number", 20),
    ("info cut.Kinetra", FAILED, None, None), ("pose none.bvh --frame 1", FAILED, "not-found", None),
    ("pose walk.bvh --all", USAGE, "usage", None), ("transcode ill.bvh x.bvh", FAILED, "bad-number", 20),
    ("resave walk.bvh x.orn", FAILED, None, None), ("extract b.orn -o x.htr", FAILED, None, None),
    ("package none.htr x.Kinetra --rate 30", FAILED, "not-found", None), ("doctor ill.bvh", FAILED, "stuck-number", 20),
    ("doctor walk.bvh ill.bvh", FAILED, "faults", None), ("profiles none.bvh", FAILED, "not-found", None),
    ("suggest small.bvh -o x.prf", FAILED, "no-body", None), ("dump none.orn --out-dir x", FAILED, "not-found", None),
    ("compare walk.bvh none.htr --profile 'Poser BVH'", FAILED, "not-found", None),
    ("align none.bvh -o x.bvh", FAILED, "not-found", None), ("align walk.bvh -o walk.bvh", FAILED, "own-source", None),
    ("render none.bvh -o x.png", FAILED, "not-found", None), ("frobnicate", USAGE, "usage", None),
]


class Json(CliTest):
    def setUp(self):
        super().setUp()
        for name in ("walk.bvh", "takes/a.bvh", "takes/b.bvh"):
            self.write(name, WALK.read_bytes())
        self.write("small.bvh", BVH)
        self.write("ill.bvh", BVH.replace("1 90 0 0 0 0 90 0 0", "1 90 0 oops 0 0 90 0 0"))
        self.succeed("convert", "walk.bvh", "-o", "a.htr")
        self.succeed("convert", "walk.bvh", "-o", "a.Kinetra")
        self.write("cut.Kinetra", self.read("a.Kinetra")[:-40])
        self.succeed("plan", "takes", "--shards", 2, "-o", "plan.jsonl", "--out-dir", "planned")
        for shard in (0, 1):
            self.succeed("run", "plan.jsonl", "--shard", shard)
        self.succeed("transcode", "walk.bvh", "c.glb")
        (self.folder / "pages").mkdir()

    def objects(self, line, code):
        result = self.with_assets(*shlex.split(line), "--json")
        self.assertEqual(result.code, code, result.err)
        objects = [json.loads(text) for text in result.out.splitlines()]
        self.assertTrue(objects)
        for each in objects:
            self.assertIn("status", each)
        return objects

    def test_every_command_is_in_both_tables(self):
        rows = self.run_program("--help").out.split("Commands:\n")[1].split("\n\n")[0].splitlines()
        commands = {row.split()[0] for row in rows if row[2] != " "}
        for table in (GOOD, [row[0] for row in BAD]):
            self.assertEqual(commands - {line.split()[0] for line in table}, set())

    def test_success(self):
        drawn = self.with_assets("render", "walk.bvh", "-o", "drawn.png", "--size", "9x9").code == DONE
        for line in GOOD:
            with self.subTest(line):
                if line.startswith("render") and not drawn:
                    continue
                objects = self.objects(line, DONE)
                self.assertFalse([each for each in objects if each["status"] == "failed"])
                self.assertEqual(objects[0]["status"] == "would_convert", "--dry-run" in line)
                many = "takes" in line and "plan" not in line or "run " in line or "walk.bvh walk" in line
                self.assertEqual("summary" in objects[-1], many or "merge" in line)

    def test_failure(self):
        for line, code, reason, place in BAD:
            with self.subTest(line):
                last = self.objects(line, code)[-1]
                self.assertEqual(last["status"], "failed")
                self.assertLessEqual({"reason", "path", "line", "byte", "name", "words"}, set(last["error"]))
                self.assertIn(reason, (None, last["error"]["reason"]))
                self.assertNotIn(last["error"]["reason"], ("", "failed", "message"))
                self.assertEqual(last["error"]["line"], place)


if __name__ == "__main__":
    main()
