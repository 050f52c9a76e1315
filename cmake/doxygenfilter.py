#!/usr/bin/env python3
"""Hands a header to Doxygen with the house's comments marked: doxygenfilter.py HEADER

The sentence at the top of a header is that of the file and of its only (else its namesake) class;
a comment on lines of its own before a declaration is that declaration's, one behind a member is the
member's. The code is printed as it is, line by line, so that places in warnings are right.
"""
import pathlib
import re
import sys

COMMENT = re.compile(r"^(\s*)//(?!/)( ?)(.*)$")
BEHIND = re.compile(r"^(.*[^\s/].*?\s)//(?![/!])( ?)(.*)$")
CLASS = re.compile(r"^(?:class|struct) (?:\[\[nodiscard\]\] )?(\w+)[^;]*$")


def top_comment(lines):
    """The comment that starts a header: its lines, in words."""
    words = []
    for line in lines:
        match = COMMENT.match(line)
        if not match:
            break
        words.append(match[3])
    return words


def main_class(lines, stem):
    """Index of the line of the class that a header is about."""
    classes = [(i, match[1]) for i, line in enumerate(lines) if (match := CLASS.match(line))]
    named = [i for i, name in classes if name.lower().removeprefix("c") == stem]
    return named[0] if named else classes[0][0] if len(classes) == 1 else None


def column(line):
    return line.index("//")


ONE = r"\w+\s*(?:=[^,;]*|\{[^{}]*\})?"  # a name with its first value
SEVERAL = re.compile(rf"^\s*([\w:<>, ]*[\w>])\s+({ONE}(?:,\s*{ONE})+);\s*$")


def declarations(code):
    """Each declaration of "size_t i = 0, j = 0;" alone; one for any other line."""
    match = SEVERAL.match(code)
    if not match or match[1] in ("return", "using"):
        return [code]
    return [f"{match[1]} {part.strip()};" for part in re.split(r",(?![^{]*\})", match[2])]


def with_words(code, words):
    """A line of code with the words for every member that it declares."""
    if code.startswith(("struct ", "class ", "enum ")) and code.endswith("{"):
        return f"/** {words} */ {code}"
    parts = declarations(code)
    if len(parts) == 1:
        return f"{code} ///< {words}"
    return " ".join(f"/** {words} */ {part}" for part in parts)


def marked(text, name):
    lines = text.split("\n")
    top, about = top_comment(lines), main_class(lines, pathlib.Path(name).stem)
    documented = about is not None and about > 0 and lines[about - 1].lstrip().startswith("///")
    out, before = [], ""  # before: the words of the comment above
    going_on = None  # the column of a comment behind a member that may go on
    for i, line in enumerate(lines):
        match, behind = COMMENT.match(line), BEHIND.match(line)
        if i < len(top):  # of the file; one line, as in the source
            out.append("/// " + (f"@file {name} @brief " if i == 0 else "") + top[i])
        elif match and going_on == column(line):
            out.append(f"{match[1]}///< {match[3]}")
        elif match:
            out.append(f"{match[1]}///{match[2]}{match[3]}")
        elif line.rstrip().endswith(") const = default;") and "operator==" in line:
            out.append(line + " ///< Member by member.")
        elif behind and '"' not in behind[1]:
            out.append(with_words(line[: column(line)].rstrip(), behind[3]))
        elif i == about and top and not documented:
            out.append("/** " + " ".join(top) + " */ " + line)
        elif before and len(declarations(line)) > 1:  # the comment above is that of the first
            first, *others = declarations(line)
            out.append(" ".join([first, *(f"/** {before} */ {part}" for part in others)]))
        else:
            out.append(line)
        above = re.match(r"\s*///? ?(.*)$", line)
        before = (before + " " + above[1]).strip() if above else ""
        if not (match and going_on == column(line)):
            going_on = column(line) if behind else None
    return "\n".join(out)


if __name__ == "__main__":
    path = pathlib.Path(sys.argv[1])
    sys.stdout.write(marked(path.read_text(), f"{path.parent.name}/{path.name}"))
