#!/usr/bin/env python3
"""Every type and every expression of zor_basis.natvis exists in the debug information of the Windows build."""

import re
import xml.etree.ElementTree

import common

FILE = "tools/debuggers/zor_basis.natvis"
LIBRARY = common.ROOT / "build/windows/bin/zor_basis.dll"
SPACE = "{http://schemas.microsoft.com/vstudio/debugger/natvis/2010}"
TEXTS = ("DisplayString",)
EXPRESSIONS = ("Item", "Size", "ValuePointer", "HeadPointer", "StringView")
OF_NODE = ("NextPointer", "ValueNode")
GROUPS = ("Expand", "ArrayItems", "LinkedListItems", "Synthetic")


def gdb(commands):
    return common.run("gdb", "--nx", "--batch", *[w for c in commands for w in ("-ex", c)], LIBRARY, check=True).stdout


def instances(pattern):
    """The types of the library that a name of the file means."""
    begin, star, _ = pattern.partition("<*>")
    if not star:
        return [pattern]
    listed = gdb([f"info types ^{begin}<"])
    return re.findall(rf"^\d+:\s+({re.escape(begin)}<.*>);$", listed, re.M)


def without_format(expression):
    """An expression and what its format asks for, as in `text_,[size_]s`."""
    expression, _, form = expression.strip().partition(",")
    return [expression, *re.findall(r"\[(.+?)\]", form)]


def expressions(element, head=None):
    """(expression, head of the list whose node it belongs to) of an element and those in it."""
    name = element.tag.removeprefix(SPACE)
    own = (element.text or "").strip()
    if "Condition" in element.attrib:
        yield element.get("Condition"), None
    if name in TEXTS:
        for part in re.findall(r"(?<!\{)\{([^{}]+)\}", own):
            yield from ((e, None) for e in without_format(part))
    elif name in EXPRESSIONS + OF_NODE:
        yield from ((e, head if name in OF_NODE else None) for e in without_format(own))
    elif own or name not in GROUPS + ("Type",):
        yield f"{name} is no element that this checker knows", None
    for child in element:
        yield from expressions(child, element.findtext(f"{SPACE}HeadPointer"))


def within(expression, scope):
    """The expression with its members named from outside the object."""
    return re.sub(r"(?<![\w.>])([A-Za-z_]\w*)", rf"{scope}->\1", expression)


def main():
    root = xml.etree.ElementTree.parse(common.ROOT / FILE).getroot()
    asked, problems = [], []
    for element in root.iter(f"{SPACE}Type"):
        found = instances(element.get("Name"))
        if not found:
            problems.append(f"{FILE}: the library has no {element.get('Name')}")
        for instance in found:
            scope = f"(('{instance}' *)0)"
            asked.append((instance, "type", f"*{scope}"))
            for expression, head in expressions(element):
                place = scope if head is None else f"({within(head, scope)})"
                asked.append((instance, expression, within(expression, place)))
    answers = gdb([c for i, (_, _, e) in enumerate(asked) for c in (f"echo [{i}]", f"whatis {e}", "echo \\n")])
    for number, (instance, expression, _) in enumerate(asked):
        if re.search(rf"^\[{number}\]type = ", answers, re.M) is None:
            problems.append(f"{FILE}: {instance} has no {expression}")
    common.finish("natvis", problems, len(asked))


main()
