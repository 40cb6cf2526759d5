"""What the program tells shells and man of itself: typed into real shells, with everything that its help names."""
import os
import pty
import re
import select
import shutil
import subprocess
import time
import unittest

from harness import DONE, PROGRAM, USAGE, CliTest, main, posix_only

PATIENCE = 20  # seconds

# A shell reads one word after the other as it is typed; the prompt tells that it is ready for the next line.
PROMPT = "ready> "
SHELLS = {
    "bash": (["bash", "--norc", "--noprofile", "-i"], "bash/gaitwright",
             "PS1='{prompt}'; bind 'set enable-bracketed-paste off'; source {script}"),
    "zsh": (["zsh", "-f", "-i"], "zsh/_gaitwright",
            "PS1='{prompt}'; unset zle_bracketed_paste; unsetopt prompt_sp auto_remove_slash; fpath=({folder} $fpath); "
            "autoload -U compinit; compinit -u -D"),
}

SEGMENTS = "Xsens MVN segments (4 spine joints)"  # of the stock profiles

TYPED = [  # what, what is typed before the tab, what the program is then called with
    ("a command", "tran", ["transcode"]),
    ("an option", "convert --keep", ["convert", "--keep-going"]),
    ("a word of a few", "batch --job h", ["batch", "--job", "htr"]),
    ("a motion, and no other file", "convert take", ["convert", "take.BVH"]),
    ("a name with a blank", "convert my", ["convert", "my walk.bvh"]),
    ("a folder in the place of a file", "info arch", ["info", "archive/"]),
    ("a folder, and no file of that name", "convert --out-dir res", ["convert", "--out-dir", "results/"]),
    ("a page", "convert --html page", ["convert", "--html", "page.html"]),
    ("an installed profile", "convert --profile Xsens\\ MVN\\ s", ["convert", "--profile", SEGMENTS]),
    ("a profile's file", "convert --profile own", ["convert", "--profile", "own.prf"]),
    ("any file where any will do", "info odd", ["info", "odd.file"]),
]


class Shell:
    """An interactive shell at the other end of a terminal."""

    def __init__(self, arguments, folder, environment):
        self.process, self.terminal = pty.fork()
        if self.process == 0:
            os.chdir(folder)
            os.execvpe(arguments[0], arguments, environment)

    def type(self, text):
        os.write(self.terminal, text.encode())

    def read_until(self, pattern):
        """What the shell has shown by the time that the pattern comes; None where it never does."""
        shown, end = "", time.monotonic() + PATIENCE
        while time.monotonic() < end:
            if select.select([self.terminal], [], [], 0.1)[0]:
                shown += os.read(self.terminal, 65536).decode("utf-8", "replace")
            found = re.search(pattern, shown)
            if found:
                return found
        raise AssertionError("the shell showed only: " + repr(shown))

    def close(self):
        os.kill(self.process, 9)
        os.close(self.terminal)
        os.waitpid(self.process, 0)


@posix_only("completion is for shells of other systems")
class Completion(CliTest):
    def setUp(self):
        super().setUp()
        self.helps = {}
        for row in self.run_program("--help").out.split("Commands:\n")[1].split("\n\n")[0].splitlines():
            name = row.split()[0] if row.startswith("  ") and row[2] != " " else None
            if name:
                self.helps[name] = self.run_program(name, "--help").out

    def options(self, command):
        rows = self.helps[command].split("\nOptions:\n")[1].split("\nExample:")[0]
        return set(re.findall(r"(?m)(?:^  |,)(--?[a-z0-9-]+)", rows))

    def script(self, shell, name):
        result = self.run_program("--completion", shell)
        self.assertEqual((result.code, result.err), (DONE, ""))
        return self.write(name, result.out)

    def made_folder(self):
        for name in ("take.BVH", "take.txt", "my walk.bvh", "my walk.mp4", "page.html", "page.css", "own.prf",
                     "own.txt", "results.html", "odd.file", "archive/inner.bvh", "results/x"):
            self.write("place/" + name, "")
        return self.folder / "place"

    def environment_with(self, program):
        """The program by its name, so that the shell's own search finds it and its profiles."""
        (self.folder / "bin").mkdir(exist_ok=True)
        script = '#!/bin/sh\n[ "$1" = profiles ] && exec {} "$@"\nprintf "GOT"; printf "[%s]" "$@"; echo\n'
        self.write("bin/gaitwright", script.format(program)).chmod(0o755)
        return {**self.environment, "PATH": "{}/bin:/usr/bin:/bin".format(self.folder), "TERM": "dumb",
                "INPUTRC": "/dev/null", "LC_ALL": "C.UTF-8"}

    def complete_what_is_typed(self, name):
        arguments, file, setup = SHELLS[name]
        script = self.script(name, file)
        shell = Shell(arguments, self.made_folder(), self.environment_with(PROGRAM))
        self.addCleanup(shell.close)
        shell.type(setup.format(prompt=PROMPT, script=script, folder=script.parent) + "\n")
        shell.read_until(r"\n\r*" + PROMPT)
        for what, typed, called in TYPED:
            with self.subTest(what):
                shell.type("gaitwright " + typed + "\t\n")
                got = shell.read_until(r"GOT(\[.*\])\r?\n[^\n]*" + PROMPT)
                self.assertEqual(got[1], "".join("[{}]".format(word) for word in called))

    def test_bash_completes_what_is_typed(self):
        self.complete_what_is_typed("bash")

    @unittest.skipUnless(shutil.which("zsh"), "there is no zsh here")
    def test_zsh_completes_what_is_typed(self):
        self.complete_what_is_typed("zsh")

    @unittest.skipUnless(shutil.which("fish"), "there is no fish here")
    def test_fish_offers_every_command_and_option_of_the_help(self):
        script = self.script("fish", "gaitwright.fish")
        place = self.made_folder()

        def offered(typed):
            command = "source {}; complete -C 'gaitwright {}'".format(script, typed)
            done = subprocess.run(["fish", "--no-config", "-c", command], cwd=place, timeout=60, check=True,
                                  env=self.environment_with(PROGRAM), capture_output=True, text=True)
            self.assertEqual(done.stderr, "")
            return {line.split("\t")[0] for line in done.stdout.splitlines()}

        self.assertEqual(offered(""), set(self.helps))
        for command in self.helps:
            with self.subTest(command):
                self.assertLessEqual({name for name in self.options(command) if name.startswith("--")} - {"--help"},
                                     offered(command + " --"))
        self.assertEqual(offered("batch --job "), {"htr", "orn"})
        self.assertEqual(offered("batch re"), {"results/"})
        self.assertIn(SEGMENTS, offered("convert --profile Xs"))

    def test_bash_offers_every_option_of_the_help_and_no_other(self):
        script = self.script("bash", "gaitwright.sh")
        for command in self.helps:
            with self.subTest(command):
                line = 'source "$1"; COMP_WORDS=(gaitwright "$2" -); COMP_CWORD=2; _gaitwright; ' \
                       'printf "%s\\n" "${COMPREPLY[@]}"'
                done = subprocess.run(["bash", "-c", line, "bash", script, command], capture_output=True, text=True,
                                      timeout=60, check=True)
                self.assertEqual(set(done.stdout.split()), self.options(command))

    def test_a_file_name_is_never_run(self):
        script = self.script("bash", "gaitwright.sh")
        self.write("place/$(touch ran).bvh", "")
        line = 'source "$1"; COMP_WORDS=(gaitwright convert \'$(touch ran)\'); COMP_CWORD=2; _gaitwright; ' \
               'printf "%s\\n" "${COMPREPLY[@]}"'
        done = subprocess.run(["bash", "-c", line, "bash", script], cwd=self.folder / "place", capture_output=True,
                              text=True, timeout=60, check=True)
        self.assertEqual(done.stdout, "$(touch ran).bvh\n")
        self.assertFalse((self.folder / "place" / "ran").exists())

    def test_the_man_page_has_every_command_with_its_options_and_its_example(self):
        page = self.run_program("--man-page").out.replace("\\-", "-").replace("\\e", "\\").replace("\\&", "")
        for command, text in self.helps.items():
            with self.subTest(command):
                entry = page.split(".SS {}\n".format(command))[1].split("\n.S")[0]
                shared = page.split(".SH OPTIONS\n")[1].split(".SH COMMANDS")[0]
                bold = set(re.findall(r"\\fB(--?[a-z0-9-]+)\\fR", entry + shared))
                self.assertLessEqual(self.options(command), bold)
                self.assertIn(text.split("\nExample:\n")[1].strip(), entry)

    def test_another_shell_is_refused(self):
        for arguments in (["--completion"], ["--completion", "tcsh"]):
            self.assertEqual(self.run_program(*arguments).code, USAGE)


if __name__ == "__main__":
    main()
