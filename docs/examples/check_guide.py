#!/usr/bin/env python3
"""Checks that docs/guide.md quotes the example programs exactly.

A fenced block that follows the line `<!-- example: NAME.cpp -->` must be the region of
docs/examples/NAME.cpp between the lines `// guide:begin` and `// guide:end`; one that follows
`<!-- output: NAME -->` must be the text of docs/examples/NAME.expected. Every program must be
quoted. With --update the quotes are rewritten from the files instead.
"""
import pathlib
import re
import sys

EXAMPLES = pathlib.Path(__file__).resolve().parent
GUIDE = EXAMPLES.parent / "guide.md"
MARKER = re.compile(r"^<!-- (example|output): (\S+) -->$")


def region(kind, name):
    path = EXAMPLES / (name if kind == "example" else name + ".expected")
    text = path.read_text()
    if kind == "output":
        return text.splitlines()
    lines = text.splitlines()
    try:
        begin = lines.index("// guide:begin")
        end = lines.index("// guide:end")
    except ValueError:
        sys.exit(f"{path}: no '// guide:begin' ... '// guide:end' region")
    return lines[begin + 1:end]


def main():
    update = "--update" in sys.argv[1:]
    lines = GUIDE.read_text().splitlines()
    out, problems, quoted = [], [], set()
    i = 0
    while i < len(lines):
        out.append(lines[i])
        m = MARKER.match(lines[i])
        i += 1
        if not m:
            continue
        kind, name = m.groups()
        if kind == "example":
            quoted.add(name)
        if i >= len(lines) or not lines[i].startswith("```"):
            problems.append(f"guide.md:{i}: no fenced block after the {kind} marker for {name}")
            continue
        fence = lines[i]
        close = next((k for k in range(i + 1, len(lines)) if lines[k] == "```"), None)
        if close is None:
            problems.append(f"guide.md:{i + 1}: the block quoting {name} is not closed")
            break
        wanted = region(kind, name)
        if lines[i + 1:close] != wanted:
            problems.append(f"guide.md:{i + 2}: the block differs from {name}")
        out.extend([fence] + wanted + ["```"])
        i = close + 1
    for program in sorted(p.name for p in EXAMPLES.glob("*.cpp")):
        if program not in quoted:
            problems.append(f"guide.md quotes no block of {program}")
    if update:
        GUIDE.write_text("\n".join(out) + "\n")
        return 0
    for p in problems:
        print(p)
    if problems:
        print("Run python3 docs/examples/check_guide.py --update to take the programs' text.")
    return 1 if problems else 0


if __name__ == "__main__":
    sys.exit(main())
