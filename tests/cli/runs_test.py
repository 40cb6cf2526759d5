"""Runs over many files by several processes: what they leave, whatever becomes of a file, a worker or the run."""
import json
import os
import pty
import signal
import subprocess
import time
from pathlib import Path

from harness import (ASSETS, DONE, FAILED, PROGRAM, SECONDS, USAGE, WALK, WINDOWS, CliTest, main, posix_only,
                     without_backslashes)
from made import BVH

BROKEN = BVH.replace("Frames: 3", "Frames: 30")
INTERRUPTED = 130
TAKES = 24


def lines(text):
    return [json.loads(line) for line in (without_backslashes(text) if WINDOWS else text).splitlines()]


def slow_source():
    """A motion that takes a good part of a second, of which most is writing."""
    head, rows = WALK.read_text().split("Frames: 67\n")
    frame_time, *frames = rows.splitlines()
    return head + "Frames: %d\n" % (100 * len(frames)) + "\n".join([frame_time] + 100 * frames) + "\n"


class RunTest(CliTest):
    def setUp(self):
        super().setUp()
        walk = WALK.read_bytes()
        for number in range(TAKES):
            self.write("takes/%s/t%02d.bvh" % ("ab"[number % 2], number), walk)

    def convert(self, *arguments, **keywords):
        return self.with_assets("convert", "takes", "--out-dir", "out", *arguments, **keywords)

    def results(self, folder="out"):
        return {str(p.relative_to(self.folder / folder)): p.read_bytes()
                for p in sorted((self.folder / folder).rglob("*.Kinetra"))}

    def report(self, name="report.jsonl"):
        return lines(self.read(name).decode())

    def start(self, *arguments):
        """Starts a run over the takes that goes on while the test looks."""
        command = [PROGRAM, "convert", "takes", "--out-dir", "out", "--data-dir", ASSETS, *arguments]
        run = subprocess.Popen([str(word) for word in command], cwd=self.folder, env=self.environment,
                               stdout=subprocess.PIPE, stderr=subprocess.PIPE)
        self.addCleanup(run.wait)
        self.addCleanup(run.kill)
        return run

    def worker_at_slow(self, run):
        """Stops the worker that writes the result of the slow source, and answers its process."""
        while run.poll() is None:
            for path in self.folder.glob("out/a/.gaitwright-*"):
                worker = int(path.name.split("-")[2].split(".")[0], 16)  # the name tells whose it is
                if self.is_large(path):
                    os.kill(worker, signal.SIGSTOP)
                    self.assertTrue(self.is_large(path), "stopped too late")
                    return worker
            time.sleep(0.001)
        self.fail("no worker came to the slow source")

    @staticmethod
    def is_large(path):
        """As only that of the slow source becomes."""
        try:
            return path.stat().st_size > 1_000_000
        except OSError:
            return False  # it has its name by now

    def crash(self, worker, number):
        os.kill(worker, number)
        os.kill(worker, signal.SIGCONT)

    def end(self, run):
        out, err = run.communicate(timeout=SECONDS)
        return run.returncode, out.decode(), err.decode()


class Same(RunTest):
    def test_any_number_of_workers_leaves_the_same_and_says_the_same(self):
        self.write("takes/a/t09.bvh", BROKEN)
        self.write("takes/b/t20.bvh", "no motion")
        for what, options in [("goes on", ["--keep-going"]), ("ends at the first failure", [])]:
            with self.subTest(what):
                told = []
                for jobs in (1, 2, 8):
                    result = self.convert("--jobs", jobs, "--json", "--force", *options)
                    told.append((result.code, result.out, result.err, self.results(), self.files()))
                    for path in self.results():
                        (self.folder / "out" / path).unlink()
                self.assertEqual(told[0], told[1])
                self.assertEqual(told[0], told[2])
                self.assertEqual(told[0][0], FAILED)

    def test_a_failure_leaves_nothing_of_what_comes_behind_it(self):
        self.write("takes/a/t00.bvh", slow_source() + "\n")
        self.write("takes/a/t02.bvh", BROKEN)
        result = self.convert("--jobs", 4)
        self.assertEqual((result.code, list(self.results())), (FAILED, ["a/t00.Kinetra"]))
        self.assertIn("1 converted, 0 skipped, 1 failed, %d left" % (TAKES - 2), result.err)

    def test_a_batch_into_a_folder_goes_through_the_tree_and_on(self):
        self.write("takes/a/t12.bvh", BROKEN)
        result = self.with_assets("batch", "takes", "--job", "htr", "--json", "--out-dir", "out", "--keep-going",
                                  "--report", "report.jsonl")
        self.assertEqual((result.code, lines(result.out)[-1]["finished"]), (FAILED, TAKES - 1))
        self.assertEqual(len([f for f in self.files() if f.startswith("out/") and f.endswith(".htr")]), TAKES - 1)
        self.assertEqual([line["source"] for line in self.report() if line["outcome"] == "failed"],
                         ["takes/a/t12.bvh"])
        again = self.with_assets("batch", "takes", "--job", "orn", "--out-dir", "orn")
        self.assertEqual((again.code, "takes" in again.err), (FAILED, True))  # there is no .htr among them


class Sources(RunTest):
    @posix_only("the emulator shows no links")
    def test_a_tree_is_mirrored_without_its_results_and_its_rings(self):
        self.write("takes/z.bvh", WALK.read_bytes())
        (self.folder / "takes/a/ring").symlink_to("..")
        (self.folder / "takes/b/up").symlink_to("../..")
        (self.folder / "takes/link").symlink_to("../other")
        self.write("other/o.bvh", WALK.read_bytes())
        self.write("takes/out/old.bvh", BROKEN)
        for jobs in (1, 3):
            result = self.succeed("convert", "takes", "--out-dir", "takes/out", "--force", "--jobs", jobs, "--verbose")
            names = [line.split(" -> ")[0] for line in result.out.splitlines()]
            self.assertEqual(names, ["takes/z.bvh"] + ["takes/a/t%02d.bvh" % n for n in range(0, TAKES, 2)] +
                             ["takes/b/t%02d.bvh" % n for n in range(1, TAKES, 2)] + ["takes/link/o.bvh"])
        self.assertEqual(set(self.results("takes/out")),
                         {name.split("/", 1)[1].replace(".bvh", ".Kinetra") for name in names})

    def test_a_list_names_sources_as_the_command_line_does(self):
        self.write("two words.bvh", WALK.read_bytes())
        names = ["takes/b/t01.bvh", "takes/a/t00.bvh"]
        rows = [  # what, list, options, sources
            ("lines", "\n".join(names) + "\n", [], ["b/t01", "a/t00"]),
            ("zero bytes", "\0".join(names) + "\0", ["-0"], ["b/t01", "a/t00"]),
            ("a folder", "takes/a\n", ["--quiet"], ["a/t%02d" % n for n in range(0, TAKES, 2)]),
            ("a name with a blank", "two words.bvh\n", [], ["two words"]),
        ]
        for what, text, options, expected in rows:
            with self.subTest(what):
                self.write("list", text)
                self.succeed("convert", "--files-from", "list", "--out-dir", what, *options)
                self.assertEqual(sorted(self.results(what)), sorted(name + ".Kinetra" for name in expected))
        result = self.with_assets("convert", "--files-from", "nowhere", "--out-dir", "x")
        self.assertEqual((result.code, "nowhere" in result.err), (FAILED, True))

    def test_options_that_do_not_go_together_are_refused(self):
        rows = [("--jobs", "0"), ("--jobs", "many"), ("--jobs", "99999"), ("--resume", "--skip-existing"),
                ("--null",), ("--dry-run", "--report", "r"), ("--time-limit", "0")]
        for options in rows:
            with self.subTest(options):
                self.assertEqual(self.convert(*options).code, USAGE)
        self.assertEqual(self.with_assets("convert", "takes/a/t00.bvh", "--resume").code, USAGE)
        self.assertFalse((self.folder / "out").exists())


@posix_only("stops and ends processes by signals")
class Lost(RunTest):
    def setUp(self):
        super().setUp()
        self.write("takes/a/t10.bvh", slow_source())

    def assert_lost(self, result, code, words):
        exit_code, _, err = result
        self.assertEqual(exit_code, FAILED)
        self.assertIn("takes/a/t10.bvh: " + words, err)
        self.assertEqual(len(self.results()), TAKES - 1)
        told = {line["source"]: line for line in self.report()}
        self.assertEqual((len(told), told["takes/a/t10.bvh"]["failures"][0]["code"]), (TAKES, code))
        self.assertEqual([f for f in self.files() if "/.gaitwright-" in f], [])

    def test_a_crash_costs_its_own_file_only(self):
        for number in (signal.SIGSEGV, signal.SIGKILL):
            with self.subTest(number):
                run = self.start("--jobs", "2", "--keep-going", "--report", "report.jsonl", "--force")
                self.crash(self.worker_at_slow(run), number)
                self.assert_lost(self.end(run), "crashed", "the conversion crashed")

    def test_a_file_that_hangs_is_given_up(self):
        run = self.start("--jobs", "2", "--keep-going", "--report", "report.jsonl", "--time-limit", "5")
        self.worker_at_slow(run)
        self.assert_lost(self.end(run), "time-limit", "not done within 5 seconds")

    def test_an_interrupted_run_ends_whole_and_goes_on_later(self):
        for number in (signal.SIGINT, signal.SIGTERM):
            with self.subTest(number):
                run = self.start("--jobs", "1", "--keep-going", "--resume", "--report", "report.jsonl")
                worker = self.worker_at_slow(run)
                run.send_signal(number)
                time.sleep(0.1)
                os.kill(worker, signal.SIGCONT)
                code, _, err = self.end(run)
                self.assertEqual(code, INTERRUPTED)
                self.assertIn("interrupted", err)
                done = self.results()
                self.assertIn("a/t10.Kinetra", done)  # what was under way is finished
                self.assertLess(len(done), TAKES)
                self.assertEqual([line["outcome"] for line in self.report()], ["converted"] * len(done))
                self.assertEqual([f for f in self.files() if "/.gaitwright-" in f], [])
                again = self.convert("--resume", "--report", "report.jsonl")
                self.assertEqual((again.code, len(self.results())), (DONE, TAKES))
                self.assertIn("%d converted, %d skipped" % (TAKES - len(done), len(done)), again.err)
                (self.folder / "out/.gaitwright.resume.run.jsonl").unlink()
                for path in self.results():
                    (self.folder / "out" / path).unlink()

    def test_a_run_that_was_killed_leaves_whole_lines_and_is_resumed(self):
        run = self.start("--jobs", "2", "--resume", "--report", "report.jsonl")
        worker = self.worker_at_slow(run)
        run.kill()
        self.end(run)
        os.kill(worker, signal.SIGKILL)
        while Path("/proc/%d" % worker).exists():
            time.sleep(0.001)
        self.assertTrue(all(line["outcome"] == "converted" for line in self.report()))
        result = self.convert("--resume", "--report", "report.jsonl")
        self.assertEqual((result.code, len(self.results()), len(self.report())), (DONE, TAKES, TAKES))
        self.assertEqual([f for f in self.files() if "/.gaitwright-" in f], [])


class Resumed(RunTest):
    def test_a_second_run_converts_what_changed_and_nothing_else(self):
        self.write("takes/b/t01.bvh", BROKEN)
        self.write("assets/own.prf", (ASSETS / "PoserBVH.prf").read_bytes())
        run = ["--resume", "--keep-going", "--report", "report.jsonl", "--profile", "assets/own.prf"]
        self.assertEqual(self.convert(*run).code, FAILED)
        first = self.results()
        report = self.report()
        changes = [  # what, change, how many are converted
            ("nothing", lambda: None, 0),
            ("an output is gone", lambda: (self.folder / "out/a/t00.Kinetra").unlink(), 1),
            ("an output was touched", lambda: (self.folder / "out/a/t02.Kinetra").touch(), 0),
            ("a source was changed", lambda: self.write("takes/a/t00.bvh", WALK.read_bytes() + b"\n"), 1),
            ("the profile was changed", lambda: self.write("assets/own.prf", self.read("assets/own.prf") + b"\n"),
             TAKES - 1),
            ("the state was cut", lambda: self.write("out/.gaitwright.resume.run.jsonl",
                                                     self.read("out/.gaitwright.resume.run.jsonl")
                                                     .rpartition(b'{"synced"')[0][:-9]), 1),
        ]
        for what, change, count in changes:
            with self.subTest(what):
                change()
                result = self.convert(*run)
                self.assertEqual(result.code, FAILED)  # the broken one is named every time
                self.assertIn("t01.bvh:", result.err)
                self.assertIn("%d converted, %d skipped, 1 failed, 0 left" % (count, TAKES - 1 - count), result.err)
                self.assertEqual(self.results(), first)
                self.assertEqual([(line["source"], line["outcome"], line["frames"]) for line in self.report()],
                                 [(line["source"], line["outcome"], line["frames"]) for line in report])
        self.assertIn("%d converted" % (TAKES - 1), self.convert(*run, "--no-legs").err)

    def test_a_strangers_file_is_not_replaced(self):
        self.write("out/a/t00.Kinetra", "a stranger's")
        result = self.convert("--resume", "--keep-going")
        self.assertEqual((result.code, self.read("out/a/t00.Kinetra")), (FAILED, b"a stranger's"))
        self.assertIn("--force", result.err)
        self.assertEqual(self.convert("--resume", "--force").code, DONE)
        self.assertNotEqual(self.read("out/a/t00.Kinetra"), b"a stranger's")

    def test_a_result_that_was_edited_since_is_kept_and_named(self):
        self.convert("--resume")
        made = self.read("out/a/t00.Kinetra")
        self.write("out/a/t00.Kinetra", "edited")
        for what, options in [("as before", []), ("with another way to convert", ["--no-legs"])]:
            with self.subTest(what):
                result = self.convert("--resume", "--keep-going", "--report", "report.jsonl", *options)
                self.assertEqual((result.code, self.read("out/a/t00.Kinetra")), (FAILED, b"edited"))
                self.assertIn("out/a/t00.Kinetra: this file was changed", result.err)
                told, = [line for line in self.report() if line["outcome"] == "failed"]
                self.assertEqual(told["failures"][0]["code"], "changed")
        self.assertEqual((self.convert("--resume", "--force").code, self.read("out/a/t00.Kinetra")), (DONE, made))

    def test_a_report_is_not_replaced_unasked_and_a_full_disk_is_told(self):
        self.write("plan.jsonl", '{"shard":0,"source":"a","output":"b"}\n')
        self.write("other.jsonl", '{"source":"a.bvh","output":"b.bvh"}\n')
        rows = [  # what, report, options
            ("a motion, resumed", "takes/a/t00.bvh", ["--resume"]),
            ("other lines, resumed", "other.jsonl", ["--resume"]),
            ("a plan", "plan.jsonl", []),
        ]
        for what, name, options in rows:
            with self.subTest(what):
                before = self.read(name)
                self.assertEqual(self.convert("--report", name, *options).code, FAILED)
                self.assertEqual((self.read(name), (self.folder / "out/a").exists()), (before, False))
        result = self.convert("--report", "/dev/full", "--force")
        self.assertEqual((result.code, len(self.results())), (FAILED, TAKES))
        self.assertIn("/dev/full: the end of the report cannot be written", result.err)

    def test_the_line_of_a_single_file_goes_to_a_report_too(self):
        self.succeed("convert", WALK, "-o", "walk.htr", "--report", "report.jsonl")
        line, = self.report()
        self.assertEqual((line["output"], line["outcome"]), ("walk.htr", "converted"))
        checked = self.succeed("convert", WALK, "-o", "walk.htr", "--check", "--json", "--force")
        self.assertEqual(line["figures"]["travelRatio"], json.loads(checked.out)["check"]["travelRatio"])
        self.assertNotIn("figures", json.loads(checked.out))

    def test_a_page_about_many_is_the_same_by_any_number_of_processes(self):
        self.write("takes/a/t12.bvh", BROKEN)
        pages = []
        for jobs in (1, 3):
            self.convert("--keep-going", "--force", "--jobs", jobs, "--html", "page.html")
            pages.append(self.read("page.html").decode())
        self.assertEqual(pages[0], pages[1])
        self.assertEqual(pages[0].count("<section id=\"motion"), 20)
        self.assertEqual(pages[0].count(".bvh\",0,0,67,"), TAKES - 1)
        self.assertIn("Failed: 1<", pages[0])


class Shown(RunTest):
    def terminal_words(self, *arguments):
        master, slave = pty.openpty()
        command = [PROGRAM, "convert", "takes", "--out-dir", "out", "--data-dir", ASSETS, "--force", *arguments]
        run = subprocess.Popen([str(word) for word in command], cwd=self.folder, env=self.environment,
                               stdout=subprocess.DEVNULL, stderr=slave)
        os.close(slave)
        text = b""
        while True:
            try:
                piece = os.read(master, 65536)
            except OSError:
                break
            text += piece
        os.close(master)
        self.assertEqual(run.wait(SECONDS), DONE)
        return text.decode()

    def test_a_terminal_shows_how_far_a_run_is_and_nothing_else_does(self):
        self.assertRegex(self.terminal_words("--jobs", "1", "--check", "--align"), r"\[=*>? *\] \d+/%d" % TAKES)
        for option in ("--quiet", "--json"):
            self.assertNotIn("[", self.terminal_words(option))
        self.assertNotIn("[", self.convert("--force").err)


if __name__ == "__main__":
    main()
