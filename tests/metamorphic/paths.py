"""Path text as cimdelta prints it, taken apart: `//host/root/cimv2:Class.Key1="text",Key2=5`."""

import re

import values

HEAD = re.compile(r'(?:(?://(?P<host>[^/]+)/)?(?P<namespace>[^:."=]*):)?(?P<name>[^.:"=,]+)')
KEY = re.compile(r"[.,](?P<name>[^=\"']+)=")
BARE = re.compile(r"[^,\"']+")


def quoted(text, at):
    """The text between the quotes that open at `at`, without escapes, and where it ends."""
    quote, at, characters = text[at], at + 1, []
    while text[at] != quote:
        if text[at] == "\\":
            at += 1
        characters.append(text[at])
        at += 1
    return "".join(characters), at + 1


def parse(text):
    """(host, namespace, class, [(key, form, text)]) with form `"`, `'` or `` for a bare word. ValueError if it is no path."""
    head = HEAD.match(text)
    if not head:
        raise ValueError(f"no path: {text}")
    at, bindings = head.end(), []
    while at < len(text):
        key = KEY.match(text, at)
        if not key:
            raise ValueError(f"no path: {text}")
        at = key.end()
        if text[at : at + 1] in ('"', "'"):
            form = text[at]
            value, at = quoted(text, at)
        else:
            bare = BARE.match(text, at)
            if not bare:
                raise ValueError(f"no path: {text}")
            form, value, at = "", bare.group(), bare.end()
        bindings.append((key["name"], form, value))
    return head["host"], head["namespace"], head["name"], bindings


def place(host, namespace):
    """Where a reference points, or None if it points into its own inventory."""
    if not namespace:
        return None
    return ((host or "").lower(), namespace.strip("/").lower())


def canonical(text, schema):
    """The canonical form of a reference given as path text. The classes of `schema` say which types its keys have."""
    host, namespace, name, bindings = parse(text)
    pairs = [(key.lower(), schema.key_value(name, key, form, value)) for key, form, value in bindings]
    return ("reference", place(host, namespace), name.lower(), frozenset(pairs))


def untyped(form, text):
    """The value of a key whose class nobody declares, or declares otherwise."""
    if form:
        return values.timestamp(text) if values.TIMESTAMP.fullmatch(text) else ("text", text)
    if text == "NULL":
        return None
    if text.lower() in ("true", "false"):
        return values.scalar("boolean", text)
    try:
        return values.scalar("sint64", text)
    except ValueError:
        return values.scalar("real64", text)
