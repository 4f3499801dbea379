#!/usr/bin/env python3
"""Cuts an inventory down to some packages and the dependencies among them.

Usage: cut_inventory.py FULL.xml PACKAGE... > CUT.xml

FULL.xml is an inventory of DEB_Package and DEB_PackageDependency with one element a line.
"""
import re
import sys

NAME = re.compile(r'<PROPERTY NAME="Name" TYPE="string"><VALUE>([^<]*)</VALUE>')
REFERENCED = re.compile(r'<KEYBINDING NAME="Name"><KEYVALUE[^>]*>([^<]*)</KEYVALUE>')


def is_kept(line, packages):
    if '<INSTANCE CLASSNAME="DEB_PackageDependency">' in line:
        return all(name in packages for name in REFERENCED.findall(line))
    if '<INSTANCE CLASSNAME="DEB_Package">' in line:
        return NAME.search(line).group(1) in packages
    return True


def main():
    packages = set(sys.argv[2:])
    with open(sys.argv[1], encoding="utf-8") as full:
        for line in full:
            if is_kept(line, packages):
                sys.stdout.write(line)


if __name__ == "__main__":
    main()
