#!/usr/bin/env python3
"""Behaviour that looks odd and is relied upon has an id. A public header describes it (`\\kept id: text`), a comment
marks its place in the code (`// kept id: text`), and a test with the id in its name pins it (`Kept_room_01_…`).
Writes docs/kept.md, which names the header and the test's file of each, and docs/guide/traps.md, which explains those
of docs/guide/traps.txt to users."""

import re
import textwrap

import common

COLUMNS = 120
TOLD = re.compile(r"\\kept ([a-z]+(?:-[a-z]+)*-\d+):\s*(.*(?:\n\s*///\s{2,}.*)*)")
SPOT = re.compile(r"(?://|/\*) kept ([a-z]+(?:-[a-z]+)*-\d+)\b")
TEST = re.compile(r"\bKept_([a-z]+(?:_[a-z]+)*_\d+)_")
HEAD = """# Kept behaviour

Behaviour that looks odd and is relied upon, collected from the public headers by `./dev lint kept`.
A comment marks each at its place in the code, and the named test fails as soon as the behaviour changes.

"""

TRAPS = "docs/guide/traps.txt"
TRAPS_HEAD = """# Traps you will meet

Some behaviour surprises, and must stay because callers rely on it. These are the cases that cost time; each says what
to do instead. The [list of all](../kept.md) also names the test that pins each.

"""


def gather(pattern, paths, key=lambda match: match[1]):
    found = {}
    for path in paths:
        for match in pattern.finditer(common.text(path)):
            found.setdefault(key(match), []).append((path, match))
    return found


def entry(identity, header, match, tests):
    """One item of the list: the text of the public header, the header, and the files of the tests."""
    pinned = ", ".join(f"`{name}`" for name in sorted({str(path) for path, _ in tests}))
    told = f"**{identity}** {words_of(match)} (`{str(header).removeprefix('include/')}`; pinned by {pinned})"
    return wrapped(told, initial_indent="- ", subsequent_indent="  ")


def listed(told, tests):
    lines, room = [], None
    for identity in sorted(told):
        if room != (room := identity.rsplit("-", 1)[0]):
            lines.append(f"\n## {room}\n" if lines else f"## {room}\n")
        lines.append(entry(identity, *told[identity][0], tests.get(identity, [])))
    return HEAD + "\n".join(lines) + "\n"


def words_of(match):
    return " ".join(re.sub(r"\n\s*///", " ", match[2]).split())


def wrapped(text, **options):
    return textwrap.fill(text, COLUMNS, break_long_words=False, break_on_hyphens=False, **options)


def traps(told, problems):
    """The page of the traps: what to do instead, and what the header says."""
    lines = []
    for number, line in enumerate(common.text(TRAPS).splitlines(), 1):
        if line.startswith("## "):
            lines.append(line + "\n")
        elif line and not line.startswith("#"):
            identity, what, instead = (part.strip() for part in line.split("|"))
            if identity not in told:
                problems.append(f"{TRAPS}:{number}: no header has {identity}")
                continue
            header, match = told[identity][0]
            lines.append(f"### {what}\n")
            lines.append(wrapped(instead) + "\n")
            reason = f"`{str(header).removeprefix('include/')}`, {identity}: {words_of(match)}"
            lines.append(wrapped(reason, initial_indent="> ", subsequent_indent="> ") + "\n")
    return TRAPS_HEAD + "\n".join(lines)


def update(name, content, problems):
    page = common.ROOT / name
    if not page.exists() or page.read_text() != content:
        page.write_text(content)
        problems.append(f"{name} was out of date and has been rewritten; commit it")


def main():
    public = common.files("include/**.h", "host/include/*.h", "basis/platform/*.h")
    sources = common.files("include/**.h", "basis/**", "host/**")
    told = gather(TOLD, public)
    spots = gather(SPOT, sources)
    tests = gather(TEST, common.files("tests/**.cpp", "tests/**.h"), lambda match: match[1].replace("_", "-"))
    problems = []
    for identity in sorted(told.keys() | spots.keys() | tests.keys()):
        lists = {"a \\kept line in a public header": told, "a mark in the code": spots, "a test": tests}
        for name, where in lists.items():
            if identity not in where:
                problems.append(f"{identity} lacks {name}")
    update("docs/kept.md", listed(told, tests), problems)
    update("docs/guide/traps.md", traps(told, problems), problems)
    common.finish("kept", problems, len(told))


main()
