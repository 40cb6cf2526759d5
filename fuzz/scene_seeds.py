"""Scene containers with every class, built field by field.

A class is a text with one letter per field: f float, v vector, q quaternion, m matrix, i integer, c count, b flag, h
short, s text, l link. A number before a letter repeats it, "#" before a field is a counted list of two, "?" before
fields is their presence word. All lists have two elements, and all counts are two."""
import struct

OBJECT = "s l l l "
CONTROL = OBJECT + "i 4f b l l "
TRACK = CONTROL + "m b #q #v #v #f #f #f #f i "
SPATIAL = OBJECT + "m b #l "
NODE = SPATIAL + "i b b #l "
LIGHT = SPATIAL + "v f b "
GEOMETRY = SPATIAL + "#v ? 2i c ? 2v c ? 2v c ? 2i ? 2i ? 2i l b "
MATERIAL = OBJECT + "b "
DATA = OBJECT + "s i i l "
PIXELS = "2c i h i i ? 16b "
VECTOR_KEYS = CONTROL + "#v #f "
BITS = "i c ? 2i "

CLASSES = {
    "CNode": NODE,
    "CBillboardNode": NODE,
    "CPointLight": LIGHT + "v",
    "CCamera": SPATIAL + "7f 3v b b l",
    "CCameraTarget": SPATIAL,
    "CKeyframeControl": TRACK,
    "CKeyframeClipControl": TRACK + "c 32b i i f f 32b i i f f c f i i f i i",
    "CLightControl": VECTOR_KEYS,
    "CCameraControl": VECTOR_KEYS,
    "CRawData": DATA + "c ? 2b",
    "CAuthorInfo": DATA + "5s",
    "CStandardMaterial": MATERIAL + "4v 10f #l",
    "CBlendMaterial": MATERIAL + "f 3l",
    "CMultiMaterial": MATERIAL + "#l",
    "CTextureMap": MATERIAL + "i l",
    "CNormalBumpTex": MATERIAL + "b b f f l l",
    "CImage": OBJECT + "e h 0 " + PIXELS,
    "CAnmImage": OBJECT + "e c 5i l 5i l",
    "CAnmImageControl": CONTROL + "l",
    "CSprite": OBJECT + "l i i b i",
    "CTriMesh": GEOMETRY + "c ? 6i ? 6i ? 6i ? 6i ? 2i ? 2i #l c 6i",
    "CTriMeshUVWMap": OBJECT + "c ? 2v c ? 6i c ? 2i",
    "CRectangle": GEOMETRY,
    "CCircle": GEOMETRY + "f",
    "CLine": GEOMETRY,
    "CParticles": GEOMETRY + "c i",
    "CSkinBoneControl": CONTROL + "c i c l f m l f m i c l f m l f m",
    "CBoneSkinControl": CONTROL + "c l m c i f i f l m c i f i f",
    "CMorphControl": CONTROL + "#v #f #f",
    "CEditNormalControl": CONTROL + "l",
    "CEditNormalData": OBJECT + "c l " + BITS + "l " + BITS + "b f",
    "CConnectControl": CONTROL + "l",
    "CConnectData": OBJECT + "l l #i #i c #i #i c #i #i",
    "CMeshSelControl": CONTROL + BITS,
    "CParticleControl": CONTROL + "i f v f v f 4v 8f 2v f f 4i",
    "CTriMeshUVWMapControl": CONTROL + "#v #f",
}

IDENTITY = (1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1)


def text(characters):
    return struct.pack("<I", len(characters)) + characters.encode()


class Fields:
    """Values for the fields of one object: the given links, and alternating numbers."""

    def __init__(self, name, links):
        self.name, self.links, self.number = name, iter(links), 0

    def alternate(self):
        self.number += 1
        return self.number % 2

    def value(self, letter):
        if letter == "f":
            return struct.pack("<f", self.alternate())
        if letter == "v":
            return struct.pack("<3f", self.alternate(), 0.5, 2)
        if letter == "q":
            return struct.pack("<4f", 1, 0, 0, 0)
        if letter == "m":
            return struct.pack("<16f", *IDENTITY)
        if letter == "s":
            name, self.name = self.name, ""
            return text(name)
        return {"b": b"\1", "0": b"\0", "h": b"\1\0", "e": text(""), "c": struct.pack("<I", 2), "?": struct.pack("<I", 1),
                "i": struct.pack("<I", self.alternate()), "l": struct.pack("<I", next(self.links, 0))}[letter]

    def bytes(self, layout):
        made = b""
        for field in layout.split():
            if field[0] == "#":
                made += self.value("c")
                field = "2" + field[1:]
            count = int(field[:-1]) if len(field) > 1 else 1
            made += b"".join(self.value(field[-1]) for _ in range(count))
        return made


class Scene:
    def __init__(self, version="1.20"):
        pixels = struct.pack("<iiiHii", 0, 0, 0, 0, 96, 96)
        self.made = b"TKOrrin Version %s\0" % version.encode() + text("_OrrinThumbnail") + pixels
        self.made += struct.pack("<IIIBI", 0, 1, 0, 0, 0)
        self.before_attachments = version < "1.01"

    def add(self, kind, number, links=(), root=True):
        layout = CLASSES[kind]
        if self.before_attachments:
            layout = layout.replace(OBJECT, "s l ", 1)
        self.made += (text("_OrrinRoot") if root else b"") + text(kind) + struct.pack("<I", number)
        self.made += Fields(kind, links).bytes(layout)
        return self


def meshes():
    """Yields a mesh with each kind of control, and the objects that these need."""
    kinds = [kind for kind, layout in CLASSES.items() if layout.startswith(CONTROL)]
    for kind in kinds:
        scene = Scene().add("CTriMesh", 1, (2, 0, 0, 3, 3, 6, 4, 4))
        scene.add(kind, 2, (0, 0, 0, 1, 0, 3, 3, 3, 3), False).add("CNode", 3, (0, 0, 0, 0, 0, 7, 8))
        scene.add("CTriMeshUVWMap", 4, root=False).add("CStandardMaterial", 6, (0, 0, 0, 9, 9), False)
        scene.add("CParticles", 7, (2,), False).add("CCircle", 8, root=False).add("CTextureMap", 9, root=False)
        yield "controlled-" + kind, scene.made


def pairs():
    """Yields objects that refer to objects of a certain class."""
    rows = [  # holder, its links, following classes starting at id 2
        ("CEditNormalControl", (0, 0, 0, 3, 0, 2), ("CEditNormalData", "CTriMesh")),
        ("CConnectControl", (0, 0, 0, 3, 0, 2), ("CConnectData", "CTriMesh")),
        ("CConnectData", (0, 0, 0, 2, 3), ("CTriMesh", "CTriMesh")),
        ("CEditNormalData", (0, 0, 0, 2, 3), ("CTriMesh", "CTriMesh")),
        ("CAnmImageControl", (0, 0, 0, 3, 0, 2), ("CAnmImage", "CTextureMap")),
        ("CAnmImage", (0, 0, 0, 2, 3), ("CImage", "CImage")),
        ("CSprite", (0, 0, 0, 2), ("CImage",)),
        ("CBlendMaterial", (0, 0, 0, 2, 3, 3), ("CTextureMap", "CMultiMaterial")),
        ("CNormalBumpTex", (0, 0, 0, 2, 2), ("CTextureMap",)),
        ("CCamera", (0, 0, 0, 0, 0, 2), ("CCameraTarget",)),
        ("CNode", (2, 3, 4), ("CKeyframeControl", "CMorphControl", "CAuthorInfo")),
    ]
    for number, (holder, links, kinds) in enumerate(rows):
        scene = Scene().add(holder, 1, links)
        for behind, kind in enumerate(kinds):
            scene.add(kind, 2 + behind, root=False)
        yield "pair-%02d-%s" % (number, holder), scene.made


def scenes():
    """Yields names and bytes of all seeds."""
    for kind in CLASSES:
        yield "alone-" + kind, Scene().add(kind, 1).made
    everything = Scene()
    for number, kind in enumerate(CLASSES):
        everything.add(kind, 1 + number)
    yield "everything", everything.made
    yield "old", Scene("1.00").add("CNode", 1).made
    yield from meshes()
    yield from pairs()
