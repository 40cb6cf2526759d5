"""What a result is written as: formats, cuts and mirror images, and all its poses as arrays."""
import array
import csv
import io
import json

from harness import WALK, CliTest, main


class Formats(CliTest):
    def setUp(self):
        super().setUp()
        self.write("walk.bvh", WALK.read_bytes())

    def positions(self, *options):
        """The positions of a result by frame and bone."""
        self.succeed("convert", "walk.bvh", "-o", "a.bvh", "--align", "--faithful", "--force", *options)
        rows = list(csv.DictReader(io.StringIO(self.succeed("pose", "a.bvh", "--all", "-o", "-").out)))
        frames = {}
        for row in rows:
            frames.setdefault(int(row["frame"]), {})[row["bone"]] = [float(row[axis]) for axis in "xyz"]
        return [frames[i] for i in range(len(frames))]

    def assert_near(self, frames, expected):
        self.assertEqual(len(frames), len(expected))
        for ours, theirs in zip(frames, expected):
            for bone, position in theirs.items():
                for a, b in zip(ours[bone], position):
                    self.assertAlmostEqual(a, b, delta=0.01, msg=bone)

    def test_cuts_and_mirror_images(self):
        whole = self.positions()
        info = json.loads(self.succeed("info", "a.bvh", "--json").out)
        source = json.loads(self.succeed("info", "walk.bvh", "--json").out)
        self.assertEqual((info["frames"], info["rate"]), (source["frames"], source["rate"]))
        self.assert_near(self.positions("--frames", "10-20"), whole[10:21])
        for frame, before in zip(self.positions("--in-place"), whole):
            x, _, z = whole[0]["LowerTorso"]
            self.assertEqual(frame["LowerTorso"], [x, before["LowerTorso"][1], z])
            self.assertAlmostEqual(frame["Head"][1], before["Head"][1], delta=0.01)
        sides = {"L": "R", "R": "L"}
        other = {bone: bone if bone == "LowerTorso" else sides.get(bone[0], bone[0]) + bone[1:] for bone in whole[0]}
        self.assert_near(self.positions("--mirror"), [
            {bone: [-frame[other[bone]][0], *frame[other[bone]][1:]] for bone in frame} for frame in whole])

    def test_a_package_is_the_motion_inside(self):
        self.succeed("convert", "walk.bvh", "-o", "a.Kinetra")
        self.succeed("extract", "a.Kinetra", "-o", "a.htr")
        for line in ("pose %s --frame 7", "transcode %s - --format bvh", "profiles %s"):
            first, second = (self.succeed(*(line % name).split()) for name in ("a.Kinetra", "a.htr"))
            self.assertEqual(first.out, second.out)
        told = json.loads(self.succeed("info", "a.Kinetra", "--json").out)
        self.assertEqual((told["format"], len(told["bones"]), told["frames"] > 4), ("Kinetra", 23, True))
        self.succeed("suggest", "a.htr", "-o", "same.prf")
        result = self.succeed("compare", "a.Kinetra", "a.htr", "--profile", "same.prf", "--json")
        self.assertEqual(json.loads(result.out)["largestError"], 0)

    def test_a_rate_replaces_that_of_the_file(self):
        for source, options in (("walk.bvh", []), ("a.bvh", ["--rate", 25])):
            self.succeed("convert", "walk.bvh", "-o", "a.bvh", "--rate", 50, "--force")
            told = json.loads(self.succeed("info", "a.bvh", *options, "--json").out)
            self.assertAlmostEqual(told["rate"], 25 if options else 50, places=4)

    def test_arrays_hold_every_frame_and_bone(self):
        self.succeed("pose", "walk.bvh", "--all", "-o", "p.npy")
        names = self.read("p.names.txt").decode().splitlines()
        pose = json.loads(self.succeed("pose", "walk.bvh", "--frame", 5).out)["nodes"]
        self.assertEqual([node["name"] for node in pose], names)
        for name, width in (("p.npy", 16), ("p.positions.npy", 3)):
            content = self.read(name)
            size = 10 + int.from_bytes(content[8:10], "little")
            header = eval(content[10:size])  # as NumPy reads it
            self.assertEqual((size % 64, header["descr"], header["shape"][1]), (0, "<f4", len(names)))
            numbers = array.array("f", content[size:])
            self.assertEqual(len(numbers), header["shape"][0] * len(names) * width)
            first = 5 * len(names) * width
            if width == 16:
                expected = [number for node in pose for number in node["world"]]
            else:
                expected = [number for node in pose for number in node["world"][12:15]]
            self.assertEqual(list(numbers[first:first + len(expected)]), list(array.array("f", expected)))


if __name__ == "__main__":
    main()
