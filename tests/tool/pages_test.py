# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Whole pages of the commands that inspect files, as they are printed without colours. Each file of
# tests/data/tool/pages is a transcript: a command behind "$ ", then what it prints on standard output, then behind "! "
# what on standard error, then its exit status where that is not 0. Commands may be joined by " | ". With --update the
# transcripts are rewritten; read the difference before you keep it. Those of ten files are also checked for consistency:
# angles with lens and film, pictures with the gate fit, and the values of a camera between commands.
import csv
import glob
import io
import json
import math
import os
import re
import shlex
import sys
import unittest

from support import ROOT, run

# Written files contain the time.
ENVIRONMENT = {"PATH": os.environ["PATH"], "SOURCE_DATE_EPOCH": "1000000000"}
PAGES = os.path.join(ROOT, "tests", "data", "tool", "pages")


def transcript(commands):
    """What the commands print now; folders of this machine are spelt ROOT."""
    lines = []
    for command in commands:
        lines.append(f"$ {command}")
        text, complaints = None, []
        for each in command.split(" | "):
            result = run(*shlex.split(each)[1:], cwd=ROOT, env=ENVIRONMENT, input=text)
            text = result.stdout
            complaints += result.stderr.replace(os.path.realpath(ROOT), "ROOT").splitlines()
        lines += text.replace(os.path.realpath(ROOT), "ROOT").splitlines()
        lines += ["! " + line for line in complaints]
        if result.returncode != 0:
            lines.append(f"[{result.returncode}]")
    return "\n".join(lines) + "\n"


def commands_of(text):
    return [line[2:] for line in text.splitlines() if line.startswith("$ ")]


def pages_of(text):
    """What each command of a transcript prints, by the command."""
    pages = {}
    for line in text.splitlines():
        if line.startswith("$ "):
            page = pages.setdefault(line[2:], [])
        elif not re.fullmatch(r"! .*|\[\d+\]", line):
            page.append(line)
    return {command: "\n".join(lines) for command, lines in pages.items()}


def transcripts(folder="**"):
    files = sorted(glob.glob(os.path.join(PAGES, folder, "*.txt"), recursive=True))
    without = "made without npm" in run("report").stderr
    return [file for file in files if not without or os.path.basename(os.path.dirname(file)) != "report"]


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


class Files(unittest.TestCase):
    """The transcripts of ten files."""

    def setUp(self):
        self.pages = {}
        for file in transcripts("files") + transcripts("report"):
            with open(file, encoding="utf-8") as stream:
                self.pages.setdefault(os.path.basename(file), {}).update(pages_of(stream.read()))

    def page(self, name, start):
        return next((page for command, page in self.pages[name].items() if command.startswith("tarnell-fbx " + start)), None)

    def test_have_every_command(self):
        commands = ["info", "tree", "props", "camera", "curve", "cache", "lint", "records", "diff", "dump", "convert"]
        commands += ["report"] if transcripts("report") else []
        self.assertGreaterEqual(len(self.pages), 10)
        for name in self.pages:
            for command in commands:
                self.assertIsNotNone(self.page(name, command + " "), (name, command))

    def rows(self):
        for name in self.pages:
            for row in csv.DictReader(io.StringIO(self.page(name, "camera --csv"))):
                yield name, row["camera"], {key: float(value) for key, value in row.items()
                                            if key not in ("file", "camera")}

    def gates(self, name):
        """The aspect of the picture and the gate fit of each camera, from the page for people."""
        page = self.page(name, "camera --explain")
        return {camera: (float(aspect), fit) for camera, aspect, fit in re.findall(
            r"^(\S+)  perspective.*?\) = ([\d.]+):1; the film .*?GateFit \d: (\w+)", page, re.S | re.M)}

    def test_angles_follow_from_lens_and_film_and_the_picture_from_the_gate_fit(self):
        compared = 0
        for name, camera, row in self.rows():
            aspect, fit = self.gates(name).get(camera, (None, None))
            if aspect is None:  # orthographic
                continue
            film = row["filmWidth"], row["filmHeight"]
            keepsWidth = fit == "horizontal" or (fit == "fill") == (aspect > film[0] / film[1])
            picture = (film[0], film[0] / aspect) if keepsWidth else (film[1] * aspect, film[1])
            picture = film if fit == "none" else picture
            for inches, key in ((film[0], "fovX"), (film[1], "fovY"), (picture[0], "pictureFovX"),
                                (picture[1], "pictureFovY")):
                angle = 2 * math.degrees(math.atan(inches * 25.4 / 2 / row["focalLength"]))
                self.assertAlmostEqual(row[key], angle, 2 if key.startswith("picture") else 4, (name, camera, key))
                compared += 1
        self.assertGreaterEqual(compared, 60)

    def test_commands_agree_on_cameras(self):
        compared = 0
        for name, camera, row in self.rows():
            dumped = json.loads(self.page(name, "dump"))["cameras"]
            values = next(each for each in dumped if each["name"] == camera)["channels"]
            explained = self.page(name, "camera --explain").split("\n" + camera + "  ")[1]
            for key, channel in (("focalLength", "focalLength"), ("fovX", "filedOfViewX"), ("near", "nearPlane")):
                if isinstance(values[channel], (int, float)):  # in every frame
                    self.assertAlmostEqual(values[channel], row[key], 4, (name, key))
                    compared += 1
            if "Focal length  " in explained.split("\n\n")[0] and "lens changes" not in explained.split("\n")[0]:
                self.assertAlmostEqual(float(re.search(r"Focal length  ([\d.]+) mm", explained)[1]), row["focalLength"], 4)
                compared += 1
        self.assertGreaterEqual(compared, 30)

    @unittest.skipUnless(transcripts("report"), "this build has no reports")
    def test_reports_agree_on_positions_of_cameras(self):
        compared = 0
        for name, camera, row in self.rows():
            document = json.loads(self.page(name, "report"))
            frame = int(row["frame"]) - document["frames"]["first"]
            node = next(each for each in document["nodes"] if each["name"] == camera)
            if not 0 <= frame < document["frames"]["count"] or node["parent"] >= 0:
                continue
            for key in ("positionX", "positionY", "positionZ", "focalLength"):
                value = node["channels"][key]
                self.assertAlmostEqual(value[frame] if isinstance(value, list) else value, row[key], 4, (name, key))
                compared += 1
        self.assertGreaterEqual(compared, 40)


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
