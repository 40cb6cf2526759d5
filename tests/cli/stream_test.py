"""Standard input and output, pipes and devices as sources and results."""
import os
import signal
import subprocess
import threading

from harness import WINDOWS, ASSETS, FAILED, PROGRAM, USAGE, WALK, CliTest, main, posix_only


class Streams(CliTest):
    def setUp(self):
        super().setUp()
        self.write("walk.bvh", WALK.read_bytes())
        for name in ("walk.htr", "walk.Kinetra"):
            self.succeed("convert", "walk.bvh", "-o", name)

    def test_a_stream_gives_the_bytes_of_a_file(self):
        self.succeed("align", "walk.bvh", "-o", "aligned.bvh")
        self.succeed("transcode", "walk.htr", "walk-2.bvh")
        self.succeed("dump", "walk.Kinetra", "-o", "dump.html")
        rows = [  # arguments, source, the file with the same bytes as standard output
            ("convert -", "walk.bvh", "walk.Kinetra"),
            ("convert - -o - --format htr", "walk.bvh", "walk.htr"),
            ("convert %s -o - --format htr" % ("-" if WINDOWS else "/dev/stdin"), "walk.bvh", "walk.htr"),
            ("extract - -o -", "walk.Kinetra", "walk.htr"),
            ("align - -o -", "walk.bvh", "aligned.bvh"),
            ("transcode - - --format bvh", "walk.htr", "walk-2.bvh"),
            ("doctor - --fix -", "walk.bvh", "walk.bvh"),
            ("dump - -o -", "walk.Kinetra", "dump.html"),
        ]
        known = self.files()
        for line, source, expected in rows:
            with self.subTest(line):
                result = self.succeed(*line.split(), given=self.read(source))
                self.assertEqual(result.bytes, self.read(expected))
                self.assertEqual(self.files(), known)
        for command in ("info", "doctor"):
            named, piped = (self.with_assets(command, name, given=self.read("walk.bvh")).out
                            for name in ("walk.bvh", "-"))
            self.assertEqual(named.replace("walk.bvh", "-"), piped)

    @posix_only("named pipes and devices of other systems")
    def test_pipes_and_devices_are_written_and_stay(self):
        for name in ("in", "out.htr"):
            os.mkfifo(self.folder / name)
        writer = threading.Thread(target=lambda: (self.folder / "in").write_bytes(WALK.read_bytes()))
        taken = []
        reader = threading.Thread(target=lambda: taken.append((self.folder / "out.htr").read_bytes()))
        for thread in (writer, reader):
            thread.start()
        self.succeed("convert", "in", "-o", "out.htr")
        for thread in (writer, reader):
            thread.join()
        self.assertEqual(taken, [self.read("walk.htr")])
        known = self.files()
        self.succeed("convert", "walk.bvh", "-o", "/dev/null")
        full = self.with_assets("convert", "walk.bvh", "-o", "/dev/full")
        self.assertEqual(full.code, FAILED)
        self.assert_words(full, ["/dev/full", "No space left on device"])
        self.assertEqual(self.files(), known)

    def test_a_result_in_a_folder_has_the_name_of_its_source(self):
        for line, name in (("convert walk.bvh -o {}", "walk.Kinetra"), ("convert walk.bvh -o {}/ --format bvh", "walk.bvh"),
                           ("extract walk.Kinetra -o {}", "walk.htr"), ("suggest walk.bvh -o {}", "walk.prf"),
                           ("align - -o {}", "stdin.bvh"), ("dump walk.Kinetra -o {}", "walk.html"),
                           ("transcode walk.htr {} --format glb", "walk.glb"), ("doctor walk.bvh --fix {}", "walk.bvh"),
                           ("package walk.htr {} --rate 30", "walk.Kinetra"), ("resave walk.Kinetra {}", "walk.Kinetra")):
            folder = self.folder / line.split()[0] / name
            folder.mkdir(parents=True)
            self.succeed(*line.format(folder).split(), given=WALK.read_bytes())
            self.assertEqual([path.name for path in folder.iterdir()], [name])

    def test_what_no_stream_can_be_is_refused(self):
        for line, code in (("convert -", FAILED), ("info /dev/zero", FAILED),
                           ("plan walk.bvh --shards 1 -o -", FAILED), ("convert - walk.bvh --out-dir d", USAGE),
                           ("dump walk.Kinetra --out-dir -", USAGE)):
            with self.subTest(line):
                self.assertEqual(self.with_assets(*line.split()).code, code)
                self.assertFalse([name for name in self.files() if name.split("/")[-1].startswith("-")])

    @posix_only("Windows sends no signal when a pipe is closed")
    def test_a_reader_that_leaves_ends_the_program_and_leaves_no_file(self):
        self.environment["TMPDIR"] = str(self.folder)
        known = self.files()
        with subprocess.Popen([PROGRAM, "convert", "walk.bvh", "-o", "-", "--data-dir", ASSETS], cwd=self.folder,
                              env=self.environment, stdout=subprocess.PIPE, stderr=subprocess.DEVNULL) as run:
            run.stdout.close()
            self.assertEqual(run.wait(), -signal.SIGPIPE)
        self.assertEqual(self.files(), known)


if __name__ == "__main__":
    main()
