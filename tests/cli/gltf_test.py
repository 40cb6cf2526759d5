"""Written glTF, judged by the validator of the format's makers. Needs node and its module gltf-validator: found by
node itself, among npm's global ones, or in the folder that GAITWRIGHT_GLTF_VALIDATOR names."""
import json
import os
import shutil
import subprocess
import unittest

import made
from harness import WALK, CliTest, main
from models import Model, turn

NODE, NPM = shutil.which("node"), shutil.which("npm")
SCRIPT = """
const fs = require('fs');
const judge = require(process.env.GAITWRIGHT_GLTF_VALIDATOR || 'gltf-validator').validateBytes;
const issues = path => judge(new Uint8Array(fs.readFileSync(path))).then(report => report.issues.messages);
Promise.all(process.argv.slice(1).map(issues)).then(all => console.log(JSON.stringify(all)));
"""


def validate(*paths):
    """What the validator has to say about each file. None if it is not installed."""
    globals_of_npm = subprocess.run([NPM, "root", "-g"], capture_output=True, text=True).stdout.strip() if NPM else ""
    folders = [folder for folder in (os.environ.get("NODE_PATH"), globals_of_npm) if folder]
    done = subprocess.run([NODE, "-e", SCRIPT, *map(str, paths)], capture_output=True, text=True,
                          env=os.environ | {"NODE_PATH": os.pathsep.join(folders)})
    if "MODULE_NOT_FOUND" in done.stderr:
        return None
    return json.loads(done.stdout)


@unittest.skipUnless(NODE and validate() is not None, "needs node and its module gltf-validator")
class Gltf(CliTest):
    def test_the_validator_has_nothing_to_say(self):
        self.write("odd.bvh", made.bvh("Hips", 'a"\\').encode() + b"\n")
        self.write("latin.bvh", made.bvh("Hips", "H\xfcfte").encode("latin-1"))
        self.write("model.glb", Model(turn(0, -90), (.01,) * 3, 100).skin().walk().glb())
        self.write("uneven.glb", Model(scale=(1, 1.2, .8)).walk().glb())
        self.write("small.htr", made.HTR)
        self.succeed("convert", WALK, "-o", "walk.Kinetra")
        sources = [WALK, "odd.bvh", "latin.bvh", "model.glb", "uneven.glb", "small.htr", "walk.Kinetra"]
        results = ["%d.glb" % index for index in range(len(sources))]
        for source, result in zip(sources, results):
            self.succeed("transcode", source, result)
        self.succeed("convert", WALK, "--format", "glb", "-o", "converted.glb")
        results.append("converted.glb")
        for result, issues in zip(results, validate(*(self.folder / result for result in results))):
            self.assertEqual(issues, [], result)


if __name__ == "__main__":
    main()
