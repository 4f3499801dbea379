#!/usr/bin/env python3
"""Compares the compiler's own dump of object layouts with the bases and fields that the types are to have, in their order.

Usage: check_layouts.py CLANG ROOT EXPECTED...

Looks at each type that EXPECTED names. Prints the differences and fails if there are any, or if there is
no clang.
"""

import re
import sys

import clang_dump

BASE = re.compile(r" \((primary |virtual )?base\)")


def readable(part):
    part = re.sub(r"\b(class|struct|enum) ", "", clang_dump.readable(part))
    part = part.replace("std::basic_string<char>", "std::string").replace("_Bool", "bool").replace(" (empty)", "")
    return re.sub(r" (?=[>*&])", "", part).replace("TCIMDiffEngine::", "")


def describe(record):
    """The bases of a type, those of its bases indented below them, its pointers to virtual tables and its own fields."""
    lines = []
    of_bases = [True]  # at each depth: whether all that leads there are bases
    for spaces, part in re.findall(r"^ *\d+ \| ( +)(.*)$", record, re.M):
        depth = len(spaces) // 2
        is_base = BASE.search(part) is not None
        is_own = depth == 1 or is_base or "vtable pointer" in part
        if is_own and of_bases[depth - 1]:
            lines.append("  " * depth + readable(part) + "\n")
        of_bases[depth:] = [of_bases[depth - 1] and is_base]
    return "".join(lines)


def layouts(text, expected):
    records = {readable(name): describe(record)
               for name, record in re.findall(r"^ *0 \| (\S.*?)(?: \(empty\))?\n(.*?) *\| \[sizeof", text, re.M | re.S)}
    names = re.findall(r"^(\S.*)\n", expected, re.M)
    return "".join(name + "\n" + records.get(name, "  is nowhere laid out\n") + "\n" for name in names)


sys.exit(clang_dump.check("LayoutProbe.cpp", "-fdump-record-layouts", layouts))
