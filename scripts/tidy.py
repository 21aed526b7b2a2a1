#!/usr/bin/env python3
"""Runs clang-tidy over the sources of a build, several sources in one translation unit.

    tidy.py BUILD [SOURCE...]

Most of the time goes into headers, so sources with the same options that stand in the same folder are included by one
generated source. Where two of them give different things the same name, the later one goes into another; so what stands
alone is checked alone. Named sources are checked one by one.
"""
import collections
import concurrent.futures
import itertools
import json
import os
import re
import shutil
import subprocess
import sys
from pathlib import Path

TOGETHER = 16
TIDY = shutil.which("clang-tidy-14") or "clang-tidy"
ERROR = re.compile(r"^(/[^:\n]+):\d+:\d+: (?:fatal )?error: ", re.MULTILINE)


def sources_by_options(build, named):
    """{(compiler's options, folder): [source...]}, in the order of their names."""
    root = Path.cwd()
    groups = collections.defaultdict(list)
    for entry in json.loads((build / "compile_commands.json").read_text()):
        source = Path(entry["file"])
        if root / "build" in source.parents or (named and source not in named):
            continue
        groups[entry["command"].split(" -o ")[0], source.parent].append(source)
    return {key: sorted(sources) for key, sources in groups.items()}


class Batches:
    """Generated sources and the compilation database that clang-tidy finds them in."""

    def __init__(self, folder):
        self.folder = folder
        self.entries = []
        self.numbers = itertools.count()  # threads share it
        shutil.rmtree(folder, ignore_errors=True)
        folder.mkdir()

    def add(self, options, sources):
        """The path of a source that includes the given ones."""
        path = self.folder / f"{next(self.numbers)}.cpp"
        path.write_text("".join(f'#include "{source}"\n' for source in sources))
        self.entries.append({"directory": str(self.folder), "file": str(path), "command": f"{options} -c {path}"})
        return path

    def close(self):
        (self.folder / "compile_commands.json").write_text(json.dumps(self.entries))


def clashing(options, path, sources):
    """Those of the sources, except the first, that cannot be compiled after the others."""
    command = f"{options} -fsyntax-only -w -ferror-limit=0 {path}"
    result = subprocess.run(command, shell=True, capture_output=True, text=True, check=False)
    wrong = {Path(name) for name in ERROR.findall(result.stderr)}
    return [source for source in sources[1:] if source in wrong]


def together(batches, options, sources):
    """The paths of generated sources, each of which compiles, that include all of the given sources."""
    paths = []
    while sources:
        path = batches.add(options, sources)
        apart = clashing(options, path, sources) if len(sources) > 1 else []
        if apart:
            path.write_text("".join(f'#include "{source}"\n' for source in sources if source not in apart))
        paths.append(path)
        sources = apart
    return paths


def tidy(database, path):
    """The output of clang-tidy, and whether there are no findings."""
    # A source that includes sources is intended here.
    command = [TIDY, "-p", str(database), "--config-file=.clang-tidy", "--checks=-bugprone-suspicious-include",
               "--quiet", "--warnings-as-errors=*", str(path)]
    result = subprocess.run(command, capture_output=True, text=True, check=False)
    # The warnings in system headers, which it counts, are noise.
    noise = re.compile(r"^.* generated\.$\n?", re.MULTILINE)
    return result.stdout + noise.sub("", result.stderr), result.returncode == 0


def main():
    build = Path(sys.argv[1]).resolve()
    named = {Path(name).resolve() for name in sys.argv[2:]}
    size = 1 if named else TOGETHER
    batches = Batches(build / "batches")
    work = [(options, sources[i:i + size]) for (options, _), sources in sources_by_options(build, named).items()
            for i in range(0, len(sources), size)]
    checked = sum(len(sources) for _, sources in work)
    if named and checked != len(named):
        sys.exit(f"{len(named) - checked} of {len(named)} named sources are not compiled")
    good = True
    with concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
        paths = [path for parts in pool.map(lambda item: together(batches, *item), work) for path in parts]
        batches.close()
        for text, clean in pool.map(lambda path: tidy(batches.folder, path), paths):
            print(text, end="")
            good = good and clean
    print(f"{checked} sources in {len(paths)} runs of clang-tidy")
    sys.exit(0 if good else 1)


if __name__ == "__main__":
    main()
