#!/usr/bin/env python3
"""Shows how much of the library the tests reach, from what gcovr has counted, and what they do not.

    tools/coverage.py COUNTS.json

Prints a row for each room; writes the places that were not reached to uncovered.txt beside the counts. Exits with 1 if
a goal is missed. Neither branches that only an exception takes count, nor those that the compiler adds where the source
decides nothing: for destructors, first uses and allocations.
"""

import json
import re
import sys
from collections import defaultdict
from pathlib import Path

# Percent of lines and of branches.
GOALS = {"basis": (97, 92), "host": (95, 88)}

DECISION = re.compile(r"\b(?:if|while|for|switch|case)\b|\?|&&|\|\|")


def branches_of(line, text):
    """The branches that count; text is the line's source."""
    if not DECISION.search(text): return []
    return [branch for branch in line["branches"] if not branch.get("throw")]


class Count:
    def __init__(self):
        self.lines = self.reached_lines = self.branches = self.reached_branches = 0

    def add(self, line, text):
        self.lines += 1
        self.reached_lines += line["count"] > 0
        branches = branches_of(line, text)
        self.branches += len(branches)
        self.reached_branches += sum(branch["count"] > 0 for branch in branches)

    def shares(self):
        return (100 * self.reached_lines / max(self.lines, 1), 100 * self.reached_branches / max(self.branches, 1))


def room_of(path):
    parts = path.split("/")
    if parts[0] == "include": return "basis"
    return "/".join(parts[:2])


def missing(line, text):
    """What a line lacks, in words; empty: nothing."""
    if line["count"] == 0: return "never reached"
    branches = branches_of(line, text)
    idle = sum(branch["count"] == 0 for branch in branches)
    return f"{idle} of {len(branches)} branches not taken" if idle else ""


def main():
    counts_file = Path(sys.argv[1])
    rooms, tops, places = defaultdict(Count), defaultdict(Count), []
    for file in sorted(json.loads(counts_file.read_text())["files"], key=lambda f: f["file"]):
        path = file["file"]
        source = Path(path).read_text().split("\n")
        for line in file["lines"]:
            if line.get("gcovr/noncode"): continue
            room = room_of(path)
            number = line["line_number"]
            text = source[number - 1]
            rooms[room].add(line, text)
            tops[room.split("/")[0]].add(line, text)
            if lack := missing(line, text): places.append(f"{path}:{number}: {lack}: {text.strip()}")
    (counts_file.parent / "uncovered.txt").write_text("\n".join(places) + "\n")
    for name, count in sorted(rooms.items()) + sorted(tops.items()):
        print(f"{name:24} {count.lines:6} lines {count.shares()[0]:6.1f} %   "
              f"{count.branches:6} branches {count.shares()[1]:6.1f} %")
    missed = [name for name, goal in GOALS.items() if any(s < g for s, g in zip(tops[name].shares(), goal))]
    for name in missed: print(f"{name} misses its goal: {GOALS[name][0]} % of lines, {GOALS[name][1]} % of branches")
    return 1 if missed else 0


if __name__ == "__main__":
    sys.exit(main())
