"""A page of documentation as what a test can take hold of: fenced blocks and tables, in their order."""
import re
from dataclasses import dataclass, field


@dataclass
class Block:
    """What stands between two fences. ```hex file=tiny.orn is the file tiny.orn, told in hex."""
    line: int
    language: str = ""
    file: str = ""
    lines: list = field(default_factory=list)


@dataclass
class Table:
    line: int
    heading: str
    head: list
    rows: list  # of cells


def cells_of(line):
    inner = line.strip().removeprefix("|").removesuffix("|")
    return [cell.replace("\\|", "|").strip() for cell in re.split(r"(?<!\\)\|", inner)]


def code_of(cell):
    """What a cell says in code, or None for one that has none. ⏎ ends a line, → is a tab."""
    found = re.search(r"`([^`]*)`", cell)
    return found and found[1].replace("⏎", "\n").replace("→", "\t")


def read_page(path):
    """The parts of a page."""
    parts, block, heading = [], None, ""
    for number, line in enumerate(path.read_text(encoding="utf-8").splitlines(), 1):
        if line.startswith("```"):
            words = line[3:].split()
            if block is None:
                file = next((word[5:] for word in words if word.startswith("file=")), "")
                parts.append(block := Block(number, words[0] if words else "", file))
            else:
                block = None
        elif block is not None:
            block.lines.append(line)
        elif line.startswith("#"):
            heading = line.lstrip("# ")
        elif line.startswith("|"):
            table = parts[-1] if parts and isinstance(parts[-1], Table) else None
            if not table or table.line + len(table.rows) + 2 != number:
                if not re.match(r"\|[-| :]+$", line):
                    parts.append(Table(number, heading, cells_of(line), []))
            elif not re.match(r"\|[-| :]+$", line):
                table.rows.append(cells_of(line))
    return parts


def bytes_of_hex(lines):
    """The bytes of a dump as xxd writes it; a line "*" stands for lines of zeros up to the next offset. The
    characters on the right must be those of the bytes."""
    content = bytearray()
    for line in lines:
        if line == "*":
            continue
        offset, rest = line.split(": ", 1)
        content += bytes(int(offset, 16) - len(content))
        row, shown = bytes.fromhex(rest[:39]), rest[41:]
        characters = "".join(chr(byte) if 32 <= byte < 127 else "." for byte in row)
        if characters != shown:
            raise AssertionError("%r stands for %r" % (shown, characters))
        content += row
    return bytes(content)


def content_of(block):
    """The bytes of the file that a block tells."""
    if block.language == "hex":
        return bytes_of_hex(block.lines)
    return "".join(line + "\n" for line in block.lines).encode()


def matches(expected, out, err):
    """Whether the lines of a console are those of two streams, each in its order. A line "..." stands for any
    lines, "..." in a line for any characters."""
    patterns = [None if line == "..." else re.compile(".*".join(map(re.escape, line.split("..."))))
                for line in expected]
    places = {(0, 0)}
    for pattern in patterns:
        if pattern is None:
            places = {(i, j) for a, b in places for i in range(a, len(out) + 1) for j in range(b, len(err) + 1)}
            continue
        places = ({(a + 1, b) for a, b in places if a < len(out) and pattern.fullmatch(out[a])} |
                  {(a, b + 1) for a, b in places if b < len(err) and pattern.fullmatch(err[b])})
    return (len(out), len(err)) in places
