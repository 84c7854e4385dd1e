#!/usr/bin/env python3
"""clang-tidy over what the library, the platform layer and the examples compile on Linux.

Sources that are compiled together are also read together. What was clean is not read again until it changes, or a
header of the project that it includes, its compiler's command or the checks do; --all reads everything.
"""

import hashlib
import json
import os
import re
from pathlib import Path

import common

BUILD = common.ROOT / "build/linux"
OWN = BUILD / "tidy"
ROOMS = ("basis", "host", "examples")
# The analyzer reads each function by itself. To follow calls took twice to ten times as long, and found nothing more
# when it was last tried.
OPTIONS = ["--quiet", "--extra-arg=-Wno-unknown-warning-option", "--extra-arg=-Xclang", "--extra-arg=-analyzer-config",
           "--extra-arg=-Xclang", "--extra-arg=mode=shallow"]


def compiled():
    """The compiler's command for each file."""
    entries = json.loads((BUILD / "compile_commands.json").read_text())
    return {e["file"]: e["command"] for e in entries
            if any(Path(e["file"]).is_relative_to(top / room) for room in ROOMS for top in (common.ROOT, BUILD))}


def included():
    """The project's files behind each source, as the last build saw them."""
    found, files = {}, []
    for line in common.run("ninja", "-C", BUILD, "-t", "deps").stdout.split("\n"):
        if line.startswith(" "):
            files.append(os.path.normpath(BUILD / line.strip()))
        elif files:
            found[files[0]] = sorted(f for f in files if Path(f).is_relative_to(common.ROOT) and Path(f).is_file())
            files = []
    return found


def state(path, command, headers):
    """What the result for a file depends on; None where the build does not know its headers."""
    if path not in headers:
        return None
    checks = (common.ROOT / ".clang-tidy").read_bytes()
    parts = [command.encode(), *map(str.encode, OPTIONS), checks, *(Path(f).read_bytes() for f in headers[path])]
    return hashlib.sha256(b"\0".join(parts)).hexdigest()


class Read:
    """What clang-tidy reads for a file of the build. The analyzer leaves out what a file includes, so sources that are
    compiled together are copied into one file."""

    def __init__(self, path):
        self.path, self.sources, self.origins = Path(path), [], []
        if self.path.is_relative_to(BUILD):
            self.sources = re.findall(r'^#include "(.+)"$', self.path.read_text(), re.M)
            self.copy()

    def copy(self):
        self.path, lines = OWN / self.path.name, []
        for source in self.sources:
            lines += Path(source).read_text().splitlines()
            self.origins += [f"{source}:{line}:" for line in range(1, len(lines) - len(self.origins) + 1)]
        self.path.write_text("\n".join(lines) + "\n")

    def named_by_origin(self, text):
        """Messages with the places that the lines were copied from."""
        if not self.origins:
            return text
        return re.sub(re.escape(str(self.path)) + r":(\d+):", lambda found: self.origins[int(found[1]) - 1], text)


def check(path):
    result = common.run("clang-tidy", "-p", OWN, *OPTIONS, read[path].path)
    if result.returncode or result.stdout:
        return read[path].named_by_origin(result.stdout + result.stderr)
    clean.note(path, states[path])
    return ""


OWN.mkdir(exist_ok=True)
commands, headers = compiled(), included()
read = {path: Read(path) for path in commands}
joined = {source for path in read for source in read[path].sources}
for path in joined & commands.keys(): # a test program compiles it too
    del commands[path]
(OWN / "compile_commands.json").write_text(json.dumps(
    [{"directory": str(BUILD), "file": str(read[path].path), "command": command.replace(path, str(read[path].path))}
     for path, command in commands.items()]))
states = {path: state(path, command, headers) for path, command in commands.items()}
clean = common.CleanFiles(BUILD / "tidy-clean.json")
changed = sorted(path for path in states if states[path] is None or clean.known.get(path) != states[path])
problems = [text for text in common.in_parallel(check, changed) if text]
common.finish("tidy", problems, len(changed))
