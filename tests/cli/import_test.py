"""Files of modeling programs: what is read from them, what is refused, and what becomes of an import that fails."""
import json
import math
import os
import shutil
import stat
import unittest
from pathlib import Path

from harness import ASSETS, DONE, FAILED, PROGRAM, CliTest, main
from models import BODY, FRAMES, Model, turn

IMPORTER = "gaitwright-import"
SANITIZED = b"__asan_init" in Path(PROGRAM).read_bytes()


def upside(model):
    """A body that lies in its armature, which is scaled and turned: as a program with Z up exports it."""
    hips = model.joints["Hips"]
    model.nodes[hips].update(rotation=turn(0, 90), translation=[0, 0, 100])
    return model.skin().walk(keys={(hips, "translation"): lambda t: (0, -20 * t, 100 + 3 * math.sin(12 * t))})


def several_skins(model):
    joints = list(model.joints.values())
    sword = model.add("Sword", None)
    model.skin(joints[:6]).skin(joints[4:]).skin([sword] + [model.add("Sword " + end, sword, (0, 1, 0)) for end in "AB"])
    return model.walk()


def posed(model):
    """A skin that was bound in another pose than the one in which the nodes are saved."""
    model.skin().nodes[model.joints["LeftArm"]]["rotation"] = turn(2, -70)
    return model.walk()


def extras(model):
    """A hat, a mesh called like a joint, joints without a name, length or difference."""
    model.mesh("Head", None)
    model.mesh("Hat", model.joints["Head"])
    fingers = [model.add(None, model.joints["LeftHand"], (.05, 0, .01 * i)) for i in range(3)]
    twist = model.add("twist", model.joints["RightHand"])
    return model.skin([*model.joints.values(), *fingers, twist]).walk()


def growing(model):
    return model.skin().walk(keys={(model.joints["Spine"], "scale"): lambda t: (1 + .3 * t,) * 3})


def vrm_name(name):
    side = {"L": "L_", "R": "R_"}[name[0]] if name.startswith(("Left", "Right")) else "C_"
    part = name.removeprefix("Left").removeprefix("Right")
    parts = {"Arm": "UpperArm", "ForeArm": "LowerArm", "UpLeg": "UpperLeg", "Leg": "LowerLeg"}
    return "J_Bip_" + side + parts.get(part, part)


MODELS = {  # file: a model with its last clip
    "skin.glb": lambda: Model().skin().walk(),
    "no-skin.glb": lambda: Model().walk(),
    "still.glb": lambda: Model().skin(),
    "armature.glb": lambda: upside(Model(turn(0, -90), (.01,) * 3, 100)),
    "uneven.glb": lambda: Model(scale=(1, 1.2, .8)).skin().walk(),
    "growing.glb": lambda: growing(Model()),
    "skins.glb": lambda: several_skins(Model()),
    "posed.glb": lambda: posed(Model()),
    "extras.glb": lambda: extras(Model()),
    "step.glb": lambda: Model().skin().walk(interpolation="STEP"),
    "cubic.glb": lambda: Model().skin().walk(interpolation="CUBICSPLINE"),
    "rates.glb": lambda: Model().skin().walk("slow", 5, 24).walk("fast", 31, 60).walk(),
    "avatar.vrm": lambda: Model(names=vrm_name).skin().walk(),
}


class Import(CliTest):
    def positions(self, name, *options):
        """Positions by frame and joint."""
        self.succeed("pose", name, "--all", "-o", "p.csv", "--force", *options)
        rows = [row.split(",") for row in self.read("p.csv").decode().splitlines()[1:]]
        frames = {}
        for row in rows:
            frames.setdefault(int(row[0]), {})[row[1]] = [float(number) for number in row[-4:-1]]
        return frames

    def test_joints_are_where_the_file_says(self):
        for name, make in MODELS.items():
            with self.subTest(name):
                model = make()
                self.write(name, model.glb())
                frames = self.positions(name)
                self.assertEqual(len(frames), FRAMES if model.keys else 1)
                for frame in range(0, len(frames), 10):
                    worlds = model.worlds(frame)
                    for joint in model.joints.values():
                        place = frames[frame][model.nodes[joint]["name"]]
                        for axis in range(3):
                            self.assertAlmostEqual(place[axis], worlds[joint][axis][3], delta=1.7e-4)
                names = set(frames[0])
                self.assertFalse(names & {"Armature", "Hat", "Sword"} or any(n.startswith("Body") for n in names))
                self.assertEqual(len(names), len(BODY) + (4 if name == "extras.glb" else 0))

    def test_every_model_converts_in_one_command(self):
        for name, make in MODELS.items():
            if name in ("uneven.glb", "growing.glb"):
                continue
            self.write(name, make().glb())
            self.succeed("convert", name, "--draft", "-o", name + ".Kinetra")
            facts = json.loads(self.succeed("doctor", name, "--json").out)["facts"]
            self.assertEqual((facts["unit"], facts["up"], facts["restPose"]), ("metres", "Y", "T-pose"), name)

    def test_the_rate_is_the_files_own_or_the_given_or_30(self):
        self.write("own.glb", Model().skin().walk(rate=60).glb())
        self.write("none.glb", Model().skin().walk(frames=2, rate=1).glb())
        for name, options, frames in (("own.glb", (), 31), ("own.glb", ("--rate", "10"), 31), ("none.glb", (), 31),
                                      ("none.glb", ("--rate", "10"), 11)):
            self.assertEqual(len(self.positions(name, *options)), frames, (name, options))

    def test_buffers_lie_next_to_their_file_or_below(self):
        model = Model().skin().walk()
        for path in ("in/side.bin", "in/sub/a b.bin", "out.bin"):
            self.write(path, model.bytes)
        os.mkfifo(self.folder / "in/pipe")
        (self.folder / "in/link.bin").symlink_to("../out.bin")
        for address, words in (("side.bin", None), ("sub/a%20b.bin", None), ("none.bin", "none.bin, which is missing"),
                               ("../out.bin", "../out.bin, which is not in its folder"), ("link.bin", "not in its folder"),
                               ("pipe", "pipe, which cannot be read"), ("sub", "sub, which cannot be read"),
                               ("/dev/zero", "which is missing"), ("http://localhost/a.bin", "which is missing"),
                               ("../../../../../../../../../../etc/passwd", "not in its folder")):
            self.write("in/a.gltf", model.gltf(address))
            result = self.with_assets("convert", "in/a.gltf", "--draft", "-o", "a.Kinetra", "--force")
            self.assertEqual(result.code, FAILED if words else DONE, (address, result.err))
            self.assert_words(result, [words] if words else [])

    def test_what_is_no_motion_of_a_body_is_refused(self):
        cube = Model()
        cube.nodes, cube.parents = [], []
        cube.mesh("Cube", None)
        twins = Model(names=lambda name: name.removeprefix("Left").removeprefix("Right"))
        ring = json.loads(Model().walk().gltf("side.bin"))
        ring["nodes"][-1]["children"] = [0]
        walk = Model().skin().walk()
        packed = Model().walk()
        turns = packed.tree["accessors"][packed.tree["animations"][0]["samplers"][0]["output"]]
        turns.update(componentType=5122, normalized=True)  # short numbers, which the library takes for long ones
        for name, content, words in (("cube.glb", cube.glb(), ["no skeleton"]), ("none.glb", b"", ["not of the format"]),
                                     ("twins.glb", twins.skin().walk().glb(), ["several nodes that are all called"]),
                                     ("ring.gltf", json.dumps(ring), ["cannot be read"]),
                                     ("packed.glb", packed.glb(), ["rotations are damaged"]),
                                     ("cut.glb", walk.glb()[:4000], ["cannot be read"])):
            self.write("side.bin", walk.bytes)
            self.write(name, content)
            before = self.files()
            result = self.with_assets("convert", name, "--draft", "-o", "x.Kinetra")
            self.assertEqual((result.code, self.files()), (FAILED, before), result.err)
            self.assert_words(result, [name, *words])

    def fail_with(self, importer, words):
        """Converts with another import program, or none, next to a copy of the shell."""
        program = self.folder / "bin" / Path(PROGRAM).name
        if not program.exists():
            program.parent.mkdir()
            shutil.copy(PROGRAM, program)
        if importer:
            self.write("bin/" + IMPORTER, "#!/bin/sh\n" + importer).chmod(stat.S_IRWXU)
        before = self.files()
        for command in (["convert", "-o", "x.Kinetra"], ["info"], ["render", "-o", "x.png"]):
            result = self.run_program(*command, "a.glb", "--data-dir", ASSETS, program=program)
            self.assertEqual((result.code, self.files()), (FAILED, before), result.err)
            self.assert_words(result, ["a.glb", *words])

    def test_a_failed_import_is_told_and_leaves_nothing(self):
        self.write("a.glb", Model().skin().walk().glb())
        stopped = ["ended before it was done"]
        for importer, words in ((None, ["install the package gaitwright-import"]), ("kill -9 $$", stopped),
                                ("printf 'gaitwright import 1\\n'", stopped), ("head -c 100000 /dev/zero", stopped),
                                ("printf x; kill -11 $$", stopped)):
            self.fail_with(importer, words)

    @unittest.skipIf(SANITIZED, "the sanitizer needs more addresses than any limit leaves")
    def test_limits_of_memory_and_time_are_told(self):
        self.write("a.fbx", "; FBX 7.4.0 project file\nA: *9 {\n a: " + "0," * 3_000_000 + "0\n}\n")
        self.write("b.glb", Model().walk(frames=2, rate=1 / 50_000).glb())  # two keys, many frames
        for limit, words in (("ulimit -v 300000; exec $0 info a.fbx", "exceeds a limit"),
                             ("ulimit -t 1; exec $0 info b.glb", "ended before it was done")):
            result = self.run_program("-c", limit, PROGRAM, program="/bin/sh")
            self.assertEqual(result.code, FAILED, result.err)
            self.assert_words(result, [words])


if __name__ == "__main__":
    main()
