#!/usr/bin/env python3
"""Every component has its tests at its own path under tests/, and every test file names what it tests; mirror.txt lists
the exceptions with their reasons."""

import re
from pathlib import Path

import common

LIST = Path("tools/lint/mirror.txt")
SYSTEM = re.compile(r"_(?:posix|win)$")
# At most so many of a hundred components may be without tests of their own.
LARGEST_SHARE = 15


def exceptions():
    """(what, where): a component and the test file that covers it, or a test file and "-"; a line ends in a reason."""
    listed, problems = {}, []
    for number, line in enumerate(common.text(LIST).splitlines(), 1):
        if line.strip() and not line.startswith("#"):
            parts = line.split(None, 2)
            if len(parts) < 3:
                problems.append(f"{LIST}:{number}: lacks the place or the reason")
            else:
                listed[parts[0]] = parts[1]
    return listed, problems


def room(path):
    """Where under tests/ the tests of a file stand."""
    parts = path.parent.parts
    if parts[:2] == ("include", "zor_basis"):
        return Path(*parts[2:])
    return Path(*parts) if parts[0] == "host" else Path(*parts[1:])


def stem(path):
    return SYSTEM.sub("", path.stem)


def tests():
    """The names of the test files of each room, with their paths."""
    found = {}
    for path in common.files("tests/**_test.cpp"):
        name = SYSTEM.sub("", path.stem.removesuffix("_test"))
        found.setdefault(Path(*path.parts[1:-1]), {})[path] = name
    return found


def begins_with(name, component):
    return name == component or name.startswith(component + "_")


def covering(component, name):
    """The test file that a line of the list names; without a folder it stands in the component's own room."""
    return Path("tests") / (name if "/" in name else room(component) / name)


def missing(components, tested, listed):
    for path in sorted(components):
        if any(begins_with(name, path.name) for name in tested.get(room(path), {}).values()):
            if str(path) in listed:
                yield f"{LIST}: {path} has tests of its own"
        elif str(path) not in listed:
            yield f"{path} has no tests/{room(path)}/{path.name}_test.cpp"
        elif not (common.ROOT / covering(path, listed[str(path)])).is_file():
            yield f"{LIST}: {path}: there is no {covering(path, listed[str(path)])}"


def unnamed(names, tested, listed):
    for place, files in sorted(tested.items()):
        for path, name in files.items():
            mirrors = any(begins_with(name, known) for known in names.get(place, ()))
            if mirrors == (str(path) in listed):
                yield f"{path} " + ("mirrors a component and is listed" if mirrors else "mirrors no component")


def main():
    listed, problems = exceptions()
    sources = common.files("basis/**.cpp", "host/**.cpp", "tools/zbtool/**.cpp")
    headers = common.files("basis/**.h", "host/**.h", "include/zor_basis/**.h", "tools/zbtool/**.h")
    components = {path.with_name(stem(path)) for path in sources}
    names = {}
    for path in sources + headers:
        names.setdefault(room(path), set()).add(stem(path))
    tested = tests()
    problems += [*missing(components, tested, listed), *unnamed(names, tested, listed)]
    known = {str(path) for path in components} | {str(path) for files in tested.values() for path in files}
    problems += [f"{LIST}: there is no {name}" for name in sorted(listed.keys() - known)]
    without = sum(str(path) in listed for path in components)
    print(f"{len(components) - without} of {len(components)} components have tests of their own")
    if without * 100 > LARGEST_SHARE * len(components):
        problems.append(f"{LIST}: {without} exceptions are more than {LARGEST_SHARE} of 100 components")
    common.finish("mirror", problems, len(components))


main()
