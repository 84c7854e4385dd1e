#!/usr/bin/env python3
"""Words that the project must not contain: unfinished work, paths of one machine, documents that are not part of it."""

import re

import common

# Written in pieces, as this file is checked like every other.
UNFINISHED = "|".join(["TO" + "DO", "FIX" + "ME", "X" + "XX", "HA" + "CK", "not (?:yet )?imple" + "mented",
                       "DIS" + "ABLED_", "GTEST_" + "SKIP"])
ELSEWHERE = "|".join(["speci" + "fication", "sp" + r"ec\.md", "the sp" + "ec", "des" + r"ign\.md", "sty" + r"le\.md",
                      "Par" + r"ts? [0-9]+(?:\.[0-9]+)?"])
MACHINE = "/(?:wo" + "rk|ro" + "ot|ho" + "me)/"
# The one place where a test may say that its case cannot hold on a target.
ALLOWED = {"tests/support/skip.h"}

pattern = re.compile(rf"\b(?:{UNFINISHED})\b|\b(?i:{ELSEWHERE})\b|(?<![\w.]){MACHINE}")
checked = common.files()
problems = []
for path in checked:
    if str(path) in ALLOWED or path.suffix in (".bin", ".png"):
        continue
    for number, line in enumerate(common.text(path).split("\n"), 1):
        if match := pattern.search(line):
            problems.append(f"{path}:{number}: {match[0]}")
common.finish("words", problems, len(checked))
