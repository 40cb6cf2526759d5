"""A motion told from another rest pose, through the program."""
import json
import math

from harness import DONE, FAILED, USAGE, WALK, CliTest, main


def hanging(text):
    """A walk on a skeleton whose arms hang before the body at rest, in no plane with an axis."""
    lines, joint = [], None
    for line in text.splitlines():
        words = line.split()
        if words[:1] == ["JOINT"]:
            joint = words[1]
        if words[:1] == ["OFFSET"] and joint and joint[1:] in ("ForeArm", "Hand"):
            x = float(words[1])
            line = f"OFFSET 0 {-0.8 * abs(x)} {0.6 * abs(x)}"
        lines.append(line)
    return "\n".join(lines) + "\n"


class Align(CliTest):
    def places(self, name, frame):
        nodes = json.loads(self.succeed("pose", name, "--frame", frame).out)["nodes"]
        return {node["name"]: node["world"][12:15] for node in nodes}

    def assert_same_places(self, first, second, frames):
        for frame in frames:
            a, b = self.places(first, frame), self.places(second, frame)
            self.assertEqual(a.keys(), b.keys())
            for joint, place in a.items():
                self.assertLess(math.dist(place, b[joint]), 0.001, f"{joint} at frame {frame}")

    def test_an_aligned_motion_has_all_frames_and_all_joints_where_they_were(self):
        self.write("walk.bvh", WALK.read_bytes())
        result = self.succeed("align", "walk.bvh", "-o", "a.bvh")
        self.assertIn("walk.bvh -> a.bvh", result.out)
        before, after = (json.loads(self.succeed("info", name, "--json").out) for name in ("walk.bvh", "a.bvh"))
        self.assertEqual(before["frames"], after["frames"])
        self.assert_same_places("walk.bvh", "a.bvh", (0, 1, before["frames"] // 2, before["frames"] - 1))

    def test_arms_point_as_their_sources_do_whatever_the_rest_pose(self):
        self.write("down.bvh", hanging(WALK.read_text()))
        errors = {}
        for name, options in (("plain", []), ("aligned", ["--align"])):
            self.succeed("convert", "down.bvh", "-o", f"{name}.htr", "--profile", "Poser BVH", *options)
            measures = json.loads(self.succeed("compare", "down.bvh", f"{name}.htr", "--profile", "Poser BVH",
                                               "--json").out)
            errors[name] = {bone["target"]: bone["meanError"] for bone in measures["bones"]}
        for bone in ("LUpperArm", "RUpperArm", "LForearm", "RForearm", "Neck", "UpperTorso"):
            self.assertLess(errors["aligned"][bone], 0.1, bone)
        self.assertGreater(errors["plain"]["LUpperArm"], 20)

    def test_what_cannot_be_aligned_is_said(self):
        self.write("walk.bvh", WALK.read_bytes())
        self.write("old.bvh", "old")
        self.write("cut.bvh", WALK.read_bytes()[:900])
        self.write("strange.bvh", WALK.read_text().replace("hip", "alpha").replace("neck", "beta"))
        rows = [  # what, arguments, exit code, words
            ("an output that exists", ("walk.bvh", "-o", "old.bvh"), FAILED, ["--force"]),
            ("no .bvh", ("walk.bvh", "-o", "a.htr"), USAGE, [".bvh"]),
            ("a damaged source", ("cut.bvh", "-o", "a.bvh"), FAILED, ["cut.bvh"]),
            ("a body that nothing names", ("strange.bvh", "-o", "a.bvh", "--profile", "Poser BVH"), FAILED,
             ["strange.bvh", '"hip"']),
        ]
        before = self.files()
        for what, arguments, code, words in rows:
            with self.subTest(what):
                result = self.with_assets("align", *arguments)
                self.assertEqual(result.code, code, result.err)
                self.assert_words(result, words)
                self.assertEqual(self.files(), before)
        self.assertEqual(self.read("old.bvh"), b"old")
        self.assertEqual(self.with_assets("align", "walk.bvh", "-o", "old.bvh", "--force").code, DONE)


if __name__ == "__main__":
    main()
