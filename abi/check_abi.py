#!/usr/bin/env python3
"""Checks the dynamic symbols liblumenutility.so exports.

list:    the exported names (demangled) are exactly those in abi/liblumenutility.symbols;
         names added or gone are printed with the command that records them on purpose.
public:  every exported symbol belongs to a namespace, class, function or variable that a
         header under include/lumen declares, so nothing internal has leaked out.
--update rewrites the list from the library (after the public check passed).

Exit status: 0 when the checks pass, 1 when one fails, 2 on a usage or tool error.
"""
import argparse
import pathlib
import re
import subprocess
import sys

HEADER = """\
# Dynamic symbols exported by liblumenutility.so.1, demangled, one per line, sorted.
# The AbiSymbolList test compares the built library with this list. After a deliberate change
# of the public interface, regenerate it and commit it with the change:
#     cmake --build build --target abi-update
# A name gone from the list breaks programs linked against an earlier build (the SONAME
# version then has to go up); a new name only extends the interface.
"""

# Special names that prefix the entity they belong to.
SPECIAL_PREFIXES = (
    "vtable for ", "typeinfo for ", "typeinfo name for ", "VTT for ",
    "construction vtable for ", "guard variable for ", "non-virtual thunk to ",
    "virtual thunk to ", "covariant return thunk to ", "TLS init function for ",
    "TLS wrapper function for ",
)
FOREIGN_NAMESPACES = {"std", "boost", "__gnu_cxx", "__cxxabiv1"}
OPERATOR = re.compile(r"\boperator\s*(\(\)|\[\]|<<=|>>=|<=>|<<|>>|<=|>=|->\*|->|<|>|[^\s(]+)")
# Operator names spelled without brackets, so that they do not upset the scope parsing.
OPERATOR_SPELLING = str.maketrans("<>()[]=-*", "LGPQBCEMS")
ABI_TAG = re.compile(r"\[abi:[^\]]*\]")


def exported_names(nm, library):
    """The demangled names of the defined dynamic symbols of `library`."""
    try:
        out = subprocess.run([nm, "-D", "--defined-only", "-C", library], check=True,
                             capture_output=True, text=True).stdout
    except (OSError, subprocess.CalledProcessError) as error:
        sys.exit(f"check_abi: cannot list the symbols of {library}: {error}")
    names = set()
    for line in out.splitlines():
        parts = line.split(None, 2)  # address, type letter, name
        if len(parts) == 3:
            names.add(re.sub(r"@@?[\w.]+$", "", parts[2]))
    return names


def split_top_level(text, separator):
    """`text` cut at each `separator` that stands outside <>, () and []."""
    pieces, depth, start, i = [], 0, 0, 0
    while i < len(text):
        if depth == 0 and text.startswith(separator, i):
            pieces.append(text[start:i])
            i += len(separator)
            start = i
            continue
        if text[i] in "<([":
            depth += 1
        elif text[i] in ">)]":
            depth -= 1
        i += 1
    pieces.append(text[start:])
    return pieces


def operator_name(match):
    return "operator_" + match.group(1).translate(OPERATOR_SPELLING)


def qualified_components(name):
    """The scopes of a demangled name: ['LumenUtility', 'InputArray', 'size'], templates
    arguments dropped."""
    for prefix in SPECIAL_PREFIXES:
        if name.startswith(prefix):
            name = name[len(prefix):]
    name = OPERATOR.sub(operator_name, ABI_TAG.sub("", name))
    head = split_top_level(name, "(")[0]  # the entity, without its parameters
    head = split_top_level(head.strip(), " ")[-1]  # without a template function's result type
    components = []
    for piece in split_top_level(head, "::"):
        components.append(split_top_level(piece, "<")[0].strip())
    return components


def header_declarations(include_dir):
    """Namespaces and declared names of the public headers, comments removed."""
    text = []
    for header in sorted(pathlib.Path(include_dir).rglob("*.h")):
        source = header.read_text(encoding="utf-8", errors="replace")
        source = re.sub(r"/\*.*?\*/", " ", source, flags=re.S)
        text.append(re.sub(r"//[^\n]*", "", source))
    text = "\n".join(text)
    namespaces = set(re.findall(r"\bnamespace\s+(\w+)", text)) - FOREIGN_NAMESPACES
    # Defined types only: a class that the headers merely name (`class TouchstoneParser;`)
    # stays internal.
    types = set(re.findall(r"\b(?:class|struct|union|enum(?:\s+class)?)\s+(?:LUMEN_API\s+)?"
                           r"(\w+)\s*(?:final\s*)?[:{]", text))
    text = re.sub(r"\b(?:class|struct|union)\s+\w+\s*;", " ", text)
    # Functions and variables: a name followed by a parameter list, an initializer or the end
    # of a declaration.
    others = set(re.findall(r"\b(\w+)\s*(?:\(|;|\[|=|\{)", text))
    operators = {operator_name(m) for m in OPERATOR.finditer(text)}
    return namespaces, types | others | operators


def owner_of(name, namespaces):
    """(namespaces, owner) of a symbol: the owner is its first scope that is no namespace of
    the library's (a class), or the entity itself at namespace scope."""
    components = qualified_components(name)
    path = []
    for component in components[:-1]:
        if component in namespaces:
            path.append(component)
            continue
        return path, component
    return path, components[-1]


def public_leaks(names, include_dir):
    namespaces, declared = header_declarations(include_dir)
    leaks = []
    for name in sorted(names):
        components = qualified_components(name)
        if components[0] in FOREIGN_NAMESPACES:
            leaks.append((name, f"namespace {components[0]} is not the library's"))
            continue
        _, owner = owner_of(name, namespaces)
        if owner not in declared:
            leaks.append((name, f"'{owner}' is not declared in {include_dir}"))
    return leaks


def read_list(path):
    try:
        lines = pathlib.Path(path).read_text(encoding="utf-8").splitlines()
    except OSError as error:
        sys.exit(f"check_abi: cannot read {path}: {error}")
    return {line for line in lines if line and not line.startswith("#")}


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--nm", default="nm")
    parser.add_argument("--library", required=True)
    parser.add_argument("--symbols", required=True, help="the committed list")
    parser.add_argument("--include", required=True, help="the public header directory")
    parser.add_argument("--check", choices=["list", "public", "all"], default="all")
    parser.add_argument("--update", action="store_true", help="rewrite the list")
    parser.add_argument("--update-command", default="cmake --build build --target abi-update",
                        help="the command named in a failure message")
    args = parser.parse_args()

    names = exported_names(args.nm, args.library)
    status = 0
    if args.update or args.check in ("public", "all"):
        leaks = public_leaks(names, args.include)
        if leaks:
            print(f"{args.library} exports {len(leaks)} symbols not declared by the public "
                  f"headers; give them hidden visibility (drop LUMEN_API, or move them into an "
                  f"unnamed namespace):")
            for name, reason in leaks:
                print(f"  {name}\n      ({reason})")
            status = 1
    if args.update:
        if status:
            print("The list was not rewritten.")
            return status
        text = HEADER + "".join(f"{name}\n" for name in sorted(names))
        pathlib.Path(args.symbols).write_text(text, encoding="utf-8")
        print(f"{args.symbols}: {len(names)} symbols written")
        return 0
    if args.check in ("list", "all"):
        expected = read_list(args.symbols)
        added = sorted(names - expected)
        gone = sorted(expected - names)
        if added or gone:
            print(f"The symbols {args.library} exports differ from {args.symbols}.")
            if added:
                print(f"Exported but not on the list ({len(added)}):")
                print("".join(f"  + {name}\n" for name in added), end="")
            if gone:
                print(f"On the list but not exported ({len(gone)}; callers linked against an "
                      f"earlier build lose them):")
                print("".join(f"  - {name}\n" for name in gone), end="")
            print(f"If the change is meant, record it and commit the list with it:\n"
                  f"    {args.update_command}")
            status = 1
        else:
            print(f"{len(names)} exported symbols, as listed in {args.symbols}")
    return status


if __name__ == "__main__":
    sys.exit(main())
