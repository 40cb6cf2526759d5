"""Converts the same motions with the program of this system and with the one for Windows, and compares the results:
compare_programs.py PROGRAM WINDOWS_PROGRAM EMULATOR. Text files have the line ends of their system. The mathematical
functions of the two C libraries round differently, so results that are not the same bytes must be the same words and
nearly the same numbers. A conversion turns such a difference into the last digits of the numbers that it writes."""
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
PROFILE = "Poser BVH"
LAST_DIGITS = 0.01  # of positions and of angles in degrees; the largest difference is printed
TEXT_SIZE, TEXT_START = 373, 381  # in a package: the size of its motion file in bytes, and the file


def conversions():
    """Yields a name and the arguments of a conversion without its output."""
    for source in sorted((ROOT / "examples").glob("*.bvh")):
        for options in ([], ["--align", "--faithful"], ["--no-legs"]):
            yield source.stem + "".join(options), [source, "--data-dir", ROOT / "assets", "--profile", PROFILE, *options]
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


def largest_difference(ours, others):
    """Between the numbers of two results; infinite if anything else differs. Angles that are a whole turn apart are
    the same."""
    ours, others = ours.split(), others.split()
    if len(ours) != len(others):
        return float("inf")
    largest = 0.0
    for one, other in zip(ours, others):
        if one == other:
            continue
        try:
            apart = abs(float(one) - float(other))
        except ValueError:
            return float("inf")
        largest = max(largest, min(apart, abs(360 - apart)))
    return largest


def difference(ours, others, extension):
    if ours == others:
        return 0.0
    if extension == "glb":  # compared by way of the other forms
        return 0.0 if len(ours) == len(others) else float("inf")
    if extension == "Kinetra":
        ours, others = ours[TEXT_START:], others[TEXT_START:]
    return largest_difference(ours, others)


def main():
    program, windows_program, emulator = sys.argv[1:]
    differing = []
    count = same = 0
    largest = 0.0
    with tempfile.TemporaryDirectory() as folder:
        for name, arguments in conversions():
            for extension in FORMATS:
                results = []
                for system, command in (("here", [program]), ("windows", [emulator, windows_program])):
                    result = Path(folder) / ("%s.%s" % (system, extension))
                    done = subprocess.run([*command, "convert", *map(str, arguments), "-o", str(result), "--force"],
                                          capture_output=True)
                    results.append(comparable(result) if done.returncode == 0 else done.stderr)
                count += 1
                same += results[0] == results[1]
                apart = difference(*results, extension)
                largest = max(largest, apart)
                if apart > LAST_DIGITS:
                    differing.append("%s.%s by %g" % (name, extension, apart))
    for name in differing:
        print("differs:", name)
    print("%d of %d results are the same bytes; numbers differ by %g at most" % (same, count, largest))
    return 1 if differing or not count else 0


if __name__ == "__main__":
    sys.exit(main())
