#!/usr/bin/env python3
"""Code that must not compile: with each compiler, the lines marked `// refused` in tests/refused are errors, no other
line is."""

import re

import common

# Without macros tracked, an error in one counts for the line that uses it.
GNU_OPTIONS = ["-fmax-errors=0", "-ftrack-macro-expansion=0"]
COMPILERS = [
    ["g++", *GNU_OPTIONS],
    ["clang++", "-ferror-limit=0"],
    ["x86_64-w64-mingw32-g++-posix", *GNU_OPTIONS],
]
OPTIONS = ["-std=c++20", "-Wall", "-Wextra", "-Werror", "-Iinclude", "-fsyntax-only"]


def marked(path):
    return {number for number, line in enumerate(common.text(path).split("\n"), 1) if line.endswith("// refused")}


def check(job):
    path, compiler = job
    result = common.run(*compiler, *OPTIONS, path)
    place = re.compile(rf"^{re.escape(str(path))}:(\d+):\d+: (?:fatal )?error:", re.M)
    refused = {int(number) for number in place.findall(result.stderr)}
    return ([f"{path}:{line}: {compiler[0]} takes this" for line in sorted(marked(path) - refused)] +
            [f"{path}:{line}: {compiler[0]} refuses this" for line in sorted(refused - marked(path))])


sources = common.files("tests/refused/*.cpp")
jobs = [(path, compiler) for path in sources for compiler in COMPILERS]
problems = [line for found in common.in_parallel(check, jobs) for line in found]
problems += [f"{path} has no line marked `// refused`" for path in sources if not marked(path)]
common.finish("refused", problems, len(jobs))
