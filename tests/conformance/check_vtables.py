#!/usr/bin/env python3
"""Compares the compiler's own dump of virtual tables with the order of operations that hosts rely on.

Usage: check_vtables.py CLANG ROOT EXPECTED

Prints the differences and fails where there are any. Exits with 77 (skipped) where there is no clang: g++ has no such dump.
"""

import difflib
import os
import re
import subprocess
import sys

SKIPPED = 77


def dump(clang, root):
    probe = os.path.join(root, "tests", "conformance", "VtableProbe.cpp")
    command = [clang, "-std=c++17", "-I", root, "-DBOOST_ENABLE_ASSERT_HANDLER", "-Xclang", "-fdump-vtable-layouts",
               "-S", "-o", os.devnull, probe]
    return subprocess.run(command, check=True, stdout=subprocess.PIPE, universal_newlines=True).stdout


def readable(operation):
    operation = operation.replace("NORVZEL20::", "").replace("boost::", "").replace("TCIMDiffEngine::TDiffXMLParser::", "")
    return re.sub(r"TProbeOf\w+::~TProbeOf\w+\(\)", "destructor", operation)


def tables(text):
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


def main():
    clang, root, expected_file = sys.argv[1:]
    if not os.path.exists(clang):
        print("skipped: no clang++ was found")
        return SKIPPED
    with open(expected_file) as file:
        expected = "".join(line for line in file if not line.startswith("#"))
    actual = tables(dump(clang, root))
    if actual == expected:
        return 0
    sys.stdout.writelines(difflib.unified_diff(expected.splitlines(True), actual.splitlines(True), "expected", "actual"))
    return 1


sys.exit(main())
