"""What the program answers to a command line that is wrong, and to a question for help."""
import shlex

from harness import DONE, FAILED, USAGE, CliTest, main

COMMANDS = ("convert", "batch", "plan", "run", "merge-report", "info", "pose", "transcode", "resave", "extract",
            "package", "profiles", "compare", "render", "dump", "suggest")

WRONG = [  # what, arguments, words on standard error
    ("no command", "", ["missing command", "--help"]),
    ("a slip in a command", "convret a.bvh", ["convret", "'convert'"]),
    ("a word that is near nothing", "frobnicate", ["unknown command", "--help"]),
    ("a slip in an option", "convert a.bvh --forse", ["--forse", "'--force'"]),
    ("an option of another command", "info a.bvh --force", ["info has no option", "--force"]),
    ("a slip is told before what is missing", "pose a.bvh --fram 3", ["--fram", "'--frame'"]),
    ("no operand", "info", ["info needs FILE", "usage: gaitwright info FILE"]),
    ("one operand of two", "resave a.orn", ["needs IN OUT"]),
    ("an operand too many", "info a.bvh b.bvh", ["b.bvh"]),
    ("a required option is missing", "extract a.Kinetra", ["-o"]),
    ("none of two options of which one must be there", "pose a.bvh", ["--frame N | --all | --time T"]),
    ("a time without end", "pose a.bvh --time inf", ["inf"]),
    ("an option without its value", "pose a.bvh --frame", ["--frame"]),
    ("an option twice", "pose a.bvh --frame 1 --frame 2", ["--frame"]),
    ("a frame that is not an integer", "pose a.bvh --frame 1.5", ["1.5"]),
    ("a rate without a frame time", "convert a.bvh --rate 1e-40", ["--rate"]),
    ("a frame before the first", "pose a.bvh --frame -1", ['--frame: "-1"']),
    ("a count below nothing", "convert a.bvh --jobs -1", ['--jobs: "-1" is not a count']),
    ("a range that ends before it begins", "convert a.bvh --frames 5-2", ["--frames", '"5-2"']),
    ("a format and another name", "convert a.bvh -o a.htr --format bvh", ["--format bvh", "a.htr"]),
    ("a frame that no integer holds", "pose a.bvh --frame 99999999999999999999", ["--frame"]),
    ("a rate of nothing", "package a.htr b.Kinetra --rate 0", ['"0"', "not a positive number"]),
    ("a rate that is not a number", "package a.htr b.Kinetra --rate nan", ["nan"]),
    ("a job that there is not", "batch . --job fbx", ["fbx", "htr|orn"]),
    ("contrary wishes", "convert a.bvh --force --skip-existing", ["cannot be combined"]),
    ("a result of another kind", "convert a.bvh -o a.fbx", ["a.fbx", ".Kinetra", ".htr"]),
    ("several sources without a folder", "convert a.bvh b.bvh", ["--out-dir"]),
    ("two sources of one stem", "convert x/a.bvh y/a.bvh --out-dir d", ["y/a.bvh", "a.Kinetra"]),
    ("an .htr of what is none", "transcode a.bvh a.htr", ["a.htr", ".bvh"]),
    ("frames of a .bvh scaled", "transcode a.htr a.bvh --frame-scale 2", ["--frame-scale"]),
]


class Usage(CliTest):
    def test_a_wrong_command_line_is_answered_with_the_right_word(self):
        for what, line, words in WRONG:
            with self.subTest(what):
                result = self.run_program(*shlex.split(line))
                self.assertEqual((result.code, result.out), (USAGE, ""), result.err)
                self.assert_words(result, words)
                self.assertEqual(self.files(), [])

    def test_control_characters_of_an_argument_do_not_reach_the_terminal(self):
        result = self.run_program("\x1b[2Jconvert")
        self.assertNotIn("\x1b", result.err)

    def test_every_command_is_in_the_help_and_has_its_own_with_an_example(self):
        listed = self.run_program("--help").out
        for command in COMMANDS:
            with self.subTest(command):
                result = self.run_program("help", command)
                self.assertEqual(self.run_program(command, "--help").out, result.out)
                self.assertEqual((result.code, result.err), (DONE, ""))
                self.assertIn("\n  " + command + " ", listed)
                self.assertIn("Usage: gaitwright " + command, result.out)
                self.assertIn("Example:\n  gaitwright " + command, result.out)

    def test_every_example_is_a_right_command_line(self):
        for command in COMMANDS:
            with self.subTest(command):
                example = self.run_program(command, "--help").out.split("Example:\n  gaitwright ")[1]
                result = self.run_program(*shlex.split(example))
                self.assertEqual(result.code, FAILED, result.err)  # its files are not there

    def test_a_minus_alone_ends_the_options(self):
        result = self.run_program("info", "--", "--json")
        self.assertEqual(result.code, FAILED)
        self.assert_words(result, ["--json: the file cannot be opened"])


if __name__ == "__main__":
    main()
