#!/usr/bin/env python3
"""Checks what gdb prints for the values of a program: printers_test.py PROGRAM LIBRARY. The printers are those that gdb
loads by itself beside the library."""

import re
import subprocess
import sys
from pathlib import Path

# An expression of printed_values.cpp, and the pattern of all that gdb prints for it.
EXPECTED = (
    ("texts.view", r'"seen"'),
    ("texts.emptyView", r'""'),
    ("texts.cutView", r'"cut"'),
    ("texts.nothing", r"null"),
    ("texts.badView", r"null of size 7"),
    ("texts.inlineText", r'"tray \\"1\\""'),
    ("texts.heapText", r"'x' <repeats 20 times>"),
    ("texts.emptyText", r'""'),
    ("texts.largeText", r'"page"'),
    ("texts.manyBytes", r"'m' <repeats 200 times>\.\.\."),
    ("texts.stored", r'"stored"'),
    ("texts.storedNothing", r'""'),
    ("texts.path", r'"/scsi0/tmp"'),
    ("texts.hashed", r'hash \d+ = \{text = "key"\}'),
    ("texts.copied", r'"copied"'),
    ("wide.view", r'"wide"'),
    ("wide.inlineText", r'"päge"'),
    ("wide.heapText", r'"(vw){100}"\.\.\.'),
    ("wide.emptyText", r'""'),
    ("wide.path", r'"c:/tmp"'),
    ("wide.fixed", r'"fixed"'),
    ("bytes.none", r"empty"),
    ("bytes.some", r'5 bytes of \d+: "a\\x22\\x00\\xffz"'),
    ("bytes.cleared", r"0 bytes of \d+"),
    ("bytes.secret", r"6 bytes of \d+: not shown"),
    ("sequences.list", r"2 units = \{1, 2\}"),
    ("sequences.movedFrom", r"empty"),
    ("sequences.emptyList", r"empty"),
    ("sequences.dict", r'1 keys, not saved, file "no such file" = '
                       r'\{\[4 bytes of \d+: "tray"\] = 1 bytes of \d+: "2"\}'),
    ("sequences.emptyDict", r'0 keys, file ""'),
    ("sequences.pointers", r"3 slots of 4 = \{(0x[0-9a-f]+), 0x0, \1\}"),
    ("sequences.noPointers", r"0 slots of 2"),
    ("timers.fresh", r'"fresh", id 0, 0 times, not started = \{total_ = 0, suspendTotal_ = 0, max_ = \S+, '
                     r"suspendMax_ = \S+\}"),
    ("timers.used", r'"used", id 0, 2 times, not started = \{total_ = [1-9]\d*, .*\}'),
    ("timers.running", r'"running", id 0, 0 times, running = \{.*, start = [1-9]\d*\}'),
    ("timers.shared", r'"shared", id 0, 0 times, not started = .*'),
    ("timers.idle", r"not started"),
    ("timers.held", r"suspended = \{start = \d+, suspendStart = \d+\}"),
    ("good", r"returned true = \{function = .*succeed\(void\*\)>, argument = 0x[0-9a-f]+.*\}"),
    ("bad", r"returned false = \{function = .*fail\(void\*\)>, argument = 0x0\}"),
    ("waiting", r"waiting = \{.*\}"),
)


def main():
    program, library = Path(sys.argv[1]), Path(sys.argv[2]).resolve()
    commands = ["set charset UTF-8", "set print elements 200", "break shown", "run"]
    command = ["gdb", "--nx", "--batch", "-iex", f"set auto-load safe-path {library.parent}"]
    for expression in commands:
        command += ["-ex", expression]
    for number, (expression, _) in enumerate(EXPECTED):
        command += ["-ex", f"echo [{number}]", "-ex", f"output {expression}", "-ex", "echo \\n"]
    done = subprocess.run([*command, str(program)], capture_output=True, encoding="utf-8", timeout=120)
    failed = 0
    for number, (expression, pattern) in enumerate(EXPECTED):
        found = re.search(rf"^\[{number}\](.*)$", done.stdout, re.MULTILINE)
        if found is None or re.fullmatch(pattern, found[1]) is None:
            failed += 1
            print(f"{expression} is printed as\n  {found[1] if found else 'nothing'}\nand not as\n  {pattern}")
    if failed != 0:
        print(done.stderr)
    print(f"[  PASSED  ] {len(EXPECTED) - failed} tests.")
    if failed != 0:
        sys.exit(f"[  FAILED  ] {failed} tests.")


main()
