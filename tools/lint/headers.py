#!/usr/bin/env python3
"""All public headers compile together with each compiler; headers that say "Valid C" also compile as C, each alone and
twice, which the checker `msvc` sees to for C++. In C++17 every header of the library is refused, and the first error
names C++20."""

import re

import common

CXX = [
    ["g++", "-std=c++20"],
    ["clang++", "-std=c++20"],
    ["x86_64-w64-mingw32-g++-posix", "-std=c++20"],
]
C = [
    ["gcc", "-std=c11"],
    ["clang", "-std=c11"],
    ["x86_64-w64-mingw32-gcc-posix", "-std=c11"],
]
WARNINGS = ["-Wall", "-Wextra", "-Wpedantic", "-Wshadow", "-Werror"]
INCLUDES = ["-Iinclude", "-Ihost/include", "-I."]

headers = common.files("include/**.h", "host/include/*.h", "basis/platform/*.h")


def is_valid_c(path):
    return "Valid C" in common.text(path)[:1500]


def name(path):
    return str(path).removeprefix("host/include/").removeprefix("include/")


def check(job):
    paths, compiler, language = job
    source = "".join(f'#include "{name(path)}"\n' for path in paths)
    if language == "c":
        source += "typedef int zb_not_an_empty_file;\n"
    command = [*compiler, *WARNINGS, *INCLUDES, "-fsyntax-only", "-x", language, "-"]
    result = common.run(*command, input=source)
    return [] if result.returncode == 0 else [f"{paths[0]} with {compiler[0]}:\n{result.stderr}"]


def check_older(job):
    path, compiler = job
    command = [compiler, "-std=c++17", "-Wfatal-errors", *INCLUDES, "-fsyntax-only", "-x", "c++", "-"]
    result = common.run(*command, input=f'#include "{name(path)}"\n')
    first = re.search("error: .*", result.stderr)
    if first and "C++20" in first[0]:
        return []
    return [f"{path} with {compiler}, C++17: {first[0] if first else 'is accepted'}"]


public = [h for h in headers if "windows_api" not in str(h)]
as_c = [h for h in public if is_valid_c(h)]
jobs = [([h, h], C[0], "c") for h in as_c]
jobs += [(public, c, "c++") for c in CXX] + [(as_c, c, "c") for c in C]
older = [(h, compiler[0]) for h in public if h.is_relative_to("include") for compiler in CXX[:2]]
problems = [line for found in common.in_parallel(check, jobs) + common.in_parallel(check_older, older)
            for line in found]
if not any(is_valid_c(h) and h.name == "flat.h" for h in public):
    problems.append("include/zor_basis/flat.h does not say that it is valid C")
common.finish("headers", problems, len(jobs) + len(older))
