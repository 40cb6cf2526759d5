"""What is wrong with a file, line by line, and the copy that is mended."""
import json

from harness import DONE, FAILED, USAGE, WALK, CliTest, main
from made import BVH, HTR, bvh, one_bone_scene

ILL = bvh("JOINT Chest", "JOINT My Chest").replace("MOTION\n", "MOTION\n\n")
SHORT = bvh("1 90 0 0 0 0 90 0 0", "1 90 0 0 0 0 90")


class Doctor(CliTest):
    def test_faults_are_lines_with_place_code_and_remedy(self):
        self.write("ill.bvh", ILL)
        result = self.run_program("doctor", "ill.bvh")
        self.assertEqual((result.code, result.err), (FAILED, ""))
        lines = result.out.splitlines()
        self.assertEqual([line.split(": ")[:2] for line in lines],
                         [["ill.bvh:6", "blank-in-name"], ["ill.bvh:17", "empty-line-before-frames"]])
        for line in lines:
            self.assertRegex(line, r"\(.+\)$")

    def test_a_healthy_file_is_told_in_one_line(self):
        result = self.run_program("doctor", WALK)
        self.assertEqual(result.code, DONE)
        self.assertRegex(result.out, r"^[^\n]*walk\.bvh: \d+ joints, \d+ frames at [\d.]+ per second, legs of .*\n$")
        self.assertEqual(self.run_program("doctor", WALK, "--quiet").out, "")

    def test_one_ill_file_of_several_counts(self):
        self.write("a.bvh", BVH)
        self.write("b.bvh", SHORT)
        self.assertEqual(self.run_program("doctor", "a.bvh", "b.bvh", "a.bvh").code, FAILED)
        self.assertEqual(self.run_program("doctor", "a.bvh", "a.bvh").code, DONE)

    def test_json_is_one_object_a_file(self):
        self.write("ill.bvh", ILL)
        self.write("a.bvh", BVH)
        result = self.run_program("doctor", "ill.bvh", "a.bvh", "--json")
        files = [json.loads(line) for line in result.out.splitlines()][:-1]
        self.assertEqual([f["healthy"] for f in files], [False, True])
        self.assertIsNone(files[0]["facts"])
        self.assertEqual(files[1]["facts"]["frames"], 3)
        found = [(f["line"], f["code"], f["severity"], f["fixable"], f["fixed"]) for f in files[0]["findings"]]
        self.assertEqual(found, [(6, "blank-in-name", "warning", True, False),
                                 (17, "empty-line-before-frames", "error", True, False)])
        self.assertTrue(all(f["words"] and f["remedy"] for f in files[0]["findings"]))

    def test_a_mended_copy_is_healthy_and_converts(self):
        text = WALK.read_text().replace("MOTION\n", "motion\n\n")
        self.write("ill.bvh", text)
        result = self.run_program("doctor", "ill.bvh", "--fix", "well.bvh", "--json")
        self.assertEqual(result.code, DONE, result.err)
        told = json.loads(result.out)
        self.assertEqual((told["output"], told["left"]), ("well.bvh", []))
        self.assertTrue(all(f["fixed"] for f in told["findings"]))
        self.assertEqual(self.read("well.bvh"), WALK.read_bytes())
        self.assertEqual(self.read("ill.bvh"), text.encode())
        self.assertEqual(self.run_program("doctor", "well.bvh").code, DONE)
        self.succeed("convert", "well.bvh", "-o", "well.htr")

    def test_what_is_not_mended_is_told(self):
        self.write("ill.bvh", SHORT.replace("JOINT Chest", "JOINT My Chest"))
        result = self.run_program("doctor", "ill.bvh", "--fix", "better.bvh")
        self.assertEqual(result.code, FAILED)
        self.assertIn("ill.bvh -> better.bvh: repaired, but these faults are left\nbetter.bvh:20: short-row", result.out)

    def test_fix_refuses_what_it_must(self):
        self.write("ill.bvh", ILL)
        self.write("old.bvh", "old")
        self.write("short.bvh", SHORT)
        (self.folder / "link.bvh").symlink_to("ill.bvh")
        rows = [  # what, arguments, code, word
            ("two files", ["ill.bvh", "old.bvh", "--fix", "out.bvh"], USAGE, "one file"),
            ("another format", [WALK, "--fix", "out.htr"], USAGE, ".bvh"),
            ("in place", ["ill.bvh", "--fix", "ill.bvh", "--force"], USAGE, "in place"),
            ("in place by a link", ["ill.bvh", "--fix", "link.bvh", "--force"], USAGE, "in place"),
            ("over a file", ["ill.bvh", "--fix", "old.bvh"], FAILED, "--force"),
            ("nothing to mend", ["short.bvh", "--fix", "out.bvh"], FAILED, "none of these faults can be repaired"),
            ("no such folder", ["ill.bvh", "--fix", "none/out.bvh"], FAILED, "cannot be written"),
            ("no such file", ["none.bvh", "--fix", "out.bvh"], FAILED, "repaired"),
        ]
        before = self.read("ill.bvh")
        for what, arguments, code, word in rows:
            with self.subTest(what):
                result = self.run_program("doctor", *arguments)
                self.assertEqual(result.code, code)
                self.assert_words(result, [word])
                self.assertEqual((self.read("ill.bvh"), self.read("old.bvh")), (before, b"old"))
                self.assertFalse((self.folder / "out.bvh").exists())
        self.assertEqual(self.run_program("doctor", "ill.bvh", "--fix", "old.bvh", "--force").code, DONE)

    def test_other_formats_say_what_their_reader_says(self):
        pointer = "version https://git-lfs.example/spec/v1\noid sha256:0\nsize 1\n"
        scene = one_bone_scene()
        rows = [  # name, content, code, beginning of the line
            ("a.htr", HTR, DONE, "a.htr: 2 joints"),
            ("b.htr", HTR.replace("2 0 0 0 30", "2 nan 0 0 30"), FAILED, "b.htr:29: bad-number: "),
            ("e.orn", scene, DONE, "e.orn: intact; "),
            ("f.orn", scene[:-20], FAILED, "f.orn: byte "),
            ("g.orn", pointer, FAILED, "g.orn: byte 1: lfs-pointer: "),
            ("h.htr", pointer, FAILED, "h.htr:1: lfs-pointer: "),
            ("i.txt", "words", FAILED, "i.txt: unknown-format: "),
            ("none.bvh", None, FAILED, "none.bvh: not-found: "),
        ]
        for name, content, code, line in rows:
            with self.subTest(name):
                if content is not None:
                    self.write(name, content)
                result = self.run_program("doctor", name)
                self.assertEqual(result.code, code, result.out + result.err)
                self.assertTrue(result.out.startswith(line), result.out)

if __name__ == "__main__":
    main()
