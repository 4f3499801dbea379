#!/usr/bin/env python3
"""Checks that the plug-in asks of its host nothing but the symbols in a list, so that another host can load it, and that it makes
no thread and takes no lock.

Usage: check_host_symbols.py NM LIBRARY LIST

Every undefined symbol that comes neither with a version (the C and C++ libraries) nor from a sanitizer must be in the list. No
undefined symbol at all, weak ones included, may be one of those that threads and locks are made with.
"""

import re
import subprocess
import sys

TOOLCHAIN = re.compile(r"@|^__(asan|ubsan|tsan|lsan|msan|sanitizer|gcov|llvm)")
THREADS = re.compile(r"^_*(pthread|thrd|mtx|cnd|tss|sem|cxa_guard)_|^_*cxa_thread_atexit|^_*call_once|^(v?fork|clone3?|syscall)@"
                     r"|^((vtable|typeinfo|VTT) for )?std::(_\w+::)*(this_thread|j?thread|\w*mutex|\w*condition_variable|\w*condvar"
                     r"|\w*once\w*|\w*future\w*|promise|\w*latch|barrier|counting_semaphore)\b")


def readable(symbol):
    symbol = symbol.replace("[abi:cxx11]", "").replace("NORVZEL20::", "")
    symbol = symbol.replace("std::__cxx11::basic_string<char, std::char_traits<char>, std::allocator<char> >", "std::string")
    symbol = re.sub(r", std::less<std::string >, std::allocator<std::pair<std::string const, TCIMValue> > >", ">", symbol)
    symbol = re.sub(r", std::less<std::string>, std::allocator<std::pair<std::string const, TCIMValue> > >", ">", symbol)
    return re.sub(r"std::vector<TCIMValue, std::allocator<TCIMValue> >", "std::vector<TCIMValue>", symbol)


def undefined(nm, library):
    """Every undefined symbol, with its letter: U, or w for one that may stay without a definition."""
    output = subprocess.run([nm, "-D", "-u", "-C", library], check=True, stdout=subprocess.PIPE, universal_newlines=True).stdout
    return [tuple(line.split(None, 1)) for line in output.splitlines()]


def main():
    nm, library, list_file = sys.argv[1:]
    with open(list_file) as file:
        allowed = {line.strip() for line in file if line.strip() and not line.startswith("#")}
    symbols = undefined(nm, library)
    asked = {readable(symbol) for letter, symbol in symbols if letter == "U" and not TOOLCHAIN.search(symbol)}
    of_threads = {symbol for _, symbol in symbols if THREADS.search(symbol)}
    for symbol in sorted(asked - allowed):
        print("not in the list: " + symbol)
    for symbol in sorted(of_threads):
        print("of threads or locks: " + symbol)
    if not asked:
        print("no undefined symbols at all: is this the plug-in?")
    return 1 if not asked or asked - allowed or of_threads else 0


sys.exit(main())
