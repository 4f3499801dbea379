#!/usr/bin/env python3
"""Checks that the plug-in asks of its host nothing but the symbols in a list, so that another host can load it.

Usage: check_host_symbols.py NM LIBRARY LIST

Every undefined symbol that comes neither with a version (the C and C++ libraries) nor from a sanitizer must be in the list.
"""

import re
import subprocess
import sys

TOOLCHAIN = re.compile(r"@|^__(asan|ubsan|tsan|lsan|msan|sanitizer|gcov|llvm)")


def readable(symbol):
    symbol = symbol.replace("[abi:cxx11]", "").replace("NORVZEL20::", "")
    symbol = symbol.replace("std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >", "std::string")
    symbol = re.sub(r", std::less<std::string >, std::allocator<std::pair<std::string const, TCIMValue> > >", ">", symbol)
    symbol = re.sub(r", std::less<std::string>, std::allocator<std::pair<std::string const, TCIMValue> > >", ">", symbol)
    return re.sub(r"std::vector<TCIMValue, std::allocator<TCIMValue> >", "std::vector<TCIMValue>", symbol)


def undefined(nm, library):
    output = subprocess.run([nm, "-D", "-u", "-C", library], check=True, stdout=subprocess.PIPE, universal_newlines=True).stdout
    strong = [line.split(None, 1)[1] for line in output.splitlines() if line.split()[0] == "U"]
    return {readable(symbol) for symbol in strong if not TOOLCHAIN.search(symbol)}


def main():
    nm, library, list_file = sys.argv[1:]
    with open(list_file) as file:
        allowed = {line.strip() for line in file if line.strip() and not line.startswith("#")}
    asked = undefined(nm, library)
    for symbol in sorted(asked - allowed):
        print("not in the list: " + symbol)
    if not asked:
        print("no undefined symbols at all: is this the plug-in?")
    return 1 if not asked or asked - allowed else 0


sys.exit(main())
