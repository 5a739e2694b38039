#!/usr/bin/env python3
"""Counts non-blank, non-comment lines of C and C++ and prints the ratio of
test lines (tests/, fuzz/) to code lines (src/, standin/, tools/, bench/).

usage: scripts/test-ratio.py [-v]   (-v lists every file's count)
"""
import pathlib
import re
import sys

CODE = ("src", "standin", "tools", "bench")
TESTS = ("tests", "fuzz")
SUFFIXES = {".c", ".cc", ".cpp", ".h", ".hpp"}
COMMENTS = re.compile(r"//[^\n]*|/\*.*?\*/", re.S)
STRINGS = re.compile(r'"(?:\\.|[^"\\\n])*"')


def lines_of(path):
    text = path.read_text(encoding="utf-8", errors="replace")
    # Strings first, so that "//" inside a string is not taken for a comment.
    text = STRINGS.sub('""', text)
    text = COMMENTS.sub(lambda m: "\n" * m.group(0).count("\n"), text)
    return sum(1 for line in text.splitlines() if line.strip())


def count(root, folders, verbose):
    total = 0
    for folder in folders:
        for path in sorted((root / folder).rglob("*")):
            if path.suffix in SUFFIXES and path.is_file():
                n = lines_of(path)
                total += n
                if verbose:
                    print(f"{n:6} {path.relative_to(root)}")
    return total


def main():
    root = pathlib.Path(__file__).resolve().parent.parent
    verbose = "-v" in sys.argv[1:]
    code = count(root, CODE, verbose)
    tests = count(root, TESTS, verbose)
    print(f"code {code}, tests {tests}, tests/code {tests / code:.2f}")


if __name__ == "__main__":
    main()
