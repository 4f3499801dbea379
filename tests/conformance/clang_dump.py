"""Compares clang's dump of a probe with the text that hosts rely on. g++ has no such dumps."""

import difflib
import os
import pathlib
import re
import subprocess
import sys


def dump(clang, root, probe, option):
    source = os.path.join(root, "tests", "conformance", probe)
    command = [clang, "-std=c++17", "-I", root, "-DBOOST_ENABLE_ASSERT_HANDLER", "-Xclang", option, "-S", "-o", os.devnull, source]
    return subprocess.run(command, check=True, stdout=subprocess.PIPE, universal_newlines=True).stdout


def readable(text):
    return text.replace("NORVZEL20::", "").replace("boost::", "").replace("TCIMDiffEngine::TDiffXMLParser::", "")


def check(probe, option, describe):
    """Describes the dump with `describe(dump, expected)` and prints how that differs. Arguments: CLANG ROOT EXPECTED...

    What is expected are paragraphs, each headed by the name of a type; they are compared in the order of these names.
    """
    clang, root, *expected_files = sys.argv[1:]
    if not os.path.exists(clang):
        print("no clang++ was found; install clang")
        return 1
    text = "".join(pathlib.Path(file).read_text() for file in expected_files)
    text = re.sub(r"^#.*\n", "", text, flags=re.M)
    expected = "".join(sorted(re.findall(r"^\S.*?\n\n", text, re.M | re.S)))
    if not expected:
        print("nothing is expected: is this the list?")
        return 1
    actual = describe(dump(clang, root, probe, option), expected)
    if actual == expected:
        return 0
    sys.stdout.writelines(difflib.unified_diff(expected.splitlines(True), actual.splitlines(True), "expected", "actual"))
    return 1
