"""Reads a text report and compares it with the JSON report of the same run."""

import re

SIGNS = {"onlyInReference": "-", "onlyInOthers": "+", "changed": "~"}
PROPERTY = re.compile(r"    ([^\s:]+): ")


def lines_of(text):
    """What the text says: [(class, sign, instance, [properties])], in its order."""
    found, name = [], None
    for line in text.splitlines()[1:]:
        if not line:
            name = None
        elif name is None:
            name = line
        elif line[:2] in ("- ", "+ ", "~ "):
            found.append((name, line[0], line[2:], []))
        elif found and PROPERTY.match(line):
            found[-1][3].append(PROPERTY.match(line).group(1))
    return found


def leaves(difference):
    """The properties that the text shows: of embedded instances, those in which they differ."""
    parts = difference.get("parts")
    return [leaf for part in parts for leaf in leaves(part)] if parts else [difference["property"]]


def expected(report):
    """The same of the JSON report."""
    found = []
    for difference in report["differences"]:
        sign = SIGNS[difference["kind"]]
        head = [difference["class"], sign, difference["instance"][len(difference["class"]) + 1 :], []]
        head[3].extend(leaf for one in difference.get("disagreements", []) for leaf in leaves(one))
        if sign != "~" or not found or found[-1][:3] != head[:3]:
            found.append(head)
        if sign == "~":
            found[-1][3].extend(leaves(difference))
    return found


def faults(text, report):
    shown, listed = lines_of(text), expected(report)
    if len(shown) != len(listed):
        yield f"text: {len(shown)} lines of instances, but JSON has {len(listed)}"
        return
    for one, other in zip(shown, listed):
        if (one[0], one[1]) != (other[0], other[1]) or one[3] != other[3]:
            yield f"text: {one}, but JSON has {other}"
        elif other[2].isascii() and other[2].isprintable() and "\\" not in other[2] and not one[2].startswith(other[2]):
            yield f"text: instance {one[2]}, but JSON has {other[2]}"
    first = text.splitlines()[0]
    count = len(report["differences"])
    if not first.startswith(f"{count} difference") and (count or "o" not in first[:2]):
        yield f"text: the first line is {first!r}, but JSON has {count} differences"
