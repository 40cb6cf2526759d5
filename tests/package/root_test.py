"""The packages, installed into a root that has nothing else: what they bring, what they ask for, and a conversion there."""
import glob
import os
import re
import shutil
import signal
import subprocess
import sysconfig
import tempfile
import time
import unittest
from pathlib import Path

PROGRAM = Path(os.environ["GAITWRIGHT"])
WALK = Path(os.environ["GAITWRIGHT_ROOT"]) / "examples" / "walk.bvh"
PACKAGES = {Path(path).name.split("_")[0]: path for path in glob.glob(os.environ["GAITWRIGHT_PACKAGES"] + "/*.deb")}
PLUGINS = "qt6/plugins/platforms/libqoffscreen.so"  # of a package that gaitforge names by itself
SECONDS = 60
SEARCH = {"PATH": os.environ.get("PATH", "") + ":/usr/sbin:/sbin"}

# Programs that only other programs start.
LIBRARIES = "usr/lib/{}/".format(sysconfig.get_config_var("MULTIARCH"))
PROGRAMS = LIBRARIES + "gaitwright/"
PYTHON = "usr/lib/python3/dist-packages/gaitwright/"
# What a user has of each package, beside its manual, its licence and its list of changes.
CONTENT = {
    "gaitwright": ["usr/bin/gaitwright", "usr/share/gaitwright/base.htr", "usr/share/gaitwright/KsBone.bsm",
                   "usr/share/gaitwright/PoserBVH.prf", "usr/share/man/man1/gaitwright.1.gz",
                   "usr/share/bash-completion/completions/gaitwright",
                   "usr/share/zsh/vendor-completions/_gaitwright",
                   "usr/share/fish/vendor_completions.d/gaitwright.fish"],
    "gaitforge": ["usr/bin/GaitForge", "usr/share/gaitwright/Content/bvh.cnt", "usr/share/man/man1/GaitForge.1.gz",
                  "usr/share/applications/gaitforge.desktop", "usr/share/mime/packages/gaitforge.xml",
                  "usr/share/icons/hicolor/scalable/apps/gaitforge.svg",
                  "usr/share/metainfo/org.example.GaitForge.metainfo.xml"],
    "gaitwright-import": [PROGRAMS + "gaitwright-import"],
    "libgaitwright2.0": [LIBRARIES + "libgaitwright.so.2.0"],
    "python3-gaitwright": [PYTHON + "__init__.pyi", PYTHON + "py.typed"],
    "libgaitwright-dev": ["usr/include/gaitwright/gaitwright.h", LIBRARIES + "libgaitwright.so",
                          LIBRARIES + "pkgconfig/gaitwright.pc", LIBRARIES + "cmake/Gaitwright/GaitwrightConfig.cmake"],
}


def output_of(*arguments):
    done = subprocess.run(list(map(str, arguments)), capture_output=True, text=True, timeout=SECONDS)
    if done.returncode != 0:
        raise AssertionError("{}: {}".format(" ".join(map(str, arguments)), done.stderr[-2000:]))
    return done.stdout


def is_program(path):
    return path.is_file() and not path.is_symlink() and path.read_bytes()[:4] == b"\x7fELF"


def libraries_of(path):
    """Where the libraries are that a program would be run with, its loader among them."""
    return re.findall(r"(?:=> )?(/\S+) \(0x", output_of("ldd", path))


def owners_of(library):
    """The packages that a file of this machine came with, whichever of its two names they know it by."""
    names = {library, os.path.realpath(library)}
    names |= {re.sub("^/usr", "", name) for name in names} | {"/usr" + name for name in names}
    done = subprocess.run(["dpkg-query", "-S", *sorted(names)], capture_output=True, text=True)
    return {line.split(":")[0] for line in done.stdout.splitlines()}


def way_into(root):
    """What runs a program in another root, as far as this machine lets its user; None where it does not."""
    for way in (["chroot"], ["unshare", "--user", "--map-root-user", "chroot"]):
        done = subprocess.run([*way, root, "/usr/bin/gaitwright", "--version"], capture_output=True, text=True)
        if done.stdout.startswith("gaitwright "):
            return way
    return None


class Root(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.root = Path(tempfile.mkdtemp(prefix="gaitwright-root-"))
        cls.addClassCleanup(shutil.rmtree, cls.root)
        for folder in ("var/lib/dpkg/info", "var/lib/dpkg/updates", "tmp"):
            (cls.root / folder).mkdir(parents=True)
        (cls.root / "var/lib/dpkg/status").touch()
        # All at once, so that two packages with one file are told of.
        done = subprocess.run(["dpkg", "--root={}".format(cls.root), "--force-depends", "--force-not-root", "--install",
                               *PACKAGES.values()], capture_output=True, text=True, timeout=SECONDS, env=SEARCH)
        if done.returncode != 0:
            raise AssertionError(done.stderr[-2000:])
        cls.brought = {name: output_of("dpkg-query", "--root={}".format(cls.root), "-L", name).split("\n")
                       for name in PACKAGES}
        cls.programs = [path for path in cls.root.glob("usr/lib/**/*") if is_program(path)]
        for program in cls.programs + list(map(Path, cls.plugins())):
            for library in libraries_of(program):
                if cls.root not in Path(library).parents:
                    cls.bring(library)
        for plugin in cls.plugins():
            cls.bring(plugin)

    @staticmethod
    def plugins():
        return glob.glob("/usr/lib/*/" + PLUGINS)

    @classmethod
    def bring(cls, path):
        """A file of this machine under the same name in the root."""
        to = cls.root / path.lstrip("/")
        to.parent.mkdir(parents=True, exist_ok=True)
        if not to.exists():
            shutil.copy(os.path.realpath(path), to)

    def command(self, *arguments):
        way = way_into(self.root)
        if way is None:
            self.skipTest("this machine lets no user change the root")
        return [*way, str(self.root), *arguments]

    def test_each_package_brings_what_its_users_look_for(self):
        self.assertEqual(set(self.brought), set(CONTENT))
        for package, names in CONTENT.items():
            documents = "usr/share/doc/{}/".format(package)
            for name in [*names, documents + "copyright", documents + "changelog.gz"]:
                with self.subTest(name):
                    self.assertIn("/" + name, self.brought[package])
                    self.assertTrue((self.root / name).is_file())

    def test_what_is_loaded_by_name_lies_beside_the_program(self):
        beside = (self.root / "usr/bin/gaitwright").resolve().parent
        modules = {path.name for path in PROGRAM.parent.glob("gw_*.so")}
        self.assertTrue(modules)
        self.assertEqual({path.name for path in beside.glob("*.so")}, modules)

    def test_nobody_but_its_owner_may_write_a_file_and_no_one_a_stock_profile(self):
        for path in self.root.glob("usr/**/*"):
            if not path.is_symlink():
                self.assertEqual(path.stat().st_mode & 0o022, 0, path)
        for path in self.root.glob("usr/share/gaitwright/*.prf"):
            self.assertEqual(path.stat().st_mode & 0o777, 0o444, path)

    def test_the_owners_of_all_libraries_are_asked_for(self):
        for program in self.programs:
            package = next(name for name, files in self.brought.items()
                           if "/" + str(program.relative_to(self.root)) in files)
            depends = output_of("dpkg-deb", "-f", PACKAGES[package], "Depends")
            asked = set(re.findall(r"[a-z0-9][a-z0-9+.-]+(?= *(?:[(,|]|$))", depends))
            needed = re.findall(r"NEEDED\s+(\S+)", output_of("objdump", "-p", program))
            for library in libraries_of(program):
                if Path(library).name in needed and "ld-linux" not in library:
                    owners = {name for name, files in self.brought.items()
                              if os.path.realpath(library).removeprefix(str(self.root)) in files}
                    with self.subTest(program=program.name, library=library):
                        self.assertTrue((owners or owners_of(library)) & asked)

    def test_the_shell_program_converts_there_as_it_does_here(self):
        shutil.copy(WALK, self.root / "tmp")
        done = subprocess.run(self.command("/usr/bin/gaitwright", "convert", "/tmp/walk.bvh"), capture_output=True,
                              text=True, timeout=SECONDS, env=SEARCH)
        self.assertEqual((done.returncode, done.stderr), (0, ""))
        self.assertIn('by profile "Poser BVH"', done.stdout)
        here = self.root / "tmp/here.Kinetra"
        output_of(PROGRAM, "convert", WALK, "-o", here)
        self.assertEqual((self.root / "tmp/walk.Kinetra").read_bytes(), here.read_bytes())

    def test_the_python_module_converts_as_the_shell_does(self):
        script = "import gaitwright, sys; gaitwright.convert(gaitwright.load(sys.argv[1])).save(sys.argv[2])"
        subprocess.run(["/usr/bin/python3", "-B", "-c", script, WALK, self.root / "tmp/module.htr"], check=True,
                       timeout=SECONDS, env={"PYTHONPATH": self.root / PYTHON / ".."})
        output_of(PROGRAM, "convert", WALK, "-o", self.root / "tmp/shell.htr")
        self.assertEqual((self.root / "tmp/module.htr").read_bytes(), (self.root / "tmp/shell.htr").read_bytes())

    def test_the_windows_open_there(self):
        """The socket for later starts is made when the window stands, with its skin."""
        environment = {**SEARCH, "HOME": "/tmp", "XDG_RUNTIME_DIR": "/tmp", "QT_QPA_PLATFORM": "offscreen",
                       "QT_PLUGIN_PATH": str(Path(self.plugins()[0]).parent.parent)}
        process = subprocess.Popen(self.command("/usr/bin/GaitForge"), env=environment, stderr=subprocess.PIPE, text=True)
        self.addCleanup(process.stderr.close)
        self.addCleanup(process.kill)
        end = time.monotonic() + SECONDS
        while not any(path.is_socket() for path in (self.root / "tmp").iterdir()):
            self.assertIsNone(process.poll(), process.stderr.read() if process.poll() is not None else "")
            self.assertLess(time.monotonic(), end, "no window came")
            time.sleep(0.1)
        process.send_signal(signal.SIGTERM)
        self.assertEqual(process.wait(SECONDS), 0)


if __name__ == "__main__":
    unittest.main()
