#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Compares reading and writing with Tarnell FBX and with assimp, and prints tables in Markdown.

Each workload runs as a pair of processes, ours and the peer's in turn, so that both meet the same state of the
machine. The answers are proven equal first, for written files by reading them; what is reported is the median time of
the read or write call, the median peak of resident memory of the process, the size of written files, and their ratios.

    compare.py BUILD_FOLDER INPUT_FOLDER [--repetitions N]

Written files go to INPUT_FOLDER, too, and are removed.
"""
import argparse
import json
import os
import platform
import statistics
import subprocess
import sys
from dataclasses import dataclass
from pathlib import Path

# Floats are compared: coordinates up to 1000 in both programs.
BOX_TOLERANCE = 1e-4


@dataclass(frozen=True)
class Workload:
    title: str
    file: str
    mode: str
    goal: str  # what docs/benchmarks.md promises
    peer_mode: str | None  # None: there is no answer of the peer's to compare with


WORKLOADS = [
    Workload("big mesh, binary", "big_mesh_raw.fbx", "mesh", "time and memory ≤ 0.5", "mesh"),
    Workload("big mesh, binary, compressed", "big_mesh_compressed.fbx", "mesh", "", "mesh"),
    Workload("big mesh, ASCII", "big_mesh_ascii.fbx", "mesh", "", "mesh"),
    Workload("10 cameras beside the big mesh", "big_mesh_raw.fbx", "cameras", "time ≤ 0.1", "cameras"),
    Workload("200 meshes, compressed", "many_meshes.fbx", "mesh", "", "mesh"),
    Workload("10 cameras beside 200 meshes", "many_meshes.fbx", "cameras", "", "cameras"),
    Workload("500 nodes, local samples of 2,000 frames", "animation.fbx", "local", "", "local"),
    Workload("500 nodes, world samples of 2,000 frames", "animation.fbx", "global", "", None),
]


@dataclass(frozen=True)
class Written:
    title: str
    mode: str
    goal: str
    read_mode: str  # in which the written file is read, to compare what is in it


WRITTEN = [
    Written("mesh of 2,000,000 polygon vertices, binary", "mesh", "time ≤ 0.5", "mesh"),
    Written("the same, ASCII", "meshAscii", "time ≤ 0.5", "mesh"),
    Written("500 nodes, a key on each of 2,000 frames, binary", "nodes", "", "local"),
    Written("the same, ASCII", "nodesAscii", "", "local"),
]


@dataclass
class Run:
    answer: dict
    seconds: float
    megabytes: float
    file_megabytes: float = 0.0


def run(program: Path, mode: str, file: Path) -> Run:
    """One process: its answer, the time that it took by itself, and its peak of resident memory."""
    process = subprocess.Popen([program, mode, file], stdout=subprocess.PIPE, text=True)
    output = process.stdout.read()
    _, status, usage = os.wait4(process.pid, 0)
    if status != 0:
        sys.exit(f"{program.name} {mode} {file.name} failed")
    answer = json.loads(output)
    return Run(answer, answer.pop("seconds"), usage.ru_maxrss / 1024)


def prove_equal(workload: Workload | Written, ours: dict, theirs: dict) -> None:
    equal = ours["count"] == theirs["count"] and all(
        abs(a - b) <= BOX_TOLERANCE for key in ("minimum", "maximum") for a, b in zip(ours[key], theirs[key]))
    if not equal:
        sys.exit(f"{workload.title}: the answers differ\n  ours:   {ours}\n  assimp: {theirs}")


def measure(workload: Workload, build: Path, inputs: Path, repetitions: int) -> tuple[list[Run], list[Run]]:
    file = inputs / workload.file
    ours, theirs = [], []
    for _ in range(repetitions):
        ours.append(run(build / "bench" / "bench_read_tarnell", workload.mode, file))
        if workload.peer_mode:
            theirs.append(run(build / "bench" / "bench_read_assimp", workload.peer_mode, file))
            prove_equal(workload, ours[-1].answer, theirs[-1].answer)
    return ours, theirs


def measure_writing(workload: Written, build: Path, folder: Path, repetitions: int) -> tuple[list[Run], list[Run]]:
    runs = {"tarnell": [], "assimp": []}
    for repetition in range(repetitions):
        answers = []
        for program, results in runs.items():
            file = folder / f"written_by_{program}.fbx"
            result = run(build / "bench" / f"bench_write_{program}", workload.mode, file)
            result.file_megabytes = file.stat().st_size / 1e6
            results.append(result)
            if repetition == 0:
                answers.append(run(build / "bench" / "bench_read_tarnell", workload.read_mode, file).answer)
            file.unlink()
        if answers:
            prove_equal(workload, *answers)
    return runs["tarnell"], runs["assimp"]


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
    line = (f"| {workload.title} | {cells(ours, theirs, lambda r: r.seconds * 1000, '.1f')} | {noise:.0%} "
            f"| {cells(ours, theirs, lambda r: r.megabytes, '.0f')} ")
    if isinstance(workload, Written):
        line += f"| {cells(ours, theirs, lambda r: r.file_megabytes, '.0f')} "
    return line + f"| {workload.goal} |"


def processor() -> str:
    try:
        for line in Path("/proc/cpuinfo").read_text().splitlines():
            if line.startswith("model name"):
                return line.split(":", 1)[1].strip()
    except OSError:
        pass
    return platform.machine()


def main() -> None:
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("build", type=Path)
    parser.add_argument("inputs", type=Path)
    parser.add_argument("--repetitions", type=int, default=5)
    options = parser.parse_args()

    print(f"{processor()}, {os.cpu_count()} threads, {platform.system()}; medians of {options.repetitions} runs\n")
    print("| workload | ours, ms | assimp, ms | ratio | spread | ours, MB | assimp, MB | ratio | goal |")
    print("|---|---:|---:|---:|---:|---:|---:|---:|---|")
    for workload in WORKLOADS:
        print(row(workload, *measure(workload, options.build, options.inputs, options.repetitions)), flush=True)

    print("\n| written | ours, ms | assimp, ms | ratio | spread | ours, MB | assimp, MB | ratio "
          "| ours, file MB | assimp, file MB | ratio | goal |")
    print("|---|---:|---:|---:|---:|---:|---:|---:|---:|---:|---:|---|")
    for written in WRITTEN:
        print(row(written, *measure_writing(written, options.build, options.inputs, options.repetitions)), flush=True)


if __name__ == "__main__":
    main()
