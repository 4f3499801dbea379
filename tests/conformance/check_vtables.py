#!/usr/bin/env python3
"""Compares the compiler's own dump of virtual tables with the order of operations that hosts rely on.

Usage: check_vtables.py CLANG ROOT EXPECTED...

Prints the differences and fails if there are any, or if there is no clang.
"""

import re
import sys

import clang_dump


def readable(operation):
    operation = re.sub(r" \[TInterface = \w+\]", "", clang_dump.readable(operation))
    return re.sub(r"TProbeOf\w+::~TProbeOf\w+\(\)", "destructor", operation)


def tables(text, _):
    """The probed types in alphabetical order, each with its operations in slot order, one line each."""
    result = {}
    for table in re.findall(r"^Vtable for 'NORVZEL20::TProbeOf(.*?)' \(\d+ entries\)\.\n(.*?)\n\n", text, re.M | re.S):
        lines = []
        for line in table[1].split("\n"):
            section = re.match(r" +-- \((.*), (\d+)\) vtable address --", line)
            operation = re.match(r" *\d+ \| (.*\).*)", line)
            if section and section.group(2) != "0":
                lines.append("  as " + readable(section.group(1)))
            elif operation and not operation.group(1).startswith("offset_to_top"):
                lines.append("  " + readable(operation.group(1)))
        result[table[0]] = lines
    return "".join(name + "\n" + "\n".join(lines) + "\n\n" for name, lines in sorted(result.items()))


sys.exit(clang_dump.check("VtableProbe.cpp", "-fdump-vtable-layouts", tables))
