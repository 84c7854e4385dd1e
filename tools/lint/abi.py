#!/usr/bin/env python3
"""The binary interface is the committed one in cmake/abi.

`linux.txt` and `windows.txt` have the layout of every public class: its size, the offsets of its fields and bases, the
slots of its virtual functions, as the compilers of both targets describe them to the debugger. `libzor_basis.abi.gz`
has the interface of the Linux library, which abidiff compares. With --update they are rewritten."""

import difflib
import gzip
import re
import sys
import tempfile
from pathlib import Path

import common

FOLDER = common.ROOT / "cmake/abi"
BASELINE = FOLDER / "libzor_basis.abi.gz"
LIBRARY = common.ROOT / "build/linux/lib/libzor_basis.so"
ABIDW = ["abidw", "--headers-dir", common.ROOT / "include", "--drop-private-types", "--no-comp-dir-path",
         "--no-corpus-path", "--no-show-locs"]
COMPILERS = {"linux": "g++", "windows": "x86_64-w64-mingw32-g++-posix"}
OPTIONS = ["-std=c++20", "-g2", "-fno-eliminate-unused-debug-types", "-femit-class-debug-always", "-Iinclude",
           "-x", "c++", "-c", "-"]
# Containers of no class of their own, as representatives of all.
INSTANCES = "template class ZOR_Basis::PtrArray<int>; template class ZOR_Basis::SngList<int>;\n"

ENTRY = re.compile(r"0x[0-9a-f]+:( +)(?:DW_TAG_(\w+)|NULL)")
ATTRIBUTE = re.compile(r' +DW_AT_(\w+)\t\((?:0x[0-9a-f]+ )?"?(.*?)"?\)$')
CLASSES = ("class_type", "structure_type", "union_type")
PARTS = ("member", "inheritance", "subprogram")
# A class that a public header defines.
DEFINITION = re.compile(
    r"^(?:template <[^>]*>\n)?(?:requires.*\) )?(?:class|struct)(?: ZB_API)? (?!\w+::)(\w+)[^;{]*\{", re.M)


class Entry:
    """One entry of the debug information, with those of its children that a layout consists of."""

    def __init__(self, tag, parent):
        self.tag = tag
        self.parent = parent
        self.attributes = {}
        self.children = []

    def name(self):
        own = self.attributes.get("name", "")
        outer = self.parent.name() if self.parent else ""
        return f"{outer}::{own}" if outer else own

    def is_public_class(self):
        return (self.tag in CLASSES and "byte_size" in self.attributes and "name" in self.attributes
                and "include/zor_basis/" in self.attributes.get("decl_file", ""))


def entries(dump):
    """All entries in the output of llvm-dwarfdump that have to do with layouts."""
    stack, found = [], []
    current = None
    for line in dump:
        if entry := ENTRY.match(line):
            current = begun(stack, len(entry[1]), entry[2])
            found += [current] if current else []
        elif current and (attribute := ATTRIBUTE.match(line)):
            current.attributes[attribute[1]] = attribute[2]
    return found


def begun(stack, depth, tag):
    """Begins an entry below the innermost one of `stack` that encloses it; none if no layout depends on it."""
    while stack and stack[-1][0] >= depth:
        stack.pop()
    parent = stack[-1][1] if stack else None
    entry = Entry(tag, parent) if tag in (*CLASSES, *PARTS, "namespace") else None
    stack.append((depth, entry))
    if entry and parent and tag in PARTS:
        parent.children.append(entry)
    return entry


def number(text):
    return int(text.split()[-1], 0)


def parts(entry):
    """What a class consists of, in the order of its layout: (position, text)."""
    for child in entry.children:
        known = child.attributes
        if child.tag == "inheritance":
            yield number(known["data_member_location"]), f"base {known['type']}"
        elif child.tag == "member" and "data_member_location" in known:
            yield number(known["data_member_location"]), f"field {known.get('name', '(nameless)')}: {known['type']}"
        elif "vtable_elem_location" in known:
            yield number(known["vtable_elem_location"]), f"slot of {known['linkage_name']}"
        elif "virtuality" in known and child.tag == "subprogram":
            yield -1, f"virtual {known['name']}"


def debug_information(target):
    """What the compiler of a target tells the debugger about all public headers."""
    headers = [str(h).removeprefix("include/") for h in common.files("include/zor_basis/**.h")]
    source = "".join(f'#include "{h}"\n' for h in headers) + INSTANCES
    with tempfile.NamedTemporaryFile(suffix=".o") as compiled:
        common.run(COMPILERS[target], *OPTIONS, "-o", compiled.name, input=source, check=True)
        return common.run("llvm-dwarfdump", "--debug-info", compiled.name, check=True).stdout.splitlines()


def table(target):
    """The layouts of a target as lines, and problems with them."""
    layouts = {}
    for entry in filter(Entry.is_public_class, entries(debug_information(target))):
        title = f"{entry.name()}, {number(entry.attributes['byte_size'])} bytes"
        layouts.setdefault(title, set()).update(parts(entry))
    lines = []
    for title, found in sorted(layouts.items()):
        lines += [title, *(f"{'' if place < 0 else place:>8}  {text}" for place, text in sorted(found))]
    readable = common.run("c++filt", input="\n".join(lines)).stdout.splitlines()
    return readable, [f"{target}: no layout of {name}" for name in sorted(public_names() - known_names(layouts))]


def public_names():
    return {name for path in common.files("include/zor_basis/**.h") for name in DEFINITION.findall(common.text(path))}


def known_names(layouts):
    return {re.sub(r"<.*|, \d+ bytes$", "", title).split("::")[-1] for title in layouts}


def check_layouts(target):
    lines, problems = table(target)
    committed = (FOLDER / f"{target}.txt").read_text().splitlines()
    return problems + list(difflib.unified_diff(committed, lines, f"committed {target}.txt", "now", lineterm="", n=2))


def check_interface():
    with tempfile.TemporaryDirectory() as folder:
        baseline = Path(folder) / "committed.abi"
        baseline.write_bytes(gzip.decompress(BASELINE.read_bytes()))
        result = common.run("abidiff", "--headers-dir2", common.ROOT / "include", "--drop-private-types",
                            baseline, LIBRARY)
    return [f"{result.stdout}{result.stderr}"] if result.returncode else []


def update():
    for target in COMPILERS:
        (FOLDER / f"{target}.txt").write_text("\n".join(table(target)[0]) + "\n")
    text = common.run(*ABIDW, LIBRARY, check=True).stdout
    BASELINE.write_bytes(gzip.compress(text.encode(), 9, mtime=0))


def main():
    if "--update" in sys.argv:
        update()
        return
    problems = [line for target in COMPILERS for line in check_layouts(target)] + check_interface()
    common.finish("abi", problems, len(public_names()))


main()
