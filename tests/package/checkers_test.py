"""The packages before those who look at packages for a living: whatever they say is a fault."""
import glob
import os
import shutil
import subprocess
import tempfile
import unittest
from pathlib import Path

PACKAGES = sorted(glob.glob(os.environ["GAITWRIGHT_PACKAGES"] + "/*.deb"))

# What is looked at lies in the packages' common folder; a checker that is not there is passed over.
CHECKERS = [
    ["lintian", "--allow-root", "--fail-on", "error,warning", *PACKAGES],
    ["lintian", "--allow-root", "--display-info", "--tags",
     "hardening-no-bindnow,hardening-no-fortify-functions,hardening-no-pie,hardening-no-relro", *PACKAGES],
    ["desktop-file-validate", "usr/share/applications/gaitforge.desktop"],
    ["appstreamcli", "validate", "--no-net", "usr/share/metainfo/org.example.GaitForge.metainfo.xml"],
    ["update-mime-database", "usr/share/mime"],
    ["man", "--warnings", "-l", "usr/share/man/man1/gaitwright.1.gz"],
    ["man", "--warnings", "-l", "usr/share/man/man1/GaitForge.1.gz"],
]


class Checkers(unittest.TestCase):
    def setUp(self):
        self.folder = Path(tempfile.mkdtemp(prefix="gaitwright-check-"))
        self.addCleanup(shutil.rmtree, self.folder)
        for package in PACKAGES:
            subprocess.run(["dpkg-deb", "-x", package, self.folder], check=True)

    def test_none_has_anything_to_say(self):
        missing = sorted({checker[0] for checker in CHECKERS if not shutil.which(checker[0])})
        for checker in CHECKERS:
            if checker[0] in missing:
                continue
            with self.subTest(checker[0]):
                done = subprocess.run(checker, cwd=self.folder, capture_output=True, text=True,
                                      env={**os.environ, "MANWIDTH": "80", "LC_ALL": "C.UTF-8",
                                           "XDG_DATA_DIRS": str(self.folder / "usr/share")})
                said = done.stderr if checker[0] == "man" else done.stdout + done.stderr
                faults = [line for line in said.splitlines() if line and "Validation was successful" not in line]
                self.assertEqual((done.returncode, faults), (0, []))
        if missing:
            self.skipTest("not on this machine: " + ", ".join(missing))


if __name__ == "__main__":
    unittest.main()
