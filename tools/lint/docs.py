#!/usr/bin/env python3
"""The reference and the guide in build/docs/html, made by Doxygen without a warning: every public symbol is described,
and every link leads somewhere."""

import os
import re

import common

SETTINGS = "docs/doxygen/Doxyfile"
PAGE = "build/docs/html/index.html"


def main():
    version = re.search(r"^project\(zor_basis VERSION (\S+)", common.text("CMakeLists.txt"), re.M)[1]
    (common.ROOT / "build").mkdir(exist_ok=True)
    done = common.run("doxygen", SETTINGS, env=dict(os.environ, ZB_VERSION=version))
    problems = sorted({line.removeprefix(f"{common.ROOT}/") for line in done.stderr.splitlines()})
    if done.returncode != 0 or not (common.ROOT / PAGE).is_file():
        problems.append(f"doxygen has made no {PAGE}")
    common.finish("docs", problems, len(common.files("include/**.h", "host/include/*.h", "docs/guide/*.md")))


main()
