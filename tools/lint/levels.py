#!/usr/bin/env python3
"""Headers include only headers of the same or a lower level (levels.txt), and components form no circle."""

import re
from pathlib import PurePosixPath

import common

INCLUDE = re.compile(r'^\s*#\s*include\s+[<"]([^">]+)[">]', re.M)
ROOTS = ("include/zor_basis/", "basis/")
# What the stand-alone platform layer may use of the library.
HOST_MAY_USE = ("basis/platform/", "basis/files/wildcard.h")


def levels():
    table = []
    for line in common.text("tools/lint/levels.txt").splitlines():
        if line.strip() and not line.startswith("#"):
            level, prefix = line.split()
            table.append((prefix, int(level)))
    return sorted(table, key=lambda row: -len(row[0]))


def inner(path):
    """The path below the library's roots, without suffixes that only tell twins and file kinds apart."""
    for root in ROOTS:
        if path.startswith(root):
            stem = path.removeprefix(root)
            stem = str(PurePosixPath(stem).with_suffix(""))
            return re.sub(r"_(win|posix|impl|detail)$", "", stem)
    return None


def level_of(component, table):
    for prefix, level in table:
        if component == prefix or component.startswith((prefix + "/", prefix + "_")):
            return level
    return None


def resolve(including, name, known):
    here = PurePosixPath(including).parent / name
    for candidate in (str(here), name, "include/" + name, "host/include/" + name):
        if candidate in known:
            return candidate
    return None


def entry_header(path):
    """An entry header (text.h) only gathers its room's headers and is no component of its own."""
    return re.fullmatch(r"include/zor_basis/[a-z]+\.h", path) and path not in (
        "include/zor_basis/export.h", "include/zor_basis/wide_char.h", "include/zor_basis/flat.h")


def main():
    table = levels()
    sources = [str(p) for p in common.files("include/**", "basis/**", "host/**") if p.suffix in (".h", ".cpp", ".c")]
    known = set(sources)
    problems, edges = [], {}
    for path in sources:
        for name in INCLUDE.findall(common.text(path)):
            target = resolve(path, name, known)
            if target is None:
                continue
            if path.startswith("host/"):
                if target.startswith(ROOTS) and not target.startswith(HOST_MAY_USE):
                    problems.append(f"{path} includes {target}, which is the library's own")
                continue
            if target.startswith("host/"):
                problems.append(f"{path} includes {target}: the library never includes from host/")
                continue
            if entry_header(path):
                continue
            if entry_header(target):
                problems.append(f"{path} includes {target}: inside the library the single headers are included")
                continue
            user, used = inner(path), inner(target)
            if user == used:
                continue
            user_level, used_level = level_of(user, table), level_of(used, table)
            if user_level is None or used_level is None:
                problems.append(f"{path}: no level for {user if user_level is None else used}")
            elif used_level > user_level:
                problems.append(f"{path} (level {user_level}) includes {target} (level {used_level})")
            edges.setdefault(user, set()).add(used)
    problems += circles(edges)
    common.finish("levels", problems, len(sources))


def circles(edges):
    found, done = [], set()

    def visit(node, trail):
        if node in trail:
            found.append("circle: " + " -> ".join(trail[trail.index(node):] + [node]))
            return
        if node in done:
            return
        for following in sorted(edges.get(node, ())):
            visit(following, trail + [node])
        done.add(node)

    for node in sorted(edges):
        visit(node, [])
    return found


main()
