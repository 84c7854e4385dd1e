#!/usr/bin/env python3
"""Every source is formatted by clang-format."""

import common

sources = common.files("*.h", "*.cpp", "*.c")


def check(path):
    result = common.run("clang-format", "--dry-run", "-Werror", path)
    return [] if result.returncode == 0 else [result.stderr.split("\n", 1)[0]]


problems = [line for found in common.in_parallel(check, sources) for line in found]
common.finish("format", problems, len(sources))
