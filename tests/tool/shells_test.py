# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The manual page and the completions: they name every command and option that --help names, and the programs that they
# are for take them.
import re
import shutil
import subprocess
import sys
import tempfile
import unittest

from support import run

COMMANDS = ("info", "tree", "props", "curve", "cache", "camera", "diff", "lint", "records", "dump", "convert", "completion")


def options_of(command):
    """The long options in a command's help."""
    return sorted(set(re.findall(r"--[a-z][a-z-]*", run(command, "--help").stdout.split("Options:")[1])) - {"--strict"}
                  | ({"--strict"} if command == "convert" else set()))


if run("help", "report").returncode == 0: # a build without npm goes without it
    COMMANDS = (*COMMANDS, "report")


def bash(line):
    """What bash offers behind a line."""
    script = ('source /dev/stdin; COMP_WORDS=("$@"); COMP_CWORD=$(($# - 1)); _tarnell_fbx; '
              'printf "%s\\n" "${COMPREPLY[@]}"')
    result = subprocess.run(["bash", "-c", script, "bash", "tarnell-fbx", *line], input=run("completion", "bash").stdout,
                            capture_output=True, text=True, timeout=60)
    assert result.returncode == 0 and result.stderr == "", result.stderr
    return sorted(result.stdout.split())


class Completions(unittest.TestCase):
    def test_bash_offers_commands_options_and_files(self):
        self.assertEqual(bash([""]), sorted([*COMMANDS, "help", "--help", "--version"]))
        self.assertEqual(bash(["c"]), ["cache", "camera", "completion", "convert", "curve"])
        self.assertEqual(bash(["help", "tr"]), ["tree"])
        for command in COMMANDS:
            self.assertEqual([each for each in bash([command, "--"])], options_of(command))
        self.assertEqual(bash(["curve", "x", "--pl"]), ["--plot"])
        with tempfile.NamedTemporaryFile(suffix=".fbx") as file:
            self.assertEqual(bash(["info", file.name[:-4]]), [file.name])

    def test_zsh_and_fish_name_every_option(self):
        for shell, spelling in (("zsh", "'{}["), ("fish", " -l {} ")):
            text = run("completion", shell).stdout
            for command in COMMANDS:
                self.assertIn(command, text)
                for option in options_of(command):
                    self.assertIn(spelling.format(option if shell == "zsh" else option[2:]), text)

    def test_shells_read_them(self):
        for shell in ("bash", "zsh", "fish"):
            if not shutil.which(shell):
                print(f"no {shell} here: its completions are not read")
                continue
            with tempfile.NamedTemporaryFile("w", suffix="." + shell) as file:
                file.write(run("completion", shell).stdout)
                file.flush()
                result = subprocess.run([shell, "-n", file.name], capture_output=True, text=True, timeout=60)
                self.assertEqual((result.returncode, result.stderr), (0, ""), shell)

    def test_another_shell_is_wrong_usage(self):
        self.assertEqual(run("completion", "tcsh").returncode, 2)


class Manual(unittest.TestCase):
    def test_has_every_command_and_option(self):
        page = run("manual").stdout.replace("\\-", "-")
        for command in COMMANDS:
            section = page.split(f".SS {command}\n")[1].split("\n.S")[0]
            for option in options_of(command):
                self.assertRegex(section, rf"\n\.B [^\n]*{option}\b", command)
        for part in ("NAME", "SYNOPSIS", "COMMANDS", '"EXIT STATUS"', "ENVIRONMENT"):
            self.assertIn(f".SH {part}\n", page)

    def test_is_sound(self):
        if not shutil.which("groff"):
            self.skipTest("no groff here")
        result = subprocess.run(["groff", "-ww", "-man", "-Tutf8"], input=run("manual").stdout, capture_output=True,
                                text=True, timeout=60)
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        self.assertIn("tarnell-fbx - ", re.sub(r".\x08", "", result.stdout))


unittest.main(argv=sys.argv[:1], verbosity=0)
