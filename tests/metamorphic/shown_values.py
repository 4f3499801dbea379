"""Reads values as reports for people and tables write them, and says whether they are those of the JSON report.

A text is read back here and what was read is compared; nothing is known of how cimdelta writes it:

    5   TRUE   NULL   plain text   "text with \\n or \\" in it"   {"a", NULL}   Cfg {Name: "x", Speed: 100}
"""

import re

ESCAPE = re.compile(r'\\(x[0-9a-f]{2}|u[0-9a-f]{4}|[nrt"\\])')
CONTROL = {"n": "\n", "r": "\r", "t": "\t"}
NULL = "NULL"


def split(text, separator, most=-1):
    """The parts of a text between separators that stand outside of quotes. A key that is a char16 has single quotes."""
    parts, begin, at, quote = [], 0, 0, ""
    while at < len(text):
        character = text[at]
        if quote:
            quote = "" if character == quote else quote
            at += 2 if character == "\\" else 1
        elif len(parts) != most and text.startswith(separator, at):
            parts.append(text[begin:at])
            at += len(separator)
            begin = at
        else:
            if character == '"' or character == "'" and text[at - 1 : at] == "=":
                quote = character
            at += 1
    return parts + [text[begin:]]


def cut(text, separator, fits):
    """What stands before and behind a separator. A char16 may be a quote, so it counts what stands before it."""
    parts = split(text, separator, 1)
    if len(parts) == 2 and fits(parts[0]):
        return parts
    for match in re.finditer(re.escape(separator), text):
        if fits(text[: match.start()]):
            return text[: match.start()], text[match.end() :]
    return parts if len(parts) == 2 else (text, "")


def unescaped(text, keeps_quotes):
    """Without the escapes of control characters; with `keeps_quotes`, those of quotes and backslashes belong to the text."""

    def character(match):
        escape = match.group(1)
        if escape in '"\\':
            return match.group() if keeps_quotes else escape
        return CONTROL[escape] if escape in CONTROL else chr(int(escape[1:], 16))

    return ESCAPE.sub(character, text)


def is_quoted(text):
    return len(text) > 1 and text[0] == '"' and text[-1] == '"' and len(split(text + "|", "|")) == 2


def is_text(text, value, is_bare_allowed=True):
    if is_quoted(text) and unescaped(text[1:-1], False) == value:
        return True
    return is_bare_allowed and text != NULL and unescaped(text, True) == value


def is_number(text, value):
    try:
        return float(text) == float(value) and (isinstance(value, float) or int(text) == value)
    except ValueError:
        return False


def is_list(text, values, is_one):
    """Whether the text shows these values [(what stands before it, value)], with commas between them."""
    if not values:
        return text == ""
    before, value = values[0]
    if not text.startswith(before):
        return False
    text = text[len(before) :]
    if len(values) == 1:
        return is_one(text, value)
    ends = (match.start() for match in re.finditer(", ", text))
    return any(is_one(text[:end], value) and is_list(text[end + 2 :], values[1:], is_one) for end in ends)


def is_array(text, values, is_one):
    return text[:1] + text[-1:] == "{}" and is_list(text[1:-1], [("", value) for value in values], is_one)


def is_value(text, value):
    """Whether the text shows that value."""
    if value is None:
        return text == NULL
    if isinstance(value, bool):
        return text == ("TRUE" if value else "FALSE")
    if isinstance(value, (int, float)):
        return is_number(text, value)
    if isinstance(value, list):
        return is_array(text, value, is_value)
    if isinstance(value, dict):
        return is_embedded(text, value)
    return is_text(text, value)


def is_embedded(text, contents):
    """Whether the text shows an embedded instance by its properties; those that are null are left out."""
    if "properties" not in contents or not text.startswith(contents["class"] + " {") or text[-1] != "}":
        return False
    shown = [(name + ": ", value) for name, value in contents["properties"].items() if value is not None]
    return is_list(text[len(contents["class"]) + 2 : -1], shown, is_value)


def is_side(text, side):
    """Whether the text shows one side of a difference: {"value": ..., "embedded": ...}. Objects that look alike are shown as CIM-XML."""
    if is_value(text, side["value"]):
        return True
    if isinstance(side.get("embedded"), list):
        pairs = [value if contents is None else contents for value, contents in zip(side["value"], side["embedded"])]
        return is_array(text, pairs, is_value)
    return "embedded" in side and is_value(text, side["embedded"])


def is_cell(text, side):
    """The same of a table. Text stands as it is, behind an apostrophe if it begins like a formula or with an apostrophe."""
    value = side["value"]
    if value is None:
        return text == ""
    if isinstance(value, str) and not side["type"].startswith(("real", "datetime")):
        return without_apostrophe(text) == value
    if isinstance(value, list):
        return is_array(text, value, is_element)
    return text == value if isinstance(value, str) else is_value(text, value)


def is_element(text, value):
    """An element in a table: only quotes and backslashes are escaped."""
    if isinstance(value, str):
        plain = re.sub(r"\\(.)", r"\1", text[1:-1], flags=re.S) if is_quoted(text) else text
        return plain == value and (is_quoted(text) or text != NULL)
    return is_value(text, value)


def without_apostrophe(cell):
    """The text of a cell. None if a spreadsheet would take the cell for a formula."""
    if cell[:1] in ("=", "+", "-", "@", "\t", "\r", "\n") and cell:
        return None
    return cell[1:] if cell.startswith("'") else cell


def described(side):
    """What stands before a value if the types of a line differ."""
    return side["type"].replace("string", "embedded object") if has_object(side) else side["type"]


def has_object(side):
    return "embedded" in side


def have_types_that_differ(sides):
    values = [side for side in sides if side["value"] is not None]
    return len({side["type"] for side in sides}) > 1 or len({has_object(side) for side in values}) > 1
