#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Counts the instructions and allocations of small workloads and compares them with costs.json.

Neither depends on how busy the machine is: more than 5 per cent above the recorded number is a change of ours. Whoever
means it records the new numbers with --update, and says why in the commit.

    costs.py BUILD_FOLDER [--update]

Without valgrind only the allocations are compared.
"""
import argparse
import json
import re
import shutil
import subprocess
import sys
import tempfile
from pathlib import Path

MOST = 1.05
SCALE = "0.01"
RECORD = Path(__file__).with_name("costs.json")
READS = [("big_mesh_raw", "mesh"), ("big_mesh_compressed", "mesh"), ("big_mesh_ascii", "mesh"),
         ("big_mesh_raw", "cameras"), ("rig", "cameras"), ("rig", "local"), ("rig", "global"), ("animation", "local"),
         ("animation", "global")]
WRITES = ["mesh", "meshAscii", "nodes", "nodesAscii"]


def measured(command: list, valgrind: str | None) -> dict:
    """The allocations of one run, and the instructions of another."""
    printed = subprocess.run(command, capture_output=True, text=True, check=True).stdout
    cost = {"allocations": json.loads(printed)["allocations"]}
    if valgrind:
        tool = [valgrind, "--tool=callgrind", "--instr-atstart=no", "--callgrind-out-file=/dev/null"]
        report = subprocess.run(tool + command, capture_output=True, text=True, check=True).stderr
        cost["instructions"] = int(re.search(r"Collected : (\d+)", report)[1])
    return cost


def all_costs(programs: Path, valgrind: str | None) -> dict:
    costs = {}
    # Always in the same folder: longer file names take more allocations.
    with tempfile.TemporaryDirectory(dir="/tmp") as folder:
        subprocess.run([programs / "generate_inputs", folder, SCALE], check=True)
        for name, mode in READS:
            command = [programs / "bench_read_tarnell", mode, Path(folder) / f"{name}.fbx"]
            costs[f"read {name}, {mode}"] = measured([str(part) for part in command], valgrind)
        for mode in WRITES:
            command = [programs / "bench_write_tarnell", mode, Path(folder) / "written.fbx", SCALE]
            costs[f"write {mode}"] = measured([str(part) for part in command], valgrind)
    return costs


def growth(old: dict, new: dict) -> list[str]:
    lines = []
    for workload, cost in new.items():
        for what, number in cost.items():
            known = old.get(workload, {}).get(what)
            if known is None:
                lines.append(f"{workload}: {what} are not recorded")
            elif number > known * MOST:
                lines.append(f"{workload}: {number:,} {what}, {number / known - 1:.1%} more than {known:,}")
            elif number * MOST < known:
                print(f"{workload}: {number:,} {what}, {1 - number / known:.1%} fewer than {known:,}")
    return lines


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("build", type=Path)
    parser.add_argument("--update", action="store_true")
    options = parser.parse_args()

    valgrind = shutil.which("valgrind")
    if not valgrind:
        print("valgrind is not installed: instructions are not counted")
    costs = all_costs(options.build / "bench", valgrind)
    if options.update:
        RECORD.write_text(json.dumps(costs, indent=2) + "\n", encoding="utf-8")
        return 0
    lines = growth(json.loads(RECORD.read_text(encoding="utf-8")), costs)
    print("\n".join(lines))
    return 1 if lines else 0


if __name__ == "__main__":
    sys.exit(main())
