"""Checks JSON reports against data/schema/comparison-1.json."""

import json
import pathlib

import jsonschema

SCHEMA = json.loads((pathlib.Path(__file__).parents[2] / "data/schema/comparison-1.json").read_text(encoding="utf-8"))
DOCUMENT = jsonschema.Draft202012Validator(SCHEMA)
LINE = jsonschema.Draft202012Validator({"$schema": SCHEMA["$schema"], "$ref": "#/$defs/line", "$defs": SCHEMA["$defs"]})


def innermost(error):
    """What is wrong, not that none of the choices fits."""
    while error.context:
        error = max(error.context, key=lambda one: len(one.absolute_path))
    return f"{error.json_path}: {error.message[:300]}"


def faults(report, lines=b""):
    yield from (f"schema: {innermost(error)}" for error in DOCUMENT.iter_errors(report))
    for number, line in enumerate(lines.decode().splitlines(), 1):
        yield from (f"schema: line {number}: {innermost(error)}" for error in LINE.iter_errors(json.loads(line)))
