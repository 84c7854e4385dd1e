#!/usr/bin/env python3
"""bench_report.py FOLDER [FAMILY...]: runs the benchmark programs and compares each row with its peers and its goal.

Benchmarks are named `row/who`, where who is `ours` or a peer. bench/FAMILY/goals.txt contains the goals, one per line:

    ROW-GLOB <= RATIO x PEER          our time is at most RATIO times the peer's
    ROW-GLOB <= RATIO x min(A,B)      … the time of the fastest of several

Repetitions of all rows are interleaved; the median counts. Ties by noise: 10 %, rows under 5 ns 30 %, rows that name
two or more threads 50 %. A row that misses its goal is measured again in two fresh processes, and the median of the
three ratios counts. Ends with how noisy the run was. Exits with 1 where a goal is missed.
"""

import fnmatch
import json
import os
import re
import statistics
import subprocess
import sys
from pathlib import Path

ROOT = Path(__file__).resolve().parents[1]
GOAL = re.compile(r"^(\S+)\s*<=\s*([\d.]+)\s*x\s*(?:min\(([^)]*)\)|(\S+))$")
# What the benchmark library appends to a name.
SUFFIX = re.compile(r"/(?:manual_time|real_time|process_time|iterations:\d+|threads:\d+|repeats:\d+|min_time:[\d.]+)"
                    r"|/\d+$")
NANOSECONDS = {"ns": 1, "us": 1e3, "ms": 1e6, "s": 1e9}
LEVELS = ("sse2", "ssse3", "avx2")  # those that kernels choose from
LEVELS_WITH_GOALS = ("ssse3", "avx2")
FRESH_PROCESSES = 2


def processor():
    """The processor's name, and those of the levels that it has."""
    facts = {}
    for line in Path("/proc/cpuinfo").read_text().splitlines():
        name, _, value = line.partition(":")
        facts.setdefault(name.strip(), value.strip())
    levels = [level for level in LEVELS if level in facts["flags"].split()]
    return f"{facts['model name']}, family {facts['cpu family']} model {facts['model']}", levels


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


def escaped(name):
    """A name in a regular expression of the benchmark library, which refuses escapes that are not needed."""
    return re.sub(r"[].*+?^${}()|[\\]", r"\\\g<0>", name)


def measure(program, wanted=(), level=None):
    """{row: {who: (median in ns, coefficient of variation)}} of one process; all rows unless some are wanted."""
    environment = dict(os.environ, BENCH_VECTORS=level) if level else None
    output = program.parent / f"{program.name}.json"
    command = [program, "--benchmark_enable_random_interleaving=true", "--benchmark_repetitions=9",
               "--benchmark_min_time=0.05", "--benchmark_report_aggregates_only=true",
               f"--benchmark_out={output}", "--benchmark_out_format=json"]
    if wanted:
        command.append(f"--benchmark_filter=^({'|'.join(map(escaped, wanted))})/")
    subprocess.run([str(c) for c in command], check=True, stdout=subprocess.DEVNULL, env=environment)
    rows = {}
    for entry in json.loads(output.read_text())["benchmarks"]:
        row, who = SUFFIX.sub("", entry["run_name"]).rsplit("/", 1)
        cell = rows.setdefault(row, {}).setdefault(who, [0, 0])
        if entry.get("aggregate_name") == "median":
            cell[0] = entry["real_time"] * NANOSECONDS[entry["time_unit"]]
        elif entry.get("aggregate_name") == "cv":
            cell[1] = entry["real_time"]
    return rows


def tolerance(row, ours):
    if re.search(r"threads|contended", row):
        return 1.5
    return 1.3 if ours < 5 else 1.1


def ratio_of(times, peers):
    """Our time over that of the fastest of the peers; None where one of both was not measured."""
    present = [times[p][0] for p in peers if p in times]
    return times["ours"][0] / min(present) if present and "ours" in times else None


def verdict(row, ratio, goal, ours):
    if ratio <= goal:
        return "met"
    return "tie" if ratio <= goal * tolerance(row, ours) else "MISSED"


def judge(rows, goals):
    """{(row, goal number): ratio} of all goals of all rows."""
    return {(row, number): ratio_of(times, peers) for row, times in rows.items()
            for number, (glob, _, peers) in enumerate(goals) if fnmatch.fnmatchcase(row, glob) and "ours" in times}


def judge_again(program, rows, goals, ratios, level):
    """Replaces the ratios of missed rows by the median of several processes."""
    missed = [key for key, ratio in ratios.items() if ratio is not None
              and verdict(key[0], ratio, goals[key[1]][1], rows[key[0]]["ours"][0]) == "MISSED"]
    if not missed:
        return
    names = sorted({row for row, _ in missed})
    runs = [ratios, *(judge(measure(program, names, level), goals) for _ in range(FRESH_PROCESSES))]
    ratios.update({key: statistics.median(run[key] for run in runs) for key in missed})


def report(title, rows, goals, ratios):
    print(f"{title}: ns, medians of interleaved repetitions, ± their coefficient of variation")
    verdicts = []
    for row, times in sorted(rows.items()):
        cells = "  ".join(f"{who} {time:.4g} ±{spread:.0%}" for who, (time, spread) in sorted(times.items()))
        print(f"  {row:44} {cells}")
        for number, (_, goal, peers) in enumerate(goals):
            if (row, number) not in ratios:
                continue
            ratio = ratios[row, number]
            if ratio is None:
                print(f"  {'':44} goal: {goal:g} x {'/'.join(peers)}, which was not measured")
                continue
            verdicts.append(verdict(row, ratio, goal, times["ours"][0]))
            print(f"  {'':44} {ratio:.2f} x {'/'.join(peers)}, goal {goal:g}: {verdicts[-1]}")
    return verdicts


def noise(spreads):
    """How much the rows' repetitions varied, in one line."""
    ordered = sorted(spreads)
    level = lambda part: f"{ordered[min(int(part * len(ordered)), len(ordered) - 1)]:.0%}"
    return (f"noise: repetitions vary by {level(0.5)} in the middle row, by more than {level(0.9)} in one row of ten, "
            f"by {level(1)} at most; {os.getloadavg()[0]:.1f} programs run on {os.cpu_count()} processors")


def runs_of(programs, levels):
    """(program, family, level to force or None) of each run."""
    for program in programs:
        family = program.name.removeprefix("bench_")
        yield program, family, None
        lower = program.with_name(f"levels_{family}")
        if lower.exists():
            yield from ((lower, family, level) for level in reversed(levels[:-1]))


def main():
    folder, families = Path(sys.argv[1]), sys.argv[2:]
    programs = sorted(p for p in folder.glob("bench_*") if p.suffix == "")
    chosen = [p for p in programs if not families or p.name.removeprefix("bench_") in families]
    if not chosen:
        sys.exit(f"no such family; there are: {' '.join(p.name.removeprefix('bench_') for p in programs)}")
    name, levels = processor()
    print(f"{name}: {', '.join(levels)}")
    verdicts, spreads = [], []
    for program, family, level in runs_of(chosen, levels):
        title = f"{family} at level {level}" if level else f"{family} at level {levels[-1]}"
        print(f"\nmeasuring {title}", flush=True)
        goals = read_goals(family) if level in (None, *LEVELS_WITH_GOALS) else []
        rows = measure(program, level=level)
        ratios = judge(rows, goals)
        judge_again(program, rows, goals, ratios, level)
        verdicts += report(title, rows, goals, ratios)
        spreads += [spread for times in rows.values() for _, spread in times.values()]
    print(f"\n{noise(spreads)}")
    print(f"{verdicts.count('met')} goals met, {verdicts.count('tie')} ties, {verdicts.count('MISSED')} missed")
    sys.exit(1 if "MISSED" in verdicts else 0)


main()
