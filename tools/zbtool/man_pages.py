#!/usr/bin/env python3
"""man_pages.py PROGRAM FOLDER VERSION: writes the manual pages of zbtool from its own help, one for the program and one
for each command, and the same compressed. The same help gives the same bytes."""

import gzip
import re
import subprocess
import sys
from pathlib import Path

SECTIONS = {"Positionals:": "ARGUMENTS", "Options:": "OPTIONS", "Subcommands:": "COMMANDS"}
ENTRY = re.compile(r"^  (\S(?:.*?\S)?)(?:\s{2,}(\S.*))?$")
EXIT_STATUS = """.SH EXIT STATUS
.TP
.B 0
All was done.
.TP
.B 1
Something failed, or nothing was found. Standard error has a line that names the path and the reason.
.TP
.B 2
The command line is wrong.
.PP
Ctrl-C ends the program by its signal and leaves no partial file.
"""
ENVIRONMENT = """.SH ENVIRONMENT
.TP
.B XOS_ROOT
The root folder below which logs and temporary folders lie.
"""


def help_of(program, path):
    return subprocess.run([program, *path, "--help"], check=True, capture_output=True, text=True).stdout


def escaped(text):
    text = text.replace("\\", "\\e").replace("-", "\\-")
    return "\\&" + text if text[:1] in ".'" else text


def entries(lines):
    """(name, text) of the entries of one section; a long name has its text on the next line."""
    found = []
    for line in lines:
        if match := ENTRY.match(line):
            found.append([match[1], match[2] or ""])
        elif line.strip():
            found[-1][1] = f"{found[-1][1]} {line.strip()}".strip()
    return found


def parts(text):
    """(about, usage, {section: entries})"""
    about, _, rest = text.partition("Usage: ")
    usage, _, rest = rest.partition("\n")
    sections, name = {}, None
    for line in rest.split("\n"):
        if line in SECTIONS:
            name = line
            sections[name] = []
        elif name:
            sections[name].append(line)
    return about.strip(), usage, {name: entries(lines) for name, lines in sections.items()}


def body(text, heading):
    about, usage, sections = parts(text)
    lines = [f".{heading[0]} SYNOPSIS", escaped(usage), f".{heading[0]} DESCRIPTION", *map(escaped, about.split("\n"))]
    for name, found in sections.items():
        lines.append(f".{heading[0]} {SECTIONS[name]}")
        for entry, meaning in found:
            lines += [".TP", f".B {escaped(entry)}", escaped(meaning)]
    return lines


def page(program, path, version):
    text = help_of(program, path)
    about, _, sections = parts(text)
    name = "-".join(["zbtool", *path])
    lines = [f'.TH {name.upper()} 1 "" "zor_basis {version}" "User Commands"', ".SH NAME",
             f"{escaped(name)} \\- {escaped(about.splitlines()[0].rstrip('.'))}", *body(text, ["SH"])]
    commands = [entry for entry, _ in sections.get("Subcommands:", [])]
    if path:
        # The parser takes the first words behind the command for its own arguments.
        arguments = [entry.split()[0] for entry, _ in sections.get("Positionals:", [])]
        for command in commands:
            lines.append(f".SH {escaped(' '.join(['zbtool', *path, *arguments, command]))}")
            lines += body(help_of(program, [*path, *arguments, command]), ["SS"])
        lines += [EXIT_STATUS.strip(), ".SH SEE ALSO", ".BR zbtool (1)"]
    else:
        lines += [EXIT_STATUS.strip(), ENVIRONMENT.strip(), ".SH SEE ALSO",
                  ",\n".join(f".BR zbtool\\-{command} (1)" for command in commands)]
    return name, "\n".join(lines) + "\n", commands


def main():
    program, folder, version = sys.argv[1], Path(sys.argv[2]), sys.argv[3]
    folder.mkdir(parents=True, exist_ok=True)
    pending = [[]]
    while pending:
        path = pending.pop()
        name, text, commands = page(program, path, version)
        (folder / f"{name}.1").write_text(text)
        (folder / f"{name}.1.gz").write_bytes(gzip.compress(text.encode(), 9, mtime=0))
        if not path:
            pending += [[command] for command in commands]


main()
