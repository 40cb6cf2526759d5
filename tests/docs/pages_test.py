"""Every page is worked through as a reader would do it: files are written as shown, commands typed, faults tried.

A page's parts and what is held against the program:
- a block with file=NAME becomes that file;
- a console block is run, and what it prints must be what stands there;
- a table of bytes ("offset", "size", "form", "here") must tell the file of the last dump without a gap;
- a table of faults ("in `FILE`", "becomes", ...) is tried row by row on a copy of the file;
- a picture that a command draws must be the one that the page shows.
"""
import os
import re
import struct
import subprocess
import unittest
from pathlib import Path

import harness
from page import Block, Table, code_of, content_of, matches, read_page
from picture import Picture, differing

PAGES = [harness.ROOT / "README.md", harness.ROOT / "docs" / "bone-maps.md", harness.ROOT / "docs" / "pipelines.md",
         *sorted((harness.ROOT / "docs" / "formats").glob("*.md"))]

# The page about the library needs a compiler, and a library that plain programs can load.
LIBRARY = {name: os.environ[name] for name in ("PKG_CONFIG_PATH", "LD_LIBRARY_PATH") if name in os.environ}
PAGES += [harness.ROOT / "docs" / "library.md"] if "PKG_CONFIG_PATH" in LIBRARY else []

# The page about the Python module needs the module, and Debian's own Python with numpy and matplotlib.
PYTHON = Path("/usr/bin/python3")
MODULES = os.environ.get("GAITWRIGHT_PYTHON")
PAGES += [harness.ROOT / "docs" / "python.md"] if MODULES else []

MOST_OTHER_BYTES = 0.005  # of a picture; the bones and axes of a figure are a fiftieth

FORMS = {"u8": "<B", "u16": "<H", "u32": "<I", "i32": "<i", "f32": "<f", "vec3": "<3f", "quat": "<4f", "mat4": "<16f"}


def decoded(form, content):
    """A field as a page tells it."""
    if form == "string":
        return content[4:].decode("latin-1"), content[:4] == struct.pack("<I", len(content) - 4)
    if form == "chars":
        return content.rstrip(b"\0").decode("latin-1"), True
    if form == "utf-16":
        return content.decode("utf-16le"), True
    values = struct.unpack(FORMS[form], content)
    return " ".join("%g" % value if isinstance(value, float) else str(value) for value in values), True


class PageTest(harness.CliTest):
    def work_through(self, path):
        self.set_the_desk()
        if path.name == "python.md":
            self.set_the_module()
        for part in read_page(path):
            where = "%s:%d" % (path.relative_to(harness.ROOT), part.line)
            with self.subTest(where):
                if isinstance(part, Block):
                    self.take_block(part)
                else:
                    self.take_table(part)
        for drawn in sorted((self.folder / "docs" / "images").glob("*.png")):
            with self.subTest(drawn.name):
                self.assert_same_picture(drawn, harness.ROOT / "docs" / "images" / drawn.name)

    def set_the_desk(self):
        """A folder as the reader has it: the program on the path, the examples and the data at hand."""
        self.status, self.dump = 0, b""
        (self.folder / "bin").mkdir()
        (self.folder / "docs" / "images").mkdir(parents=True)
        for name in ("examples", "assets"):
            (self.folder / name).symlink_to(harness.ROOT / name)
        os.symlink(harness.PROGRAM, self.folder / "bin" / "gaitwright")
        self.environment.update(LIBRARY)
        self.environment["PATH"] = "%s:%s" % (self.folder / "bin", self.environment["PATH"])

    def set_the_module(self):
        """Plots are drawn without a display. The first start of matplotlib may say that it lists the fonts."""
        (self.folder / "bin" / "python3").symlink_to(PYTHON)
        self.environment.update(PYTHONPATH=MODULES, MPLBACKEND="Agg", MPLCONFIGDIR=str(self.folder / "matplotlib"))
        subprocess.run([PYTHON, "-c", "import matplotlib.font_manager"], env=self.environment, capture_output=True,
                       timeout=harness.SECONDS, check=True)

    def take_block(self, block):
        if block.file:
            content = content_of(block)
            self.write(block.file, content)
            self.dump = content if block.language == "hex" else self.dump
        elif block.language == "console":
            self.type_in(block.lines)

    def type_in(self, lines):
        command, expected = "", []
        for line in [*lines, "$ :"]:
            if not line.startswith("$ "):
                expected.append(line)
                continue
            if command:
                self.run_line(command, expected)
            command, expected = line[2:], []

    def run_line(self, command, expected):
        done = subprocess.run(["bash", "-c", "(exit %d)\n%s" % (self.status, command)], cwd=self.folder,
                              env=self.environment, stdin=subprocess.DEVNULL, capture_output=True,
                              timeout=harness.SECONDS, text=True)
        self.status = done.returncode
        out, err = done.stdout.splitlines(), done.stderr.splitlines()
        if not matches(expected, out, err):
            self.fail("$ %s\nprints\n%s\n%s" % (command, done.stdout, done.stderr))

    def take_table(self, table):
        if table.head[:4] == ["offset", "size", "form", "here"]:
            self.check_bytes(table.rows)
        elif table.head[1:2] == ["becomes"]:
            for row in table.rows:
                self.try_fault(code_of(table.head[0]), row)

    def check_bytes(self, rows):
        end = int(rows[0][0])
        for offset, size, form, here, *_ in rows:
            self.assertEqual(int(offset), end, "a gap or an overlap")
            end += int(size)
            told, sound = decoded(form, self.dump[int(offset):end])
            self.assertTrue(sound, (offset, "the length of a string"))
            self.assertEqual(told, code_of(here), offset)
        self.assertEqual(end, len(self.dump))

    def assert_same_picture(self, drawn, kept):
        """Another GL may round smooth edges differently, and another font sets labels differently."""
        if drawn.read_bytes() == kept.read_bytes():
            return
        ours, theirs = Picture(drawn.read_bytes()), Picture(kept.read_bytes())
        self.assertEqual((ours.width, ours.height), (theirs.width, theirs.height))
        self.assertLess(differing(ours.rows, theirs.rows), MOST_OTHER_BYTES)

    def try_fault(self, name, row):
        """A row of changes and answer. Texts are replaced once; at a byte of a dump stands hex, or "end"."""
        place, becomes, answer = code_of(row[0]), code_of(row[1]) or "", row[2]
        content = self.read(name)
        if place.startswith("byte "):
            at = int(place[5:])
            new = bytes.fromhex(becomes) if becomes != "end" else None
            content = content[:at] if new is None else content[:at] + new + content[at + len(new):]
        else:
            self.assertIn(place.encode(), content, "the page's file has no such text")
            content = content.replace(place.encode(), becomes.encode(), 1)
        (self.folder / "tried").mkdir(exist_ok=True)
        self.write("tried/" + name, content)
        self.assert_answer(answer, row[0], subprocess.run(
            [harness.PROGRAM, "info", name], cwd=self.folder / "tried", env=self.environment, capture_output=True,
            timeout=harness.SECONDS, text=True))

    def assert_answer(self, answer, what, done):
        code = harness.FAILED if answer.startswith(("refused", "damaged")) else harness.DONE
        self.assertEqual(done.returncode, code, (what, done.stderr))
        words = code_of(answer)
        if words is None:
            self.assertEqual(done.stderr, "", what)
        else:
            self.assertIn(words, done.stderr, what)


def add_test(path):
    name = "test_" + re.sub(r"\W", "_", str(path.relative_to(harness.ROOT).with_suffix("")))
    setattr(PageTest, name, lambda self: self.work_through(path))


for page in PAGES:
    add_test(page)

if __name__ == "__main__":
    unittest.main()
