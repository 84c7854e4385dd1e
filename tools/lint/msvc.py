#!/usr/bin/env python3
"""What MSVC would make of the library, as far as it can be checked without it.

1. Words and headers that MSVC does not know, in the lines that its preprocessor would leave.
2. Each public header alone and twice, as a program sees it; all of them as the library and a static build see them.
3. Each source for Windows down to its object: only then all members of exported classes are compiled, and clang asks
   whether a function may use its vector instructions. Those that the build compiles together are so here.
4. Virtual functions in the same slots as with the other compilers, and no warnings (C4251, C4275) for users.

It cannot see MSVC's own warnings and errors, the headers of Microsoft's SDK, linking, or anything at run time. What was
clean is not compiled again until a file of the project that it includes changes; --all compiles everything.
"""

import functools
import hashlib
import json
import re
import sys
import tempfile
from pathlib import Path

import common
import msvc_layouts
import msvc_prefixes
import msvc_target
from msvc_target import including

WARNINGS = ["-Wall", "-Wextra", "-Wpedantic", "-Wshadow", "-Werror"]
# What MSVC predefines, for a preprocessor that predefines nothing else.
PREDEFINED = ["-undef", "-D_MSC_VER=1938", "-D_MSVC_LANG=202002L", "-D_WIN32=1", "-D_WIN64=1", "-D_M_X64=100",
              "-D__cplusplus=199711L", "-DZB_BUILDING", "-DXOS_BUILDING"]
GNU_WORDS = re.compile(r"\[\[\s*(?:gnu|clang)::|__attribute__|__builtin_|__(?:asm|typeof|restrict|inline)__|\basm\b|"
                       r"\b__asm\b|__extension__|__u?int128|__PRETTY_FUNCTION__|\bssize_t\b|#\s*pragma (?:GCC|clang)|"
                       r"\b(?:strn?casecmp|strtok_r|ftello64|fseeko64|fopen64|usleep|gettimeofday|__mingw_\w+)\b")
# Headers of MSVC and its SDK: those of C++ have no dot in their names.
HEADERS_OF_MSVC = re.compile(r"[a-z_]+|(?:std\w+|windows|intrin|[ipnetsxm]mmintrin|io|fcntl|direct|process|wincrypt|"
                             r"winhttp|winnetwk|winsock2|shlwapi|synchapi|sys/stat|sys/types)\.h")
WINDOWS_API = "basis/platform/windows_api_win.h" # often precompiled, and then not named among the files of a result
FOREIGN = "zb_header_that_msvc_has_not"


def files(*patterns):
    """Those that Windows compiles."""
    return [str(path) for path in common.files(*patterns) if "_posix." not in path.name]


PUBLIC = [name.removeprefix("include/") for name in files("include/**.h")]
HOST = ["xos_host.h", *(name for name in files("basis/platform/*.h"))]
SOURCES = files("basis/**.cpp", "host/**.cpp", "cmake/windows/*.cpp")
EXAMPLES = files("examples/**.cpp")


# ---- words ----------------------------------------------------------------------------------------------------------


def make_empty_headers(folder):
    """The headers of the system and the standard library, each empty or a word that says that MSVC has none."""
    texts = [common.text(path) for path in files("include/**.h", "basis/**.h", "host/**.h", "examples/**.h")]
    texts += [common.text(path) for path in [*SOURCES, *EXAMPLES]]
    for name in set(re.findall(r"^\s*#\s*include\s*<([^>]+)>", "\n".join(texts), re.M)):
        (folder / name).parent.mkdir(parents=True, exist_ok=True)
        (folder / name).write_text("" if HEADERS_OF_MSVC.fullmatch(name) else f"{FOREIGN}\n")


def lines_with_places(preprocessed):
    """(file, line number, line, the place that includes the file) of a preprocessor's output."""
    places, number = [("", 0)], 0
    for line in preprocessed.split("\n"):
        if marker := re.match(r'# (\d+) "([^"]*)"(?: ([12]))?', line):
            if marker[3] == "1":
                places[-1] = (places[-1][0], number)
                places.append((marker[2], 0))
            elif marker[3] == "2":
                places.pop()
            number = int(marker[1])
            places[-1] = (marker[2], number)
        else:
            yield places[-1][0].removeprefix("./"), number, line, places[-2] if len(places) > 1 else ("", 0)
            number += 1


def unknown_words():
    with tempfile.TemporaryDirectory() as folder:
        make_empty_headers(Path(folder))
        result = common.run(msvc_target.CLANG, "--target=x86_64-pc-windows-msvc", *PREDEFINED, *msvc_target.INCLUDES,
                            "-nostdinc", "-isystem", folder, "-w", "-E", "-x", "c++", "-",
                            input=including(*PUBLIC, *HOST, *SOURCES, *EXAMPLES))
    problems = [] if result.returncode == 0 else [result.stderr]
    for file, number, line, (includer, where) in lines_with_places(result.stdout):
        if line == FOREIGN:
            problems.append(f"{includer.removeprefix('./')}:{where}: MSVC has no {file.removeprefix(folder + '/')}")
        elif word := GNU_WORDS.search(re.sub(r'"(\\.|[^"\\])*"', '""', line)):
            problems.append(f"{file}:{number}: MSVC does not know {word[0]}")
    return sorted(set(problems))


# ---- compiling ------------------------------------------------------------------------------------------------------


@functools.cache
def content(file):
    return common.text(file)


class Job:
    """One compilation: a text, or the file of that name, in one of the ways in which the library is compiled."""

    def __init__(self, name, *flags, text=None, language="c++"):
        target = msvc_target.CXX if language == "c++" else [*msvc_target.C, "-std=c11"]
        self.name = " ".join([name, *flags, language])
        self.file = "-" if text else name
        self.text = text or content(name)
        self.language = language
        self.flags = [*target, *WARNINGS, *flags]

    def state(self, included):
        """What the result depends on."""
        parts = [SURROUNDINGS, self.text, *map(str, self.flags), *map(content, included)]
        return hashlib.sha256("\0".join(parts).encode()).hexdigest()

    def is_clean(self):
        included, state = clean.known.get(self.name, ([], ""))
        return all((common.ROOT / file).exists() for file in included) and self.state(included) == state

    def problems(self, prefixes):
        prefix = prefixes.flags_for(self.text) if self.language == "c++" else []
        with tempfile.NamedTemporaryFile("r") as makefile:
            result = msvc_target.clang(*self.flags, *prefix, "-MMD", "-MF", makefile.name, file=self.file,
                                       text=self.text, language=self.language)
            if result.returncode or result.stderr:
                return [f"{self.name}:\n{result.stderr}"]
            included = {WINDOWS_API, *re.findall(r"\S+\.(?:h|cpp)\b", makefile.read())}
        clean.note(self.name, (sorted(included), self.state(sorted(included))))
        return []


def is_valid_c(name):
    path = next(p for p in (f"include/{name}", f"host/include/{name}", name) if (common.ROOT / p).exists())
    return "Valid C" in common.text(path)[:1500]


def joined():
    """The sources that the build for Windows compiles together, as lists."""
    commands = common.ROOT / "build/windows/compile_commands.json"
    files = [entry["file"] for entry in json.loads(commands.read_text())] if commands.exists() else []
    own = {f"{common.ROOT / source}": source for source in SOURCES}
    for file in sorted(file for file in files if "/Unity/" in file):
        included = re.findall(r'^#include "(.+)"$', common.text(file), re.M)
        if all(source in own for source in included):
            yield [own[source] for source in included]


def mode(source):
    return "-DZB_BUILDING" if source.startswith("basis/") else "-DXOS_BUILDING"


def jobs():
    once = ["-fsyntax-only"]
    objects = ["-c", "-o", "/dev/null"]
    for name in [*PUBLIC, *HOST]:
        twice = including(name, name)
        yield Job(name, *once, text=twice)
        if is_valid_c(name):
            yield Job(name, *once, text=twice + "typedef int zb_not_an_empty_file;\n", language="c")
    for way in ("-DZB_BUILDING", "-DZB_STATIC"):
        yield Job("all headers", way, *objects, text=including(*PUBLIC))
    for name in EXAMPLES:
        yield Job(name, *objects)
    together = {group[0]: group for group in joined()}
    for group in together.values():
        yield Job(f"{group[0]} and others", mode(group[0]), *objects, text=including(*group))
    for name in sorted(set(SOURCES).difference(*together.values())):
        yield Job(name, mode(name), *objects)


def surroundings():
    """What all results depend on: the compiler, and the headers that stand in for Microsoft's."""
    version = common.run(msvc_target.CLANG, "--version", check=True).stdout
    return "\0".join([version, *(common.text(path) for path in common.files("tools/lint/msvc/**"))])


SURROUNDINGS = surroundings()
clean = common.CleanFiles(common.ROOT / "build/msvc-clean.json")
todo = [job for job in jobs() if not job.is_clean()]
problems = unknown_words() + msvc_layouts.problems(PUBLIC)
with tempfile.TemporaryDirectory() as folder:
    prefixes = msvc_prefixes.Prefixes(folder, [job.text for job in todo if job.language == "c++"])
    problems += [text for found in common.in_parallel(lambda job: job.problems(prefixes), todo) for text in found]
common.finish("msvc", problems, len(todo))
