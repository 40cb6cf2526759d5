"""The library in another program: found in an installation, by CMake and by pkg-config, and equal to the shell."""
import os
import shutil
import subprocess
import tempfile
import unittest
from pathlib import Path

PROGRAM = os.environ["GAITWRIGHT"]
ROOT = Path(os.environ["GAITWRIGHT_ROOT"])
BUILD = os.environ["GAITWRIGHT_BUILD"]
CMAKE = os.environ["CMAKE"]
WALK = ROOT / "examples" / "walk.bvh"
SECONDS = 120

REFUSED = [  # what, source, profile, output, words
    ("a motion without frames", "still.bvh", "PoserBVH.prf", "a.Kinetra", "no frames"),
    ("a profile for other bones", "walk.bvh", "Mixamo.prf", "a.Kinetra", "the source has no bone"),
]


class Engine(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.folder = Path(tempfile.mkdtemp(prefix="gaitwright-engine-"))
        cls.addClassCleanup(shutil.rmtree, cls.folder)
        # Moved before it is used: nothing may have kept where it was installed.
        cls.run_here(CMAKE, "--install", BUILD, "--prefix", cls.folder / "first")
        cls.prefix = cls.folder / "moved"
        (cls.folder / "first").rename(cls.prefix)
        cls.run_here(CMAKE, "-S", ROOT / "examples/convert", "-B", "build", "-G", "Ninja",
                     "-DCMAKE_PREFIX_PATH={}".format(cls.prefix), "-DCMAKE_CXX_COMPILER=" + os.environ["CXX"])
        cls.run_here(CMAKE, "--build", "build")
        found = next(cls.prefix.glob("lib/**/pkgconfig"))
        os.environ["PKG_CONFIG_PATH"] = str(found)
        flags = cls.run_here("pkg-config", "--cflags", "--libs", "gaitwright >= 2.0").split()
        (cls.folder / "plain").mkdir()
        cls.run_here(os.environ["CXX"], "-std=c++20", "-Wall", "-Wextra", "-Werror", ROOT / "examples/convert/main.cpp",
                     "-o", "plain/convert", *flags, "-Wl,-rpath,{}".format(found.parent))
        shutil.copy(WALK, cls.folder)
        text = WALK.read_text()
        (cls.folder / "still.bvh").write_text(text[:text.index("Frames:")] + "Frames: 0\nFrame Time: 0.033333\n")

    @classmethod
    def run_here(cls, *arguments):
        done = subprocess.run(list(map(str, arguments)), cwd=cls.folder, capture_output=True, text=True, timeout=SECONDS)
        if done.returncode != 0:
            raise AssertionError("{}: {}".format(" ".join(map(str, arguments)), done.stdout + done.stderr))
        return done.stdout

    def convert(self, source, profile, output, folder="build"):
        return subprocess.run([folder + "/convert", source, self.prefix / "share/gaitwright" / profile, output],
                              cwd=self.folder, capture_output=True, text=True, timeout=SECONDS)

    def test_the_example_writes_what_the_shell_writes(self):
        for folder, name in (("build", "walk.Kinetra"), ("plain", "walk.htr")):
            done = self.convert("walk.bvh", "PoserBVH.prf", "example-" + name, folder)
            self.assertEqual((done.returncode, done.stderr), (0, ""))
            self.run_here(PROGRAM, "convert", "walk.bvh", "-o", "shell-" + name, "--profile", "Poser BVH")
            self.assertEqual((self.folder / ("example-" + name)).read_bytes(),
                             (self.folder / ("shell-" + name)).read_bytes())

    def test_what_cannot_be_done_is_said_and_nothing_is_written(self):
        before = sorted(self.folder.iterdir())
        for what, source, profile, output, words in REFUSED:
            with self.subTest(what):
                done = self.convert(source, profile, output)
                self.assertEqual(done.returncode, 1)
                self.assertIn(words, done.stderr)
                self.assertEqual(sorted(self.folder.iterdir()), before)

    def test_nothing_but_the_header_is_installed_or_exported(self):
        self.assertEqual([path.name for path in (self.prefix / "include").rglob("*") if path.is_file()], ["gaitwright.h"])
        library = next(self.prefix.glob("lib/**/libgaitwright.so"))
        symbols = self.run_here("nm", "-DC", "--defined-only", library).splitlines()
        self.assertTrue(symbols)
        self.assertEqual([symbol for symbol in symbols if " gaitwright::" not in symbol], [])

    def test_the_installed_program_finds_its_data_where_it_was_moved_to(self):
        told = self.run_here(self.prefix / "bin/gaitwright", "profiles")
        self.assertIn("(stock, {}/share/gaitwright/PoserBVH.prf)".format(self.prefix), told)


if __name__ == "__main__":
    unittest.main()
