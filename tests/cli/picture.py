"""Reads the PNG pictures of the program: eight bits of red, green and blue."""
import struct
import zlib


def unfilter(kind, row, above):
    """Undoes a row's filter in place. Every byte was told as the difference to a guess from its neighbours."""
    for i in range(len(row)):
        left, up, corner = (row[i - 3], above[i], above[i - 3]) if i > 2 else (0, above[i], 0)
        estimate = left + up - corner
        nearest = min((left, up, corner), key=lambda value: abs(estimate - value))
        row[i] = (row[i] + (0, left, up, (left + up) // 2, nearest)[kind]) & 255


class Picture:
    def __init__(self, content):
        assert content.startswith(b"\x89PNG\r\n\x1a\n")
        self.width, self.height, *kind = struct.unpack(">IIBBBBB", content[16:33][:13])
        assert kind == [8, 2, 0, 0, 0], kind
        pixels, at = b"", 8
        while at < len(content):
            size, name = struct.unpack(">I4s", content[at:at + 8])
            pixels += content[at + 8:at + 8 + size] if name == b"IDAT" else b""
            at += size + 12
        self.rows = self.unpack(zlib.decompress(pixels))

    def unpack(self, pixels):
        length = 3 * self.width
        assert len(pixels) == (length + 1) * self.height
        rows = [bytearray(length)]
        for start in range(0, len(pixels), length + 1):
            row = bytearray(pixels[start + 1:start + 1 + length])
            unfilter(pixels[start], row, rows[-1])
            rows.append(row)
        return rows[1:]

    def drawn(self, left, top, right, bottom):
        """How many pixels of a part of the picture, in shares of its sides, are not of the ground's colour."""
        columns = range(int(left * self.width), int(right * self.width))
        part = self.rows[int(top * self.height):int(bottom * self.height)]
        ground = self.rows[0][:3]
        return sum(row[3 * x:3 * x + 3] != ground for row in part for x in columns)

    def colored(self, left, top, right, bottom):
        """How many pixels of a part are of the colors of a side: limbs, but neither trunk nor floor."""
        columns = range(int(left * self.width), int(right * self.width))
        part = self.rows[int(top * self.height):int(bottom * self.height)]
        return sum(abs(row[3 * x] - row[3 * x + 1]) > 60 for row in part for x in columns)


def differing(rows, others):
    """The share of bytes that differ by more than another rounding of a smooth edge does."""
    pairs = [pair for row, other in zip(rows, others) for pair in zip(row, other)]
    return sum(abs(a - b) > 64 for a, b in pairs) / len(pairs)


def chunks(content):
    """The names and contents of a PNG's chunks, whose checksums are checked."""
    found, at = [], 8
    while at < len(content):
        size, name = struct.unpack(">I4s", content[at:at + 8])
        body = content[at + 8:at + 8 + size]
        assert struct.unpack(">I", content[at + 8 + size:at + 12 + size])[0] == zlib.crc32(name + body), name
        found.append((name.decode(), body))
        at += size + 12
    return found
