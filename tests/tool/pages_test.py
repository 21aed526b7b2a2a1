# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Whole pages of the commands that inspect files, as they are printed without colours. Each file of
# tests/data/tool/pages is a transcript: a command behind "$ ", then what it prints on standard output, then behind "! "
# what on standard error, then its exit status where that is not 0. With --update the transcripts are rewritten; read
# the difference before you keep it.
import glob
import os
import shlex
import sys
import unittest

from support import ROOT, run

PAGES = os.path.join(ROOT, "tests", "data", "tool", "pages")


def transcript(commands):
    """What the commands print now; folders of this machine are spelt ROOT."""
    lines = []
    for command in commands:
        result = run(*shlex.split(command)[1:], cwd=ROOT, env={"PATH": os.environ["PATH"]})
        lines.append(f"$ {command}")
        lines += result.stdout.replace(os.path.realpath(ROOT), "ROOT").splitlines()
        lines += ["! " + line for line in result.stderr.replace(os.path.realpath(ROOT), "ROOT").splitlines()]
        if result.returncode != 0:
            lines.append(f"[{result.returncode}]")
    return "\n".join(lines) + "\n"


def commands_of(text):
    return [line[2:] for line in text.splitlines() if line.startswith("$ ")]


def transcripts():
    return sorted(glob.glob(os.path.join(PAGES, "**", "*.txt"), recursive=True))


class Pages(unittest.TestCase):
    maxDiff = None

    def test_are_as_they_were_checked(self):
        files = transcripts()
        self.assertGreaterEqual(len(files), 19)
        for file in files:
            with self.subTest(os.path.basename(file)), open(file, encoding="utf-8") as stream:
                text = stream.read()
                self.assertTrue(commands_of(text))
                self.assertEqual(transcript(commands_of(text)), text)


def update():
    for file in transcripts():
        with open(file, encoding="utf-8") as stream:
            text = stream.read()
        with open(file, "w", encoding="utf-8") as stream:
            stream.write(transcript(commands_of(text)))


if "--update" in sys.argv:
    update()
else:
    unittest.main(argv=sys.argv[:1], verbosity=0)
