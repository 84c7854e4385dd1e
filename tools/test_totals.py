#!/usr/bin/env python3
"""Counts the cases in the verbose output of ctest: `passed failed skipped`.

For a GoogleTest program it counts the cases; any other test counts as one. With --failures it prints the output of the
tests that failed instead.
"""

import re
import sys

START = re.compile(r"^test (\d+)$")
LINE = re.compile(r"^(\d+): (.*)$")
END = re.compile(r"^\s*\d+/\d+ Test\s+#(\d+): (\S+) \.*\s*(.*?)\s+[\d.]+ sec")
CASES = re.compile(r"^\[  (PASSED |FAILED |SKIPPED)\s?\] (\d+) tests?\b")
FIXTURES = {"wine_session_start", "wine_session_stop"}


def read(path):
    """The output lines and the verdict of each test."""
    output, verdicts = {}, {}
    with open(path, encoding="utf-8", errors="replace") as log:
        for raw in log:
            line = raw.rstrip("\r\n")
            if match := LINE.match(line):
                output.setdefault(match[1], []).append(match[2].rstrip("\r"))
            elif match := END.match(line):
                verdicts[match[1]] = (match[2], match[3].startswith("Passed"))
    return output, verdicts


def totals(output, verdicts):
    passed = failed = skipped = 0
    for number, (name, good) in verdicts.items():
        counts = {"PASSED": 0, "FAILED": 0, "SKIPPED": 0}
        found = False
        for line in output.get(number, []):
            if match := CASES.match(line):
                counts[match[1].strip()] += int(match[2])
                found = True
        if found:
            passed += counts["PASSED"]
            failed += counts["FAILED"]
            skipped += counts["SKIPPED"]
            if not good and counts["FAILED"] == 0:
                failed += 1
        elif name not in FIXTURES:
            passed, failed = (passed + 1, failed) if good else (passed, failed + 1)
    return passed, failed, skipped


def main():
    path = sys.argv[-1]
    output, verdicts = read(path)
    if "--failures" in sys.argv:
        for number, (name, good) in verdicts.items():
            if not good:
                lines = output.get(number, [])
                interesting = [l for l in lines if not l.startswith(("[ RUN ", "[       OK", "[-----"))]
                print(f"---- {name}", *interesting[-80:], sep="\n")
        return
    print(*totals(output, verdicts))


if __name__ == "__main__":
    main()
