#!/usr/bin/env python3
"""Each shared library exports exactly the names in its committed lists in cmake/exports.

`NAME.elf.txt` lists the names that the .so exports, which its export macros and version script decide. `NAME.def` lists
the same functions and data for the DLL; the linker reads it. With --update both are rewritten: the second from the
objects of the DLL, with the names that have a counterpart in the first.
"""

import re
import sys

import common

LISTS = common.ROOT / "cmake/exports"
MODULES = {
    "zor_basis": "zor_basis_objects.dir",
    "xos_basics": "xos_basics.dir",
    "xos_url": "xos_url.dir",
    "hq_basis": "hq_basis.dir",
}
# Names that exist on one target only: twins that the other target does not have.
ONLY_WINDOWS = re.compile(r"ZOR_Basis::(WinDirIterW|CryptWin)\b")


def elf_names(module):
    library = common.ROOT / f"build/linux/lib/lib{module}.so"
    result = common.run("nm", "-D", "--defined-only", library, check=True)
    names = set()
    for line in result.stdout.splitlines():
        _, kind, name = line.split(maxsplit=2)
        name = name.split("@")[0]
        if kind != "A" and not name.startswith("_ZTS"):
            names.add(name)
    return names


def pe_names(module):
    result = common.run("x86_64-w64-mingw32-objdump", "-p", common.ROOT / f"build/windows/bin/{module}.dll", check=True)
    names, inside = set(), False
    for line in result.stdout.splitlines():
        if line.startswith("[Ordinal/Name Pointer] Table"):
            inside = True
        elif inside:
            if not line.strip():
                break
            names.add(line.split()[-1])
    return names


def meaning(mangled):
    """What each mangled name stands for, whatever the target's integer types: {name: qualified name}."""
    names = sorted(mangled)
    readable = common.run("c++filt", input="\n".join(names)).stdout.split("\n")
    return {name: qualified(text) for name, text in zip(names, readable)}


def qualified(text):
    text = re.sub(r"(\d+)(?:u|ul|ull|l|ll)\b", r"\1", text).replace("char16_t", "wchar_t")
    depth = 0
    start = text.find("operator()") + len("operator()") if "operator()" in text else 0
    for position in range(start, len(text)):
        if text[position] in "<":
            depth += 1
        elif text[position] in ">" and depth:
            depth -= 1
        elif text[position] == "(" and depth == 0:
            return text[:position]
    return text


def pe_definitions(module):
    """External definitions in the objects of the DLL: {name: is data}."""
    folder = MODULES[module]
    objects = [p for p in (common.ROOT / "build/windows").rglob("*.obj") if folder in p.parts]
    result = common.run("x86_64-w64-mingw32-nm", "--defined-only", "--extern-only", *objects, check=True)
    found = {}
    for line in result.stdout.splitlines():
        fields = line.split()
        if len(fields) == 3 and fields[1] in "TDRBVW":
            found[fields[2]] = fields[1] in "DRB"
    return found


def write_def(module):
    wanted = {name for name in meaning(elf_names(module)).values()}
    definitions = pe_definitions(module)
    lines = [f"LIBRARY {module}.dll", "EXPORTS"]
    for name, stands_for in sorted(meaning(definitions).items()):
        if not name.startswith("_ZTS") and (stands_for in wanted or ONLY_WINDOWS.search(stands_for)):
            lines.append(f"    {name}{' DATA' if definitions[name] else ''}")
    (LISTS / f"{module}.def").write_text("\n".join(lines) + "\n")


def def_names(module):
    lines = (LISTS / f"{module}.def").read_text().splitlines()[2:]
    return {line.split()[0] for line in lines if line.strip()}


def differences(where, listed, exported):
    return ([f"{where}: {name} is listed and not exported" for name in sorted(listed - exported)] +
            [f"{where}: {name} is exported and not listed" for name in sorted(exported - listed)])


def check(module):
    listed = set((LISTS / f"{module}.elf.txt").read_text().split())
    problems = differences(f"lib{module}.so", listed, elf_names(module))
    problems += differences(f"{module}.dll", def_names(module), pe_names(module))
    on_linux = set(meaning(listed).values())
    on_windows = set(meaning(def_names(module)).values())
    problems += [f"{module}: {name} is exported on Linux only" for name in sorted(on_linux - on_windows)
                 if not name.startswith(("typeinfo", "vtable"))]
    return problems


def main():
    if "--update" in sys.argv:
        for module in MODULES:
            (LISTS / f"{module}.elf.txt").write_text("\n".join(sorted(elf_names(module))) + "\n")
            write_def(module)
        return
    problems = [line for module in MODULES for line in check(module)]
    common.finish("exports", problems, len(MODULES))


main()
