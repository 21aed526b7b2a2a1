#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Compares two builds of ours, run in turn: the median of the ratios of adjacent runs, new over old.

A slow-down of a few per cent disappears in the noise of separate measurements; in pairs it shows.

    compare_builds.py OLD_BUILD_FOLDER NEW_BUILD_FOLDER INPUT_FOLDER [--repetitions N] [--only WORD]

Exit status 1 when a workload got slower by more than 5 per cent and by more than its noise.
"""
import argparse
import statistics
import sys
from pathlib import Path

from compare import WORKLOADS, WRITTEN, run

MOST = 1.05


def pairs(title: str, command, old: Path, new: Path, repetitions: int) -> bool:
    """Prints a line. False for a slow-down."""
    ratios = []
    for repetition in range(repetitions):
        order = (old, new) if repetition % 2 == 0 else (new, old)
        seconds = {build: command(build) for build in order}
        ratios.append(seconds[new] / seconds[old])
    ratios.sort()
    middle, low = statistics.median(ratios), ratios[len(ratios) // 4]
    slower = middle > MOST and low > 1.0
    print(f"{middle:6.3f}  ({ratios[0]:.3f} to {ratios[-1]:.3f})  {title}{'  SLOWER' if slower else ''}", flush=True)
    return not slower


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("old", type=Path)
    parser.add_argument("new", type=Path)
    parser.add_argument("inputs", type=Path)
    parser.add_argument("--repetitions", type=int, default=9)
    parser.add_argument("--only", default="", metavar="WORD")
    options = parser.parse_args()

    good = True
    for file, mode in dict.fromkeys((w.file, w.mode) for w in WORKLOADS):
        title = f"{file} {mode}"
        if options.only in title:
            read = lambda build: run(build / "bench/bench_read_tarnell", mode, options.inputs / file).seconds  # noqa: E731
            good &= pairs(title, read, options.old, options.new, options.repetitions)
    output = options.inputs / "written.fbx"
    for written in WRITTEN:
        title = f"written {written.mode}"
        if options.only in title:
            write = lambda build: run(build / "bench/bench_write_tarnell", written.mode, output).seconds  # noqa: E731
            good &= pairs(title, write, options.old, options.new, options.repetitions)
    output.unlink(missing_ok=True)
    return 0 if good else 1


if __name__ == "__main__":
    sys.exit(main())
