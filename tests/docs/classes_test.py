"""Writes an object of every class by the tables of container-classes.md and compares what the program reads in it.

A field that the page leaves out, has at another place or in another form moves all bytes behind it, so that values turn
up under other names or the record ends elsewhere than the file.
"""
import json
import re
import struct
import unittest

import harness
from page import Table, read_page

PAGE = harness.ROOT / "docs" / "formats" / "container-classes.md"
HEAD = b"TKOrrin Version 1.20\0" + struct.pack("<I15sIII", 15, b"_OrrinThumbnail", 0, 0, 0) + \
    struct.pack("<HIIIIIBI", 0, 96, 96, 0, 1, 0, 0, 0)

# form: how numbers become bytes, how many there are, and what is added to whole ones
NUMBERS = {"bool": ("<B", 1, 0), "u8": ("<B", 1, 0), "u16": ("<H", 1, 0), "u32": ("<I", 1, 0), "i32": ("<i", 1, 0),
           "f32": ("<f", 1, 0.5), "vec3": ("<3f", 3, 0.5), "quat": ("<4f", 4, 0.5), "mat4": ("<16f", 16, 0.5)}
ELEMENTS = 2  # in every list


def string(text):
    return struct.pack("<I", len(text)) + text.encode()


class Record:
    """The bytes of a class's fields, and the JSON that should come of them."""

    def __init__(self):
        self.content, self.fields, self.links, self.lengths, self.count = b"", {}, {}, {}, 0

    def number(self, form, fixed=None):
        pack, size, fraction = NUMBERS[form]
        values = []
        for _ in range(size):
            self.count = self.count % 199 + 1
            values.append(1 if form == "bool" else self.count + fraction)
        values = [int(fixed)] if fixed else values
        self.content += struct.pack(pack, *values)
        return bool(values[0]) if form == "bool" else values[0] if size == 1 else values

    def row(self, form, count):
        """Values one behind the other; bytes are shown in hex."""
        if form == "link":
            self.content += bytes(4 * count)
            return [None] * count
        values = [self.number(form) for _ in range(count)]
        return bytes(values).hex() if form == "u8" else values

    def counted(self, form, fixed=None):
        count = int(fixed) if fixed else ELEMENTS
        self.content += struct.pack("<I", count)
        return self.row(form, count)

    def length(self, words):
        """How many elements the fields before tell, as in "3 × triangle quantity"."""
        product = 1
        for word in words.split(" × "):
            product *= int(word) if word.isdigit() else self.stride() if word == "stride" else self.lengths[word]
        return product

    def stride(self):
        return (self.lengths["width"] * (4, 3, 2, 2, 2, 1)[self.lengths["format"]] + 3) // 4 * 4

    def value(self, form, below):
        form, _, fixed = form.partition(" = ")
        if form == "string":
            text = "" if fixed else "text%d" % self.count
            self.content += string(text)
            return text or None
        if form == "list of records":
            self.content += struct.pack("<I", ELEMENTS)
            return [self.members(below) for _ in range(ELEMENTS)]
        if found := re.fullmatch(r"(?:signed )?list of (\w+)", form):
            return self.counted(found[1], fixed)
        if found := re.fullmatch(r"if present: (.*) × (\w+)", form):
            self.content += struct.pack("<I", 1)
            return self.row(found[2], self.length(found[1]))
        if found := re.fullmatch(r"(\d+) × (\w+)", form):
            return self.row(found[2], int(found[1]))
        if form in ("link", "plain link"):
            self.content += bytes(4)
            return None
        return self.number(form, fixed)

    def take(self, rows, into):
        """Writes rows with those that stand below them, marked by dots."""
        while rows:
            (name, form, *_), rows = rows[0], rows[1:]
            below = []
            while rows and rows[0][0].startswith("· "):
                below.append([rows[0][0][2:], *rows[0][1:]])
                rows = rows[1:]
            value = self.value(form, below)
            self.lengths[name] = len(value) if isinstance(value, (list, str)) else value
            into(name, form)[name] = value

    def members(self, rows):
        members = {}
        self.take(rows, lambda name, form: members)
        return members

    def write(self, rows):
        self.take(rows, lambda name, form: self.links if "link" in form.split() else self.fields)


def classes_of_page():
    """Headings as "CNode : CSpatial", with the rows that follow."""
    tables = {part.heading: part.rows for part in read_page(PAGE) if isinstance(part, Table)}
    headings = [line[4:] for line in PAGE.read_text().splitlines() if line.startswith("### ")]
    return {heading.split(" : ")[0]: (heading.partition(" : ")[2], tables.get(heading, [])) for heading in headings}


CLASSES = classes_of_page()


def rows_of(title):
    """All rows of a class, its base's first."""
    base, rows = CLASSES[title]
    return (rows_of(base) if base else []) + rows


def made_classes(word):
    """The classes of the program's own tables: those that it makes of a file, or those that it only knows."""
    text = "".join(path.read_text() for path in sorted((harness.ROOT / "src").glob("*/*Classes.cpp")))
    return set(re.findall(r"\{&(\w+)::ms_kRTTI, +" + word, text))


class ClassesTest(harness.CliTest):
    def read_back(self, name, record):
        path = self.write("object.orn", HEAD + string("_OrrinRoot") + string(name) + struct.pack("<I", 1) +
                          record.content)
        result = self.run_program("info", path, "--json")
        self.assertEqual(result.code, harness.DONE, result.err)
        return json.loads(result.out)["objects"]

    def test_every_class_reads_as_its_table_says(self):
        for title in CLASSES:
            name = title.split(" (")[0]
            if name not in made_classes("MakeObject"):
                continue
            with self.subTest(title):
                record = Record()
                record.write(rows_of(title))
                objects = self.read_back(name, record)
                self.assertEqual([found["class"] for found in objects], [name])
                self.assertEqual(list(objects[0]["links"].items()), list(record.links.items()))
                self.assertEqual(list(self.without_folder(objects[0]["fields"]).items()), list(record.fields.items()))

    def without_folder(self, fields):
        """The name of a picture file as it stands in the container: the program tells where it looked."""
        name = fields.get("m_pcLinkFileName")
        return {**fields, "m_pcLinkFileName": name.rsplit("/", 1)[-1]} if name else fields

    def test_no_class_is_left_out(self):
        told = {title.split(" (")[0] for title in CLASSES}
        self.assertEqual(made_classes("MakeObject") - told, set())
        text = PAGE.read_text()
        self.assertEqual({name for name in made_classes("MakeNothing") if name not in text}, set())


if __name__ == "__main__":
    unittest.main()
