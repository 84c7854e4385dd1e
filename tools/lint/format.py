#!/usr/bin/env python3
"""Every source is formatted by clang-format."""

import re

import common

sources = common.files("*.h", "*.cpp", "*.c")


def check(paths):
    """Many files in one process: it takes longer to start than to read one."""
    result = common.run("clang-format", "--dry-run", "-Werror", *paths)
    first = {message[1]: message[0] for message in reversed(list(re.finditer(r"^(.+?):\d+:.*", result.stderr, re.M)))}
    return list(first.values()) or ([result.stderr] if result.returncode else [])


problems = [line for found in common.in_parallel(check, [sources[::2], sources[1::2]]) for line in found]
common.finish("format", problems, len(sources))
