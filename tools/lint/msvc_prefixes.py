"""Costly headers, compiled once for all texts that include them anyway.

A text gets no header that it does not include itself or through a header of the project, so that a forgotten include
is still an error.
"""

import functools
import re
from collections import Counter

import common
import msvc_target

COSTLY = ("string", "functional", "algorithm", "memory", "vector", "mutex", "thread", "chrono",
          "basis/platform/windows_api_win.h")
FOLDERS = ("include/", "host/include/", "")
WORTHWHILE = 4 # as many texts must include the same headers


def names_in(text):
    return re.findall(r'^\s*#\s*include\s*[<"]([^>"]+)', text, re.M)


def file_of(name):
    """The project's file of that name, or none."""
    return next((folder + name for folder in FOLDERS if (common.ROOT / folder / name).is_file()), None)


@functools.cache
def names_below(file):
    return names_in(common.text(file))


def costly_headers(text):
    """Those that a text includes, directly or not, in the order of the list."""
    found, left = set(), names_in(text)
    while left:
        name = left.pop()
        if name not in found:
            found.add(name)
            left += names_below(file) if (file := file_of(name)) else []
    return tuple(header for header in COSTLY if header in found)


class Prefixes:
    """The precompiled sets of headers, in a folder."""

    def __init__(self, folder, texts):
        counts = Counter(costly_headers(text) for text in texts)
        wanted = [headers for headers, count in counts.items() if headers and count >= WORTHWHILE]
        self.files = {headers: f"{folder}/{number}.pch" for number, headers in enumerate(wanted)}
        common.in_parallel(self.compile, wanted)

    def compile(self, headers):
        result = msvc_target.clang(*msvc_target.CXX, "-o", self.files[headers], language="c++-header",
                                   text=msvc_target.including(*headers))
        if result.returncode:
            raise SystemExit(result.stderr)

    def flags_for(self, text):
        """The option for the largest set of which the text includes all."""
        own = set(costly_headers(text))
        fitting = [headers for headers in self.files if own.issuperset(headers)]
        return ["-include-pch", self.files[max(fitting, key=len)]] if fitting else []
