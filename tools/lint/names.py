#!/usr/bin/env python3
"""One dialect: how members, constants, enumerators and suites are named, how a twin begins, where tags stand, and that
no line is longer than 120 columns."""

import re

import common

COLUMNS = 120
# Data, made by programs or by the systems they are to be compared with.
DATA = (".inc", ".bin", ".png", ".def", ".map", ".txt", ".gz")
# Names that the interface gives.
GIVEN = {"Binary", "Continue", "Mutex", "SizeWChar", "StopOnError", "_CurName", "_ExtRip", "_GlbTmp", "_Level", "_Sem",
         "_freq", "slashBad", "slashGood"}

COMMENT = re.compile(r"//[^\n]*|/\*.*?\*/|\"(?:[^\"\\\n]|\\.)*\"", re.S)
UNDERSCORE = re.compile(r"(?<![\w.>:\"])(?:_|m_)[a-z]\w*(?=(?:\[[^]]*\])?(?:\{[^;]*\}| = [^;]*)?;)")
CONSTANT = re.compile(r"^(?: *(?:static|inline) )?(?:inline |static )?constexpr (?!bool is|bool has)"
                      r"[\w:<>, *&]*?[ *&](\w+)(?:\[[^]]*\])?(?: =|\{|;)", re.M)
ENUMERATION = re.compile(r"\benum(?: class| struct)?(?: \w+)?(?: : [\w:]+)? \{([^}]*)\}")
ENUMERATOR = re.compile(r"(?:^|,)\s*(\w+)")
ALL_CAPS = re.compile(r"[A-Z][A-Z0-9_]*$")
PRIVATE = re.compile(r"^(?:class|struct) (?:\w+ )*\w+[^;{]*\{.*?^\};", re.M | re.S)
MEMBER = re.compile(r"^    (?! |using |friend |static constexpr |typedef |return |template )"
                    r"(?:mutable |static |inline )*[\w:<>, *&]+[ *&](\w+)(?:\[[^]]*\])?(?:\{[^;]*\}| = [^;]*)?;", re.M)

SUITE = re.compile(r"^(?:TYPED_)?TEST(?:_[FP])?\((\w+),|^TYPED_TEST_SUITE(?:_P)?\((\w+),", re.M)
SYSTEM = re.compile(r"_(posix|win)_test$")
SYSTEM_WORD = re.compile(r"Linux|Windows|(?:Posix|Win)$")

TAG = re.compile(r"(?<!`)\\(param|pre|return|error|thread|cost|kept|since)\b")
TAG_LINE = re.compile(r"\s*///<? (?:\\param \w+(?:, \w+)*  \S|\\kept [a-z-]+-\d+: \S"
                      r"|\\(?:pre|return|error|thread|cost|since) \S)")
CONTINUED = re.compile(r"\s*///     \S")


def is_twin(path):
    """A source of which the same room has the other system's."""
    for mine, other in (("_posix.cpp", "_win.cpp"), ("_win.cpp", "_posix.cpp")):
        if path.name.endswith(mine):
            sibling = path.with_name(path.name.removesuffix(mine) + other)
            return sibling.name if (common.ROOT / sibling).exists() else None
    return None


def line_of(content, position):
    return content.count("\n", 0, position) + 1


def names_in(content):
    """What breaks the rules of names in a source without comments and texts: (position, message)."""
    for match in UNDERSCORE.finditer(content):
        if match[0] not in GIVEN:
            yield match.start(), f"{match[0]}: members end in _ instead"
    for match in CONSTANT.finditer(content):
        if not ALL_CAPS.match(match[1]) and match[1] not in GIVEN:
            yield match.start(1), f"{match[1]}: constants are ALL_CAPS"
    for block in ENUMERATION.finditer(content):
        if "#define" in block[1]:  # made by a macro, of names that the interface gives
            continue
        for match in ENUMERATOR.finditer(block[1]):
            if not ALL_CAPS.match(match[1]) and match[1] not in GIVEN:
                yield block.start(), f"{match[1]}: enumerators are ALL_CAPS"
    for block in PRIVATE.finditer(content):
        start = block[0].find("\nprivate:")
        for match in MEMBER.finditer(block[0], start) if start >= 0 else ():
            if not match[1].endswith("_") and match[1] not in GIVEN:
                yield block.start() + match.start(1), f"{match[1]}: private members end in _"


def suites_in(path, content):
    system = SYSTEM.search(path.stem)
    expected = system and {"posix": "Posix", "win": "Win"}[system[1]]
    for match in SUITE.finditer(content):
        name = match[1] or match[2]
        if not re.match(r"[A-Z]", name) or name.endswith("Test"):
            yield match.start(), f"suite {name}: UpperCamel, named after what it tests, without Test"
        elif expected and not name.endswith(expected):
            yield match.start(), f"suite {name}: ends in {expected} like its file"
        elif not expected and SYSTEM_WORD.search(name):
            yield match.start(), f"suite {name}: names a system, its file does not"


def tags_in(content):
    within = False
    for number, line in enumerate(content.split("\n"), 1):
        is_comment = line.lstrip().startswith("///")
        if is_comment and TAG.search(line):
            within = True
            if not TAG_LINE.match(line):
                yield number, "a tag begins its line, with one space behind it and two behind a parameter"
        elif not is_comment or not line.lstrip().removeprefix("///").strip(" @{}"):
            within = False
        elif within and not CONTINUED.match(line):
            yield number, "a tag's further lines are indented by five spaces"


def is_written_by_hand(path):
    is_data = path.suffix in DATA or "corpus" in path.parts
    return not is_data or path.name == "CMakeLists.txt" or path.parts[0] == "tools"


def problems_in(path):
    content = common.text(path)
    if is_written_by_hand(path):
        for number, line in enumerate(content.split("\n"), 1):
            if len(line) > COLUMNS:
                yield f"{path}:{number}: {len(line)} columns"
    if path.suffix not in (".h", ".cpp"):
        return
    bare = COMMENT.sub(lambda match: re.sub(r"[^\n]", " ", match[0]), content)
    found = [*names_in(bare), *(suites_in(path, bare) if path.parts[0] == "tests" else ())]
    yield from (f"{path}:{line_of(bare, position)}: {message}" for position, message in found)
    if (sibling := is_twin(path)) and not content.startswith(f"// The sibling is {sibling}."):
        yield f'{path}:1: begins with "// The sibling is {sibling}."'
    if path.suffix == ".h" and path.parts[0] != "tests":
        yield from (f"{path}:{number}: {message}" for number, message in tags_in(content))


checked = common.files()
common.finish("names", [problem for path in checked for problem in problems_in(path)], len(checked))
