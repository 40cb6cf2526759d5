"""Runs the program as its users do: arguments in, exit code, two texts and files out."""
import os
import shutil
import subprocess
import tempfile
import unittest
from pathlib import Path

PROGRAM = os.environ["GAITWRIGHT"]
ROOT = Path(os.environ["GAITWRIGHT_ROOT"])
ASSETS = ROOT / "assets"
WALK = ROOT / "examples" / "walk.bvh"
DATA = os.environ.get("GAITWRIGHT_TEST_DATA")

DONE, FAILED, USAGE = 0, 1, 2
SECONDS = 60  # for a run that takes a tenth of one, on a busy machine under a sanitizer


# The program for Windows runs under an emulator: its paths have other separators, and it knows no pipes or signals.
WINDOWS = os.environ.get("GAITWRIGHT_SYSTEM") == "windows"


def posix_only(reason):
    """Skips a test, or a class of tests, on Windows."""
    return unittest.skipIf(WINDOWS, reason)


def without_backslashes(text):
    """Returns output with the separators that the tests expect, also within JSON, where they are doubled."""
    def plain(line):
        return line.replace("\\\\", "/") if line.startswith(("{", "[")) else line.replace("\\", "/")
    return "".join(map(plain, text.splitlines(True))).replace("Z:/", "/")


class Result:
    def __init__(self, done):
        self.code = done.returncode
        self.bytes = done.stdout
        self.out = done.stdout.decode("utf-8", "replace")  # whatever the names in a file: output is UTF-8
        self.err = done.stderr.decode("utf-8")
        if WINDOWS:
            self.out = without_backslashes(self.out)
            self.err = without_backslashes(self.err)


class CliTest(unittest.TestCase):
    """A folder of its own for every test, which is also the home of a user without settings."""

    def setUp(self):
        self.folder = Path(tempfile.mkdtemp(prefix="gaitwright-test-"))
        self.addCleanup(shutil.rmtree, self.folder, ignore_errors=True)
        self.environment = {"HOME": str(self.folder / "home"), "PATH": os.environ.get("PATH", "")}
        for name, value in os.environ.items():
            if name.endswith("SAN_OPTIONS"):
                self.environment[name] = value

    def run_program(self, *arguments, program=PROGRAM, stdout=subprocess.PIPE, given=b""):
        """Runs in the test's folder, with bytes on standard input."""
        done = subprocess.run([program, *map(str, arguments)], cwd=self.folder, env=self.environment,
                              input=given, stdout=stdout, stderr=subprocess.PIPE, timeout=SECONDS)
        if done.stdout is None:
            done.stdout = b""
        self.assertIn(done.returncode, (DONE, FAILED, USAGE), done.stderr[-2000:])
        return Result(done)

    def with_assets(self, *arguments, **keywords):
        return self.run_program(*arguments, "--data-dir", ASSETS, **keywords)

    def succeed(self, *arguments, **keywords):
        result = self.with_assets(*arguments, **keywords)
        self.assertEqual(result.code, DONE, result.err)
        return result

    def write(self, name, content):
        path = self.folder / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(content if isinstance(content, bytes) else content.encode())
        return path

    def read(self, name):
        return (self.folder / name).read_bytes()

    def read_text(self, name):
        """The bytes of a text file, whose line ends are those of the system."""
        return self.read(name).replace(b"\r\n", b"\n")

    def files(self):
        """All files below the folder, hidden ones included, so that nothing is left behind unseen."""
        return sorted(str(p.relative_to(self.folder)) for p in self.folder.rglob("*") if p.is_file())

    def assert_words(self, result, words):
        for word in words:
            self.assertIn(word, result.err)


def main():
    unittest.main(verbosity=1)
