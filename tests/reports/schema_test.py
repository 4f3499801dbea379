"""JSON reports against data/schema/comparison-1.json: everything that a report may say is said in some case, every case follows the
schema, and the schema is strict: a report with a field more or less, or with another kind of value, does not follow it.

Arguments: CIMDELTA ROOT, and those of unittest.
"""

import copy
import json
import os
import pathlib
import subprocess
import sys
import tempfile
import unittest

sys.path.append(str(pathlib.Path(__file__).parent.parent / "metamorphic"))

import schema  # noqa: E402
from small_documents import (  # noqa: E402
    SYSTEM,
    SYSTEM_CLASS,
    array,
    cls,
    declared,
    declared_array,
    document,
    embedded,
    instance,
    key,
    path,
    reference,
    rules,
    value,
)

CIMDELTA, ROOT = (pathlib.Path(sys.argv[1]).resolve(), pathlib.Path(sys.argv[2]).resolve()) if len(sys.argv) > 2 else (None, None)
ACCEPTED = ROOT / "tests/client/data/accepted.txt" if ROOT else None
OPTIONAL = {"sharing", "path", "madeIn", "embedded", "parts", "disagreements", "baseline", "notShown", "notCollected"}
MAPS = {"keys", "contents", "properties"}  # names in them are those of an inventory
WORDS = {"format", "role", "namespaceFrom", "kind", "state", "reason", "takenAs", "type"}


class Reports:
    """The reports of all cases, by name. A case is inventories, the arguments that come with them, rules, and the inventories of an
    earlier comparison, of which the differences are accepted."""

    def __init__(self):
        self.made = {}

    def of(self, name):
        if name not in self.made:
            self.made[name] = self.compare(*CASES[name])
        return self.made[name]

    @staticmethod
    def write(folder, inventories):
        names = []
        for letter, text in zip("abcd", inventories):
            names.append(str(text) if isinstance(text, pathlib.Path) else f"{letter}.xml")
            if not isinstance(text, pathlib.Path):
                (pathlib.Path(folder) / names[-1]).write_text(text, encoding="utf-8")
        return names

    @staticmethod
    def run(folder, arguments):
        environment = dict(os.environ, CIMDELTA_ROOT=str(ROOT))
        done = subprocess.run([CIMDELTA, "compare", *arguments], cwd=folder, env=environment, capture_output=True, check=False)
        if done.returncode not in (0, 1):
            raise AssertionError(done.stderr.decode())
        return done.stdout

    @classmethod
    def compare(cls_, inventories, arguments=(), rules_text=None, accepted=()):
        with tempfile.TemporaryDirectory(prefix="cimdelta-schema-") as folder:
            if accepted:
                cls_.run(folder, ["--accept", "baseline.txt", *cls_.write(folder, accepted)])
                arguments = [*arguments, "--baseline", "baseline.txt"]
            names = cls_.write(folder, inventories)
            if rules_text:
                (pathlib.Path(folder) / "rules.xml").write_text(rules_text, encoding="utf-8")
                arguments = [*arguments, "--spec", "rules.xml"]
            json_report, lines = (cls_.run(folder, ["-o", one, *arguments, *names]) for one in ("json", "ndjson"))
            return json.loads(json_report), lines


def disk(properties, *instances):
    return SYSTEM + cls("Disk", key("Id") + properties) + "".join(instance("Disk", value("Id", "sda") + one) for one in instances)


EVERY_TYPE = [
    *[(name, "1", "2") for name in ("uint8", "sint8", "uint16", "sint16", "uint32", "sint32")],
    ("uint64", "18446744073709551615", "0"),
    ("sint64", "-9223372036854775808", "0"),
    ("boolean", "TRUE", "FALSE"),
    ("real32", "0.1", "-0.0"),
    ("real64", "NaN", "-INF"),
    ("string", "a", ""),
    ("char16", "a", "b"),
    ("datetime", "20240229110000.000000+000", "00000001000000.000000:000"),
]


def of_every_type(column):
    singles = "".join(value(f"One{row[0]}", row[column], row[0]) for row in EVERY_TYPE)
    return singles + "".join(array(f"Many{row[0]}", [row[column], None], row[0]) for row in EVERY_TYPE)


DECLARED_TYPES = "".join(declared(f"One{row[0]}", row[0]) + declared_array(f"Many{row[0]}", row[0]) for row in EVERY_TYPE)
SETTINGS = declared("Settings") + declared_array("More")
TO_DISK = '<PROPERTY.REFERENCE NAME="To"/>'


def settings(speed, inner):
    return embedded("Settings", "Cfg", value("Speed", speed, "uint32") + embedded("Inner", "Cfg", value("Speed", inner, "uint32")))


A_CLASS = '&lt;CLASS NAME="Cfg"&gt;&lt;/CLASS&gt;'
EMBEDDED_CLASS = value("Settings", A_CLASS, attributes=' EmbeddedObject="object"')
EMBEDDED_CLASSES = array("More", [A_CLASS, None], attributes=' EmbeddedObject="object"')


def storage(name, *extra):
    return document(
        SYSTEM,
        cls("KALMO_ComputerSystem", key("Name")),
        cls("Volume", key("SystemName") + key("Id") + declared("Owner")),
        instance("KALMO_ComputerSystem", value("Name", name)),
        *(instance("Volume", value("SystemName", name) + value("Id", one)) for one in ("1", "2", *extra)),
    )


def two_boots(*sizes):
    disks = "".join(instance("Disk", value("Id", "sda") + value("Boot", str(at)) + value("Size", size, "uint32")) for at, size in enumerate(sizes))
    return document(SYSTEM, cls("Disk", key("Id") + key("Boot") + declared("Size", "uint32")), disks)


WITHOUT_BOOT = rules('<class name="Disk" default="include" excludekeys="Boot"><excludelist><value>Boot</value></excludelist></class>')
NAMED = (
    '<CIM CIMVERSION="2.0" DTDVERSION="2.0"><DECLARATION><DECLGROUP.WITHNAME><VALUE.NAMEDOBJECT><INSTANCENAME CLASSNAME="Disk"><KEYBINDING NAME="Id">'
    "<KEYVALUE>%s</KEYVALUE></KEYBINDING></INSTANCENAME>"
    '<INSTANCE CLASSNAME="Disk"><PROPERTY NAME="Id" TYPE="string"><VALUE>%s</VALUE></PROPERTY></INSTANCE></VALUE.NAMEDOBJECT></DECLGROUP.WITHNAME>'
    "</DECLARATION></CIM>"
)
TIMED = document(SYSTEM, cls("Probe", declared("DateTimeOfCollection", "datetime")), instance("Probe", ""))
LACK = document(
    SYSTEM,
    cls("KALMO_NotCollected", key("Kind") + key("Reason") + declared("Count", "uint32") + declared_array("Subjects")),
    instance(
        "KALMO_NotCollected",
        value("Kind", "Disk") + value("Reason", "CIM_ERR_FAILED (1)") + value("Count", "1", "uint32") + array("Subjects", ["sda"]),
    ),
)
CASES = {
    "not collected": ([LACK, LACK],),
    "a pair": ([document(disk(declared("Size", "uint32"), value("Size", "1", "uint32"))), document(disk(declared("Size", "uint32")))],),
    "equal": ([document(disk("")), document(disk(""))],),
    "a fleet": ([ROOT / "tests/client/data" / f"web0{number}.xml" for number in (1, 2, 3)] if ROOT else [],),
    "the majority": ([ROOT / "tests/client/data" / f"web0{number}.xml" for number in (1, 2, 3)] if ROOT else [], ["--reference", "majority"]),
    "a baseline of a fleet": ([ROOT / "tests/client/data" / f"web0{number}.xml" for number in (1, 2, 3)] if ROOT else [], ["--baseline", str(ACCEPTED)]),
    "every type": ([document(disk(DECLARED_TYPES, of_every_type(column))) for column in (1, 2)],),
    "every type and null": ([document(disk(DECLARED_TYPES, of_every_type(1))), document(disk(DECLARED_TYPES, ""))],),
    "every type in contents": ([document(disk(DECLARED_TYPES)), document(disk(DECLARED_TYPES, of_every_type(2)))],),
    "references": (
        [
            document(disk(""), cls("Link", key("Id") + TO_DISK), instance("Link", value("Id", "1") + reference("To", path("Disk", [("Id", one)]))))
            for one in ("sda", "sdb")
        ],
    ),
    "embedded values": (
        [
            document(disk(SETTINGS, settings("1", "5") + array("More", ["text", None]))),
            document(disk(SETTINGS, settings("2", "6"))),
            document(disk(SETTINGS, value("Settings", "plain"))),
        ],
    ),
    "an embedded class": (
        [document(disk(SETTINGS, settings("1", "1"))), document(disk(SETTINGS, EMBEDDED_CLASS)), document(disk(SETTINGS, EMBEDDED_CLASSES))],
    ),
    "parts": ([document(disk(SETTINGS, settings(one, one))) for one in ("1", "2")],),
    "disagreements": ([document(disk(SETTINGS)), *(document(disk(SETTINGS, settings(one, one))) for one in ("1", "2"))],),
    "shared keys": ([two_boots("5", "6"), two_boots("7", "8")], [], WITHOUT_BOOT),
    "shared keys alone": ([two_boots(), two_boots("7", "8")], [], WITHOUT_BOOT),
    "shared keys missing": ([two_boots("7", "8"), two_boots()], [], WITHOUT_BOOT),
    "bad values as null": ([document(disk(declared("Size", "uint8"), value("Size", size, "uint8"))) for size in ("1", "700")], ["--bad-values", "null"]),
    "bad values as text": ([document(disk(declared("Size", "uint8"), value("Size", size, "uint8"))) for size in ("1", "700")], ["--bad-values", "text"]),
    "system names": ([storage("array1"), storage("array2", "array2-x")], ["--self"]),
    "a hint": ([storage("array1"), storage("array2")],),
    "a made system": ([document(disk("", "")), document(cls("Disk", key("Id")), instance("Disk", value("Id", "sda")))],),
    "no system": ([document(cls("Disk", key("Id")), instance("Disk", value("Id", one))) for one in ("1", "2")],),
    "inferred classes": ([NAMED % (one, one) for one in ("1", "2")], ["--infer-classes"]),
    "a namespace": ([document(disk(""))] * 2, ["--namespace", "root/other"]),
    "a namespace in references": (
        [
            document(disk(""), cls("Link", key("Id") + TO_DISK), instance("Link", value("Id", "1") + reference("To", path("Disk", [("Id", "1")], "root/x"))))
        ]
        * 2,
    ),
    "a namespace in documents": (
        [
            '<CIM CIMVERSION="2.0" DTDVERSION="2.0"><DECLARATION><DECLGROUP><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/></LOCALNAMESPACEPATH>'
            + disk("")
            + "</DECLGROUP></DECLARATION></CIM>"
        ]
        * 2,
    ),
    "declared elsewhere": ([document(disk("")), document(disk(declared("Size", "uint32")), cls("Tape", key("Id")))],),
    "other spellings": ([document(disk(declared("Size"))), document(SYSTEM, cls("disk", key("Id") + declared("size")))],),
    "other spellings left": (
        [document(disk("")), document(SYSTEM, cls("disk", key("id")))],
        ["--strict-schema"],
    ),
    "other types": ([document(disk(declared("Size", one))) for one in ("uint8", "string")],),
    "other keys": ([document(disk(one(key))) for one in (lambda _: declared("Boot"), lambda make: make("Boot"))],),
    "other orders": ([document(disk(declared_array("Size", "uint8", one))) for one in ("Bag", "Ordered")],),
    "other superclasses": ([document(SYSTEM, cls("Top"), cls("Disk", key("Id"), one)) for one in ("", "Top")],),
    "unknown to the reference": ([document(SYSTEM), document(disk("", ""))], ["--strict-schema", "--allow-empty"]),
    "not declared": (
        [document(disk("", "")), document(disk(declared("Size"), value("Size", "1")))],
        ["--strict-schema"],
    ),
    "excluded": ([document(disk(declared("Size"), "")), document(disk(declared("Size"), ""))], ["--allow-empty"], rules('<class name="Disk" default="exclude"/>')),
    "partly excluded": (
        [document(disk(declared("Size"), value("Size", one))) for one in "12"],
        [],
        rules('<class name="Disk" default="include"><excludelist><value>Size</value></excludelist></class>'),
    ),
    "partly included": (
        [document(disk(declared("Size"), value("Size", one))) for one in "12"],
        [],
        rules('<class name="Disk" default="exclude"><includelist><value>Size</value></includelist></class>'),
    ),
    "a baseline": (
        [document(disk(declared("Size"), value("Size", one))) for one in "13"],
        [],
        None,
        [document(disk(declared("Size"), *ones)) for ones in ([value("Size", "1")], [value("Size", "2")], [value("Size", "2")])],
    ),
    "what options leave out": (
        [document(disk(declared("Size") + declared("Model"), value("Size", one) + value("Model", "A"))) for one in ("1", "2")],
        ["--exclude", "Disk.Model", "--exclude", "KALMO_OperatingSystem", "--only", "+"],
    ),
    "nothing to compare": ([TIMED, TIMED], ["--allow-empty"]),
    "no instance": ([document(SYSTEM_CLASS)] * 2, ["--allow-empty"]),
}


def walk(node, name=""):
    """(node, the name of the field that holds it), for every value in a document."""
    yield node, name
    if isinstance(node, dict):
        for field, one in node.items():
            yield from walk(one, field)
    elif isinstance(node, list):
        for one in node:
            yield from walk(one, name)


def places(node, where=(), shape=()):
    """One (path, shape, node) for each shape: the path without the numbers and names that belong to the inventories."""
    yield where, shape, node
    if isinstance(node, dict):
        for field, one in node.items():
            yield from places(one, (*where, field), (*shape, "*" if shape and shape[-1] in MAPS else field))
    elif isinstance(node, list):
        for at, one in enumerate(node):
            yield from places(one, (*where, at), (*shape, ""))


def with_change(report, where, change):
    """A copy in which `change` was applied to what holds the place; the copy and the original share the rest."""
    changed = copy.copy(report)
    node = changed
    for step in where[:-1]:
        node[step] = copy.copy(node[step])
        node = node[step]
    change(node, where[-1])
    return changed


def set_to(made):
    def change(holder, at):
        holder[at] = made

    return change


def remove(holder, at):
    del holder[at]


REPORTS = Reports()


class SchemaTest(unittest.TestCase):
    def test_every_report_follows_it(self):
        for name in CASES:
            with self.subTest(name):
                report, lines = REPORTS.of(name)
                self.assertEqual([], list(schema.faults(report, lines)))

    def test_every_word_of_it_is_in_some_report(self):
        """So the cases say everything that a report may say, and the schema knows no word that is never said."""
        said = {one for name in CASES for one, _ in walk(REPORTS.of(name)[0]) if isinstance(one, str)}
        said |= {json.loads(line)["kind"] for name in CASES for line in REPORTS.of(name)[1].decode().splitlines()}
        words = set()
        for node, field in walk(schema.SCHEMA):
            if isinstance(node, dict) and isinstance(node.get("const"), str):
                words.add(node["const"])
            if isinstance(node, dict) and isinstance(node.get("enum"), list):
                words.update(node["enum"])
        self.assertGreater(len(words), 60)
        self.assertEqual({"INF", "reference[]"}, words - said)  # INF is as -INF; CIM has no arrays of references

    def test_every_field_of_it_is_in_some_report(self):
        seen = {field for name in CASES for node, _ in walk(REPORTS.of(name)[0]) if isinstance(node, dict) for field in node}
        known = set()
        for node, field in walk(schema.SCHEMA):
            if isinstance(node, dict) and isinstance(node.get("required"), list) and isinstance(node.get("properties"), dict):
                known.update(node["properties"])
        self.assertGreater(len(known), 70)
        self.assertEqual(set(), known - seen)

    def refused(self, mutations):
        """Each mutation of a report, one for each shape of place, has to be refused."""
        tried = {}
        for name in CASES:
            report = REPORTS.of(name)[0]
            for where, shape, node in places(report):
                for kind, made in mutations(where, shape, node, report):
                    if (shape, kind) not in tried:
                        tried[shape, kind] = where
                        self.assertFalse(schema.DOCUMENT.is_valid(made), f"{name}: {kind} at {where}")
        return len(tried)

    def test_a_field_that_it_does_not_know_is_refused(self):
        def mutations(where, shape, node, report):
            if isinstance(node, dict):
                yield "a new field", with_change(report, (*where, "unheardOf"), set_to({"of": 1}))

        self.assertGreater(self.refused(mutations), 50)

    def test_a_missing_field_is_refused(self):
        def mutations(where, shape, node, report):
            is_field = where and isinstance(where[-1], str) and shape[-1] != "*" and shape[-1] not in OPTIONAL
            if is_field and not self.is_optional_property(shape, report, where):
                yield "no field", with_change(report, where, remove)

        self.assertGreater(self.refused(mutations), 100)

    @staticmethod
    def is_optional_property(shape, report, where):
        """A note on another spelling names a property only if it is about one. What is accepted may have no value in the reference."""
        if shape[0] == "baseline" and len(shape) > 2 and shape[-1] in ("reference", "accepted"):
            return True
        return shape[-1] == "property" and shape[:2] == ("coverage", "schema") and report["coverage"]["schema"][where[2]]["kind"] == "spellingDiffers"

    def test_another_kind_of_value_is_refused(self):
        def mutations(where, shape, node, report):
            if where and shape[-1] != "":
                yield "another kind", with_change(report, where, set_to({"of": [{}]}))

        self.assertGreater(self.refused(mutations), 150)

    def test_a_word_that_it_does_not_know_is_refused(self):
        def mutations(where, shape, node, report):
            is_free = "first" in shape or "notCollected" in shape or shape[-1:] == ("*",) or shape[:1] == ("baseline",) and where[-1] == "reason"
            if where and where[-1] in WORDS and not is_free:
                yield "another word", with_change(report, where, set_to("nonsense"))

        self.assertGreater(self.refused(mutations), 15)

    def test_a_value_of_another_type_is_refused(self):
        """A value fits the type that stands beside it."""
        count = 0
        for name in ("every type", "every type in contents"):
            report = REPORTS.of(name)[0]
            for where, _, node in places(report):
                if isinstance(node, dict) and "type" in node and "value" in node:
                    other = True if node["type"].startswith("real") else 5 if isinstance(node["value"], (str, list)) else "text"
                    count += 1
                    self.assertFalse(schema.DOCUMENT.is_valid(with_change(report, (*where, "value"), set_to(other))), f"{where}: {node}")
        self.assertGreater(count, 50)

    def test_a_line_that_is_none_is_refused(self):
        report, lines = REPORTS.of("a fleet")
        for line in map(json.loads, lines.decode().splitlines()):
            self.assertTrue(schema.LINE.is_valid(line))
            self.assertFalse(schema.LINE.is_valid({**line, "kind": "moved"}))
            self.assertFalse(schema.LINE.is_valid({**line, "unheardOf": 1}))
        self.assertFalse(schema.LINE.is_valid(report))


if __name__ == "__main__":
    if CIMDELTA is None:
        sys.exit("arguments: CIMDELTA ROOT")
    unittest.main(argv=[sys.argv[0], *sys.argv[3:]])
