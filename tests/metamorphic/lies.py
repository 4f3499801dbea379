"""Ways in which cimdelta could be wrong, and the relation that has to notice each.

A lie changes what a run of cimdelta printed. It gets the arguments and the documents too, and returns None if it has nothing to say there.
The relations must not hold for a program that lies; so it is seen that each of them can fail.
"""

import dataclasses
import gzip
import json
import re

import program
import relations


RECORD = rb'<INSTANCE CLASSNAME="KALMO_Delta">.*?</INSTANCE>'


class LyingProgram(program.Program):
    def __init__(self, path, root, folder, lie):
        super().__init__(path, root, folder)
        self.lie = lie
        self.told = 0  # how often it lied

    def run(self, arguments, documents):
        result = super().run(arguments, documents)
        lied = self.lie(result, arguments, documents)
        if lied is None or lied == result:
            return result
        self.told += 1
        return lied


def is_json(arguments):
    return arguments[0] == "compare" and "json" in arguments


def on_report(change):
    """A lie that changes the JSON report of a comparison. `change(report, documents)` returns whether it did."""

    def lie(result, arguments, documents):
        if not is_json(arguments):
            return None
        report = json.loads(result.output)
        if not change(report, [one for one in documents if one[0] != "rules.xml"]):
            return None
        return dataclasses.replace(result, output=json.dumps(report, indent=2).encode())

    return lie


def without_first_line(output_format, pattern):
    """A lie that leaves out the first line, or element, that matches."""
    return with_first(output_format, pattern, b"")


def with_first(output_format, pattern, replacement):
    """A lie that replaces the first text that matches."""

    def lie(result, arguments, _documents):
        if arguments[0] != "compare" or (output_format not in arguments):
            return None
        return dataclasses.replace(result, output=re.sub(pattern, replacement, result.output, count=1))

    return lie


def drop_difference(report, _documents):
    if report["differences"]:
        kind = report["differences"].pop(0)["kind"]
        report["summary"]["differences"] -= 1
        report["summary"]["changedValues" if kind == "changed" else kind] -= 1
        return True
    return False


def invent_difference(report, _documents):
    classes = [one["class"] for one in report["coverage"]["classes"] if one["state"] == "compared"]
    if not classes:
        return False
    label = report["inventories"][-1]["label"]
    made = {"kind": "onlyInOthers", "class": classes[0], "instance": classes[0], "keys": {}, "inventories": [label]}
    report["differences"].append(made)
    report["summary"]["differences"] += 1
    report["summary"]["onlyInOthers"] += 1
    return True


def change_value(report, _documents):
    changed = [one for one in report["differences"] if one["kind"] == "changed" and one["others"][0]["value"] is None]
    for one in changed[:1]:
        one["others"][0]["value"] = one["reference"]["value"]
    return bool(changed)


def claim_completeness(report, _documents):
    was_complete, report["summary"]["everythingCompared"] = report["summary"]["everythingCompared"], True
    return not was_complete


def hide_left_out(report, _documents):
    hiding = [one for one in report["coverage"]["classes"] if one["propertiesLeftOut"]]
    for one in hiding:
        one["propertiesLeftOut"] = []
    return bool(hiding)


def invent_if(condition):
    return lambda report, documents: condition([data for _, data in documents]) and invent_difference(report, documents)


def drop_if(condition):
    return lambda report, documents: condition([data for _, data in documents]) and drop_difference(report, documents)


def change_group(field, change):
    """A lie about the first group that has the field."""

    def lie(report, _documents):
        groups = [one for one in report["groups"] if field in one]
        for one in groups[:1]:
            one[field] = change(one[field])
        return bool(groups)

    return on_report(lie)


def drop_group(report, _documents):
    return bool(report["groups"]) and bool(report["groups"].pop())


def miscount_inventory(report, _documents):
    report["inventories"][-1]["differences"] += 1
    return True


def invent_field(report, _documents):
    for one in report["differences"][:1]:
        one["severity"] = 5
    return bool(report["differences"])


def lose_field(report, _documents):
    found = [one for one in report["differences"] if "contents" in one]
    for one in found[:1]:
        del one["contents"]
    return bool(found)


def drop_new_instances(report, _documents):
    count = len(report["differences"])
    report["differences"] = [one for one in report["differences"] if one["kind"] != "onlyInOthers"]
    return len(report["differences"]) != count


def always_agree(result, arguments, _documents):
    return dataclasses.replace(result, status=0) if "-o" not in arguments else None


def lose_value_shown(result, arguments, _documents):
    if arguments[0] != "show" or "json" not in arguments:
        return None
    shown = json.loads(result.output)
    for one in shown[:1]:
        one["properties"] = {}
    return dataclasses.replace(result, output=json.dumps(shown).encode())


def lose_instance(command):
    def lie(result, arguments, _documents):
        if arguments[0] != command or "cimxml" not in arguments:
            return None
        return dataclasses.replace(result, output=re.sub(rb"<VALUE.OBJECT>\s*<INSTANCE .*?</VALUE.OBJECT>", b"", result.output, count=1, flags=re.S))

    return lie


def on_encoded_rules(result, arguments, documents):
    """Rules that are not plain UTF-8 are taken for others."""
    rules = dict(documents).get("rules.xml", b"")
    return on_report(drop_difference)(result, arguments, documents) if b"&#" in rules or b"encoding" in rules else None


def explain_all(result, arguments, _documents):
    return dataclasses.replace(result, output=result.output.replace(b": not compared", b": compared")) if arguments[0] == "explain" else None


class IgnoresLists(LyingProgram):
    """A program that does not know excludelist."""

    def __init__(self, path, root, folder, _lie):
        super().__init__(path, root, folder, lambda *_: None)

    def run(self, arguments, documents):
        kept = [(name, re.sub(rb"<excludelist>.*</excludelist>", b"", data) if name == "rules.xml" else data) for name, data in documents]
        self.told += kept != documents
        return super().run(arguments, kept)


LIES = [
    ("a difference is not reported", relations.is_what_the_files_say, LyingProgram, on_report(drop_difference)),
    ("a difference is invented", relations.is_what_the_files_say, LyingProgram, on_report(invent_difference)),
    ("a value is another", relations.is_what_the_files_say, LyingProgram, on_report(change_value)),
    ("everything was compared", relations.is_what_the_files_say, LyingProgram, on_report(claim_completeness)),
    ("no property was left out", relations.is_what_the_files_say, LyingProgram, on_report(hide_left_out)),
    ("the status is always 0", relations.ends_with_the_right_status, LyingProgram, always_agree),
    ("values are not shown", relations.shows_what_the_files_say, LyingProgram, lose_value_shown),
    ("an inventory differs from itself", relations.equals_itself, LyingProgram, on_report(invent_if(lambda data: data[0] == data[1]))),
    ("bytes differ", relations.equals_its_rewritings, LyingProgram, on_report(invent_if(lambda data: data[0] != data[1]))),
    ("compression hides", relations.report_does_not_change, LyingProgram, on_report(drop_if(lambda data: data[0][:2] == gzip.compress(b"")[:2]))),
    ("letter case hides", relations.means_the_same_if_shown_otherwise, LyingProgram, on_report(drop_if(lambda data: b'"value0of0"' in data[-1]))),
    ("show loses an instance", relations.survives_writing, LyingProgram, lose_instance("show")),
    ("query loses an instance", relations.survives_a_query, LyingProgram, lose_instance("query")),
    ("new instances are not reported", relations.mirrors, LyingProgram, on_report(drop_new_instances)),
    ("a third inventory hides", relations.many_are_pairs, LyingProgram, on_report(drop_if(lambda data: len(data) > 2))),
    ("lists of rules are not read", relations.excluding_removes_exactly_that, IgnoresLists, None),
    ("entities of rules are not read", relations.rules_may_be_written_otherwise, LyingProgram, on_encoded_rules),
    ("explain includes all", relations.explain_says_what_is_compared, LyingProgram, explain_all),
    ("a line is missing", relations.formats_agree, LyingProgram, without_first_line("ndjson", rb'\{"kind":"[a-z]*[^\n]*\n')),
    ("a record is missing", relations.formats_agree, LyingProgram, without_first_line("cimxml", RECORD)),
    ("an instance is missing", relations.detail_says_what_json_says, LyingProgram, without_first_line("text", rb"\n[-+~] [^\n]*")),
    ("a property is missing", relations.detail_says_what_json_says, LyingProgram, without_first_line("text", rb"\n    [^\n]*")),
    ("values change places", relations.detail_says_what_json_says, LyingProgram, with_first("text", rb"(\S+) -> (\w+): (\S+)", rb"\3 -> \2: \1")),
    ("another inventory is named", relations.detail_says_what_json_says, LyingProgram, with_first("text", rb"-> b: ", rb"-> c: ")),
    ("a line says nothing", relations.detail_says_what_json_says, LyingProgram, with_first("text", rb"\n    ", rb"\nperhaps\n    ")),
    ("a row is missing", relations.csv_says_what_json_says, LyingProgram, without_first_line("csv", rb"\n[^\n]*,[cC]hanged,[^\n]*")),
    ("a cell is another", relations.csv_says_what_json_says, LyingProgram, with_first("csv", rb",(\w+),string,", rb",\1x,string,")),
    ("a group is missing", relations.groups_hold_the_differences, LyingProgram, on_report(drop_group)),
    ("a group counts too many", relations.groups_hold_the_differences, LyingProgram, change_group("instances", lambda count: count + 1)),
    ("a change counts twice", relations.groups_hold_the_differences, LyingProgram, change_group("distinctChanges", lambda count: count + 1)),
    ("an example is of no use", relations.groups_hold_the_differences, LyingProgram, change_group("examples", lambda _: ["x"])),
    ("an inventory has more", relations.groups_hold_the_differences, LyingProgram, on_report(miscount_inventory)),
    ("a class has other counts", relations.groups_hold_the_differences, LyingProgram, with_first("text", rb"\n(\S+ +[-+~])\d", rb"\n\g<1>7")),
    ("a heading is missing", relations.groups_hold_the_differences, LyingProgram, without_first_line("markdown", rb"### [^\n]*\n")),
    ("a field is new", relations.follows_the_schema, LyingProgram, on_report(invent_field)),
    ("a field is missing", relations.follows_the_schema, LyingProgram, on_report(lose_field)),
    ("a line is of no kind", relations.follows_the_schema, LyingProgram, with_first("ndjson", rb'"kind":"[a-zA-Z]*"', rb'"kind":"moved"')),
]
