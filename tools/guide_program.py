#!/usr/bin/env python3
"""Makes the test of a page of the guide: guide_program.py cpp|c|program|console|text OUTPUT PAGE.

The C++ blocks of a page are one function, in which a block sees what the earlier ones declared; what the page prints
must be its `text` blocks. The C block of a page is a program. Errors name the line of the page.

For a reader who follows the page without the tests: `program` makes a program of the C++ blocks, `console` a script of
the commands, `text` what the program prints."""

import re
import sys
from pathlib import Path


def blocks(page):
    """(language, number of the first line, lines) of the blocks of a page."""
    language, first, lines = None, 0, []
    for number, line in enumerate(page.read_text(encoding="utf-8").splitlines(), 1):
        if language is None:
            if line.startswith("```"):
                language, first, lines = line[3:].strip(), number + 1, []
        elif line == "```":
            yield language, first, lines
            language = None
        else:
            lines.append(line)


def of_language(page, language):
    return [(first, lines) for found, first, lines in blocks(page) if found == language]


def outputs_after(page, language):
    """The `text` blocks that follow a block of the language, up to one of another."""
    last, outputs = None, []
    for found, _, lines in blocks(page):
        if found != "text":
            last = found
        elif last == language:
            outputs += lines
    return "".join(line + "\n" for line in outputs)


def test_of(page):
    name = re.sub(r"\W", "_", page.stem)
    code = []
    for first, lines in of_language(page, "cpp"):
        code.append(f'#line {first} "{page.as_posix()}"')
        code += ["" if line.startswith("#include") else line for line in lines]
    expected = "".join(f'    "{line}\\n"\n' for line in
                       (l.replace("\\", "\\\\").replace('"', '\\"') for l in outputs_after(page, "cpp").splitlines()))
    return ["", f"static void {name}() {{", *code, "}", "", f"TEST(Guide, {name}) {{", "    Page const page;",
            f"    {name}();", f'    EXPECT_EQ(page.printed(),\n{expected or "    " + chr(34) * 2});', "}"]


def cpp(page):
    """A page sees only what it includes itself, so that it is a program without the others."""
    if not of_language(page, "cpp"):
        return []
    return [*includes_of(page), '#include "tests/guide/page.h"', *test_of(page)]


def includes_of(page):
    return [line for _, lines in of_language(page, "cpp") for line in lines if line.startswith("#include")]


def program(page):
    code = [line for _, lines in of_language(page, "cpp") for line in lines if not line.startswith("#include")]
    return [*includes_of(page), "", "int main() {", *code, "}"]


def as_it_is(page, language):
    return [line for _, lines in of_language(page, language) for line in lines]


def c(page):
    return [line for first, block in of_language(page, "c")
            for line in (f'#line {first} "{page.as_posix()}"', *block)]


MAKERS = {"cpp": cpp, "c": c, "program": program, "console": lambda page: as_it_is(page, "console"),
          "text": lambda page: as_it_is(page, "text")}


def main():
    maker, output, page = sys.argv[1], Path(sys.argv[2]), Path(sys.argv[3])
    output.write_text("\n".join(MAKERS[maker](page)) + "\n", encoding="utf-8")


if __name__ == "__main__":
    main()
