#!/usr/bin/env python3
"""Runs clang-tidy over the sources that the library, the platform layer and the examples compile on Linux."""

import json

import common

database = common.ROOT / "build/linux"
entries = json.loads((database / "compile_commands.json").read_text())
sources = sorted({e["file"] for e in entries if any(f"/{room}/" in e["file"].replace(str(common.ROOT), "")
                                                    for room in ("basis", "host", "examples"))
                  and "/tests/" not in e["file"].replace(str(common.ROOT), "")})


def check(path):
    result = common.run("clang-tidy", "-p", database, "--quiet", path)
    return [result.stdout] if result.returncode else []


problems = [text for found in common.in_parallel(check, sources) for text in found]
common.finish("tidy", problems, len(sources))
