"""The Python module, compared with what the shell program prints and writes."""
import ast
import gc
import inspect
import json
import pickle
import sys
import threading
import unittest
from pathlib import Path

import gaitwright
import harness
import numpy

WALK = str(harness.WALK)


def failure_of(function, *arguments, **keywords):
    try:
        function(*arguments, **keywords)
    except gaitwright.Error as error:
        return error
    raise AssertionError("no error")


class ModuleTest(harness.CliTest):
    @classmethod
    def setUpClass(cls):
        cls.walk = gaitwright.load(WALK)

    def test_writes_what_the_shell_writes(self):
        for flags, options in (("", {}), ("--align --faithful", {"align": True, "faithful": True}),
                               ("--faithful --no-hands --no-legs", {"faithful": True, "hands": False, "legs": False}),
                               ("--frames 10-20 --mirror --in-place --draft",
                                {"frames": (10, 20), "mirror": True, "in_place": True, "draft": True})):
            result = gaitwright.convert(self.walk, map="Poser BVH", data_folder=harness.ASSETS, **options)
            for extension in ("Kinetra", "htr", "bvh", "glb"):
                with self.subTest(flags, extension=extension):
                    name = "shell." + extension
                    self.succeed("convert", WALK, "-o", name, "--force", "--profile", "Poser BVH", *flags.split())
                    result.save(self.folder / ("own." + extension))
                    self.assertEqual(self.read("own." + extension), self.read(name))
                    self.assertEqual(result.bytes(extension), self.read(name))

    def test_checks_as_the_shell_does(self):
        told = json.loads(self.succeed("convert", WALK, "-o", "a.htr", "--faithful", "--check", "--json").out)["check"]
        check = gaitwright.convert(self.walk, faithful=True, in_place=True).check()
        told.pop("kneePopFrames")
        self.assertEqual(set(check) - set(told), {"keyFigures"})
        self.assert_close({name: check[name] for name in told}, told)

    def assert_close(self, ours, told):
        if isinstance(told, dict):
            self.assertEqual(set(ours) - {"kneePopFrames"}, set(told))
            for name in told:
                self.assert_close(ours[name], told[name])
        elif isinstance(told, list):
            self.assertEqual(len(ours), len(told))
            for own, other in zip(ours, told):
                self.assert_close(own, other)
        elif isinstance(told, (int, float)):
            numpy.testing.assert_allclose(ours, told, rtol=1e-6)
        else:
            self.assertEqual(ours, told)

    def test_arrays_are_the_motions_own_memory(self):
        self.succeed("pose", WALK, "--all", "-o", self.folder / "poses.npy")
        motion = gaitwright.load(self.read_walk(), "bvh")
        poses, positions, rest = motion.poses(), motion.positions(), motion.rest_pose()
        numpy.testing.assert_array_equal(poses, numpy.load(self.folder / "poses.npy"))
        numpy.testing.assert_array_equal(positions, poses[:, :, 3, :3])
        frames, bones = motion.frame_count, motion.bone_count
        self.assertEqual((poses.shape, rest.shape, motion.parents.shape), ((frames, bones, 4, 4), (bones, 4, 4), (bones,)))
        self.assertEqual(sorted(zip(motion.parents, motion.bone_names))[0], (-1, "hip"))
        self.assertTrue(numpy.shares_memory(poses, motion.poses()))
        for array in (poses, positions, rest, motion.parents):
            self.assertIs(array.base, motion)
            with self.assertRaises(ValueError):
                array[0] = 0
            with self.assertRaises(ValueError):
                array.flags.writeable = True
        kept = positions.copy()
        del motion, poses, rest, array
        gc.collect()
        gaitwright.load(WALK).positions()  # would reuse freed memory
        numpy.testing.assert_array_equal(positions, kept)

    @staticmethod
    def read_walk():
        return Path(WALK).read_bytes()

    def test_failures_are_errors_with_the_records_fields(self):
        text = self.read_walk()
        broken = text[:text.index(b"CHANNELS")] + b"CHANNELS six\n"
        self.write("broken.bvh", broken)
        self.write("there.glb", "kept")
        line = broken.count(b"\n")
        done = gaitwright.convert(self.walk)
        for reason, line, error in (
                ("not-found", 0, failure_of(gaitwright.load, self.folder / "none.bvh")),
                ("bad-number", line, failure_of(gaitwright.load, self.folder / "broken.bvh")),
                ("bad-number", line, failure_of(gaitwright.load, bytearray(broken), ".BVH")),
                ("bad-number", 0, failure_of(gaitwright.load, WALK, rate=float("nan"))),
                ("not-installed", 0, failure_of(gaitwright.load_map, "Nobody")),
                ("no-such-frame", 0, failure_of(gaitwright.convert, self.walk, frames=(500, None))),
                ("unknown-format", 0, failure_of(done.bytes, "fbx")),
                ("exists", 0, failure_of(done.save, self.folder / "there.glb", overwrite=False))):
            with self.subTest(error):
                self.assertEqual((error.reason, error.line), (reason, line))
                self.assertIn(error.words, str(error))
                self.assertEqual(pickle.loads(pickle.dumps(error)).__dict__, error.__dict__)
        self.assertEqual(self.read("there.glb"), b"kept")

    def test_wrong_arguments_are_python_errors(self):
        for kind, function, arguments, keywords in (
                (TypeError, gaitwright.load, (3,), {}), (TypeError, gaitwright.load, (b"HIERARCHY",), {}),
                (TypeError, gaitwright.load, (WALK, "bvh"), {}), (TypeError, gaitwright.load, (None,), {}),
                (ValueError, gaitwright.load, ("a\0b.bvh",), {}), (TypeError, gaitwright.load, (WALK,), {"rate": "fast"}),
                (BufferError, gaitwright.load, (memoryview(b"abcd")[::2], "bvh"), {}),
                (TypeError, gaitwright.convert, (WALK,), {}), (TypeError, gaitwright.convert, (self.walk, True), {}),
                (TypeError, gaitwright.convert, (self.walk,), {"aligned": True}),
                (TypeError, gaitwright.convert, (self.walk,), {"map": 3}),
                (TypeError, gaitwright.convert, (self.walk,), {"frames": 10}),
                (TypeError, gaitwright.convert, (self.walk,), {"frames": ("a", "b")}),
                (ValueError, gaitwright.convert, (self.walk,), {"frames": (20, 10)}),
                (OverflowError, gaitwright.convert, (self.walk,), {"frames": (0, 1 << 70)}),
                (TypeError, gaitwright.parse_map, (3,), {}), (TypeError, gaitwright.Motion, (), {})):
            with self.subTest(arguments=arguments, keywords=keywords), self.assertRaises(kind):
                function(*arguments, **keywords)

    def test_maps_are_drafted_chosen_and_saved(self):
        draft = gaitwright.suggest(self.walk)
        self.assertIn("hip", [row.row.source for row in draft.rows])
        draft.map.save(self.folder / "draft.prf")
        again = gaitwright.load_map(self.folder / "draft.prf")
        self.assertEqual((again.text(), gaitwright.parse_map(again.text()).text()), (draft.map.text(),) * 2)
        self.assertEqual(gaitwright.convert(self.walk, map=again).map.map.text(), again.text())
        best = gaitwright.rank_maps(self.walk)[0]
        self.assertEqual((best.map.name, best.fits), (gaitwright.choose_map(self.walk).map.name, True))
        self.assertIn("sureness=", repr(best))

    def test_examines_and_mends(self):
        self.write("blank.bvh", self.read_walk().replace(b"Frames:", b"\nFrames:"))
        faulty = gaitwright.doctor(self.folder / "blank.bvh")
        self.assertEqual((faulty.healthy, faulty.findings[0].fixable), (False, True))
        self.assertIn("repaired", str(gaitwright.load(self.folder / "blank.bvh", mend=True).warnings[0]))
        mended = gaitwright.mend(self.folder / "blank.bvh", self.folder / "mended.bvh")
        self.assertEqual((mended.healthy, mended.facts.joint_count), (True, self.walk.bone_count))

    def test_names_that_are_not_utf_8_survive(self):
        odd = gaitwright.load(self.read_walk().replace(b"lHand", b"l\xc4Hand"), "bvh")
        self.assertIn(b"l\xc4Hand", [name.encode("utf-8", "surrogateescape") for name in odd.bone_names])

    def test_eight_threads_do_what_one_does(self):
        def work():
            own = gaitwright.load(WALK)
            bytes_of = [gaitwright.convert(motion, faithful=True).bytes("htr") for motion in (own, self.walk)]
            return bytes_of, own.positions().tobytes(), self.walk.poses().tobytes(), gaitwright.suggest(own).map.text()

        alone, together = work(), []
        threads = [threading.Thread(target=lambda: together.append(work())) for _ in range(8)]
        for thread in threads:
            thread.start()
        for thread in threads:
            thread.join()
        self.assertEqual(len(together), 8)
        self.assertTrue(all(result == alone for result in together))

    def test_others_run_during_a_conversion(self):
        """Python interrupts no thread here, so this one continues early only if a call lets it."""
        results = []
        self.addCleanup(sys.setswitchinterval, sys.getswitchinterval())
        sys.setswitchinterval(1000)
        thread = threading.Thread(target=lambda: [results.append(self.convert_walk()) for _ in range(20)])
        thread.start()
        done_early = len(results)
        thread.join()
        self.assertLess(done_early, len(results))

    def convert_walk(self):
        return gaitwright.convert(self.walk, faithful=True)

    def test_the_stubs_declare_what_there_is(self):
        stub = ast.parse((harness.ROOT / "python/__init__.pyi").read_text())
        declared = {node.name: node for node in stub.body if isinstance(node, (ast.FunctionDef, ast.ClassDef))}
        self.assertEqual(set(declared), {name for name in dir(gaitwright) if not name.startswith("_")})
        for name, node in declared.items():
            if isinstance(node, ast.FunctionDef):
                self.assert_declared(node, getattr(gaitwright, name))
                continue
            members = {part.target.id if isinstance(part, ast.AnnAssign) else part.name: part for part in node.body}
            own = getattr(gaitwright, name)
            self.assertEqual(set(members), {member for member in vars(own) if not member.startswith("_")}, name)
            for member, part in members.items():
                if isinstance(part, ast.FunctionDef) and not part.decorator_list:
                    self.assert_declared(part, getattr(own, member))
                else:
                    self.assertTrue(own is gaitwright.Error or getattr(own, member).__doc__, member)

    def assert_declared(self, node, function):
        names = [argument.arg for argument in node.args.args + node.args.kwonlyargs if argument.arg != "self"]
        self.assertEqual(names, list(inspect.signature(function).parameters), node.name)
        self.assertGreater(len(function.__doc__), 20, node.name)


if __name__ == "__main__":
    unittest.main()
