# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Every rule of lint has a file of tests/data/lint that is about it and trips it, and clean.fbx, which trips none; every
# rule is in docs/lint.md with the same words.
import glob
import importlib.util
import json
import os
import re
import subprocess
import tempfile
import unittest

from support import ROOT, SDK_DATA, SHOT, run

DATA = os.path.join(ROOT, "tests", "data", "lint")
spec = importlib.util.spec_from_file_location("make_lint_files", os.path.join(DATA, "make_lint_files.py"))
scenes = importlib.util.module_from_spec(spec)
spec.loader.exec_module(scenes)
# All of the files are texts.
OF_A_TEXT = {"ascii-encoding"}
# What cannot be had alone.
ALONG = {"not-readable": {"span-differs-from-keys"},  # a span that long
         "repaired": {"rate-unstated"},  # a custom rate that is worked out
         "take-without-keys": {"several-takes"}}
# Files with other names: the clean one is a text, and for the rule of texts the other way round.
TRIPS = {"ascii-encoding": os.path.join(DATA, "clean.fbx")}


def rules():
    return json.loads(run("lint", "--list", "--json").stdout)


def lint(file, *arguments):
    result = run("lint", "--json", *arguments, file)
    page = json.loads(result.stdout)
    assert "error" not in page, page
    return page, result.returncode


def found(page):
    return {each["rule"] for each in page["findings"]}


class Rules(unittest.TestCase):
    def test_are_many_and_have_ids_of_their_own(self):
        ids = [rule["rule"] for rule in rules()]
        self.assertGreaterEqual(len(ids), 25)
        self.assertEqual(len(set(ids)), len(ids))
        for rule in rules():
            self.assertRegex(rule["rule"], "^[a-z]+(-[a-z]+)*$")
            self.assertIn(rule["severity"], ("note", "warning", "error"))
            self.assertTrue(rule["reason"].endswith("."), rule)
            self.assertTrue(rule["remedy"].endswith("."), rule)

    def test_each_has_a_file_that_trips_it_and_nothing_else(self):
        for rule in rules():
            name = rule["rule"]
            with self.subTest(name):
                page, status = lint(TRIPS.get(name, os.path.join(DATA, name + ".fbx")))
                self.assertEqual(found(page), {name} | ALONG.get(name, set()) | OF_A_TEXT)
                severities = {each["severity"] for each in page["findings"]}
                self.assertEqual(status, 0 if severities == {"note"} else 1)

    def test_each_has_a_file_that_does_not_trip_it(self):
        page, status = lint(os.path.join(DATA, "clean.fbx"))
        self.assertEqual((found(page), status), (OF_A_TEXT, 0))
        self.assertNotIn("ascii-encoding", found(lint(SHOT)[0]))

    def test_every_file_belongs_to_a_rule(self):
        names = {os.path.basename(file)[:-4] for file in glob.glob(os.path.join(DATA, "*.fbx"))}
        self.assertEqual(names, {rule["rule"] for rule in rules()} - set(TRIPS) | {"clean"})

    def test_files_are_as_their_script_writes_them(self):
        with tempfile.TemporaryDirectory() as folder:
            script = os.path.join(folder, "make_lint_files.py")
            with open(os.path.join(DATA, "make_lint_files.py"), encoding="utf-8") as stream:
                text = stream.read()
            with open(script, "w", encoding="utf-8") as stream:
                stream.write(text)
            subprocess.run(["python3", "-B", script], check=True)
            for file in glob.glob(os.path.join(DATA, "*.fbx")):
                with open(file, "rb") as ours, open(os.path.join(folder, os.path.basename(file)), "rb") as theirs:
                    self.assertEqual(ours.read(), theirs.read(), file)

    def test_stand_in_the_documentation_with_the_same_words(self):
        with open(os.path.join(ROOT, "docs", "lint.md"), encoding="utf-8") as stream:
            text = stream.read()
        sections = re.split("^### ", text, flags=re.M)[1:]
        self.assertEqual([each.split("\n", 1)[0] for each in sections], [rule["rule"] for rule in rules()])
        for rule, section in zip(rules(), sections):
            words = " ".join(section.split())
            for part in (rule["severity"], rule["reason"], rule["remedy"]):
                self.assertIn(part, words, rule["rule"])
            file = re.search(r"\(\.\./(tests/data/[^)]+)\)", section).group(1)
            self.assertTrue(os.path.exists(os.path.join(ROOT, file)), file)


class Findings(unittest.TestCase):
    def test_name_the_object_and_the_numbers(self):
        for name, who, words in (("keys-between-frames", "cam", "1 of 5 keys between whole frames, the first at 2.25"),
                                 ("span-differs-from-keys", "shot", "frames 0 to 10, its keys are at frames 0 to 4"),
                                 ("rotation-flips", "cam", "from 180° to −175° between frames 2 and 3"),
                                 ("film-shape-differs", "cam", "the film is 1.7778:1, the picture 0.9259:1"),
                                 ("far-from-origin", "tri", "200000 cm from the origin, where adjacent floats are 0.0156 cm apart"),
                                 ("lens-values-disagree", "cam", "FieldOfViewX is 90°"),
                                 ("polygons-out-of-range", "tri", "1 polygon vertex refers to a point beyond the 3 of the mesh"),
                                 ("cache-unusable", "tri", "4"), ("cache-range", "tri", "from frame 0 to 2"),
                                 ("cache-rate", "tri", "24 frames per second, and the file has 25"),
                                 ("duplicate-names", "twin", "2 nodes"), ("constraints", None, '"Aim"'),
                                 ("take-without-keys", "still", "nothing is keyed in the take"),
                                 ("unparented-nodes", "stray", "it has descendants, but no parent")):
            page, _ = lint(os.path.join(DATA, name + ".fbx"), "--rules", name)
            self.assertEqual([each["object"] for each in page["findings"]], [who], name)
            self.assertIn(words, page["findings"][0]["text"])

    def test_of_takes_name_them(self):
        rules = "keys-between-frames,far-from-origin,clip-planes,unparented-nodes"
        text = scenes.with_takes(("run", (0, 4), (0, 2.25, 4)), ("far", (0, 4), (200000, 200004)),
                                 camera={"NearPlane": 10.0, "FarPlane": 5.0}).replace("200000.0,200004.0", "2e5,2e5")
        page = json.loads(run("lint", "--json", "--rules", rules, "-", input=text).stdout)
        found = {(each["rule"], each["object"]): each for each in page["findings"]}
        self.assertEqual(set(found), {("keys-between-frames", "cam"), ("far-from-origin", "cam"), ("clip-planes", "cam")})
        self.assertEqual(found["keys-between-frames", "cam"]["takes"], ["run"])
        self.assertEqual(found["far-from-origin", "cam"]["takes"], ["far"])
        self.assertEqual(found["clip-planes", "cam"]["takes"], ["shot", "run", "far"])  # once, in all of them
        lines = run("lint", "--rules", rules, "-", input=text).stdout
        self.assertIn('the first at 2.25 (in take "run")\n', lines)
        self.assertIn('floats are 0.0156 cm apart (in take "far")\n', lines)
        self.assertNotIn('"shot"', lines)  # what holds in every take needs no names

    def test_of_cameras_are_those_of_the_take(self):
        mesh, film = (20, "Lcl Translation", "d|X"), (2, "FilmOffsetX", "d|FilmOffsetX")

        def takes(first, *others):
            further = [("b%d" % i, (0, 4), (0, 4), *each) for i, each in enumerate(others)]
            text = scenes.with_takes(*further, **dict(zip(("on", "animated", "channel"), first)),
                                     camera={"FilmOffsetX": 0.125})  # keys begin at 0
            page = json.loads(run("lint", "--json", "--rules", "film-offset", "-", input=text).stdout)
            return [take for each in page["findings"] for take in each["takes"]]
        self.assertEqual(takes(mesh, mesh), ["shot", "b0"])
        self.assertEqual(takes(mesh, film, mesh), ["shot", "b1"])
        self.assertEqual(takes(film, mesh, film), ["b0"])

    def test_of_rates_are_of_files_that_state_none(self):
        def found(text):
            page = json.loads(run("lint", "--json", "--rules", "rate-unstated", "-", input=text).stdout)
            return [each["text"] for each in page["findings"]]
        unstated = dict(time_mode=14, frames=(0, 1), rate=12.5)
        self.assertEqual(found(scenes.scene(**unstated)),
                         ["the time mode is custom, without a frame rate; read as 12.5 frames per second"])
        stated = ('"TimeMode", "enum", "", "",14\n',
                  '"TimeMode", "enum", "", "",14\n\t\tP: "CustomFrameRate", "double", "Number", "",12.5\n')
        self.assertEqual(found(scenes.scene(**unstated).replace(*stated)), [])
        self.assertEqual(found(scenes.scene(**unstated).replace(stated[0], stated[1].replace("12.5", "-1"))),
                         ["the time mode is custom, without a frame rate; read as 12.5 frames per second"])
        still = scenes.scene(time_mode=14, keyed=False, span=(0, 0))  # no times to derive a rate from
        self.assertEqual(found(still), ["the time mode is custom, without a frame rate; read as 30 frames per second"])
        self.assertEqual(found(scenes.scene(time_mode=0, rate=30)),
                         ["the time mode is 0, the default of the application; read as 30 frames per second"])
        self.assertEqual(found(scenes.scene(time_mode=14, taken=False)), [])  # nothing has a time
        # A warning that quotes a name is not about rates.
        twice = scenes.scene(names=("cam", "states no frame rate"), connections='C: "OO",20,1\n')
        self.assertIn("states no frame rate", json.loads(run("lint", "--json", "-", input=twice).stdout)["findings"][0]["text"])
        self.assertEqual(found(twice), [])

    def test_of_scales_see_their_keys(self):
        def found(rule, **keys):
            nulls = scenes.null(30, "big") + scenes.null(31, "free", {"InheritType": 2})
            text = scenes.scene(objects=nulls, connections='C: "OO",30,0\nC: "OO",31,30\n', on=30,
                                animated="Lcl Scaling", **keys)
            page = json.loads(run("lint", "--json", "--rules", rule, "-", input=text).stdout)
            return [(each["object"], each["text"], each["takes"]) for each in page["findings"]]
        grows = {"frames": (0, 4), "values": [1.0, 3.0]}
        self.assertEqual(found("inherited-scale", **grows),
                         [("free", 'it does not inherit the scale of its parent "big", which is keyed', ["shot"])])
        self.assertEqual(found("inherited-scale", frames=(0, 4), values=[1.0, 1.0]), [])
        self.assertEqual(found("inherited-scale", frames=(0, 4), values=[3.0, 3.0]),
                         [("free", 'it does not inherit the scale of its parent "big", (3, 1, 1)', ["shot"])])
        self.assertEqual(found("zero-scale", frames=(0, 4), values=[0.0, 1.0]),
                         [("big", "its scale is (0, 1, 1)", ["shot"])])

    def test_that_depend_on_no_take_name_none(self):
        page, _ = lint(os.path.join(DATA, "squeezed-film.fbx"))
        self.assertEqual({tuple(each["takes"]) for each in page["findings"]}, {()})

    def test_of_two_objects_with_one_name_are_two(self):
        text = scenes.scene(names=("twin", "twin"), camera_node={"Lcl Translation": (0.0, 2e5, 0.0)},
                            mesh_node={"Lcl Translation": (0.0, 2e5, 0.0)}, keyed=False)
        page = json.loads(run("lint", "--json", "--rules", "far-from-origin", "-", input=text).stdout)
        self.assertEqual(len(page["findings"]), 2)

    def test_of_what_nothing_holds_follow_from_the_connections_of_any_version(self):
        rule = ("--rules", "unparented-nodes")
        with tempfile.TemporaryDirectory() as folder:
            for version in ("2010", "2014", "2016"):
                for form in ("--ascii", "--binary"):
                    file = os.path.join(folder, f"{version}{form}.fbx")
                    source = os.path.join(DATA, "unparented-nodes.fbx")
                    self.assertEqual(run("convert", source, file, "--version", version, form).returncode, 0)
                    self.assertEqual(lint(file, *rule)[0]["findings"], [], file)  # convert connects it
                    if form == "--ascii":
                        with open(file, encoding="utf-8") as stream:
                            text = stream.read()
                        link = (re.search(r'\n[^\n]*"Model::stray"[^\n]*"Model::Scene"', text) if version == "2010"
                                else re.search(r'\n\s*C: "OO",%s,0' % re.search(r'Model: (\d+), "Model::stray"', text)[1],
                                               text))
                        result = run("lint", "--json", *rule, "-", input=text.replace(link[0], ""))
                        self.assertEqual([each["object"] for each in json.loads(result.stdout)["findings"]], ["stray"])
        views = os.path.join(SDK_DATA, "producer_cameras_6100_ascii.fbx")
        self.assertEqual(lint(views, *rule)[0]["findings"], [])

    def test_of_chosen_rules_only(self):
        file = os.path.join(DATA, "repaired.fbx")
        self.assertEqual(found(lint(file, "--rules", "repaired")[0]), {"repaired"})
        self.assertEqual(found(lint(file, "--rules", "repaired,rate-unstated")[0]), {"repaired", "rate-unstated"})
        self.assertEqual(lint(file, "--rules", "clip-planes")[1], 0)
        result = run("lint", "--rules", "repaird", file)
        self.assertEqual((result.returncode, result.stdout), (2, ""))
        self.assertIn("did you mean repaired", result.stderr)

    def test_of_several_files_decide_the_status(self):
        clean, other = os.path.join(DATA, "clean.fbx"), os.path.join(DATA, "clip-planes.fbx")
        self.assertEqual(run("lint", clean, clean).returncode, 0)
        self.assertEqual(run("lint", clean, other, clean).returncode, 1)

    def test_that_are_many_are_counted_for_people_and_listed_for_programs(self):
        with open(os.path.join(SDK_DATA, "nulls_7400_ascii.fbx"), encoding="utf-8") as stream:
            text = stream.read()
        more = "".join('\tModel: %d, "Model::pair%d", "Null" {\n\t\tVersion: 232\n\t}\n' % (100 + i, i // 2)
                       for i in range(60))
        text = text.replace("Objects:  {\n", "Objects:  {\n" + more, 1)
        result = run("lint", "--json", "--rules", "duplicate-names", "-", input=text)
        self.assertEqual(len(json.loads(result.stdout)["findings"]), 30)
        self.assertIn("… and 10 more; --json lists all", run("lint", "--rules", "duplicate-names", "-", input=text).stdout)

    def test_of_files_that_cannot_be_read_are_errors(self):
        result = run("lint", "--json", os.path.join(DATA, "missing.fbx"))
        self.assertEqual((result.returncode, list(json.loads(result.stdout))), (1, ["format", "file", "error"]))

    def test_without_a_file_are_wrong_usage(self):
        result = run("lint")
        self.assertEqual((result.returncode, result.stdout), (2, ""))
        self.assertIn("FILE", result.stderr)


unittest.main(argv=[__file__], verbosity=0)
