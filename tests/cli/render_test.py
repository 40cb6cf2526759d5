"""Pictures of motions, drawn without a display: what is in them, and what is no picture."""
import json
import shutil

from harness import DONE, FAILED, PROGRAM, USAGE, WALK, CliTest, main, posix_only
from made import BVH, Container
from picture import Picture, chunks, differing

LEFT, RIGHT = (0, 0, 0.5, 1), (0.5, 0, 1, 1)
SIZE = ("--size", "160x120")


@posix_only("the module that draws is not built")
class Pictures(CliTest):
    def render(self, *arguments):
        """Draws out.png. A machine without a GL of its own has nothing to test."""
        result = self.with_assets("render", *arguments, "-o", "out.png", "--json", "--force")
        if result.code == FAILED and "without a display" in result.err:
            self.skipTest(result.err)
        self.assertEqual(result.code, DONE, result.err)
        self.facts = json.loads(result.out)
        return Picture(self.read("out.png"))

    def test_a_picture_has_the_size_that_was_asked_for_and_a_figure_in_its_middle(self):
        for size, arguments in (((640, 480), ()), ((201, 99), ("--size", "201x99"))):
            picture = self.render(WALK, *arguments)
            self.assertEqual((picture.width, picture.height), size)
            self.assertEqual((self.facts["width"], self.facts["height"]), size)
            self.assertGreater(picture.colored(0.3, 0.2, 0.7, 1), 50)
            self.assertEqual(picture.colored(0, 0.2, 0.2, 1), 0)

    def test_frames_look_different_and_those_behind_the_end_like_the_end(self):
        rows = [(frame, self.render(WALK, *SIZE, "--frame=%d" % frame).rows, self.facts["frame"])
                for frame in (0, 20, 66, 67, 10**15)]
        pixels = [row[1] for row in rows]
        self.assertEqual([row[2] for row in rows], [0, 20, 66, 66, 66])
        self.assertEqual(pixels[2], pixels[3])
        self.assertEqual(pixels[2], pixels[4])
        self.assertTrue(pixels[0] != pixels[1] != pixels[2])

    def test_a_result_stands_beside_its_source_whatever_file_it_lies_in(self):
        alone = self.render(WALK, *SIZE)
        self.assertEqual(max(alone.colored(0, 0.3, 0.3, 1), alone.colored(0.7, 0.3, 1, 1)), 0)
        halves = []
        for name in ("walk.htr", "walk.Kinetra"):
            self.succeed("convert", WALK, "-o", name)
            both = self.render(WALK, *SIZE, "--with", name)
            self.assertGreater(min(both.colored(*LEFT), both.colored(*RIGHT)), 30)
            halves.append([row[240:] for row in both.rows])
        self.assertEqual(halves[0], halves[1])
        result = self.render("walk.Kinetra", "--size", "80x120")
        self.assertEqual(result.rows, halves[0])

    def test_a_strip_shows_the_way_from_the_frame_to_the_end(self):
        strip = self.render(WALK, "--size", "400x90", "--strip", 4, "--frame", 6)
        self.assertEqual((self.facts["poses"], self.facts["frame"]), (4, 6))
        poses = [[row[300 * i:300 * (i + 1)] for row in strip.rows] for i in range(4)]
        for i in range(4):
            self.assertGreater(strip.colored(i / 4, 0, (i + 1) / 4, 1), 30)
        self.assertEqual(len({str(pose) for pose in poses}), 4)
        two = self.render(WALK, "--size", "400x180", "--strip", 4, "--frame", 6, "--with", WALK)
        for half in (two.rows[:90], two.rows[90:]):
            self.assertLess(differing(half, strip.rows), 0.002)

    def test_a_picture_has_views_a_background_axes_and_labels(self):
        pictures = [self.render(WALK, *SIZE, *options).rows for options in
                    ((), ("--view", "side"), ("--view", "three-quarter"), ("--view", "top"), ("--axes",),
                     ("--background", "dark"), ("--frame", 3))]
        self.assertEqual(len({str(rows) for rows in pictures}), len(pictures))
        self.assertEqual([tuple(pictures[i][0][-3:]) for i in (0, 5)], [(0xfb, 0xfb, 0xf9), (0x15, 0x18, 0x1a)])
        self.assertEqual(self.render(WALK, *SIZE, "--upright").rows, pictures[0], "Y is up already")

    def test_an_animation_has_a_picture_for_each_moment(self):
        still = self.render(WALK, *SIZE, "--frame", 60)
        shown = self.with_assets("render", WALK, "--animate", "moves.png", *SIZE, "--frame", 60, "--json")
        self.assertEqual((shown.code, json.loads(shown.out)["pictures"]), (DONE, 7), shown.err)
        content = self.read("moves.png")
        self.assertEqual(Picture(content).width, still.width)
        found = chunks(content)
        self.assertEqual([name for name, _ in found].count("fcTL"), 7)
        numbers = [body[:4] for name, body in found if name in ("fcTL", "fdAT")]
        self.assertEqual(numbers, [number.to_bytes(4, "big") for number in range(len(numbers))])
        self.succeed("convert", WALK, "-o", "walk.Kinetra")
        for options, pictures in (([], 67), (["--rate", "30"], 268)):
            result = self.succeed("render", "walk.Kinetra", "--animate", "moves.png", *SIZE, "--json", "--force", *options)
            self.assertEqual(json.loads(result.out)["pictures"], pictures, "a result lasts as long as its source")


class Refusals(CliTest):
    def test_what_is_no_picture_is_refused_before_anything_is_written(self):
        self.write("take.bvh", BVH)
        self.write("still.orn", Container().node(1, "hip", root=True).bytes)
        self.write("old.png", "old")
        rows = [  # what, exit code, arguments, words
            ("a size without a cross", USAGE, ["take.bvh", "--size", "640"], ['"640"', "640x480"]),
            ("a side of nothing", USAGE, ["take.bvh", "--size", "0x48"], ["0x48", "8192"]),
            ("no pose", USAGE, ["take.bvh", "--strip", "0"], ["--strip 0"]),
            ("more poses than pixels", USAGE, ["take.bvh", "--size", "9x9", "--strip", "10"], ["10 poses", "9x9"]),
            ("another kind of picture", USAGE, ["take.bvh", "-o", "out.jpg"], ["out.jpg", ".png"]),
            ("a picture and an animation", USAGE, ["take.bvh", "-o", "a.png", "--animate", "b.png"], ["--animate"]),
            ("a strip that moves", USAGE, ["take.bvh", "--animate", "b.png", "--strip", "3"], ["--strip"]),
            ("no such view", USAGE, ["take.bvh", "--view", "back"], ["back", "three-quarter"]),
            ("contrary wishes", USAGE, ["take.bvh", "--force", "--skip-existing"], ["cannot be combined"]),
            ("a picture that is there", FAILED, ["take.bvh", "-o", "old.png"], ["old.png", "--force"]),
            ("no such motion", FAILED, ["none.bvh"], ["none.bvh"]),
            ("a scene in which nothing moves", FAILED, ["still.orn"], ["still.orn", "no keyframes"]),
            ("a folder that there is not", FAILED, ["take.bvh", "-o", "none/out.png"], ["none/out.png"]),
        ]
        before = self.files()
        for what, code, arguments, words in rows:
            with self.subTest(what):
                output = [] if {"-o", "--animate"} & {*arguments} else ["-o", "out.png"]
                result = self.run_program("render", *arguments, *output)
                self.assertEqual((result.code, result.out), (code, ""), result.err)
                if "without a display" not in result.err:
                    self.assert_words(result, words)
                self.assertEqual(self.files(), before)
        self.assertEqual(self.read("old.png"), b"old")

    def test_a_program_without_the_module_that_draws_says_so_and_does_all_else(self):
        alone = shutil.copy(PROGRAM, self.folder / "alone")
        for arguments, code, words in ((["render", WALK, "-o", "out.png"], FAILED, ["gw_picture_painter"]),
                                       (["info", WALK], DONE, [])):
            result = self.run_program(*arguments, program=alone)
            self.assertEqual(result.code, code, result.err)
            self.assert_words(result, words)
        self.assertEqual(self.files(), ["alone"])

    def test_a_picture_that_is_there_is_passed_over_when_asked(self):
        self.write("out.png", "old")
        result = self.run_program("render", "none.bvh", "-o", "out.png", "--skip-existing", "--json")
        self.assertEqual((result.code, json.loads(result.out)["outcome"]), (DONE, "skipped"), result.err)
        self.assertEqual(self.read("out.png"), b"old")


if __name__ == "__main__":
    main()
