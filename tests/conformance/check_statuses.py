"""Fails if docs/statuses.md and the status codes of the host differ, or if a text names a status with a wrong number.

Argument: ROOT. The table must list every status of host/TZELStatusCode.h, in order, with its number and with the text of the embedded host.
Everywhere in documents and sources, `kNotFound (15)` must be the name and the number of one status. Documents name a status, so "status 15"
is a fault in them; 0, 1 and 2 may also be exit statuses.
"""

import pathlib
import re
import sys

ENUMERATOR = re.compile(r"^\s+(k\w+) = (\d+)", re.M)
TEXT = re.compile(r"\{TZELStatusCode::(k\w+), \"([^\"]*)\"\}")
ROW = re.compile(r"^\| (\d+) \| `(k\w+)` \| ([^|]+) \|", re.M)
NAMED = re.compile(r"\b(k[A-Z]\w+)`? \((\d+)\)")
BARE = re.compile(r"\bstatus(?:es)? (?:[3-9]|[1-9]\d)\b")
NOT_OURS = {"build", ".git"}


def read(path):
    return path.read_text(encoding="utf-8")


def texts(root):
    for path in sorted(root.rglob("*")):
        ours = not any(part in NOT_OURS for part in path.relative_to(root).parts)
        if ours and path.suffix in {".md", ".h", ".cpp"} and path.is_file():
            yield path.relative_to(root), read(path)


def table_faults(root, numbers):
    shown = dict(TEXT.findall(read(root / "embedded/services/TZELStatusCode.cpp")))
    expected = [(number, name, shown.get(name)) for name, number in numbers.items()]
    rows = ROW.findall(read(root / "docs/statuses.md"))
    yield from (f"docs/statuses.md: lacks {row}" for row in expected if row not in rows)
    yield from (f"docs/statuses.md: has {row}, which is no status of the host" for row in rows if row not in expected)
    if rows != sorted(rows, key=lambda row: int(row[0])):
        yield "docs/statuses.md: the rows are not in the order of their numbers"


def name_faults(root, numbers):
    seen = 0
    for path, text in texts(root):
        for name, number in NAMED.findall(text):
            seen += name in numbers
            if numbers.get(name, number) != number:
                yield f"{path}: says {name} ({number}), which is {numbers[name]}"
        if path.suffix == ".md":
            yield from (f"{path}: says \"{bare}\" without the name" for bare in BARE.findall(text))
    if seen < 20:
        yield f"only {seen} statuses were found in the texts: is this the root of the tree?"


def main():
    root = pathlib.Path(sys.argv[1]).resolve()
    numbers = dict(ENUMERATOR.findall(read(root / "host/TZELStatusCode.h")))
    found = [*table_faults(root, numbers), *name_faults(root, numbers)]
    print("\n".join(found) if found else "every status has its name and its number")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
