#!/usr/bin/env python3
"""What Doxygen reads instead of a header or a page: doxygen_filter.py FILE.

In our headers a comment describes all declarations that follow it up to an empty line, and the comment of the file
describes the class that it begins with. This writes both down as Doxygen expects them. Special members without a
comment of their own are described by their class; they and instantiations are left out."""

import re
import sys
from pathlib import Path

COMMENT = re.compile(r"\s*///(?!<)")
SPECIAL = re.compile(r".*= (?:default|delete);$|\s*(?:virtual )?~\w+\(\).*;$|ZB_EXTERN_TEMPLATE .*;$|"
                     r"\s*using \w+::\w+;$")
TYPE = re.compile(r"\s*(?:requires\b.*\) )?(?:class|struct|union|enum|typedef struct|namespace)\b[^;]*$")
CLASS = re.compile(r"(?:requires\b.*\) )?(?:class|struct) (?:ZB_API )?(\w+)(?:<.*>)?(?: final)?(?: :.*)?\s*\{")
IGNORED = re.compile(r"\s*(?:template <.*>|ZB_INLINE_PARTS_\w+|#.*|public:|protected:|private:)?$")
# A backslash that begins no tag, in text and not in an example.
BACKSLASH = re.compile(r"\\(?!(?:param|pre|return|error|thread|cost|kept|since|file)\b)(?=[A-Za-z])")


def starts_type(lines, index):
    """Whether the declaration at a line defines a type, which has its own members."""
    while index < len(lines) and IGNORED.match(lines[index]) and lines[index].strip():
        index += 1
    return index < len(lines) and TYPE.match(lines[index]) is not None


def file_comment(lines):
    """The comment of the file, from behind `\\file`."""
    found = []
    if lines and lines[0].startswith("/// \\file"):
        for line in lines[1:]:
            if not line.startswith("///"):
                break
            found.append(line)
    return found


def with_groups(lines):
    """Puts what a comment describes into a group, whose members then share the comment."""
    depth = start = 0
    grouped = False
    for index, line in enumerate(lines):
        is_comment = COMMENT.match(line) is not None
        begins = is_comment and (index == 0 or not COMMENT.match(lines[index - 1]))
        if grouped and depth == start and (begins or not line.strip() or re.match(r"\s*(?:\}|\w+:$)", line)):
            yield "///@}"
            grouped = False
        after = next((i for i in range(index, len(lines)) if not COMMENT.match(lines[i])), len(lines))
        if begins and index > 0 and after < len(lines) and lines[after].strip() and not starts_type(lines, after):
            yield "///@{"
            grouped, start = True, depth
        yield line
        code = re.sub(r"//.*|\"(?:\\.|[^\"])*\"|'(?:\\.|[^'])'", "", line)
        depth += code.count("{") - code.count("}")


def described_classes(lines):
    """Gives the first class the comment of the file, and leaves out special members without a comment."""
    comment, previous = file_comment(lines), ""
    name = re.match(r"/// `(\w+)", comment[0])[1] if comment and comment[0].startswith("/// `") else None
    for line in lines:
        found = CLASS.match(line)
        if comment and found and found[1] == name:
            if not COMMENT.match(previous):
                yield from comment
            comment = []
        if SPECIAL.match(line) and not COMMENT.match(previous):
            continue
        # An instance of a template as a base would be described a second time.
        yield re.sub(r"(: public \w+)<.*> \{$", r"\1 {", line) if found else line
        if line.strip() and not IGNORED.match(line):
            previous = line


def without_paths(lines, is_page):
    """Keeps Doxygen from taking the parts of a path for its tags, but not in code."""
    in_code, previous = False, ""
    for line in lines:
        if is_page:
            in_code ^= line.startswith("```")
        else:
            in_code = line.lstrip().startswith("///     ") and (in_code or previous.strip() == "///")
        is_text = not in_code and (is_page or COMMENT.match(line))
        pieces = re.split(r"(`[^`]*`)", line) if is_text else [line]
        yield "".join(BACKSLASH.sub(r"\\\\", p) if is_text and not p.startswith("`") else p for p in pieces)
        previous = line


def without_names(lines):
    """Makes ordinary comments of the headings over groups of members, as Doxygen asks for a comment of each member."""
    for line in lines:
        if not re.match(r"\s*/// @[{}]$", line):
            yield re.sub(r"/// \\name (.*?)[.:]?$", r"/// \1.", line)


def main():
    path = Path(sys.argv[1])
    text = path.read_text(encoding="utf-8")
    lines = text.splitlines()
    is_page = path.suffix == ".md"
    if not is_page:
        lines = list(with_groups(list(described_classes(list(without_names(lines))))))
    sys.stdout.write("".join(line + "\n" for line in without_paths(lines, is_page)))


main()
