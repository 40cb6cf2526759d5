"""Pages about runs: made from the records of this run and of earlier ones, small however long the run."""
import json
import xml.etree.ElementTree as ElementTree

from harness import ASSETS, DONE, FAILED, WALK, CliTest, main, posix_only

FILES = 10_000


class RunPage(CliTest):
    def page(self, name="page.html"):
        text = self.read(name).decode()
        ElementTree.fromstring(text)
        data = text.split('id="rows">', 1)[1].split("</script>", 1)[0] if 'id="rows"' in text else "{}"
        return text, json.loads(data)

    def test_what_is_told_of_a_run_converts_nothing_again(self):
        for name in ("a", "b", "c"):
            self.write("takes/%s.bvh" % name, WALK.read_bytes())
        run = ["convert", "takes", "--out-dir", "out", "--resume", "--force", "--json"]
        whole = json.loads(self.succeed(*run, "--html", "page.html").out.splitlines()[-1])
        for options in (["--check"], ["--html", "again.html"], ["--html", "again.html", "--check"],
                        ["--report", "report.jsonl"]):
            again = json.loads(self.succeed(*run, *options).out.splitlines()[-1])
            self.assertEqual((whole["converted"], again["converted"], again["skipped"]), (3, 0, 3), options)
        first, second = self.page(), self.page("again.html")
        self.assertEqual(first[1], second[1], "figures of skipped files")
        self.assertEqual(first[0].split("<section")[1:], second[0].split("<section")[1:], "and details")

    def test_a_page_links_the_model_beside_it(self):
        self.write("pages/a b.glb", "old")
        for output, link in (("pages/sub/c%.glb", "sub/c%25.glb"), ("a b.Kinetra", "a%20b.glb"), ("c.glb", None)):
            (self.folder / output).parent.mkdir(exist_ok=True)
            self.succeed("convert", WALK, "-o", output, "--html", "pages/page.html", "--force")
            links = [part.split('"')[0] for part in self.page("pages/page.html")[0].split('<a href="')[1:]]
            self.assertEqual(links, [link] if link else [], output)

    @posix_only("the records are made from paths with slashes")
    def test_ten_thousand_files_make_a_small_page(self):
        self.write("takes/a.bvh", WALK.read_bytes())
        self.succeed("plan", "takes", "--shards", 1, "-o", "plan.jsonl", "--out-dir", "out")
        self.succeed("run", "plan.jsonl", "--shard", 0)
        head, entry = self.read("plan.jsonl").decode().splitlines()
        record = self.read("plan.shard-0.jsonl").decode()
        names = ["takes/a.bvh" if i < 30 else "archive/session_%03d/take_%05d.bvh" % (i // 50, i) for i in range(FILES)]
        outputs = ["out/take_%05d.Kinetra" % i for i in range(FILES)]
        fit = lambda line, i: line.replace("takes/a.bvh", names[i]).replace("out/a.Kinetra", outputs[i])
        records = [fit(record, i).replace('"soleTilt":0', '"soleTilt":%d' % (80 if i < 30 else i % 9))
                   for i in range(FILES)]
        records[-1] = json.dumps({**json.loads(records[-1]), "outcome": "failed", "failures": [
            {"path": names[-1], "where": 7, "code": "misfit", "name": "", "words": "nothing fits"}]}).replace(": ", ":")
        self.write("plan.jsonl", "\n".join([head] + [fit(entry, i) for i in range(FILES)]) + "\n")
        self.write("plan.shard-0.jsonl", "".join(line.strip() + "\n" for line in records))
        merged = self.run_program("merge-report", "plan.jsonl", "-o", "all.jsonl", "--html", "page.html",
                                  "--data-dir", ASSETS)
        self.assertEqual(merged.code, FAILED, "one source has failed")
        text, data = self.page()
        self.assertLess(len(text), 5_000_000)
        self.assertEqual((len(data["rows"]), text.count("<section")), (FILES - 1, 20))
        self.assertLess(text.index("line 7: nothing fits"), text.index("Totals"))


if __name__ == "__main__":
    main()
