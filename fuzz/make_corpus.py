"""Makes the seeds of the fuzz targets: small files of every kind as a start for mutations.

    make_corpus.py PROJECT_FOLDER CORPUS_FOLDER"""
import json
import struct
import sys
from pathlib import Path

from scene_seeds import scenes

PROJECT, CORPUS = Path(sys.argv[1]), Path(sys.argv[2])
sys.path.insert(0, str(PROJECT / "tests" / "cli"))
import made  # noqa: E402: small motions that the tests use too


def short_motion(path, frames):
    """Returns the first frames of a motion, so that mutations are cheap."""
    lines = path.read_text().splitlines()
    rows = next(i for i, line in enumerate(lines) if line.startswith("Frames:"))
    kept = lines[:rows] + ["Frames: %d" % frames] + lines[rows + 1:rows + 2 + frames]
    return "\n".join(kept) + "\n"


def bmp(depth, width=5, height=4, palette=0, header=40):
    """Returns a BMP file of a depth; a negative height means that rows start at the top."""
    offset = 14 + header + 4 * palette
    stride = (width * depth + 31) // 32 * 4
    head = struct.pack("<IiiHHIIiiII", header, width, height, 1, depth, 0, 0, 2835, 2835, palette, 0)
    colors = b"".join(struct.pack("<I", 0x123456 * i & 0xffffff) for i in range(palette))
    rows = bytes(i * 37 & 0xff for i in range(stride * abs(height)))
    file_head = b"BM" + struct.pack("<IHHI", offset + len(rows), 0, 0, offset)
    return file_head + head + bytes(header - 40) + colors + rows


def gif(width=4, height=4, interlaced=False, images=1, local=False, control=True):
    """Returns a GIF file. Each pixel is one code after a clear code, so no code table is needed."""
    palette = bytes(range(12))
    bits, held, count = 0, 0, b""
    for code in [4] + [c for i in range(width * height) for c in (i % 4, 4)] + [5]:
        bits |= code << held
        held += 3
    packed = bits.to_bytes((held + 7) // 8, "little")
    for start in range(0, len(packed), 255):
        piece = packed[start:start + 255]
        count += bytes([len(piece)]) + piece
    flags = (0x81 if local else 0) | (0x40 if interlaced else 0)
    image = b"," + struct.pack("<4HB", 0, 0, width, height, flags) + (palette if local else b"") + b"\2" + count + b"\0"
    extension = b"!\xf9\4\5\7\0\1\0" if control else b""
    return b"GIF89a" + struct.pack("<HHBBB", width, height, 0x81, 0, 0) + palette + (extension + image) * images + b";"


def directory(entries):
    return bytes(14) + struct.pack("<H", len(entries)) + b"".join(struct.pack("<II", *entry) for entry in entries)


def library(optional=0x20b):
    """Returns a library with one block of texts, 128 to 143, in one language."""
    words = [""] * 10 + ["Invalid file %s.", "*"] + [""] * 4
    block = b"".join(struct.pack("<H", len(w)) + w.encode("utf-16-le") for w in words)
    deeper = 1 << 31
    section = directory([(6, deeper | 24)]) + directory([(9, deeper | 48)]) + directory([(1031, 72)])
    section += struct.pack("<IIII", 0x1000 + 88, len(block), 0, 0) + block
    directories = 112 if optional == 0x20b else 96
    header = struct.pack("<H", optional).ljust(directories - 4, b"\0") + struct.pack("<I", 16)
    header += bytes(16) + struct.pack("<II", 0x1000, len(section)) + bytes(13 * 8)
    made_bytes = b"MZ".ljust(0x3c, b"\0") + struct.pack("<I", 0x40)
    made_bytes += b"PE\0\0" + struct.pack("<HHIIIHH", 0x8664, 1, 0, 0, 0, len(header), 0) + header
    made_bytes += struct.pack("<8sIIIIIIHHI", b".rsrc", len(section), 0x1000, len(section), 0x200, 0, 0, 0, 0, 0)
    return made_bytes.ljust(0x200, b"\0") + section


def motions():
    walk = short_motion(PROJECT / "examples" / "walk.bvh", 2)
    wave = short_motion(PROJECT / "examples" / "wave.bvh", 2)
    yield "bvh", {"small": made.BVH, "walk": walk, "wave": wave,
                  "commas": made.bvh("1 90 0 0", "1, 90.5 ,-0 0"), "crlf": made.BVH.replace("\n", "\r\n"),
                  "endless": made.bvh("    End Site\n    {\n      OFFSET 0 5 0\n    }\n", "")}
    yield "htr", {"small": made.HTR, "radians": made.HTR.replace("Units Degrees", "Units Radians"),
                  "order": made.HTR.replace("Order ZYX", "Order XYZ")}
    yield "cha", {"small": made.page_file("tiny.cha")}
    chb = made.page_file("tiny.chb")
    yield "chb", {"small": chb, "old": chb.replace(struct.pack("<i", 721), struct.pack("<i", 100), 1)}
    body = [("Hips", -1), ("Spine", 0), ("Head", 1), ("Leg", 0)]
    yield "import", {"still": message(1, body), "moving": message(3, body), "refused": message(0, [], 1, "no scene")}
    ways = {"plain": 0, "packaged": 2, "feet": 4, "all": 2 | 8 | 16 | 32 | 64}
    converts = {"walk-" + what: bytes([way]) + walk.encode() for what, way in ways.items()}
    converts["scene"] = b"\1" + made.one_bone_scene()
    converts["small"] = b"\0" + made.BVH.encode()
    yield "convert", converts


def sent_text(text):
    return struct.pack("<I", len(text)) + text.encode()


def message(frames, joints, outcome=0, words=""):
    """What the import program sends. Joints are names and parents."""
    keys = struct.pack("<3f", 0, 1, 0) * frames + struct.pack("<4f", 1, 0, 0, 0) * frames
    bones = b"".join(sent_text(name) + struct.pack("<i3f", parent, 0, 1, 0) + keys for name, parent in joints)
    head = struct.pack("<I", outcome) + sent_text(words) + struct.pack("<I", 1) + 2 * sent_text("walk")
    facts = struct.pack("<dBdBII", 30, 1, 0.01, 0, frames, len(joints))
    return b"gaitwright import 1\n" + head + facts + bones


def maps():
    stock = (PROJECT / "assets" / "PoserBVH.prf").read_text()
    rows = {"stock": stock, "small": made.profile("Mine", [("Hips", "LowerTorso"), ("Chest", "UpperTorso")]),
            "fixed": "Name\n* Pelvis . .1,2,3\nPosition 1 -2 3.5\nFrameRate 30\n"}
    yield "profile", rows
    yield "maplines", rows
    yield "shares", {"stock": (PROJECT / "assets" / "KsBone.bsm").read_bytes(), "small": "LThigh 0.5 1 2\nNobody 1 2 3\n"}
    yield "settings", {"small": "[Settings]\nLastFolder=/home\n\n[General]\nx=1\n",
                       "odd": '; note\n[Settings]\nLastFolder="a, b;\\x41\\n" ; tail\nk%20y=1,2, 3\n[%General]\n'}


def lines(*records):
    return "".join(json.dumps(record, separators=(",", ":")) + "\n" for record in records)


def nested(levels):
    return "[" * levels + "]" * levels + "\n"


def runs():
    head = {"plan": 1, "version": "1", "shards": 2, "outputFolder": "out", "options": {}}
    told = {"--profile": "Poser BVH", "--no-legs": True, "--jobs": 4, "--rate": 30.5, "--sixty": 7}
    source = {"shard": 1, "source": "a\u00e9.bvh", "output": "out/a.Kinetra", "bytes": 4096}
    deep = nested(70000)
    yield "plan", {"small": lines(head, source), "options": lines(head | {"options": told}, source),
                   "empty": lines(head), "deep": lines(head, source)[:-2] + ',"x":' + deep, "first": deep}
    begun = {"output": "a.Kinetra"}
    done = begun | {"key": "a key", "digits": "0f" * 16, "told": '"outcome":"converted"'}
    yield "resume", {"small": lines(begun, done), "torn": lines(done, done)[:-20], "deep": lines(done) + deep}
    failure = {"path": "a.bvh", "where": 7, "code": "bad-number", "name": "1x", "words": "a number is expected"}
    result = {"source": "a.bvh", "output": "a.Kinetra", "outcome": "converted", "check": {"figures": {"slide": 0.5}},
              "failures": [failure], "warnings": [failure, failure]}
    clean = result | {"failures": [], "warnings": []}
    yield "report", {"small": lines(result), "clean": lines(clean, result), "torn": lines(result)[:-9],
                     "deep": lines(result)[:-2] + ',"x":' + deep}


def pictures():
    yield "bmp", {"%d" % depth: bmp(depth, palette=1 << depth if depth <= 8 else 0) for depth in (1, 4, 8, 16, 24, 32)} | {
        "top": bmp(24, height=-4), "large-head": bmp(8, palette=256, header=124)}
    yield "gif", {"plain": gif(), "interlaced": gif(interlaced=True), "film": gif(images=3), "local": gif(local=True),
                  "bare": gif(control=False), "wide": gif(20, 20)}
    yield "strings", {"64": library(), "32": library(0x10b)}


def main():
    kinds = [*motions(), *maps(), *runs(), *pictures(), ("container", dict(scenes()))]
    for target, seeds in kinds:
        folder = CORPUS / target
        folder.mkdir(parents=True, exist_ok=True)
        for name, content in seeds.items():
            (folder / name).write_bytes(content if isinstance(content, bytes) else content.encode())


if __name__ == "__main__":
    main()
