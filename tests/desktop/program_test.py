"""The desktop program run as a whole: what it says when it cannot start, and how its starts know each other."""

import os
import pathlib
import shutil
import signal
import subprocess
import tempfile
import time
import unittest

FORGE = pathlib.Path(os.environ["GAITFORGE"])
ROOT = pathlib.Path(os.environ["GAITWRIGHT_ROOT"])
PATIENCE = 20  # seconds


class Home:
    """A user of their own: settings, documents, counter and socket are nobody else's."""

    def __init__(self, folder):
        self.folder = pathlib.Path(folder)
        self.environment = dict(os.environ, HOME=folder, XDG_CONFIG_HOME=folder, XDG_CONFIG_DIRS=folder,
                                XDG_RUNTIME_DIR=folder)
        self.started = []

    def start(self, *arguments, forge=FORGE, **environment):
        process = subprocess.Popen([str(forge), *map(str, arguments)], env={**self.environment, **environment},
                                   stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True)
        self.started.append(process)
        return process

    def run(self, *arguments, **more):
        process = self.start(*arguments, **more)
        out, errors = process.communicate(timeout=PATIENCE)
        return process.returncode, out, errors

    def settings(self):
        path = self.folder / "Tessarine" / "Gaitwright.conf"
        return path.read_text() if path.exists() else ""

    def close(self):
        for process in self.started:
            process.kill()
            process.communicate()
        self.run("--reset-instance-counter")


def wait_until(holds):
    end = time.monotonic() + PATIENCE
    while not holds():
        if time.monotonic() > end:
            return False
        time.sleep(0.05)
    return True


class Program(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.home = Home(folder.name)
        self.addCleanup(self.home.close)

    def first_line(self, process):
        """The first line of the program's own on standard error; its window waits for an answer meanwhile."""
        for line in process.stderr:
            if line.startswith("GaitForge:"):
                return line
        self.fail("the program said nothing")

    def check_map_tool(self, **more):
        tool = self.home.start("-s", **more)
        time.sleep(1)
        self.assertIsNone(tool.poll())
        tool.send_signal(signal.SIGTERM)
        self.assertEqual(tool.wait(PATIENCE), 0)

    def hand(self, *what):
        """Does something with the screen's own mouse and keyboard, or waits for a window to be there."""
        return subprocess.run(["xdotool", *what], check=True, timeout=PATIENCE, capture_output=True, text=True).stdout

    def wait_for_socket(self):
        self.assertTrue(wait_until(lambda: list(self.home.folder.glob("*TK_KESTRO_GAIT_CONV_1*"))))

    def test_needs_no_display_to_say_what_it_takes(self):
        code, out, _ = self.home.run("--help", DISPLAY="")
        self.assertEqual(code, 0)
        self.assertIn("Usage: GaitForge", out)
        code, _, errors = self.home.run(DISPLAY="", WAYLAND_DISPLAY="")
        self.assertEqual(code, 1)
        self.assertIn("display", errors)

    def test_says_what_is_missing_beside_it(self):
        for missing, words, ends_with in (("Content/bvh.cnt", "skin", 1), ("Content/icons/play.svg", "play.svg", 1),
                                          ("base.htr", "base.htr", 0)):
            with self.subTest(missing), tempfile.TemporaryDirectory() as folder:
                copy = pathlib.Path(folder)
                shutil.copy(FORGE, copy)
                shutil.copytree(FORGE.parent / "Content", copy / "Content")
                shutil.copy(FORGE.parent / "base.htr", copy)
                (copy / missing).unlink()
                process = self.home.start(forge=copy / FORGE.name)
                self.assertIn(words, self.first_line(process))
                process.send_signal(signal.SIGTERM)  # while the box with these words is open
                self.assertEqual(process.wait(PATIENCE), ends_with)
                self.check_map_tool(forge=copy / FORGE.name)  # it needs none of these

    def test_stands_without_opengl(self):
        process = self.home.start(ROOT / "examples" / "walk.bvh", QT_QPA_PLATFORM="offscreen")
        self.assertTrue(wait_until(lambda: "walk.bvh" in self.home.settings()))
        process.send_signal(signal.SIGTERM)  # comes after whatever the window still has to paint
        self.assertEqual(process.wait(PATIENCE), 0)

    def test_a_second_start_hands_its_file_to_the_first(self):
        first = self.home.start()
        self.wait_for_socket()
        code, _, errors = self.home.run(ROOT / "examples" / "walk.bvh")
        self.assertEqual((code, errors), (0, ""))
        self.assertTrue(wait_until(lambda: "walk.bvh" in self.home.settings()))
        self.assertIsNone(first.poll())

    def test_a_counter_left_by_a_crash_is_named_and_reset(self):
        self.home.run("--reset-instance-counter")  # the counter is the user's, and may have been left before
        first = self.home.start()
        self.wait_for_socket()
        first.kill()
        first.wait()
        code, _, errors = self.home.run()
        self.assertEqual(code, 1)
        self.assertIn("GaitForge --reset-instance-counter", errors)
        self.assertEqual(self.home.run("--reset-instance-counter")[0], 0)
        again = self.home.start()
        time.sleep(1)
        self.assertIsNone(again.poll())
        again.send_signal(signal.SIGTERM)
        again.wait(PATIENCE)
        after = self.home.start()
        time.sleep(1)
        self.assertIsNone(after.poll(), "a program that is told to end leaves its place")

    def test_a_left_key_that_was_pressed_over_another_program_counts(self):
        lines = [line.split() for line in (FORGE.parent / "Content" / "bvh.cnt").read_text().splitlines()]
        left, top, width, height = next(map(int, line[2:6]) for line in lines if line[:2] == ["button", "open"])
        self.home.start("-s")
        self.hand("search", "--sync", "--onlyvisible", "--name", "^GaitTool$")
        self.hand("keydown", "Control_L")
        self.addCleanup(self.hand, "keyup", "Control_L")
        self.home.start()
        window = self.hand("search", "--sync", "--onlyvisible", "--name", "^Gaitwright v2.0$").split()[-1]
        self.hand("mousemove", "--window", window, str(left + width // 2), str(top + height // 2))
        self.hand("mousedown", "1")
        time.sleep(0.12)
        self.hand("mouseup", "1")
        self.hand("search", "--sync", "--onlyvisible", "--name", "^Select folder$")


if __name__ == "__main__":
    unittest.main()
