"""Converts the same motions with the program of this system and with the one for Windows, and compares the results:
compare_programs.py PROGRAM WINDOWS_PROGRAM EMULATOR. They must be the same bytes, but text files have the line ends of
their system, and a package says how long its text is."""
import json
import os
import struct
import subprocess
import sys
import tempfile
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
DATA = os.environ.get("GAITWRIGHT_TEST_DATA")
FORMATS = ("htr", "bvh", "glb", "Kinetra")
TEXT_SIZE, TEXT_START = 373, 381  # in a package: the size of its motion file in bytes, and the file


def conversions():
    """Yields a name and the arguments of a conversion without its output."""
    for source in sorted((ROOT / "examples").glob("*.bvh")):
        for options in ([], ["--align", "--faithful"], ["--no-legs"]):
            yield source.stem + "".join(options), [source, "--data-dir", ROOT / "assets", *options]
    for folder in ("golden", "golden-gaps") if DATA else ():
        for case in json.loads((Path(DATA) / folder / "cases.json").read_text()):
            place = Path(DATA) / folder / case["name"]
            legs = [] if case["legs"] else ["--no-legs"]
            yield case["name"], [place / "source.bvh", "--data-dir", Path(DATA) / "golden" / "skeleton", "--profile",
                                 place / "map.prf", *legs]


def comparable(path):
    """Returns the bytes of a result with the line ends of this system, also in the text that a package holds."""
    content = path.read_bytes()
    if path.suffix == ".glb":
        return content
    if path.suffix != ".Kinetra":
        return content.replace(b"\r\n", b"\n")
    text = content[TEXT_START:].replace(b"\r\n", b"\n")
    assert struct.unpack_from("<I", content, TEXT_SIZE)[0] == len(content) - TEXT_START
    return content[:TEXT_SIZE] + struct.pack("<I", len(text)) + content[TEXT_SIZE + 4:TEXT_START] + text


def convert(command, arguments, result):
    """Returns the comparable bytes of a result; raises an error with the program's message if there is none."""
    # The message is no pipe: the emulator's server, which outlives the program, would keep it open.
    with open(result.with_suffix(".message"), "w+") as message:
        done = subprocess.run([*command, "convert", *map(str, arguments), "-o", str(result), "--force"],
                              stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=message, timeout=300)
        if done.returncode != 0:
            message.seek(0)
            raise RuntimeError("%s ended with %d: %s" % (command[-1], done.returncode, message.read()))
    return comparable(result)


def main():
    program, windows_program, emulator = sys.argv[1:]
    count = same = 0
    with tempfile.TemporaryDirectory() as folder:
        for name, arguments in conversions():
            for extension in FORMATS:
                ours, others = (convert(command, arguments, Path(folder) / ("%s.%s" % (system, extension))) for
                                system, command in (("here", [program]), ("windows", [emulator, windows_program])))
                count += 1
                same += ours == others
                if ours != others:
                    print("differs: %s.%s" % (name, extension))
    print("%d of %d results are the same bytes" % (same, count))
    return 0 if count and same == count else 1


if __name__ == "__main__":
    sys.exit(main())
