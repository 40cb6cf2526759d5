"""Each call that a save rests on fails once: what was there stays whole, nothing is left beside it, and it is told.

The shim counts the calls of a run and lets one of them fail; a test goes through all of them, and through a sample
of the thousands of allocations."""
import atexit
import json
import os
import resource
import shutil
import signal
import struct
import subprocess
import sys
import tempfile
import time
import unittest
from collections import namedtuple
from pathlib import Path

sys.path.insert(0, str(Path(os.environ["GAITWRIGHT_ROOT"]) / "tests" / "cli"))
from harness import ASSETS, DONE, FAILED, PROGRAM, SECONDS, WALK, CliTest, main  # noqa: E402
from made import BVH, HTR, Container, profile  # noqa: E402

if Path("/dev/shm").is_dir():
    tempfile.tempdir = "/dev/shm"  # thousands of syncs: no disk has to take part

SHIM = os.environ["GAITWRIGHT_FAULT_SHIM"]
SANITIZED = os.environ["GAITWRIGHT_SANITIZED"] == "1"
OPERATIONS = ["open", "read", "write", "rename", "sync", "close", "map", "mode", "reserve"]
REASONS = {"write": "No space left on device", "rename": "Input/output error", "sync": "Input/output error"}
SAMPLES = int(os.environ.get("FAULT_SAMPLES", 40))  # of the allocations of one run
OLD = b"what was there\n"
DATA = Path(tempfile.mkdtemp(prefix="gaitwright-data-"))  # with a few profiles in place of all
atexit.register(shutil.rmtree, DATA, True)
for name in ("base.htr", "KsBone.bsm", "PoserBVH.prf", "CMUOriginalFingers.prf"):
    shutil.copy(Path(ASSETS) / name, DATA)
SMALL = profile("Small", [("Hips", "LowerTorso")])


def preload():
    if not SANITIZED:
        return SHIM
    runtime = subprocess.run(["g++", "-print-file-name=libasan.so"], capture_output=True, check=True)
    return runtime.stdout.decode().strip() + " " + SHIM


def small_motion(number):
    return BVH.replace("2 90 0", "%d 90 0" % (number + 3))


def large_motion(count):
    rows = "".join("%d 90 0 0 0 0 90 0 0\n" % (row % 100) for row in range(count))
    return BVH.replace("Frames: 3", "Frames: %d" % (count + 3)) + rows


def is_mapped(running, name):
    try:
        return name.encode() in Path("/proc/%d/maps" % running.pid).read_bytes()
    except OSError:
        return False  # it is just beginning or ending


def picture_scene():
    """An image whose pixels stand in a temporary file while it is in memory."""
    layout = struct.pack("<IHBiiiHiiI", 0, 1, 0, 2, 2, 0, 0, 96, 96, 1)
    return Container().record("CImage", 1, "", (0, 0, 0), layout + bytes(range(16)), True).bytes


# A run with the files that it begins with, those that it replaces, and names of which one is in the words of a failure.
Case = namedtuple("Case", "what command files replaced names")


def convert(output):
    # By name: where one profile of many cannot be read, the best of the others may be another one.
    profile = (Path(ASSETS) / "PoserBVH.prf").read_bytes()
    command = [PROGRAM, "convert", "a.bvh", "-o", output, "--force", "--data-dir", DATA, "--profile", "named.prf"]
    files = {"a.bvh": WALK.read_bytes(), "named.prf": profile, output: OLD}
    return Case("convert to " + output, command, files, [output],
                ["a.bvh", output, ".prf", "base.htr", "KsBone.bsm", "not enough memory"])


def resave():
    command = [PROGRAM, "resave", "in.orn", "out.orn", "--force"]
    return Case("resave a picture", command, {"in.orn": picture_scene(), "out.orn": OLD}, ["out.orn"],
                ["in.orn", "out.orn", "not enough memory"])


def merge():
    """A plan with options and a report with warnings: all kinds of lines that are nested."""
    version = subprocess.run([PROGRAM, "--version"], capture_output=True, check=True).stdout.decode().split()[-1]
    head = {"plan": 1, "version": version, "shards": 1, "outputFolder": "", "options": {"--no-legs": True}}
    source = {"shard": 0, "source": "a.bvh", "output": "a.Kinetra", "bytes": 9}
    warning = {"path": "a.bvh", "where": 7, "code": "short-row", "name": "Hips", "words": "a row is too short"}
    line = {"output": "a.Kinetra", "outcome": "converted", "failures": [], "warnings": [warning] * 3}
    files = {"plan.jsonl": json.dumps(head) + "\n" + json.dumps(source) + "\n", "one.jsonl": json.dumps(line) + "\n",
             "all.jsonl": OLD}
    command = [PROGRAM, "merge-report", "plan.jsonl", "one.jsonl", "-o", "all.jsonl", "--force"]
    return Case("merge reports", command, files, ["all.jsonl"], [".jsonl", "not enough memory"])


def plan():
    command = [PROGRAM, "plan", "a.bvh", "--shards", 1, "-o", "plan.jsonl", "--force", "--no-legs"]
    return Case("plan", command, {"a.bvh": BVH, "plan.jsonl": OLD}, ["plan.jsonl"],
                ["a.bvh", "plan.jsonl", "not enough memory"])


def batch(job, sources, extension):
    command = [PROGRAM, "batch", "takes", "--job", job, "--data-dir", DATA]
    command += ["--profile", "small.prf"] if job == "htr" else []
    results = [name[:-4] + extension for name in sources]
    files = {**sources, **{name: OLD for name in results}, "small.prf": SMALL}
    return Case("batch to " + job, command, files, results,
                ["takes", ".prf", "base.htr", "KsBone.bsm", "not enough memory"])


def cases():
    yield batch("htr", {"takes/a.bvh": BVH, "takes/b.bvh": small_motion(4)}, ".htr")
    yield batch("orn", {"takes/a.htr": HTR, "takes/b.htr": HTR}, ".orn")
    yield convert("out.htr")
    yield convert("out.Kinetra")
    yield resave()
    yield plan()
    yield merge()


class Faults(CliTest):
    def setUp(self):
        super().setUp()
        self.environment["TMPDIR"] = str(self.folder)  # so that nothing is left there unseen

    def begin(self, case):
        for entry in self.folder.iterdir():
            shutil.rmtree(entry) if entry.is_dir() else entry.unlink()
        for name, content in case.files.items():
            self.write(name, content)

    def start(self, case, operation="none", number=0, file_limit=None):
        """Exit code, standard error and the calls that there were of the operation."""
        report = str(self.folder) + "-calls"
        self.addCleanup(Path(report).unlink, missing_ok=True)
        environment = dict(self.environment, LD_PRELOAD=preload(), FAULT_OPERATION=operation,
                           FAULT_NUMBER=str(number), FAULT_REPORT=report)

        def limit():
            resource.setrlimit(resource.RLIMIT_FSIZE, (file_limit, file_limit))

        done = subprocess.run(list(map(str, case.command)), cwd=self.folder, env=environment, timeout=SECONDS,
                              capture_output=True, preexec_fn=limit if file_limit is not None else None)
        calls = int(Path(report).read_text()) if Path(report).exists() and file_limit is None else 0
        return done.returncode, done.stderr.decode(), calls

    def content(self, case):
        return {name: self.read(name) for name in case.files}

    def assert_whole(self, case, good, code, words):
        self.assertIn(code, (DONE, FAILED), words)
        self.assertNotIn("terminate", words)
        before = {name: content if isinstance(content, bytes) else content.encode()
                  for name, content in case.files.items()}
        self.assertEqual(self.files(), sorted(case.files), "nothing is left, nothing is gone")
        now = self.content(case)
        for name in case.files:
            self.assertIn(now[name], (before[name], good[name]), name)
        if code == DONE:
            self.assertEqual(now, good, "a run that answers well has done all")
        else:
            self.assertTrue(any(name in words for name in case.names), words)

    def undisturbed(self, case, operation):
        self.begin(case)
        code, words, calls = self.start(case, operation)
        self.assertEqual(code, DONE, words)
        good = self.content(case)
        for name in case.replaced:
            self.assertNotEqual(good[name], case.files[name])
        return good, calls

    def go_through(self, operations, samples):
        for case in cases():
            for operation in operations:
                good, calls = self.undisturbed(case, operation)
                step = max(1, calls // samples)
                failed = 0
                for number in range(1, calls + 1, step):
                    with self.subTest(case.what, operation=operation, number=number):
                        self.begin(case)
                        code, words, _ = self.start(case, operation, number)
                        self.assert_whole(case, good, code, words)
                        failed += code == FAILED
                        if code == FAILED and operation in REASONS and case.command[0] == PROGRAM:
                            self.assertIn(REASONS[operation], words, "the system's own reason")
                print("%s: %s: %d calls, %d tried, %d told" % (case.what, operation, calls,
                                                               len(range(1, calls + 1, step)), failed), flush=True)
                if operation in ("write", "rename", "sync"):
                    self.assertEqual(failed, calls, "what was not written may not be told as saved")
                    self.assertGreater(calls, 0)

    def test_a_call_of_the_system_that_fails(self):
        self.go_through(OPERATIONS, 1000)

    @unittest.skipIf(SANITIZED, "the sanitizer has the allocations")
    def test_memory_that_is_not_there(self):
        self.go_through(["allocate"], SAMPLES)

    def test_a_limit_on_the_size_of_files(self):
        for case in cases():
            good, _ = self.undisturbed(case, "none")
            for limit in (0, 10):
                with self.subTest(case.what, limit=limit):
                    self.begin(case)
                    code, words, _ = self.start(case, file_limit=limit)
                    self.assertEqual(code, FAILED, words)
                    self.assert_whole(case, good, code, words)

class Stopped(CliTest):
    """What other programs do while a conversion reads or writes."""

    def setUp(self):
        super().setUp()
        self.write("small.prf", SMALL)
        self.write("small.bvh", BVH)
        self.write("large.bvh", large_motion(40_000))

    def convert(self, source, missing=""):
        return self.start([PROGRAM, "convert", source, "-o", "out.Kinetra", "--profile", "small.prf", "--data-dir",
                           str(DATA)], missing)

    def start(self, command, missing=""):
        environment = dict(self.environment, FAULT_MISSING=missing, TMPDIR=str(self.folder))
        if missing:
            environment["LD_PRELOAD"] = preload()
        return subprocess.Popen(command, cwd=self.folder, env=environment, stdout=subprocess.PIPE,
                                stderr=subprocess.STDOUT)

    def private_files(self):
        return [path for path in self.folder.iterdir() if path.name.startswith(".gaitwright-")]

    def test_standard_output_that_is_full_is_told(self):
        with open("/dev/full", "wb") as full:
            result = self.with_assets("convert", "small.bvh", "-o", "a.htr", "--profile", "small.prf", stdout=full)
        self.assertEqual(result.code, FAILED)
        self.assert_words(result, ["standard output"])

    def stopped_when(self, condition, start):
        """A program in the state that a condition names; a busy machine may take a few attempts."""
        for _ in range(20):
            running = start()
            while not condition(running) and running.poll() is None:
                pass
            running.send_signal(signal.SIGSTOP)
            if condition(running):
                return running
            self.end(running, signal.SIGKILL)
            for path in self.folder.glob("out.*"):
                path.unlink()
        self.fail("it is too fast")

    def stopped_writing(self, missing=""):
        return self.stopped_when(lambda running: self.private_files(), lambda: self.convert("large.bvh", missing))

    def end(self, running, number=signal.SIGCONT):
        running.send_signal(number)
        running.send_signal(signal.SIGCONT)
        words, _ = running.communicate(timeout=SECONDS)
        return running.returncode, words.decode()

    def test_a_single_conversion_that_is_ended_leaves_nothing(self):
        for number in (signal.SIGINT, signal.SIGTERM, signal.SIGHUP, signal.SIGKILL):
            with self.subTest(number):
                code, _ = self.end(self.stopped_writing(), number)
                self.assertEqual(code, -number)
                self.assertEqual(len(self.private_files()), number == signal.SIGKILL)
        self.assertEqual(self.end(self.convert("small.bvh"))[0], DONE)
        self.assertEqual(self.private_files(), [], "the next save removes what was killed")

    def test_a_file_that_appears_meanwhile_stays(self):
        for missing in ("", "renameat2", "renameat2 link"):
            with self.subTest(missing):
                running = self.stopped_writing(missing)
                self.write("out.Kinetra", OLD)
                code, words = self.end(running)
                self.assertEqual(code, FAILED)
                self.assertIn("--force", words)
                self.assertEqual(self.read("out.Kinetra"), OLD)
                (self.folder / "out.Kinetra").unlink()
                self.assertEqual(self.end(self.convert("small.bvh", missing))[0], DONE)
                self.assertGreater(len(self.read("out.Kinetra")), len(OLD))
                (self.folder / "out.Kinetra").unlink()
                self.assertEqual(self.files(), ["large.bvh", "small.bvh", "small.prf"])

    def test_a_source_that_is_cut_while_it_is_read_is_a_failure(self):
        large = large_motion(400_000)  # long enough to be met while it is read
        for command in (["convert", "large.bvh", "-o", "out.htr", "--profile", "small.prf"], ["info", "large.bvh"],
                        ["doctor", "large.bvh"]):
            with self.subTest(command[0]):
                self.write("large.bvh", large)
                running = self.stopped_when(lambda running: is_mapped(running, "large.bvh"),
                                            lambda: self.start([PROGRAM, *command, "--data-dir", str(DATA)]))
                os.truncate(self.folder / "large.bvh", 5000)
                code, words = self.end(running)
                self.assertEqual(code, FAILED, words)
                self.assertIn("truncated", words)
                self.assertEqual(self.files(), ["large.bvh", "small.bvh", "small.prf"])

    def test_without_locks_only_old_leftovers_are_removed(self):
        for days, is_kept in ((0, True), (2, False)):
            left = self.write(".gaitwright-12345678-00000001-00000002.tmp", "x")
            os.utime(left, (time.time() - days * 86400,) * 2)
            self.assertEqual(self.end(self.convert("small.bvh", "flock"))[0], DONE)
            self.assertEqual(left.exists(), is_kept)
            (self.folder / "out.Kinetra").unlink()


if __name__ == "__main__":
    main()
