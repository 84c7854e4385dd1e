#!/usr/bin/env python3
"""bench_report.py FOLDER [FAMILY...]: runs the benchmark programs and compares each row with its peers and its goal.

Benchmarks are named `row/who`, where who is `ours` or a peer. bench/FAMILY/goals.txt contains the goals, one per line:

    ROW-GLOB <= RATIO x PEER          our time is at most RATIO times the peer's
    ROW-GLOB <= RATIO x min(A,B)      … the time of the fastest of several

Repetitions of all rows are interleaved; the median counts. Ties by noise: 10 %, rows under 5 ns 30 %, rows that name
two or more threads 50 %.
"""

import fnmatch
import json
import re
import subprocess
import sys
from pathlib import Path

ROOT = Path(__file__).resolve().parents[1]
GOAL = re.compile(r"^(\S+)\s*<=\s*([\d.]+)\s*x\s*(?:min\(([^)]*)\)|(\S+))$")


def read_goals(family):
    goals = []
    for line in (ROOT / "bench" / family / "goals.txt").read_text().splitlines():
        line = line.split("#")[0].strip()
        if line:
            match = GOAL.match(line)
            if not match:
                sys.exit(f"bench/{family}/goals.txt: cannot read '{line}'")
            peers = [p.strip() for p in (match[3] or match[4]).split(",")]
            goals.append((match[1], float(match[2]), peers))
    return goals


def measure(program):
    report = program.parent / f"{program.name}.json"
    command = [program, "--benchmark_enable_random_interleaving=true", "--benchmark_repetitions=9",
               "--benchmark_min_time=0.05", "--benchmark_report_aggregates_only=true",
               f"--benchmark_out={report}", "--benchmark_out_format=json"]
    subprocess.run([str(c) for c in command], check=True, stdout=subprocess.DEVNULL)
    rows = {}
    for entry in json.loads(report.read_text())["benchmarks"]:
        if entry.get("aggregate_name") != "median":
            continue
        name = re.sub(r"/(manual_time|real_time|process_time|iterations:\d+|threads:\d+|repeats:\d+|min_time:[\d.]+)"
                      r"|/\d+$",
                      "", entry["run_name"])
        row, who = name.rsplit("/", 1)
        scale = {"ns": 1, "us": 1e3, "ms": 1e6, "s": 1e9}[entry["time_unit"]]
        rows.setdefault(row, {})[who] = entry["real_time"] * scale
    return rows


def tolerance(row, ours):
    if re.search(r"threads|contended", row):
        return 1.5
    return 1.3 if ours < 5 else 1.1


def report(family, rows, goals):
    print(f"\n{family}: ns, medians of interleaved repetitions")
    missed = 0
    for row, times in sorted(rows.items()):
        cells = "  ".join(f"{who} {time:.4g}" for who, time in sorted(times.items()))
        print(f"  {row:44} {cells}")
        for glob, ratio, peers in goals:
            if not fnmatch.fnmatchcase(row, glob) or "ours" not in times:
                continue
            present = [times[p] for p in peers if p in times]
            if not present:
                print(f"  {'':44} goal: {ratio:g} x {'/'.join(peers)}, which was not measured")
                continue
            reached = times["ours"] / min(present)
            is_tie = reached <= ratio * tolerance(row, times["ours"])
            verdict = "met" if reached <= ratio else "tie" if is_tie else "MISSED"
            missed += verdict == "MISSED"
            print(f"  {'':44} {reached:.2f} x {'/'.join(peers)}, goal {ratio:g}: {verdict}")
    return missed


def main():
    folder, families = Path(sys.argv[1]), sys.argv[2:]
    programs = sorted(p for p in folder.glob("bench_*") if p.suffix == "")
    chosen = [p for p in programs if not families or p.name.removeprefix("bench_") in families]
    if not chosen:
        sys.exit(f"no such family; there are: {' '.join(p.name.removeprefix('bench_') for p in programs)}")
    missed = 0
    for program in chosen:
        family = program.name.removeprefix("bench_")
        missed += report(family, measure(program), read_goals(family))
    print(f"\n{missed} goals missed")


main()
