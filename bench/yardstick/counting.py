"""How many differences a report of cimdelta has. A difference counts once for each inventory that it holds for.

The files are read in small pieces: a process inherits the peak memory of its parent, and the peak is measured.
"""
import json
import re


class NotCountable(Exception):
    """A report is not what it should be."""


def in_ndjson(path):
    listed = pairs = 0
    with open(path, encoding="utf-8") as file:
        for line in file:
            record = json.loads(line)
            if record["kind"] == "coverage":
                if record["summary"]["differences"] != listed:
                    raise NotCountable(f"{path}: the summary counts {record['summary']['differences']}, the list {listed}")
                return pairs
            listed += 1
            pairs += len(record["inventories"])
    raise NotCountable(f"{path}: no line says what was covered")


def in_json(path):
    """For two inventories: each element of the list holds for one of them."""
    summary = None
    listed = 0
    is_in_list = False
    with open(path, encoding="utf-8") as file:
        for line in file:
            if summary is None:
                found = re.match(r'    "differences": (\d+),', line)
                summary = int(found[1]) if found else None
            is_in_list = line.startswith('  "differences": [') or (is_in_list and not line.startswith("  ]"))
            listed += is_in_list and line.startswith('      "kind": ')
    if summary != listed:
        raise NotCountable(f"{path}: the summary counts {summary}, the list {listed}")
    return listed


def in_text(path):
    """For two inventories. The headline is compared with the lines of values and instances."""
    with open(path, encoding="utf-8") as file:
        found = re.match(r"(\d+) differences? between ", file.readline())
        listed = sum(1 for line in file if re.match(r"[-+] |    [^ ]", line))
    if not found or int(found[1]) != listed:
        raise NotCountable(f"{path}: the headline counts {found[1] if found else 'nothing'}, the list {listed}")
    return listed


BY_FORMAT = {"ndjson": in_ndjson, "json": in_json, "text": in_text}
