"""Calls of one system are in folders with its name, so everything else compiles for all systems."""
import re
import unittest
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
ROOMS = ("math", "src", "profile", "analysis", "preview", "app")
# Built for one system only: the program that reads other formats in a sandbox.
ELSEWHERE = {"posix", "windows", "import"}
OF_ONE_SYSTEM = re.compile(
    r"#\s*include\s*<(sys/|unistd|fcntl|poll|pwd|dirent|dlfcn|termios|iconv|signal\.h|spawn|pthread|sched|windows|io\.h|X11/)"
    r"|_WIN32")


class Systems(unittest.TestCase):
    def test_sources_outside_the_folders_of_a_system_are_for_all(self):
        found = []
        for room in ROOMS:
            for path in (ROOT / room).rglob("*"):
                below = path.relative_to(ROOT)
                if path.suffix not in (".cpp", ".h") or (ELSEWHERE & {*below.parts} and below.parts[0] != "src"
                                                         or {"posix", "windows"} & {*below.parts}):
                    continue
                found += ["%s: %s" % (below, line) for line in path.read_text().splitlines() if OF_ONE_SYSTEM.search(line)]
        self.assertEqual(found, [])


if __name__ == "__main__":
    unittest.main()
