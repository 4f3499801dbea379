"""Reads the CSV report back and compares it with the JSON report of the same run, row by row."""

import csv
import io

from shown_values import is_cell, without_apostrophe

HEADER = ["class", "instance", "name", "kind", "property", "inventory", "reference value", "value", "reference type", "type"]


def rows_in(report):
    """What JSON has of each row: (class, instance, kind, property, inventory), and the two sides of a change."""
    for difference in report["differences"]:
        begin = (difference["class"], difference["instance"], difference["kind"], difference.get("property", ""))
        if difference["kind"] == "changed":
            for group in difference["others"]:
                yield from (((*begin, label), difference["reference"], group) for label in group["inventories"])
        else:
            yield from (((*begin, label), None, None) for label in difference["inventories"])


def type_of(side):
    return "" if side is None else side["type"] + (" NULL" if side["value"] is None else "")


def row_faults(row, place, reference, other):
    texts = [without_apostrophe(row[at]) for at in (0, 1, 3, 4, 5)]
    if tuple(texts) != place:
        yield f"csv: {texts} instead of {place}"
    if [row[8], row[9]] != [type_of(reference), type_of(other)]:
        yield f"csv: {place}: types {row[8:]} instead of {[type_of(reference), type_of(other)]}"
    for cell, side in ((row[6], reference), (row[7], other)):
        if cell != "" if side is None else not is_cell(cell, side):
            yield f"csv: {place}: {cell!r} instead of {side and side['value']!r}"


def faults(data, report):
    rows = list(csv.reader(io.StringIO(data.decode(), newline=""), strict=True))
    if rows[:1] != [HEADER] or any(len(row) != len(HEADER) for row in rows):
        yield f"csv: the columns are {rows[:1]}, and rows have {sorted({len(row) for row in rows})} cells"
        return
    if data.count(b"\r\n") < len(rows) or not data.endswith(b"\r\n"):
        yield "csv: a row does not end with CR LF"
    expected = list(rows_in(report))
    if len(rows) - 1 != len(expected):
        yield f"csv: {len(rows) - 1} rows instead of {len(expected)}"
        return
    for row, one in zip(rows[1:], expected):
        yield from row_faults(row, *one)
    yield from name_faults(rows[1:])


def name_faults(rows):
    """One instance has one name."""
    names = {}
    for row in rows:
        if names.setdefault((row[0], row[1]), row[2]) != row[2] or not row[2]:
            yield f"csv: {row[1]} has the names {names[row[0], row[1]]!r} and {row[2]!r}"
