#!/usr/bin/env python3
"""Phrases that read as translated, in comments, documents and messages; docs/glossary.md says what to write instead.
And parameters of public functions whose text has no verb: `\\param path  copied` is `\\param path  is copied`."""

import re

import common

START = r"(?:^|(?<=[.:;?!] )|(?<=\*\* )|(?<=\| )|(?<=- ))"
PHRASES = {
    START + r"Who (?![^.]*\?)": "A caller that …",
    r"\b[Ww]hoever\b": "a caller that …, the thread that …",
    r"\b(?:is|are) as good\b": "counts as success",
    r"\b[Aa]t once\b": "immediately; concurrently; in one step",
    r"(?<!\bin )\b(?:the|that) way\b": "so that; through; how",
    r"\bby way of\b": "through, by",
    r"\b(?:[Nn]obody's|(?:by|that) nobody|nobody (?:waits|awaits|else))\b": "never …, no other …, without an owner",
    r"\bwants? (?:its?|the|an?)\b": "requires, must be followed by, expects",
    r"\bnothing ever\b": "never … anything",
    r"\bfor ever\b": "forever",
    r"\b[Ss]o (?:is|are|does|do) (?:any|every) other\b": "any other value means the same",
    START + r"Has (?:the|a|its) (?!same)": "Makes the …",
    r"\bno need of\b": "not meant for, needs no",
    r"\bmemory lacks\b": "memory is short",
    r"\ball that (?:is in|lies in|they have) \w+": "all its contents",
    r"\bas [^.,;:()]{1,40} (?:has|have) (?:it|them)\b": "like …, as … defines it",
    r"\b[Tt]ak(?:es?|en|ing) away\b": "removes",
    r"\b[Tt]ak(?:es?|en|ing) (?:\w+ ){0,2}apart\b": "splits, parses",
    r"\bstays? as (?:it|they) (?:was|were|is|are)\b": "is unchanged",
    r"\bwhatever comes out\b": "whatever the result",
    r"\bupper and lower case differ\b": "case-sensitive",
    r"\bC-clean\b": "valid C",
    r"\bis told why\b": "reports why",
    r"\bbut where\b": "unless",
    r"\bsomebody\b": "the caller, a thread",
}
PATTERN = re.compile("|".join(f"(?P<p{i}>{phrase})" for i, phrase in enumerate(PHRASES)))
INSTEAD = list(PHRASES.values())

# What a comment line begins with; the marks of C, of scripts and of lists are no text.
MARK = re.compile(r"^\s*(?:///?<?|/\*+|\*+/?|#+(?!\s*(?:include|define|if|else|elif|endif|pragma|undef)\b))\s?")
TRAILING = re.compile(r"(?<=[;{},)])\s*///?<? ?(.*)$")
CODE = re.compile(r"`[^`]*`|\"[^\"]*\"")

PARAMETER = re.compile(r"\\param (\w+(?:, \w+)*)\s+(.*)")
VERB = re.compile(r"(?:\\kept |(?:then |also |only )?(?:may|must|can|cannot|has|is|does|[a-z]+s)\b)")
PLURAL = re.compile(r"(?:have|pass|may|must|are|receive)\b")
NOUNS = re.compile(r"(?:bytes|units|keys|times|seconds|arguments|elements|flags|texts|its|as|this|unless|less)\b")


def lines_of_prose(path, content):
    """The lines of a file with their numbers, only the comments of sources; None ends a paragraph."""
    source = path.suffix in (".h", ".cpp", ".c", ".py", ".cmake")
    quoted = False
    for number, line in enumerate(content.split("\n"), 1):
        if path.suffix == ".md":
            quoted ^= line.startswith("```")
            yield number, None if quoted or path.name == "glossary.md" and line.startswith("|") else line
        elif mark := MARK.match(line):
            yield number, line[mark.end():]
        elif source:
            yield number, trailing[1] if (trailing := TRAILING.search(line)) else None
        else:
            yield number, line


def paragraphs(path, content):
    """Runs of lines as one text each, with the numbers of the lines that its characters come from."""
    words, numbers = "", []
    for number, line in [*lines_of_prose(path, content), (0, None)]:
        text = None if line is None else line.strip()
        if words and (not text or text.startswith(("\\", "- ", "|", "@"))):
            yield words, numbers
            words, numbers = "", []
        if text:
            words += text + " "
            numbers += [number] * (len(text) + 1)


def without_code(path, words):
    """Code and quoted texts are not prose, but in scripts the quoted texts are the messages."""
    return words if path.name == "dev" else CODE.sub(lambda code: "`" + "_" * (len(code[0]) - 2) + "`", words)


def problems_in(path):
    public = str(path).startswith(("include/", "host/include/"))
    for words, numbers in paragraphs(path, common.text(path)):
        for match in PATTERN.finditer(without_code(path, words)):
            instead = INSTEAD[int(match.lastgroup[1:])]
            yield f'{path}:{numbers[match.start()]}: "{match[0].strip()}" (write: {instead})'
        if public and (parameter := PARAMETER.match(words)):
            expected = PLURAL if "," in parameter[1] else VERB
            if not expected.match(parameter[2]) or NOUNS.match(parameter[2]):
                yield f"{path}:{numbers[0]}: \\param {parameter[1]} has no verb: {parameter[2].strip()}"


def main():
    checked = common.files("include/**.h", "basis/**", "host/**", "docs/**.md", "README.md", "CHANGELOG.md", "dev")
    problems = [problem for path in checked for problem in problems_in(path)]
    common.finish("prose", problems, len(checked))


main()
