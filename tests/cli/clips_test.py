"""Files with several clips: listed, chosen by name, and one result for each in a folder."""
import json
import struct

from harness import FAILED, WALK, CliTest, main


def with_second_clip(glb):
    """A copy of a binary glTF file in which half of the motion is a clip of its own."""
    size = struct.unpack("<I", glb[12:16])[0]
    tree, rest = json.loads(glb[20:20 + size]), glb[20 + size:]
    second = json.loads(json.dumps(tree["animations"][0]))
    for sampler in second["samplers"]:
        for key in ("input", "output"):
            half = dict(tree["accessors"][sampler[key]])
            half["count"] = (half["count"] + 1) // 2
            if key == "input":
                half["max"] = [half["max"][0] / 2]
            tree["accessors"].append(half)
            sampler[key] = len(tree["accessors"]) - 1
    second["name"] = "Half"
    tree["animations"].insert(0, second)
    text = json.dumps(tree).encode()
    text += b" " * (-len(text) % 4)
    return (b"glTF" + struct.pack("<III", 2, 20 + len(text) + len(rest), len(text)) + b"JSON" + text + rest)


class Clips(CliTest):
    def test_a_clip_is_listed_chosen_and_converted(self):
        self.succeed("transcode", WALK, "one.glb")
        self.write("takes/two.glb", with_second_clip(self.read("one.glb")))
        for name, clips in (("one.glb", ["Motion"]), ("takes/two.glb", ["Half", "Motion"])):
            self.assertEqual(self.succeed("info", name, "--list-clips").out.splitlines(), clips)
            self.assertEqual(json.loads(self.succeed("info", name, "--json").out)["clips"], clips)
        for option, frames in (([], 67), (["--clip", "Half"], 34), (["--clip", "Motion"], 67)):
            self.assertEqual(json.loads(self.succeed("info", "takes/two.glb", "--json", *option).out)["frames"], frames)
            self.succeed("convert", "takes/two.glb", *option, "-o", "%d.Kinetra" % frames, "--force")
        self.succeed("convert", "takes", "--out-dir", "results")
        for name, frames in (("Half", 34), ("Motion", 67)):
            self.assertEqual(self.read("results/two-%s.Kinetra" % name), self.read("%d.Kinetra" % frames))
        for command in (["info"], ["convert", "-o", "x.Kinetra"], ["pose", "--frame", "1"], ["render", "-o", "x.png"]):
            refused = self.with_assets(*command, "takes/two.glb", "--clip", "None")
            self.assertEqual(refused.code, FAILED)
            self.assert_words(refused, ['"None"', "--list-clips"])


if __name__ == "__main__":
    main()
