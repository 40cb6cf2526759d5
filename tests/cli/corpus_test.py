"""Containers of an independent writer, good, odd and damaged, through every command that reads one."""
import json
import os
import shutil
import subprocess
import unittest
from pathlib import Path

from harness import DATA, DONE, FAILED, PROGRAM, CliTest, main

COMMANDS = {
    "resave": ["resave", "{}", "out.orn"],
    "info": ["info", "{}", "--json"],
    "dump": ["dump", "{}", "--out-dir", "pages"],
    "pose": ["pose", "{}", "--time", "1.5", "--objects"],
}
SANITIZED = b"__asan_init" in Path(PROGRAM).read_bytes()


def entries():
    folder = Path(DATA) / "containers"
    for entry in json.loads((folder / "expect.json").read_text())["files"]:
        yield folder / entry["file"], entry["must"], entry["why"]


@unittest.skipUnless(DATA, "the corpus is not on this machine")
class Corpus(CliTest):
    def peak(self, arguments):
        """Runs a command and answers its exit code, its output and the bytes of memory that it took."""
        with open(self.folder / "told", "wb") as told:
            run = subprocess.Popen([PROGRAM, *arguments], cwd=self.folder, env=self.environment, stdout=told,
                                   stderr=subprocess.PIPE, stdin=subprocess.DEVNULL)
            words = run.stderr.read()
            run.stderr.close()
            _, status, usage = os.wait4(run.pid, 0)
            run.returncode = os.waitstatus_to_exitcode(status)
        self.assertIn(run.returncode, (DONE, FAILED), words[-2000:])
        return run.returncode, (self.folder / "told").read_bytes(), 1024 * usage.ru_maxrss

    def run_all(self, path):
        """The answer that all commands agree on, and what `info` tells."""
        codes, told = {}, b""
        for name, line in COMMANDS.items():
            codes[name], out, memory = self.peak([word.replace("{}", str(path)) for word in line])
            if not SANITIZED:
                self.assertLessEqual(memory, (64 << 20) + 16 * path.stat().st_size, name)
            told = out if name == "info" else told
        self.assertEqual(len(set(codes.values())), 1, codes)
        return codes["info"], told

    def assert_written_whole(self, told):
        """What was written reads as the same objects, and is written again as the same bytes."""
        again = self.run_program("info", "out.orn", "--json")
        self.assertEqual(again.code, DONE, again.err)
        objects = [json.loads(text).get("objects") for text in (told, again.out)]
        self.assertEqual(objects[0], objects[1])
        self.run_program("resave", "out.orn", "again.orn")
        self.assertEqual(self.read("again.orn"), self.read("out.orn"))

    def check(self, path, must):
        code, told = self.run_all(path)
        if must != "survive":
            self.assertEqual(code, DONE if must == "read" else FAILED)
        if code == DONE and "image_link" not in path.name:  # whose names follow the folder
            self.assert_written_whole(told)
        if code == FAILED:
            self.assertEqual([f for f in self.files() if f != "told"], [])

    def test_every_file_is_read_or_refused_by_all_commands_alike(self):
        for path, must, why in entries():
            with self.subTest(path.name, why=why):
                self.check(path, must)
            shutil.rmtree(self.folder / "pages", ignore_errors=True)
            for name in ("out.orn", "again.orn"):
                (self.folder / name).unlink(missing_ok=True)


if __name__ == "__main__":
    main()
