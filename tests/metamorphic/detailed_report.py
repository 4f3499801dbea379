"""Reads the detailed text report back and compares it with the JSON report of the same run, difference by difference.

    Disk
    ~ Id="sdc"  (the first of 2 instances of a with this key)
        Size: 500 -> b: 250 / c: NULL

Every line in front of the coverage has to be one of these, and everything that JSON has of a difference has to stand in one of them.
What an instance holds that only one side has is in JSON alone.
"""

import dataclasses
import re

from shown_values import cut, described, have_types_that_differ, is_side, split, unescaped

SIGNS = {"onlyInReference": "-", "onlyInOthers": "+", "changed": "~"}
NOTES = ("(the only instance; the class has no keys)", "(any instance of the class; the rules exclude every key)")
SHARES = " with this key"
LINE = re.compile(r"    (\S(?:.*?[^:])?): (.*)")


@dataclasses.dataclass
class Entry:
    """An instance, and the lines below it."""

    class_name: str
    sign: str
    name: str
    remarks: list
    lines: list = dataclasses.field(default_factory=list)


@dataclasses.dataclass
class Line:
    """What the JSON report has of one line: a property, and the sides of which it has values."""

    property: str
    reference: dict
    others: list
    difference: dict


def entries_of(text):
    """What the text says: entries in its order, each line as (property, rest). Raises ValueError for a line that is none of these."""
    lines = text.split("\n")
    found, name, at = [], None, 1
    while at < len(lines) and not (lines[at - 1] == "" and lines[at].startswith("Compared: ")):
        line = lines[at]
        at += 1
        if not line:
            name = None
        elif name is None:
            name = line
        elif line[:2] in ("- ", "+ ", "~ "):
            shown, *remarks = split(line[2:], "  (", 1) if line[2:] not in NOTES else [line[2:]]
            found.append(Entry(name, line[0], shown, split(remarks[0][:-1], "; ") if remarks else []))
        elif found and found[-1].class_name == name and LINE.fullmatch(line):
            found[-1].lines.append(LINE.fullmatch(line).groups())
        else:
            raise ValueError(f"{line!r} says nothing")
    return found


def entries_in(report):
    """The same of the JSON report. Changes of one instance that follow one another are one entry."""
    found, before = [], None
    for difference in report["differences"]:
        key = (difference["kind"], difference["class"], difference["instance"])
        if key != before or difference["kind"] != "changed":
            name = difference["instance"][len(difference["class"]) + 1 :]
            found.append(Entry(difference["class"], SIGNS[difference["kind"]], name, remarks_of(report, difference)))
        values = [difference] if difference["kind"] == "changed" else difference.get("disagreements", [])
        found[-1].lines += [line for one in values for line in leaves(one, difference)]
        before = key
    return found


def leaves(values, difference):
    """The lines of a property: of embedded instances, those of the parts in which they differ."""
    if values.get("parts"):
        return [leaf for part in values["parts"] for leaf in leaves(part, difference)]
    return [Line(values["property"], values.get("reference"), values["others"], difference)]


def labels_of(report):
    return [one["label"] for one in report["inventories"]]


def sharing_of(difference, label):
    return next((one["instances"] for one in difference.get("sharing", []) if one["inventory"] == label), 0)


def remarks_of(report, difference):
    labels, remarks = labels_of(report), []
    if difference["kind"] != "changed" and len(labels) > 2:
        where = "not in " if difference["kind"] == "onlyInReference" else "in "
        remarks.append(where + ", ".join(difference["inventories"]))
    if sharing_of(difference, labels[0]):
        remarks.append(f"the first of {sharing_of(difference, labels[0])} instances of {labels[0]}{SHARES}")
    if difference["kind"] == "onlyInOthers":
        shared = [(label, sharing_of(difference, label)) for label in difference["inventories"]]
        remarks += [f"{count} instances of {label}{SHARES}" for label, count in shared if count]
    if "path" in difference:
        remarks.append("path: " + difference["path"])
    return remarks


# One group of a line: `b, c: 250 (one of 2 instances of b with this key)`.


def group_of(text, has_labels):
    """(labels, value, remarks)"""
    labels = []
    if has_labels:
        names, text = [*split(text, ": ", 1), ""][:2]
        labels = names.split(", ")
    remarks = []
    if text.endswith(SHARES + ")"):
        *values, last = split(text, " (")
        text, remarks = " (".join(values), last[:-1].split(", ")
    return labels, text, remarks


def group_remarks(report, line, group):
    remarks = []
    for one in group.get("sharing", []):
        total, count = sharing_of(line.difference, one["inventory"]), "one" if one["instances"] == 1 else one["instances"]
        if line.difference["kind"] == "changed":
            remarks.append(f"{count} of {total} instances of {one['inventory']}{SHARES}")
        else:
            where = f" of {one['inventory']}" if len(labels_of(report)) > 2 else ""
            remarks.append(f"{count} of {total}{where}{SHARES}")
    return remarks


def side_faults(text, side, is_typed):
    prefix = described(side) + " " if is_typed else ""
    if not text.startswith(prefix) or not is_side(text[len(prefix) :], side):
        yield f"{text!r} instead of {prefix}{side.get('embedded', side['value'])!r}"


def groups_of(text, sides, has_labels, is_typed):
    """The groups of a line; the last one holds what cannot be read."""
    found = []
    for side in sides[:-1]:
        one, text = cut(text, " / ", lambda shown, side=side: not any(side_faults(group_of(shown, has_labels)[1], side, is_typed)))
        found.append(group_of(one, has_labels))
    return found + [group_of(text, has_labels)]


def line_faults(report, shown, line):
    name, rest = shown
    if unescaped(name, True) != line.property:
        yield f"property {name!r} instead of {line.property!r}"
        return
    sides = ([line.reference] if line.reference else []) + line.others
    is_typed = have_types_that_differ(sides)
    texts = []
    if line.reference:
        before, rest = cut(rest, " -> ", lambda text: not any(side_faults(text, line.reference, is_typed)))
        texts.append(before)
        yield from side_faults(before, line.reference, is_typed)
    for (labels, text, remarks), group in zip(groups_of(rest, line.others, len(labels_of(report)) > 2, is_typed), line.others):
        texts.append(text)
        yield from side_faults(text, group, is_typed)
        if labels and labels != group["inventories"]:
            yield f"inventories {labels} instead of {group['inventories']}"
        if remarks != group_remarks(report, line, group):
            yield f"remarks {remarks} instead of {group_remarks(report, line, group)}"
    if len(set(texts)) != len(texts):
        yield f"values that look alike: {texts}"


def entry_faults(report, shown, entry):
    if (shown.class_name, shown.sign) != (entry.class_name, entry.sign):
        yield f"{shown.sign} {shown.class_name} instead of {entry.sign} {entry.class_name}"
    if (shown.name not in NOTES) if entry.name == "" else (unescaped(shown.name, True) != entry.name):
        yield f"instance {shown.name!r} instead of {entry.name!r}"
    if [unescaped(one, True) for one in shown.remarks] != entry.remarks:
        yield f"remarks {shown.remarks} instead of {entry.remarks}"
    if len(shown.lines) != len(entry.lines):
        yield f"{len(shown.lines)} lines below {shown.name} instead of {len(entry.lines)}"
        return
    for one, line in zip(shown.lines, entry.lines):
        yield from line_faults(report, one, line)


def faults(text, report):
    try:
        shown = entries_of(text)
    except ValueError as error:
        yield f"detail: {error}"
        return
    expected = entries_in(report)
    if len(shown) != len(expected):
        yield f"detail: {len(shown)} instances, but JSON has {len(expected)}"
        return
    for one, entry in zip(shown, expected):
        yield from (f"detail: {entry.sign} {entry.class_name} {entry.name}: {fault}" for fault in entry_faults(report, one, entry))
    first, count = text.splitlines()[0], len(report["differences"])
    if not first.startswith(f"{count} difference") and (count or "o" not in first[:2]):
        yield f"detail: the first line is {first!r}, but JSON has {count} differences"
