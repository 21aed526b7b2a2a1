#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Compares reading and writing with Tarnell FBX, assimp and ufbx, and prints tables in Markdown.

Each workload runs as a pair of processes, ours and the peer's in turn, so that both meet the same state of the
machine. The answers are proven equal first, for written files by reading them; what is reported is the median time of
the read or write call, the median peak of resident memory of the process, the allocations of the call, the size of
written files, and their ratios. A peer that was not built has a row that says so.

    compare.py BUILD_FOLDER INPUT_FOLDER [--repetitions N] [--corpus FOLDER] [--only WORD] [--record FILE]

Written files go to INPUT_FOLDER, too, and are removed. `--corpus` adds the geometric means over all its FBX files.
`--record` puts the tables between the markers of a Markdown file (docs/benchmarks.md), with date, machine and commit.
"""
import argparse
import datetime
import json
import math
import os
import platform
import statistics
import subprocess
import sys
from dataclasses import dataclass
from pathlib import Path

# Floats are compared: coordinates up to 1000 in both programs.
BOX_TOLERANCE = 1e-4
# Smaller files measure the start of a program.
SMALLEST_CORPUS_FILE = 1024
# Clips that last for days, which are not sampled, and positions that are not finite, which have no bounding box.
LEFT_OUT = ("huge", "long_key", "nan")
BEGIN_MARK, END_MARK = "<!-- measured: begin -->", "<!-- measured: end -->"


@dataclass(frozen=True)
class Workload:
    title: str
    file: str
    mode: str
    peer: str
    goal: str = ""  # the goal in docs/benchmarks.md
    threads: int = 1  # of ours


WORKLOADS = [
    Workload("big mesh, binary", "big_mesh_raw.fbx", "mesh", "assimp", "time and memory ≤ 0.5"),
    Workload("the same", "big_mesh_raw.fbx", "mesh", "ufbx", "time ≤ 0.8"),
    Workload("big mesh, binary, compressed", "big_mesh_compressed.fbx", "mesh", "assimp"),
    Workload("the same", "big_mesh_compressed.fbx", "mesh", "ufbx", "time ≤ 0.95"),
    Workload("the same, two threads", "big_mesh_compressed.fbx", "mesh", "ufbx", "time ≤ 0.55", 2),
    Workload("big mesh, ASCII", "big_mesh_ascii.fbx", "mesh", "assimp"),
    Workload("the same", "big_mesh_ascii.fbx", "mesh", "ufbx", "time ≤ 0.5"),
    Workload("the same, two threads", "big_mesh_ascii.fbx", "mesh", "ufbx", "time ≤ 0.35", 2),
    Workload("10 cameras beside the big mesh", "big_mesh_raw.fbx", "cameras", "assimp", "time ≤ 0.1"),
    Workload("the same", "big_mesh_raw.fbx", "cameras", "ufbx", "time ≤ 0.01"),
    Workload("200 meshes, compressed", "many_meshes.fbx", "mesh", "assimp"),
    Workload("the same", "many_meshes.fbx", "mesh", "ufbx", "time ≤ 0.95"),
    Workload("the same, two threads", "many_meshes.fbx", "mesh", "ufbx", "time ≤ 0.55", 2),
    Workload("10 cameras beside 200 meshes", "many_meshes.fbx", "cameras", "ufbx"),
    Workload("rig of 156 nodes and 2,184 curves, cameras", "rig.fbx", "cameras", "ufbx", "time ≤ 0.6, memory ≤ 1.2"),
    Workload("the same, meshes", "rig.fbx", "mesh", "ufbx", "time ≤ 0.6, memory ≤ 1.2"),
    Workload("the same, local samples", "rig.fbx", "local", "ufbx", "time ≤ 0.6, memory ≤ 1.2"),
    Workload("the same, world samples", "rig.fbx", "global", "ufbx", "time ≤ 0.6, memory ≤ 1.2"),
    Workload("500 nodes, local samples of 2,000 frames", "animation.fbx", "local", "assimp"),
    Workload("the same", "animation.fbx", "local", "ufbx", "time ≤ 0.35"),
    Workload("500 nodes, world samples of 2,000 frames", "animation.fbx", "global", "ufbx", "time ≤ 0.35"),
]


@dataclass(frozen=True)
class Written:
    title: str
    mode: str
    goal: str
    read_mode: str  # in which the written file is read, to compare what is in it
    threads: int = 1  # of ours
    peer: str = "assimp"


WRITTEN = [
    Written("mesh of 2,000,000 polygon vertices, binary", "mesh", "time ≤ 0.4", "mesh"),
    Written("the same, two threads", "mesh", "time ≤ 0.25", "mesh", 2),
    Written("the same mesh, ASCII", "meshAscii", "time ≤ 0.4", "mesh"),
    Written("the same, two threads", "meshAscii", "time ≤ 0.25", "mesh", 2),
    Written("500 nodes, a key on each of 2,000 frames, binary", "nodes", "time ≤ 0.4", "local"),
    Written("the same, two threads", "nodes", "time ≤ 0.25", "local", 2),
    Written("the same nodes, ASCII", "nodesAscii", "time ≤ 0.4", "local"),
    Written("the same, two threads", "nodesAscii", "time ≤ 0.25", "local", 2),
]

# Over all files of the corpus: mode, and the goal of the geometric mean.
CORPUS = [("cameras", "≤ 0.5"), ("mesh", "≤ 0.8"), ("local", "≤ 0.6"), ("global", "≤ 0.5")]


@dataclass
class Run:
    answer: dict
    seconds: float
    allocations: int
    megabytes: float
    file_megabytes: float = 0.0


def run(program: Path, mode: str, file: Path, *more: str, quiet: bool = False, threads: int = 1) -> Run | None:
    """One process: its result, its own time, and its peak of resident memory. None, when quiet, for a file
    that it refuses."""
    process = subprocess.run([program, mode, file, *more], stdout=subprocess.PIPE, text=True, check=False,
                             stderr=subprocess.DEVNULL if quiet else None,
                             env=dict(os.environ, TARNELL_FBX_THREADS=str(threads)))
    if process.returncode != 0 and quiet:
        return None
    if process.returncode != 0:
        sys.exit(f"{program.name} {mode} {file.name} failed")
    answer = json.loads(process.stdout)
    return Run(answer, answer.pop("seconds"), answer.pop("allocations"), answer.pop("peakKilobytes") / 1024)


def prove_equal(title: str, ours: dict, theirs: dict) -> None:
    equal = ours["count"] == theirs["count"] and all(
        abs(a - b) <= BOX_TOLERANCE for key in ("minimum", "maximum") for a, b in zip(ours[key], theirs[key]))
    if not equal:
        sys.exit(f"{title}: the answers differ\n  ours: {ours}\n  peer: {theirs}")


def measure(workload: Workload, programs: Path, inputs: Path, repetitions: int) -> tuple[list[Run], list[Run]]:
    file = inputs / workload.file
    peer = programs / f"bench_read_{workload.peer}"
    ours, theirs = [], []
    for _ in range(repetitions):
        ours.append(run(programs / "bench_read_tarnell", workload.mode, file, threads=workload.threads))
        if peer.exists():
            theirs.append(run(peer, workload.mode, file))
            prove_equal(workload.title, ours[-1].answer, theirs[-1].answer)
    return ours, theirs


def measure_writing(workload: Written, programs: Path, folder: Path, repetitions: int) -> tuple[list[Run], list[Run]]:
    runs = {"tarnell": [], workload.peer: []}
    for repetition in range(repetitions):
        answers = []
        for program, results in runs.items():
            if not (programs / f"bench_write_{program}").exists():
                continue
            file = folder / f"written_by_{program}.fbx"
            result = run(programs / f"bench_write_{program}", workload.mode, file, threads=workload.threads)
            result.file_megabytes = file.stat().st_size / 1e6
            results.append(result)
            if repetition == 0:
                answers.append(run(programs / "bench_read_tarnell", workload.read_mode, file).answer)
            file.unlink()
        if len(answers) == 2:
            prove_equal(workload.title, *answers)
    return runs["tarnell"], runs[workload.peer]


def spread(values: list[float]) -> float:
    return (max(values) - min(values)) / statistics.median(values)


def cells(ours: list[Run], theirs: list[Run], value, unit: str) -> str:
    mine = statistics.median(value(r) for r in ours)
    if not theirs:
        return f"{mine:{unit}} | – | –"
    peer = statistics.median(value(r) for r in theirs)
    return f"{mine:{unit}} | {peer:{unit}} | **{mine / peer:.2f}**"


def row(workload: Workload | Written, ours: list[Run], theirs: list[Run]) -> str:
    noise = max(spread([r.seconds for r in runs]) for runs in (ours, theirs) if runs)
    peer = workload.peer if theirs else f"no {workload.peer}"
    line = (f"| {workload.title} | {peer} | {cells(ours, theirs, lambda r: r.seconds * 1000, '.1f')} | {noise:.0%} "
            f"| {cells(ours, theirs, lambda r: r.megabytes, '.0f')} ")
    if isinstance(workload, Written):
        line += f"| {cells(ours, theirs, lambda r: r.file_megabytes, '.0f')} "
    allocations = statistics.median(r.allocations for r in ours)
    return line + f"| {allocations:,.0f} | {workload.goal} |"


def corpus_rows(programs: Path, corpus: Path, repetitions: int):
    """The geometric mean of our time over the peer's, each the best of some in one process, per mode."""
    ours, peer = programs / "bench_read_tarnell", programs / "bench_read_ufbx"
    files = [f for f in sorted(corpus.rglob("*.fbx"))
             if f.stat().st_size >= SMALLEST_CORPUS_FILE and not any(word in f.name for word in LEFT_OUT)]
    for mode, goal in CORPUS:
        ratios = []
        for file in files:
            mine = run(ours, mode, file, str(repetitions), quiet=True)
            other = run(peer, mode, file, str(repetitions), quiet=True) if mine else None
            if other:
                ratios.append((mine.seconds / other.seconds, file.name))
        mean = math.exp(statistics.mean(math.log(ratio) for ratio, _ in ratios))
        worst = ", ".join(f"{name} {ratio:.1f}" for ratio, name in sorted(ratios, reverse=True)[:3])
        yield f"| {mode} | {len(ratios)} | **{mean:.2f}** | {goal} | {worst} |"


def processor() -> str:
    try:
        for line in Path("/proc/cpuinfo").read_text().splitlines():
            if line.startswith("model name"):
                return line.split(":", 1)[1].strip()
    except OSError:
        pass
    return platform.machine()


def commit() -> str:
    described = subprocess.run(["git", "describe", "--always", "--dirty"], capture_output=True, text=True, check=False)
    return described.stdout.strip() or "unknown"


def record(file: Path, text: str) -> None:
    old = file.read_text(encoding="utf-8")
    begin, end = old.index(BEGIN_MARK) + len(BEGIN_MARK), old.index(END_MARK)
    file.write_text(old[:begin] + "\n" + text + "\n" + old[end:], encoding="utf-8")


def tables(options: argparse.Namespace):
    programs, wanted = options.build / "bench", lambda title: options.only in title
    yield (f"{datetime.date.today()}, commit {commit()}: {processor()}, {os.cpu_count()} threads, {platform.system()}; "
           f"medians of {options.repetitions} runs\n")
    yield "| workload | peer | ours, ms | peer, ms | ratio | spread | ours, MB | peer, MB | ratio | our allocations | goal |"
    yield "|---|---|---:|---:|---:|---:|---:|---:|---:|---:|---|"
    for workload in WORKLOADS:
        if wanted(workload.title) or wanted(workload.file):
            yield row(workload, *measure(workload, programs, options.inputs, options.repetitions))
    yield "\n| written | peer | ours, ms | peer, ms | ratio | spread | ours, MB | peer, MB | ratio " \
          "| ours, file MB | peer, file MB | ratio | our allocations | goal |"
    yield "|---|---|---:|---:|---:|---:|---:|---:|---:|---:|---:|---:|---:|---|"
    for written in WRITTEN:
        if wanted(written.title) or wanted(written.mode):
            yield row(written, *measure_writing(written, programs, options.inputs, options.repetitions))
    if options.corpus and (programs / "bench_read_ufbx").exists():
        yield "\n| corpus, against ufbx | files | mean ratio | goal | slowest |"
        yield "|---|---:|---:|---|---|"
        yield from corpus_rows(programs, options.corpus, options.repetitions)


def main() -> None:
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("build", type=Path)
    parser.add_argument("inputs", type=Path)
    parser.add_argument("--repetitions", type=int, default=5)
    parser.add_argument("--corpus", type=Path)
    parser.add_argument("--only", default="", metavar="WORD", help="only workloads with this word in title or file")
    parser.add_argument("--record", type=Path, metavar="FILE")
    options = parser.parse_args()

    lines = []
    for line in tables(options):
        print(line, flush=True)
        lines.append(line)
    if options.record:
        record(options.record, "\n".join(lines))


if __name__ == "__main__":
    main()
