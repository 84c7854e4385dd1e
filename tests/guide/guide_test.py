#!/usr/bin/env python3
"""Runs the blocks of the guide that are no C++, in the order of a page: guide_test.py BIN LIB C_PROGRAM PAGE...
C programs are built already; shell and Python blocks run in an empty folder, which is also their root."""

import os
import subprocess
import sys
import tempfile
from pathlib import Path

sys.path.insert(0, str(Path(__file__).resolve().parents[2] / "tools"))
import guide_program


def run(command, folder, binaries, libraries, **options):
    environment = dict(os.environ, XOS_ROOT=folder, LD_LIBRARY_PATH=str(libraries),
                       PATH=f"{binaries}:{os.environ['PATH']}")
    return subprocess.run(command, cwd=folder, env=environment, capture_output=True, text=True, timeout=120, **options)


def result_of(page, language, c_program, *places):
    with tempfile.TemporaryDirectory() as folder:
        if language == "c":
            return run([c_program], folder, *places)
        code = "".join(line + "\n" for _, lines in guide_program.of_language(page, language) for line in lines)
        command = [sys.executable, "-"] if language == "python" else ["bash", "-euo", "pipefail"]
        return run(command, folder, *places, input=code)


def main():
    binaries, libraries, c_program, *pages = (Path(argument).resolve() for argument in sys.argv[1:])
    passed = failed = 0
    for page in pages:
        for language in ("c", "python", "sh"):
            if not guide_program.of_language(page, language):
                continue
            done = result_of(page, language, c_program, binaries, libraries)
            expected = guide_program.outputs_after(page, language)
            if done.returncode == 0 and done.stdout == expected:
                passed += 1
            else:
                failed += 1
                print(f"{page}, {language}: exit code {done.returncode}, printed\n{done.stdout}{done.stderr}"
                      f"and not\n{expected}")
    print(f"[  PASSED  ] {passed} tests.")
    if failed != 0 or passed == 0:
        sys.exit(f"[  FAILED  ] {failed} tests.")


main()
