#!/usr/bin/env python3
"""Includes lead from higher rooms to lower ones (levels.txt), and neither rooms nor components form a circle, in the
library and in the host."""

import re
from pathlib import PurePosixPath

import common

INCLUDE = re.compile(r'^\s*#\s*include\s+[<"]([^">]+)[">]', re.M)
COMMENT = re.compile(r"//[^\n]*|/\*.*?\*/", re.S)
PUBLIC = "include/zor_basis/"
LIBRARY = (PUBLIC, "basis/")
# What the host may use of the library.
HOST_MAY_USE = ("basis/platform/", "basis/ground/wildcard.h")


def levels():
    table = {}
    for line in common.text("tools/lint/levels.txt").splitlines():
        if line.strip() and not line.startswith("#"):
            level, room = line.split()
            table[room] = int(level)
    return table


def room_of(path, table):
    """The room that a file belongs to; where none is listed, the folder that would be one."""
    for root in LIBRARY:
        if path.startswith(root):
            folder, _, rest = path.removeprefix(root).partition("/")
            if rest:
                return folder
            name = PurePosixPath(folder).stem
            return name if name in table else "ground"
    return str(PurePosixPath(path).parent)


def component_of(path, table):
    """A header, its source and its twins are one component."""
    name = re.sub(r"_(win|posix|impl|detail)$", "", PurePosixPath(path).stem)
    return f"{room_of(path, table)}/{name}"


def resolve(including, name, known):
    here = PurePosixPath(including).parent / name
    for candidate in (str(here), name, "include/" + name, "host/include/" + name):
        if candidate in known:
            return candidate
    return None


def only_gathers(path):
    """A public header that has nothing but includes: an entry header (text.h), or a second path of a header."""
    if not path.startswith(PUBLIC):
        return False
    lines = COMMENT.sub("", common.text(path)).splitlines()
    return all(re.match(r"\s*(#\s*(ifndef|define|include|endif)\b.*)?$", line) for line in lines)


def forbidden(path, target, gathering):
    """Why a file must not include another one, whatever their levels are; None where it may."""
    if path.startswith("host/"):
        if target.startswith(LIBRARY) and not target.startswith(HOST_MAY_USE):
            return f"{path} includes {target}, which is the library's own"
    elif target.startswith("host/"):
        return f"{path} includes {target}: the library never includes from host/"
    elif target in gathering:
        return f"{path} includes {target}, which only gathers others: the library includes those themselves"
    return None


def wrong_level(path, target, table):
    user, used = room_of(path, table), room_of(target, table)
    for file, room in ((path, user), (target, used)):
        if room not in table:
            return f"{file}: levels.txt has no room {room}"
    # The host has an order of its own; `forbidden` knows what it may use of the library.
    if path.startswith("host/") == target.startswith("host/") and table[used] > table[user]:
        return f"{path} (room {user}, level {table[user]}) includes {target} (room {used}, level {table[used]})"
    return None


def circles(kind, edges):
    found, done = [], set()

    def visit(node, trail):
        if node in trail:
            found.append(f"circle of {kind}: " + " -> ".join(trail[trail.index(node):] + [node]))
            return
        if node in done:
            return
        for following in sorted(edges.get(node, ())):
            visit(following, trail + [node])
        done.add(node)

    for node in sorted(edges):
        visit(node, [])
    return found


def add_edge(edges, user, used):
    if user != used:
        edges.setdefault(user, set()).add(used)


def main():
    table = levels()
    sources = [str(p) for p in common.files("include/**", "basis/**", "host/**") if p.suffix in (".h", ".cpp", ".c")]
    known = set(sources)
    gathering = {path for path in sources if only_gathers(path)}
    problems, rooms, components = [], {}, {}
    for path in known - gathering:
        for name in INCLUDE.findall(common.text(path)):
            target = resolve(path, name, known)
            if target is None:
                continue
            problem = forbidden(path, target, gathering) or wrong_level(path, target, table)
            if problem:
                problems.append(problem)
            if target not in gathering:
                add_edge(rooms, room_of(path, table), room_of(target, table))
                add_edge(components, component_of(path, table), component_of(target, table))
    empty = table.keys() - {room_of(path, table) for path in sources}
    problems += [f"levels.txt lists {room}, which holds no file" for room in empty]
    problems = sorted(problems) + circles("rooms", rooms) + circles("components", components)
    common.finish("levels", problems, len(sources))


main()
