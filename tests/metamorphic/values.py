"""CIM values in a canonical form: two values are equal exactly if their canonical forms are.

Made from the XML of an inventory or from what cimdelta prints, by code that shares nothing with cimdelta:

    null                 None
    integer              ("number", 5)
    real                 ("real", 1.5), ("real", "NaN")
    boolean, text        ("truth", True), ("text", "a"); char16 is text too
    timestamp            ("instant", microseconds, mask): offsets from UTC are applied; the mask says where asterisks stand
    interval             ("interval", text)
    reference            ("reference", namespace, class, bindings)
    embedded object      ("object", kind, class, properties)
    array                ("array", elements); an array of a bag is sorted

Names of classes, properties, keys, namespaces and hosts are in lower case, because letter case does not count in them.
"""

import datetime
import math
import re
import struct

INTEGERS = ("uint8", "sint8", "uint16", "sint16", "uint32", "sint32", "uint64", "sint64")
REALS = ("real32", "real64")
TIMESTAMP = re.compile(r"[0-9*]{14}\.[0-9*]{6}[+:-][0-9*]{3}")


def integer(text):
    text = text.strip()
    sign = -1 if text.startswith("-") else 1
    digits = text.lstrip("+-")
    if digits[:2].lower() == "0x":
        return sign * int(digits[2:], 16)
    if digits[-1:].lower() == "b":
        return sign * int(digits[:-1], 2)
    return sign * int(digits, 10)


def real(type_name, text):
    number = float(text)
    if math.isnan(number):
        return "NaN"
    if type_name == "real32" and math.isfinite(number):
        try:
            number = struct.unpack("f", struct.pack("f", number))[0]
        except OverflowError:
            number = math.copysign(math.inf, number)
    return number + 0.0  # -0.0 is 0.0


def timestamp(text):
    """A moment as microseconds since year 0. Asterisks count as the lowest value; the mask keeps them apart from digits."""
    if text[21] == ":":
        return ("interval", text)
    mask = "".join("*" if c == "*" else "." for c in text[:21])
    offset = int(text[22:25]) * (-1 if text[21] == "-" else 1) if "*" not in text[22:25] else 0
    if "*" in text[:12]:  # minutes or more are unknown: the offset cannot be applied
        return ("instant", text, mask)
    digits = text[:21].replace("*", "0")
    year, month, day, hour, minute, second = (int(digits[a:b]) for a, b in ((0, 4), (4, 6), (6, 8), (8, 10), (10, 12), (12, 14)))
    days = datetime.date(year, month, day).toordinal() if year else datetime.date(4, month, day).toordinal() - 1461
    seconds = ((days * 24 + hour) * 60 + minute - offset) * 60 + second
    return ("instant", seconds * 1000000 + int(digits[15:21]), mask)


def scalar(type_name, text):
    """The canonical form of one value of a plain type, given as the text of its VALUE."""
    if type_name in INTEGERS:
        return ("number", integer(text))
    if type_name in REALS:
        return ("real", real(type_name, text))
    if type_name == "boolean":
        return ("truth", text.strip().lower() == "true")
    if type_name == "datetime":
        return timestamp(text.strip())
    return ("text", text)


def ordered(value):
    """A canonical form with its sets in order, so that equal forms have equal text."""
    if isinstance(value, frozenset):
        return sorted((ordered(item) for item in value), key=repr)
    if isinstance(value, tuple):
        return tuple(ordered(item) for item in value)
    return value


def as_bag(value):
    """The canonical form if the order of the elements does not count."""
    if isinstance(value, tuple) and value and value[0] == "array":
        return ("array", tuple(sorted(value[1], key=lambda item: repr(ordered(item)))))
    return value
