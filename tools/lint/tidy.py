#!/usr/bin/env python3
"""clang-tidy over what the library, the platform layer and the examples compile on Linux.

A file that was clean is not read again until it changes, or a header of the project that it includes, its compiler's
command or the checks do; --all reads every file.
"""

import hashlib
import json
import os
from pathlib import Path

import common

BUILD = common.ROOT / "build/linux"
ROOMS = ("basis", "host", "examples")
# The analyzer stops at a third of its usual number of steps. It takes new lines first; the rest mostly repeats them.
OPTIONS = ["--quiet", "--extra-arg=-Wno-unknown-warning-option", "--extra-arg=-Xclang", "--extra-arg=-analyzer-config",
           "--extra-arg=-Xclang", "--extra-arg=max-nodes=75000"]


def sources():
    """The compiler's command for each file."""
    entries = json.loads((BUILD / "compile_commands.json").read_text())
    return {e["file"]: e["command"] for e in entries
            if any(Path(e["file"]).is_relative_to(common.ROOT / room) for room in ROOMS)}


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


def check(path):
    result = common.run("clang-tidy", "-p", BUILD, *OPTIONS, path)
    if result.returncode or result.stdout:
        return result.stdout + result.stderr
    clean.note(path, states[path])
    return ""


headers = included()
states = {path: state(path, command, headers) for path, command in sources().items()}
clean = common.CleanFiles(BUILD / "tidy-clean.json")
changed = sorted(path for path in states if states[path] is None or clean.known.get(path) != states[path])
problems = [text for text in common.in_parallel(check, changed) if text]
common.finish("tidy", problems, len(changed))
