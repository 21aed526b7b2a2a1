# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# What the commands that look into files have in common: several files and patterns, JSON, jobs, terminals, output that
# goes nowhere, and answers to what was mistyped.
import fcntl
import json
import os
import pty
import re
import shutil
import signal
import struct
import subprocess
import sys
import tempfile
import termios
import unittest

from support import ROOT, SDK_DATA, SHOT, TOOL, edited, run

TWO = [os.path.join(SDK_DATA, name) for name in ("nulls_7400_ascii.fbx", "two_stacks_7400_ascii.fbx")]
ESCAPE = "\x1b["


def on_terminal(*arguments, width=80, **environment):
    """What a person sees on a terminal, standard error included."""
    master, slave = pty.openpty()
    fcntl.ioctl(slave, termios.TIOCSWINSZ, struct.pack("HHHH", 24, width, 0, 0))
    kept = {"PATH": os.environ["PATH"], "TERM": "xterm"}
    process = subprocess.Popen([TOOL, *arguments], stdout=slave, stderr=slave, env={**kept, **environment})
    os.close(slave)
    shown = b""
    while True:
        try:
            piece = os.read(master, 65536)
        except OSError:  # the other end is closed
            break
        if not piece:
            break
        shown += piece
    os.close(master)
    assert process.wait(timeout=60) == 0
    return shown.decode().replace("\r\n", "\n")


class Folder(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = folder.name

    def path(self, name):
        return os.path.join(self.folder, name)


class SeveralFiles(Folder):
    def test_come_in_the_order_of_the_command_line_with_a_line_between(self):
        single = [run("info", file).stdout for file in TWO]
        self.assertEqual(run("info", *TWO).stdout, single[0] + "\n" + single[1])

    def test_are_an_array_as_json_and_lines_as_json_lines(self):
        pages = json.loads(run("info", "--json", *TWO).stdout)
        self.assertEqual([page["file"] for page in pages], TWO)
        self.assertEqual(json.loads(run("info", "--json", TWO[0]).stdout), pages[0])
        lines = run("info", "--jsonl", *TWO).stdout.splitlines()
        self.assertEqual([json.loads(line) for line in lines], pages)

    def test_may_be_patterns(self):
        for name in ("b.fbx", "a.fbx", "c.txt"):
            shutil.copy(TWO[0], self.path(name))
        lines = run("tree", "--jsonl", self.path("*.fbx")).stdout.splitlines()
        self.assertEqual([json.loads(line)["file"] for line in lines], [self.path("a.fbx"), self.path("b.fbx")])

    def test_a_name_that_looks_like_a_pattern_may_be_a_file(self):
        shutil.copy(TWO[0], self.path("shot[1].fbx"))
        shutil.copy(TWO[1], self.path("shot1.fbx"))
        self.assertEqual(json.loads(run("info", "--json", self.path("shot[1].fbx")).stdout)["stacks"], [])

    def test_a_pattern_that_stands_for_no_file_is_an_error(self):
        result = run("info", self.path("*.fbx"))
        self.assertEqual((result.returncode, result.stdout), (1, ""))
        self.assertIn("no file matches", result.stderr)
        result = run("info", "--json", self.path("*.fbx"))
        self.assertEqual((result.returncode, json.loads(result.stdout)), (1, []))

    def test_a_file_that_fails_does_not_keep_the_others_from_being_shown(self):
        missing = self.path("missing.fbx")
        result = run("tree", TWO[0], missing, TWO[1])
        self.assertEqual(result.returncode, 1)
        self.assertEqual(result.stdout, run("tree", *TWO).stdout)
        self.assertEqual(len(result.stderr.splitlines()), 1)
        pages = json.loads(run("tree", "--json", TWO[0], missing, TWO[1]).stdout)
        self.assertEqual([page["file"] for page in pages], [TWO[0], missing, TWO[1]])
        self.assertIn("No such file", pages[1]["error"])


class Jobs(Folder):
    def test_change_nothing_but_the_time(self):
        files = []
        for i in range(40):  # more than wait at a time
            files.append(self.path(f"{i:02}.fbx"))
            if i % 7 != 3:
                shutil.copy([SHOT, *TWO][i % 3], files[-1])
        for form in ((), ("--json",), ("--jsonl",)):
            alone = run("info", *form, *files)
            together = run("info", *form, "--jobs", "4", *files)
            self.assertEqual((together.returncode, together.stdout), (1, alone.stdout))
            self.assertEqual(sorted(together.stderr.splitlines()), sorted(alone.stderr.splitlines()))

    def test_have_to_be_a_number_from_one_on(self):
        for jobs in ("0", "-1", "x", "", "1.5", "99999999999"):
            result = run("info", "--jobs", jobs, SHOT)
            self.assertEqual((result.returncode, result.stdout), (2, ""), jobs)
            self.assertIn("--jobs", result.stderr)


class Output(Folder):
    def test_that_cannot_be_written_is_an_error_of_every_command(self):
        for arguments in (("info", SHOT), ("tree", SHOT), ("props", SHOT, "crate"), ("curve", SHOT, "shotCam"),
                          ("camera", SHOT), ("camera", "--csv", SHOT), ("diff", SHOT, SHOT), ("lint", SHOT), ("lint", "--list"), ("cache", SHOT), ("records", SHOT),
                          ("records", "--json", SHOT), ("dump", SHOT),
                          ("info", "--jobs", "2", SHOT, SHOT), ("--help",), ("--version",), ("help", "tree"),
                          ("completion", "bash"), ("manual",)):
            with open("/dev/full", "w", encoding="utf-8") as full:
                result = subprocess.run([TOOL, *arguments], stdout=full, stderr=subprocess.PIPE, text=True, timeout=60)
            self.assertEqual(result.returncode, 1, arguments)
            self.assertEqual(result.stderr, "tarnell-fbx: standard output: No space left on device\n", arguments)

    def test_is_quiet_when_the_reader_leaves(self):
        for handler in (signal.SIG_DFL, signal.SIG_IGN):  # shells leave either
            process = subprocess.Popen([TOOL, "records", "--values", "0", SHOT], stdout=subprocess.PIPE,
                                       stderr=subprocess.PIPE, restore_signals=False,
                                       preexec_fn=lambda handler=handler: signal.signal(signal.SIGPIPE, handler))
            process.stdout.read(1)
            process.stdout.close()
            self.assertEqual(process.stderr.read(), b"")
            self.assertIn(process.wait(timeout=60), (-signal.SIGPIPE, 1, 0))
            process.stderr.close()


class Info(Folder):
    def test_is_one_screen(self):
        many = "".join('\tModel: %d, "Model::n%d", "Null" {\n\t}\n' % (100 + i, i) for i in range(60))
        links = "".join('\tC: "OO",%d,0\n' % (100 + i) for i in range(60))
        file = edited("nulls_7400_ascii.fbx", self.path("many.fbx"), ("Objects:  {\n", "Objects:  {\n" + many),
                      ("Connections:  {\n", "Connections:  {\n" + links))
        lines = run("info", file).stdout.splitlines()
        self.assertLess(len(lines), 60)
        nodes = len(json.loads(run("tree", "--json", file).stdout)["nodes"])
        self.assertEqual(lines[-1], f"    … and {nodes - 40} more; tarnell-fbx tree lists all")

    def test_says_when_takes_begin_and_end_to_four_decimals(self):
        self.assertIn("frames 1001 to 1048  (41.7083 to 43.6667 s)", run("info", SHOT).stdout)


class Terminals(Folder):
    def test_show_colours_unless_somebody_minds(self):
        self.assertIn(ESCAPE, on_terminal("tree", SHOT))
        self.assertNotIn(ESCAPE, on_terminal("tree", SHOT, NO_COLOR="1"))
        self.assertNotIn(ESCAPE, on_terminal("tree", SHOT, TERM="dumb"))
        self.assertNotIn(ESCAPE, run("tree", SHOT).stdout)
        self.assertNotIn(ESCAPE, on_terminal("tree", "--json", SHOT))

    def test_say_the_same_in_colour(self):
        for arguments in (("info", SHOT), ("tree", SHOT), ("records", "--depth", "2", SHOT)):
            shown = on_terminal(*arguments, width=200)
            self.assertEqual(re.sub(r"\x1b\[[0-9;]*m", "", shown), run(*arguments).stdout)

    def test_tables_are_no_wider_than_the_terminal(self):
        shown = on_terminal("curve", SHOT, "crate", width=60, NO_COLOR="1")
        self.assertIn("…", on_terminal("props", SHOT, "shotCam", width=60, NO_COLOR="1"))
        self.assertTrue(shown)
        plot = on_terminal("curve", SHOT, "shotCam.FocalLength", "--plot", width=60, NO_COLOR="1")
        dots = [line for line in plot.splitlines() if re.search("[\u2800-\u28ff]", line)]
        self.assertEqual({len(line) for line in dots}, {60})

    def test_show_what_takes_long(self):
        master, slave = pty.openpty()
        files = [SHOT] * 20
        process = subprocess.Popen([TOOL, "records", "--values", "0", *files], stdout=subprocess.PIPE, stderr=slave)
        os.close(slave)
        # Nobody reads the pages, so that work does not end; after a second it says where it is.
        said = os.read(master, 4096).decode()
        self.assertRegex(said, "^[0-9]+ of 20: ")
        self.assertLessEqual(len(said), 78)
        self.assertEqual(process.stdout.read().count(b"FBXHeaderExtension"), 20)
        process.stdout.close()
        self.assertEqual(process.wait(timeout=60), 0)
        self.assertTrue(os.read(master, 4096).decode().endswith(" \r"))  # taken back
        os.close(master)

    def test_say_nothing_of_what_takes_no_time(self):
        self.assertEqual(on_terminal("info", "--json", SHOT).count("\r"), 0)

    def test_names_cannot_write_on_them(self):
        file = edited("nulls_7400_ascii.fbx", self.path("a.fbx"),
                      ('"Model::parent", "Null"', '"Model::a\x1b[31mb\x07c\u202ed", "Null"'))
        for command in ("info", "tree"):
            shown = on_terminal(command, file, NO_COLOR="1")
            self.assertIn("a\\x1b[31mb\\x07c\\u202ed", shown)
            self.assertNotIn("\x1b", shown)
        self.assertEqual(json.loads(run("tree", "--json", file).stdout)["nodes"][0]["name"], "a\x1b[31mb\x07c\u202ed")
        result = run("info", self.path("\x1b[2Jmissing.fbx"))
        self.assertIn("\\x1b[2Jmissing.fbx", result.stderr)
        self.assertNotIn("\x1b", result.stderr)


class Usage(unittest.TestCase):
    def test_version_and_help_get_an_answer(self):
        with open(os.path.join(ROOT, "CMakeLists.txt"), encoding="utf-8") as stream:
            version = re.search(r"project\(TarnellFbx VERSION (\S+)", stream.read()).group(1)
        self.assertEqual(run("--version").stdout, f"tarnell-fbx {version}\n")
        self.assertEqual(run("help").stdout, run("--help").stdout)
        for command in ("info", "tree", "props", "camera", "curve", "cache", "diff", "lint", "records", "dump", "convert",
                        "completion"):
            self.assertIn(command, run("help").stdout)
            self.assertEqual(run("help", command).stdout, run(command, "--help").stdout)
            self.assertIn("Exit status", run("help", command).stdout)

    def test_a_mistyped_command_gets_an_answer(self):
        for word, meant in (("inof", "info"), ("INFO", "info"), ("conver", "convert"), ("hlep", "help")):
            result = run(word, SHOT)
            self.assertEqual((result.returncode, result.stdout), (2, ""))
            self.assertIn(f"did you mean {meant}", result.stderr)
        result = run("frobnicate")
        self.assertEqual(result.returncode, 2)
        self.assertIn("tarnell-fbx help", result.stderr)
        self.assertEqual(run("help", "inof").returncode, 2)

    def test_two_forms_at_a_time_are_wrong_usage(self):
        self.assertEqual(run("info", "--json", "--jsonl", SHOT).returncode, 2)
        self.assertEqual(run("curve", SHOT, "shotCam", "--csv", "--plot").returncode, 2)

    def test_a_rate_that_is_none_is_wrong_usage(self):
        for rate in ("-5", "0", "-0.0"):
            result = run("dump", "--sample-fps", rate, SHOT)
            self.assertEqual((result.returncode, result.stdout), (2, ""), rate)

    def test_take_and_stack_are_one_option(self):
        file = os.path.join(SDK_DATA, "two_stacks_7400_ascii.fbx")
        for command in (["camera", file], ["curve", file, "node"], ["dump", "--faithful", file]):
            take, stack = (run(*command, option, "run") for option in ("--take", "--stack"))
            self.assertEqual((take.returncode, take.stdout), (0, stack.stdout), command)
            self.assertNotEqual(take.stdout, run(*command).stdout, command)

    def test_a_name_that_there_is_not_is_an_error(self):
        result = run("dump", "--name", "nosuch", SHOT)
        self.assertEqual((result.returncode, result.stdout), (1, ""))
        self.assertIn('"nosuch"', result.stderr)

    def test_losses_count_under_strict(self):
        with tempfile.TemporaryDirectory() as folder:
            arguments = ("convert", "--force", SHOT, os.path.join(folder, "out.fbx"))
            lossy = run(*arguments)
            self.assertEqual(lossy.returncode, 0)
            self.assertTrue(lossy.stderr)
            self.assertEqual(run(*arguments, "--strict").returncode, 3)
            self.assertTrue(os.path.exists(os.path.join(folder, "out.fbx")))
            without = ("convert", "--force", "--strict",
                       os.path.join(ROOT, "tests", "data", "tool", "moving_triangle.fbx"),
                       os.path.join(folder, "out.fbx"))
            self.assertEqual(run(*without).returncode, 0)


unittest.main(argv=sys.argv[:1], verbosity=0)
