#!/usr/bin/env python3
"""Writes a source that holds every example of the public headers, each in a function of its own, so that the tests
compile them: header_examples.py OUTPUT SURROUNDINGS HEADER...

An example is a block of a `///` comment that is indented by five spaces and stands behind an empty comment line. What
it takes for granted of its caller is declared in SURROUNDINGS. Errors name the line of the header."""

import re
import sys
from pathlib import Path

EMPTY = re.compile(r"\s*///\s*$")
CODE = re.compile(r"\s*///     (.*)")


def examples(lines):
    """(number of the first line, lines of the example)."""
    block, previous = [], ""
    for number, line in enumerate([*lines, ""], 1):
        match = CODE.match(line)
        if match and (block or EMPTY.match(previous)):
            block.append(match[1])
        elif block:
            yield number - len(block), block
            block = []
        previous = line


def function(header, number, block):
    name = re.sub(r"\W", "_", f"{header.parent.name}_{header.stem}_{number}")
    path = str(header).replace("\\", "/")
    return [f"bool {name}() {{", f'#line {number} "{path}"', *block, "return true;", "}", ""]


def main():
    output, surroundings, *headers = map(Path, sys.argv[1:])
    entries = sorted({header for header in headers if header.parent.name == "zor_basis"})
    lines = [f'#include "{header}"' for header in entries] + [f'#include "{surroundings}"', ""]
    lines += ["namespace callers {", "", "using namespace ZOR_Basis;", ""]
    found = 0
    for header in sorted(headers):
        for number, block in examples(header.read_text(encoding="utf-8").splitlines()):
            lines += function(header, number, block)
            found += 1
    lines += ["} // namespace callers", ""]
    if found == 0:
        sys.exit("no header has an example")
    output.write_text("\n".join(lines), encoding="utf-8")


main()
