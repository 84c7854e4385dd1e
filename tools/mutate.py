#!/usr/bin/env python3
"""Changes the library one place at a time and reports the changes that no test notices.

    tools/mutate.py [ROOM] [N] [--seed S] [--list]

ROOM is a folder like `basis/text` or its last part; without one, every room is drawn from. N mutants (by default 50)
are drawn that have no result yet. Results are kept in build/mutate/results.json under what a file and its mutant
contain, so that a later run continues where this one ends, and a changed file is examined anew. Linux only: what
Windows alone compiles is left out.

A mutant may remove files or kill processes. The tests therefore run where they can write only to memory and see only
each other's processes, which needs root; without it nothing is run.
"""

import argparse
import hashlib
import json
import os
import random
import re
import shutil
import subprocess
import sys
import time
from pathlib import Path

ROOT = Path(__file__).resolve().parent.parent
WORK = ROOT / "build/mutate"
COPY = WORK / "src"
BUILD = WORK / "build"
RESULTS = WORK / "results.json"
JOBS = str(os.cpu_count() or 1)

# The programs that test a room, those first that tell most.
PROGRAMS = {
    "basis/ground": ["ground_tests"],
    "basis/text": ["text_tests", "ground_tests", "store_tests", "flat_tests"],
    "basis/containers": ["containers_tests", "store_tests"],
    "basis/memory": ["memory_tests", "containers_tests"],
    "basis/sync": ["sync_tests", "timers_tests", "log_tests"],
    "basis/files": ["files_tests", "system_tests", "walk_tests", "store_tests"],
    "basis/store": ["store_tests"],
    "basis/walk": ["walk_tests"],
    "basis/timers": ["timers_tests", "flat_tests"],
    "basis/log": ["log_tests"],
    "basis/system": ["system_tests", "flat_tests"],
    "basis/crypto": ["crypto_tests", "crypto_memory_tests"],
    "basis/flat": ["flat_tests"],
    "host/xos_basics/files": ["host_files_tests", "host_inner_tests", "host_directories_tests"],
    "host/xos_basics/directories": ["host_directories_tests", "walk_tests"],
    "host/xos_basics": ["host_inner_tests", "host_basics_tests"],
    "host/xos_url": ["host_url_inner_tests", "host_url_tests"],
    "host/hq_basis": ["host_basics_tests"],
    "host": ["host_control_link_tests", "host_basics_tests"],
}
# What the programs of host/ start.
HELPERS = ["host_child", "module_child"]

# What a mutant's tests run in: the file system can only be read but for folders in memory, and processes are their own.
SANDBOX = ["unshare", "--mount", "--pid", "--fork", "--mount-proc", "--kill-child", "sh", "-c", """
    mount --make-rprivate / && mount -o remount,bind,ro / || exit 125
    for folder in /tmp /dev/shm /run; do mount -t tmpfs -o size=300m,mode=1777 tmpfs $folder || exit 125; done
    mkdir -m 1777 /run/lock && cd /tmp && exec "$@"
""", "sandbox"]

RELATIONS = {" < ": " <= ", " <= ": " < ", " > ": " >= ", " >= ": " > ", " == ": " != ", " != ": " == "}
LOGIC = {" && ": " || ", " || ": " && "}
ARITHMETIC = {" + ": " - ", " - ": " + ", " * ": " / ", " / ": " * ", " % ": " * ", " += ": " -= ", " -= ": " += ",
              " << ": " >> ", " >> ": " << ", " & ": " | ", " | ": " & ", "++": "--"}
STATEMENT = re.compile(r"^\s+(?!return|throw|delete|using|typedef|static_assert|goto|break|continue|case|default)"
                       r"[A-Za-z_:][\w.:]*(?:->\w+|\[\w+\])*(?: [-+|&]?= .*|\(.*\)|(?:->|\.)\w+\(.*\)|\+\+|--);$")
RETURN = re.compile(r"^(\s+)return (.+);$")
CONDITION = re.compile(r"\b(if|while) \((?!constexpr)([^;]*)\)( |$)")
NUMBER = re.compile(r"(?<![\w.'\"])(\d+)(?![\w.'])")
PAIR = re.compile(r"\b(\w+)\(([A-Za-z_][\w.]*), ([A-Za-z_][\w.]*)\)")


def code_of(line):
    """The line without its comment and with the insides of its texts blanked, at the same places."""
    line = re.sub(r'"(?:\\.|[^"\\])*"|\'(?:\\.|[^\'\\])\'', lambda m: '"' + "_" * (len(m[0]) - 2) + '"', line)
    return re.sub(r"//.*", "", line)


def mutants_of(line):
    """Pairs of an operator's name and the changed line."""
    code = code_of(line)
    stripped = code.strip()
    if not stripped or stripped.startswith(("#", "template", "static_assert", "using ", "namespace")): return

    def at(position, old, new):
        return line[:position] + new + line[position + len(old):]

    for name, table in (("relation", RELATIONS), ("logic", LOGIC), ("arithmetic", ARITHMETIC)):
        for old, new in table.items():
            for match in re.finditer(re.escape(old), code): yield name, at(match.start(), old, new)
    for match in NUMBER.finditer(code): yield "constant", at(match.start(1), match[1], str(int(match[1]) + 1))
    for match in re.finditer(r"\b(?:true|false)\b", code):
        yield "constant", at(match.start(), match[0], "false" if match[0] == "true" else "true")
    match = CONDITION.search(code)
    if match and match[2].count("(") == match[2].count(")"):
        yield "condition", at(match.start(2), match[2], f"!({line[match.start(2):match.end(2)]})")
    if STATEMENT.match(code.rstrip()): yield "statement", re.match(r"\s*", line)[0] + ";"
    match = RETURN.match(code.rstrip())
    if match and match[2] not in ("true", "false", "*this") and not match[2].isdigit():
        yield "return", match[1] + "return {};"
    for match in PAIR.finditer(code):
        if match[2] != match[3]: yield "arguments", at(match.start(), match[0], f"{match[1]}({match[3]}, {match[2]})")


def room_of(path):
    for room in sorted(PROGRAMS, key=len, reverse=True):
        if path.startswith(room + "/"): return room
    return None


def sources():
    for path in subprocess.run(["git", "ls-files", "basis", "host"], cwd=ROOT, check=True, capture_output=True,
                               text=True).stdout.split():
        if path.endswith(".cpp") and not path.endswith("_win.cpp") and room_of(path): yield path


def all_mutants(wanted):
    """Every mutant of the wanted rooms: path, number of the line, operator, the changed line, key."""
    for path in sources():
        room = room_of(path)
        if wanted and wanted not in (room, room.split("/")[-1]): continue
        text = (ROOT / path).read_text()
        digest = hashlib.sha1(text.encode()).hexdigest()
        for number, line in enumerate(text.split("\n")):
            for operator, changed in mutants_of(line):
                key = hashlib.sha1(f"{path} {digest} {number} {changed}".encode()).hexdigest()[:16]
                yield path, number, operator, changed, key


def build(targets):
    return subprocess.run(["cmake", "--build", str(BUILD), "--parallel", JOBS, "--target", *targets],
                          capture_output=True, text=True)


def prepare():
    """Copies the sources and builds all programs unchanged."""
    listed = subprocess.run(["git", "ls-files", "-co", "--exclude-standard"], cwd=ROOT, check=True,
                            capture_output=True, text=True).stdout.split("\n")
    for path in filter(None, listed):
        target = COPY / path
        source = ROOT / path
        if not source.is_file(): continue
        if target.is_file() and target.read_bytes() == source.read_bytes(): continue
        target.parent.mkdir(parents=True, exist_ok=True)
        shutil.copy(source, target)
    if not (BUILD / "build.ninja").exists():
        subprocess.run(["cmake", "-S", str(COPY), "-B", str(BUILD), "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Debug",
                        "-DCMAKE_CXX_FLAGS_DEBUG=-O1 -g0", "-DZB_JOINED_TESTS=ON", "-DZB_TESTS_BY_ROOM=ON",
                        "-DZB_BUILD_EXAMPLES=OFF"], check=True, capture_output=True)


def run(program, limit):
    """Whether a program's tests succeed, and for how long they run."""
    start = time.monotonic()
    command = SANDBOX + ["timeout", "-s", "KILL", str(limit), str(BUILD / "bin" / program), "--gtest_brief=1",
                         "--gtest_fail_fast"]
    status = subprocess.run(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL,
                            stdin=subprocess.DEVNULL).returncode
    if status == 125: sys.exit("The tests cannot be kept from the file system here; mutants are run as root only.")
    return status == 0, time.monotonic() - start


class Campaign:
    def __init__(self):
        self.results = json.loads(RESULTS.read_text()) if RESULTS.exists() else {}
        self.limits = {}
        self.ready = set()

    def make_ready(self, room):
        """Builds a room's programs unchanged and measures them."""
        if room in self.ready: return
        built = build(PROGRAMS[room] + (HELPERS if room.startswith("host") else []))
        if built.returncode != 0: sys.exit(built.stdout[-3000:])
        for program in PROGRAMS[room]:
            if program in self.limits: continue
            good, seconds = run(program, 300)
            if not good: sys.exit(f"{program} fails without any change.")
            self.limits[program] = 10 + 4 * seconds
        self.ready.add(room)

    def verdict(self, room):
        """Of the mutant that lies in the copy."""
        for program in PROGRAMS[room]:
            if build([program]).returncode != 0: return "refused"
            if not run(program, self.limits[program])[0]: return "killed"
        return "survived"

    def examine(self, mutant):
        path, number, operator, changed, key = mutant
        room = room_of(path)
        self.make_ready(room)
        file = COPY / path
        original = file.read_text()
        lines = original.split("\n")
        was = lines[number].strip()
        lines[number] = changed
        try:
            file.write_text("\n".join(lines))
            verdict = self.verdict(room)
        finally:
            file.write_text(original)
        self.results[key] = {"path": path, "line": number + 1, "operator": operator, "was": was, "now": changed.strip(),
                             "verdict": verdict}
        RESULTS.write_text(json.dumps(self.results, indent=1))
        return self.results[key]


def show(results):
    counts = {name: sum(1 for r in results if r["verdict"] == name) for name in ("killed", "survived", "refused")}
    judged = counts["killed"] + counts["survived"]
    share = f"{100 * counts['killed'] / judged:.1f} %" if judged else "-"
    print(f"{judged} mutants, {counts['killed']} killed ({share}), {counts['survived']} survived; "
          f"{counts['refused']} did not compile")


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument("words", nargs="*")
    parser.add_argument("--seed", type=int, default=1)
    parser.add_argument("--list", action="store_true", help="show what survived so far")
    options = parser.parse_args()
    numbers = [int(word) for word in options.words if word.isdigit()]
    rooms = [word for word in options.words if not word.isdigit()]
    names = set(PROGRAMS) | {room.split("/")[-1] for room in PROGRAMS}
    if len(numbers) > 1 or len(rooms) > 1 or not set(rooms) <= names:
        sys.exit("ROOM is one of: " + " ".join(sorted(PROGRAMS)))
    WORK.mkdir(parents=True, exist_ok=True)
    campaign = Campaign()
    mutants = list(all_mutants(rooms[0] if rooms else None))
    known = [campaign.results[key] for *_, key in mutants if key in campaign.results]
    if options.list:
        for result in known:
            if result["verdict"] != "survived": continue
            print(f"{result['path']}:{result['line']}: {result['operator']}\n    {result['was']}\n    {result['now']}")
        return show(known)
    prepare()
    fresh = [mutant for mutant in mutants if mutant[-1] not in campaign.results]
    random.Random(options.seed).shuffle(fresh)
    drawn = sorted(fresh[:numbers[0] if numbers else 50], key=lambda mutant: (room_of(mutant[0]), mutant[0]))
    made = []
    for mutant in drawn:
        result = campaign.examine(mutant)
        made.append(result)
        if result["verdict"] == "survived":
            print(f"{result['path']}:{result['line']}: {result['operator']}\n    {result['was']}\n    {result['now']}",
                  flush=True)
    show(made)
    print("all results: ", end="")
    show(known + made)
    return None


if __name__ == "__main__":
    main()
