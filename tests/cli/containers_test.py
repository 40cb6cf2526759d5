"""Containers and packages: told, posed, written again, and refused where they are damaged."""
import json
import struct

from harness import DONE, FAILED, CliTest, main
from made import HTR, IDENTITY, Container, moved, one_bone_scene, profile


def skeleton():
    """Two bones under a group; the lower one moves, and a slot is empty."""
    scene = Container().node(1, "Group", moved(0, 0, 7), children=(2, 0), root=True)
    scene.node(2, "Hips", moved(0, 90, 0), children=(3,)).node(3, "Chest", moved(0, 10, 0), control=4)
    return scene.track(4, 3, [(0, 10, 0), (1, 10, 0), (2, 10, 0)]).bytes


def lattice(levels):
    """Each node twice below the one above: walks that tell shared nodes apart would never end."""
    scene = Container()
    for number in range(1, levels + 1):
        below = (number + 1, number + 1) if number < levels else ()
        scene.node(number, "n%d" % number, children=below, root=number == 1)
    return scene.bytes


def odd_numbers():
    values = [float("nan"), float("inf"), float("-inf"), 1e-45, -0.0] + [0.0] * 11
    return Container().node(1, "odd", values, root=True).bytes


DAMAGED = [  # what, content, words
    ("an object of a class that there is not", Container().record("CGhost", 1, "", (0, 0, 0), b"", True).bytes,
     ["damaged at byte", '"CGhost"']),
    ("nesting without end", lattice(200), ["damaged", "limit"]),
]


class Containers(CliTest):
    def pose(self, name, frame):
        result = self.run_program("pose", name, "--frame", frame)
        self.assertEqual(result.code, DONE, result.err)
        return {node["name"]: node for node in json.loads(result.out)["nodes"]}

    def test_a_scene_is_posed_by_the_clock_of_its_first_track(self):
        self.write("scene.orn", skeleton())
        for frame in (0, 1, 2, 9):
            chest = self.pose("scene.orn", frame)["Chest"]
            self.assertEqual(chest["parent"], "Hips")
            self.assertEqual(chest["local"][12:15], [min(frame, 2), 10, 0])
            self.assertEqual(chest["world"][12:15], [min(frame, 2), 100, 7])

    def test_info_reads_no_linked_picture(self):
        name = b"none.png"
        fields = struct.pack("<I", len(name)) + name + struct.pack("<H", 0)
        self.write("a.orn", Container().record("CImage", 1, "", (0, 0, 0), fields, True).bytes)
        self.succeed("info", "a.orn")
        self.assertEqual(self.files(), ["a.orn"], "no note of a picture that cannot be read")
        self.succeed("resave", "a.orn", "b.orn")
        self.assertIn("ImageLoadFailed.txt", self.files())

    def test_every_object_is_told_with_links_and_fields(self):
        self.write("scene.orn", skeleton())
        told = json.loads(self.run_program("info", "scene.orn", "--json").out)
        group, hips, chest, track = told["objects"]
        self.assertEqual([o["class"] for o in told["objects"]], ["CNode", "CNode", "CNode", "CKeyframeControl"])
        self.assertEqual((told["roots"], group["root"], hips["root"]), ([group["id"]], True, False))
        self.assertEqual(group["links"]["m_kChild"], [hips["id"], None])
        self.assertEqual(chest["links"]["m_spkControl"], track["id"])
        self.assertEqual(track["links"]["m_pkTarget"], chest["id"])
        self.assertEqual(track["fields"]["m_kPositionKeys"], [[0, 10, 0], [1, 10, 0], [2, 10, 0]])
        self.assertEqual(track["fields"]["m_fFrequency"], 0.5)
        self.assertEqual(hips["fields"]["m_kMatrix"], moved(0, 90, 0))
        self.assertEqual((told["frames"], told["rate"], told["seconds"]), (3, 2, 1))

    def test_a_list_of_one_stays_a_list(self):
        body = Container.floats(IDENTITY) + struct.pack("<BIi3f", 1, 0, 1, 4, 5, 6) + bytes(41)
        circle = Container().record("CCircle", 1, "", (0, 0, 0), body + Container.floats([2]), True).bytes
        self.write("circle.orn", circle)
        told = json.loads(self.run_program("info", "circle.orn", "--json").out)["objects"][0]["fields"]
        self.assertEqual((told["XYZBuffer"], told["m_fRadius"]), ([[4, 5, 6]], 2))

    def test_a_scene_is_converted_if_it_ends_after_it_begins(self):
        self.write("hip.prf", profile("Hip", [("hip", "LowerTorso")]))
        for scene, words in ((one_bone_scene(), []), (one_bone_scene(0), ["no frames"]),
                             (one_bone_scene(end=float("inf")), ["limit"])):
            self.write("scene.orn", scene)
            result = self.with_assets("convert", "scene.orn", "-o", "a.Kinetra", "--force", "--profile", "hip.prf")
            self.assertEqual(result.code, FAILED if words else DONE, result.err)
            self.assert_words(result, words and ["scene.orn"] + words)
        self.assertEqual(self.files(), ["a.Kinetra", "hip.prf", "scene.orn"])

    def test_json_stays_json_whatever_a_file_holds(self):
        self.write("odd.orn", odd_numbers())
        node = json.loads(self.run_program("info", "odd.orn", "--json").out)["objects"][0]
        self.assertEqual(node["fields"]["m_kMatrix"][:5], ["nan", "inf", "-inf", 1e-45, 0])
        self.write("name.orn", Container().node(1, b"\x1b]0;\xff\"\\\n", root=True).bytes)
        told = json.loads(self.run_program("info", "name.orn", "--json").bytes)["objects"][0]
        self.assertEqual(told["name"], "\x1b]0;\ufffd\"\\\n")
        self.assertNotIn("\x1b", self.run_program("info", "name.orn").out)

    def test_damage_is_told_with_its_byte_and_nothing_is_written(self):
        for what, content, words in DAMAGED:
            self.write("bad.orn", content)
            for command in (["resave", "bad.orn", "out.orn"], ["extract", "bad.orn", "-o", "out.htr"],
                            ["pose", "bad.orn", "--frame", "0"], ["pose", "bad.orn", "--time", "1", "--objects"],
                            ["dump", "bad.orn", "--out-dir", "pages"], ["info", "bad.orn", "--json"]):
                with self.subTest(what, command=command[0]):
                    result = self.run_program(*command)
                    self.assertEqual(result.code, FAILED)
                    self.assert_words(result, ["bad.orn"] + words)
                    self.assertEqual(self.files(), ["bad.orn"])
                    if command[0] == "info":
                        self.assertEqual(len(json.loads(result.out)["failures"]), 1)
            self.assertEqual(self.with_assets("convert", "bad.orn", "-o", "a.htr").code, FAILED)

    def test_pages_do_not_replace_folders(self):
        self.write("one.orn", Container().node(1, b"one", root=True).bytes)
        (self.folder / "pages/OrnHTML0.htm").mkdir(parents=True)
        result = self.run_program("dump", "one.orn", "--out-dir", "pages")
        self.assertEqual(result.code, FAILED)
        self.assert_words(result, ["pages/OrnHTML0.htm: the page cannot be written: a link, a folder"])

    def test_a_package_holds_the_file_and_what_was_said_of_it(self):
        rows = [("take.htr", 3), ("take.HTR", 3), ("take.cha", 1), ("take.chb", 2), ("take.txt", 0)]
        for name, code in rows:
            with self.subTest(name):
                self.write(name, HTR)
                run = self.run_program("package", name, "out.Kinetra", "--rate", "29.97", "--force")
                self.assertEqual(run.code, DONE, run.err)
                package = self.read("out.Kinetra")
                self.assertEqual(len(package), 381 + len(HTR))
                self.assertEqual(package[290:306], struct.pack("<IIff", 1, code, 29.97, 60))

    def test_a_package_that_cannot_be_made_or_opened_is_told(self):
        self.write("take.htr", HTR)
        self.write("scene.orn", skeleton())
        rows = [
            (["package", "none.htr", "a.Kinetra", "--rate", "30"], ["none.htr"]),
            (["package", "take.htr", "none/a.Kinetra", "--rate", "30"], ["none/a.Kinetra", "cannot be written"]),
            (["extract", "scene.orn", "-o", "a.htr"], ["scene.orn", "MotionFile"]),
            (["extract", "take.htr", "-o", "a.htr"], ["take.htr"]),
            (["resave", "scene.orn", "take.htr"], ["take.htr", "--force"]),
        ]
        for arguments, words in rows:
            with self.subTest(arguments[0:2]):
                result = self.run_program(*arguments)
                self.assertEqual((result.code, result.out), (FAILED, ""))
                self.assert_words(result, words)
                self.assertEqual(self.files(), ["scene.orn", "take.htr"])
                self.assertEqual(self.read("take.htr"), HTR.encode())


if __name__ == "__main__":
    main()
