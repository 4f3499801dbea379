"""What must hold between runs of cimdelta, whatever the inventories are.

Each relation takes a Case and yields what is wrong, one text each.
"""

import dataclasses
import json
import random
import re

from lxml import etree

import checker
import detailed_report
import differences as d
import grouped_report
import inventory
import program
import rewriting
import schema
import table_report
import values


REWRITINGS_AT_ONCE = 3


@dataclasses.dataclass
class Case:
    run: program.Program
    documents: list  # [(file name, bytes)], the reference first
    rules: bytes = None
    seed: int = 0
    is_thorough: bool = True

    def some(self, rewritings, relation):
        """All rewritings, or a few of them, others for other seeds."""
        if self.is_thorough:
            return rewritings
        return self.random(relation).sample(rewritings, min(len(rewritings), REWRITINGS_AT_ONCE))

    def random(self, name):
        return random.Random(f"{self.seed} {name}")

    def report(self, documents=None, rules=False):
        return self.run.report(documents or self.documents, self.rules if rules is False else rules)

    def read(self, report, documents=None, rules=False):
        """A checker that reads the report; it knows the files."""
        data = [one for _, one in documents or self.documents]
        return checker.Checker(data, self.rules if rules is False else rules, report)

    def said(self, documents=None, rules=False):
        """What a report says, with labels as positions: a set of (difference, values in the reference, values in the other)."""
        report = self.report(documents, rules)
        return said(self.read(report, documents, rules))


def said(read):
    found = set()
    for difference in read.report["differences"]:
        for one in read.flattened(difference):
            found.add((one, *values_of(read, one, difference)))
    return found


def values_of(read, one, difference):
    if one.kind != d.CHANGED:
        return (None, None)
    otherwise = read.key_type(one.class_name, one.property)
    declared = [read.comparison.type_of(index, one.class_name, one.property) or otherwise for index in (0, one.index)]
    reference = read.canonical(declared[0], difference["reference"]["value"])
    others = [
        read.canonical(declared[1], other["value"])
        for other in difference["others"]
        if read.labels[one.index] in other["inventories"]
    ]
    excluded = read.coverage[one.class_name]["excludedKeys"]
    if excluded and declared == ["reference", "reference"]:  # the value shown stands for all that are equal without these keys
        reference, *others = (d.without_keys(value, excluded) if value else None for value in (reference, *others))
    # Which side is the reference decides whether the order counts. The order that is shown is checked against the files.
    return values.as_bag(reference), frozenset(map(values.as_bag, others))


def difference_between(name, one, other):
    """Texts about what only one of two sets has."""
    for only in sorted(map(str, one - other))[:5]:
        yield f"{name}: only before: {only}"
    for only in sorted(map(str, other - one))[:5]:
        yield f"{name}: only after: {only}"


def has_sharing(report):
    return any(any(one["sharingKeys"]) for one in report["coverage"]["classes"])


# The files.


def is_what_the_files_say(case):
    """Every difference in the files is reported or named as not compared, and nothing else is reported."""
    yield from case.read(case.report()).faults()


def ends_with_the_right_status(case):
    """0 without differences, 1 with differences, 2 if nothing was compared."""
    report = case.report()
    right = 2 if report["summary"]["nothingCompared"] else 1 if report["differences"] else 0
    status = case.run.status(case.documents, case.rules)
    if status != right:
        yield f"status: {status}, not {right}"


def shows_what_the_files_say(case):
    """`show` gives each instance with the values in the file."""
    for name, data in case.documents:
        read = inventory.Inventory(data)
        read.read_instances(read.schema)
        for cls in read.schema.classes.values():
            if cls.superclass:
                continue
            shown = json.loads(case.run.document(["show", name, cls.name, "-o", "json"], (name, data)))
            below = {lower for lower in read.schema.classes if cls.name.lower() in read.schema.ancestry(lower)}
            expected = {instance_text(one.class_name, one.values) for one in read.instances if one.class_name in below}
            found = [shown_text(read, one) for one in shown]
            yield from difference_between(f"show {name} {cls.name}", expected, set(found))
            if len(found) != len(expected):
                yield f"show: {name}: {cls.name}: {len(found)} instances, not {len(expected)}"


def instance_text(class_name, found):
    return repr((class_name, sorted((name, repr(values.ordered(value))) for name, value in found.items() if value is not None)))


def shown_text(read, shown):
    lower = shown["class"].lower()
    comparison = checker.Checker.__new__(checker.Checker)
    comparison.schema = read.schema
    declared = read.schema.properties(lower)
    found = {name.lower(): comparison.canonical(declared[name.lower()].type, value) for name, value in shown["properties"].items()}
    return instance_text(lower, found)


# The same inventory twice.


def equals_itself(case):
    for name, data in case.documents:
        report = case.run.report([("one.xml", data), ("two.xml", data)])
        if report["differences"]:
            yield f"itself: {name} differs from itself: {report['differences'][0]}"


def equals_its_rewritings(case):
    for how in case.some(rewriting.ALL, "rewritings"):
        name, data = case.documents[case.random(how.__name__).randrange(len(case.documents))]
        other = how(data, case.random(how.__name__))
        report = case.run.report([("one.xml", data), ("two.xml", other)])
        if report["differences"]:
            yield f"rewriting {how.__name__}: {name} differs from its rewriting: {report['differences'][0]}"


def report_does_not_change(case):
    """Rewritten inventories give the same report, byte for byte."""
    before = case.run.compare(case.documents, case.rules, "json").output
    shares = has_sharing(json.loads(before))
    for how in case.some(rewriting.ALIKE, "alike"):
        if shares and how is rewriting.declarations_in_another_order:
            continue  # the first of several instances in the file stands for all
        documents = [(name, how(data, case.random(how.__name__ + name))) for name, data in case.documents]
        after = case.run.compare(documents, case.rules, "json").output
        if before != after:
            yield f"rewritten {how.__name__}: {first_difference(before, after)}"


def first_difference(before, after):
    for one, other in zip(before.decode().splitlines(), after.decode().splitlines()):
        if one != other:
            return f"{one.strip()[:200]} became {other.strip()[:200]}"
    return "one report is longer"


def means_the_same_if_shown_otherwise(case):
    """Another order of properties and bags, other spellings of values, and of the names in all inventories but the reference."""
    report = case.report()
    before = said(case.read(report))
    are_bags_agreed = all(one["kind"] != "arrayTypeDiffers" for one in report["coverage"]["schema"])
    for how in rewriting.DISPLAY:
        if how is rewriting.bags_in_another_order and not are_bags_agreed:
            continue  # the declaration of the reference decides
        kept = 1 if how is rewriting.names_in_another_case else 0  # names are spelled as in the reference
        documents = case.documents[:kept] + [(name, how(data, case.random(how.__name__ + name))) for name, data in case.documents[kept:]]
        yield from difference_between(f"shown otherwise {how.__name__}", before, case.said(documents))


def survives_writing(case):
    """What `show` writes as CIM-XML is the same inventory."""
    rewritten = [(name, case.run.document(["show", name, "-o", "cimxml"], (name, data))) for name, data in case.documents]
    for (name, data), (_, copied) in zip(case.documents, rewritten):
        report = case.run.report([("one.xml", data), ("two.xml", copied)])
        if report["differences"]:
            yield f"written: {name} differs from what show writes: {report['differences'][0]}"
    yield from difference_between("written", case.said(), case.said(rewritten))


def survives_a_query(case):
    """What `query` writes as CIM-XML holds the instances of that class as they were."""
    name, data = case.documents[0]
    read = inventory.Inventory(data)
    read.read_instances(read.schema)
    tops = [cls for lower, cls in read.schema.classes.items() if not cls.superclass]
    cls = case.random("query").choice(tops)
    below = {lower for lower in read.schema.classes if cls.name.lower() in read.schema.ancestry(lower)}
    copied = case.run.document(["query", f"SELECT * FROM {cls.name}", name, "-o", "cimxml"], (name, data))
    report = case.run.report([("one.xml", data), ("two.xml", copied)])
    for difference in report["differences"]:
        if difference["class"].lower() in below:
            yield f"queried: {difference}"


# Other inventories beside and in front.


def mirrors(case):
    """The other way round, what only one has is what only the other has, and values change places."""
    pair = case.documents[:2]
    report = case.report(pair)
    if has_sharing(report) or any(one["kind"] == "arrayTypeDiffers" for one in report["coverage"]["schema"]):
        return  # the first of several instances, and the declaration of the reference, decide
    mirrored = {d.ONLY_REFERENCE: d.ONLY_OTHERS, d.ONLY_OTHERS: d.ONLY_REFERENCE, d.CHANGED: d.CHANGED}
    forth = set()
    for one, reference, others in case.said(pair):
        turned = (next(iter(others)), frozenset([reference])) if one.kind == d.CHANGED else (None, None)
        forth.add((dataclasses.replace(one, kind=mirrored[one.kind]), *turned))
    yield from difference_between("mirrored", forth, case.said(pair[::-1]))


def many_are_pairs(case):
    """A report on many inventories says of each what the report on it alone says."""
    everything = case.said()
    for index in range(1, len(case.documents)):
        pair = [case.documents[0], case.documents[index]]
        alone = {(dataclasses.replace(one, index=index), *rest) for one, *rest in case.said(pair)}
        yield from difference_between(f"pairs [{index}]", {x for x in everything if x[0].index == index}, alone)


# Rules.


def excluding_removes_exactly_that(case):
    """A property that the rules leave out takes its differences away, and no other."""
    read = case.read(case.report(rules=None), rules=None)
    if any(name == inventory.OPERATING_SYSTEM and state["state"] != "compared" for name, state in read.coverage.items()):
        skipped = {inventory.OPERATING_SYSTEM}
    else:
        skipped = set()
    classes = {lower: cls for lower, cls in read.schema.classes.items() if lower not in skipped}
    base = etree.Element("DifftoolSpec")
    for cls in classes.values():
        if not cls.superclass:
            etree.SubElement(base, "class", name=cls.name, default="include")
    everything = case.said(rules=etree.tostring(base))
    yield from difference_between("rules that include everything", {x for x in case.said(rules=None) if x[0].class_name not in skipped}, everything)
    source = case.random("excluding")
    lower = source.choice(sorted(classes))
    chosen = source.choice(sorted(read.schema.properties(lower).values(), key=lambda p: p.name))
    element = etree.SubElement(base, "class", name=classes[lower].name, default="include")
    etree.SubElement(etree.SubElement(element, "excludelist"), "value").text = chosen.name
    below = {other for other in classes if lower in read.schema.ancestry(other)}
    expected = {x for x in everything if not (x[0].class_name in below and x[0].property == chosen.name.lower())}
    alone = [name for name in below if len(read.schema.properties(name)) == 1]  # nothing is left to compare there
    expected = {x for x in expected if x[0].class_name not in alone}
    yield from difference_between(f"without {classes[lower].name}.{chosen.name}", expected, case.said(rules=etree.tostring(base)))


def rules_may_be_written_otherwise(case):
    """Rules mean the same in any XML that says the same."""
    if case.rules is None:
        return
    before = case.run.compare(case.documents, case.rules, "json").output
    for how in case.some(rewriting.RULES, "rules"):
        after = case.run.compare(case.documents, how(case.rules, case.random(how.__name__)), "json").output
        if before != after:
            yield f"rules rewritten {how.__name__}: {first_difference(before, after)}"


def explain_says_what_is_compared(case):
    """`explain` and the coverage of the comparison agree, property by property."""
    read = case.read(case.report())
    options = [part for name, _ in case.documents for part in ("--schema", name)] + (["--spec", "rules.xml"] if case.rules is not None else [])
    documents = case.documents + ([("rules.xml", case.rules)] if case.rules is not None else [])
    for lower, covered in read.coverage.items():
        if covered["state"] == "madeByCimdelta":
            continue
        result = case.run.run(["explain", covered["class"], *options], documents)
        verdicts = re.findall(r"^  ([^\s:]+): (not )?compared", result.output.decode(), re.M)
        explained = {name.lower() for name, negation in verdicts if not negation}
        yield from difference_between(f"explain {covered['class']}", read.comparison.rules.compared(lower), explained)
        if len(verdicts) != len(read.comparison.properties(lower)):
            yield f"explain {covered['class']}: {len(verdicts)} properties, not {len(read.comparison.properties(lower))}"


# Formats.


def formats_agree(case):
    report = case.report()
    lines = [json.loads(line) for line in case.run.compare(case.documents, case.rules, "ndjson").output.decode().splitlines()]
    if lines[:-1] != report["differences"]:
        yield "ndjson: other differences than in JSON"
    ending = dict(lines[-1])
    right = {**{name: report[name] for name in ("inventories", "summary", "groups")}, **report["coverage"]}
    if ending.pop("kind") != "coverage" or ending != right:
        yield "ndjson: another coverage than in JSON"
    yield from record_faults(case.run.compare(case.documents, case.rules, "cimxml").output, report)


def detail_says_what_json_says(case):
    yield from detailed_report.faults(case.run.compare(case.documents, case.rules, "text").output.decode(), case.report())


def csv_says_what_json_says(case):
    yield from table_report.faults(case.run.compare(case.documents, case.rules, "csv").output, case.report())


def groups_hold_the_differences(case):
    text = case.run.grouped(case.documents, case.rules)
    yield from grouped_report.faults(case.report(), text, case.run.grouped(case.documents, case.rules, "markdown"))


def follows_the_schema(case):
    """The JSON report and each line of ndjson are as the published schema says."""
    yield from schema.faults(case.report(), case.run.compare(case.documents, case.rules, "ndjson").output)


def record_faults(data, report):
    """Records in CIM-XML against the JSON report."""
    labels = [one["label"] for one in report["inventories"]]
    excluding = {one["class"] for one in report["coverage"]["classes"] if one["excludedKeys"]}
    kinds = {"1": d.ONLY_REFERENCE, "2": d.ONLY_OTHERS, "4": d.CHANGED}
    found = set()
    root = etree.fromstring(data, inventory.XML)
    records = [one for one in root.iter("INSTANCE") if one.get("CLASSNAME") == "KALMO_Delta"]
    for record in records:
        fields = {p.get("NAME"): [v.text or "" for v in p.iter("VALUE")] for p in record}
        name = fields["InstanceName"][0]
        indices = {min(int(i), len(labels) - 1) for i in fields["NamespaceIndices"]}  # a pair may be compared at two positions
        found.add((kinds[fields["Type"][0]], name, fields["Property"][0], frozenset(indices)))
    expected = set()
    for difference in report["differences"]:
        name = difference["instance"]
        if difference["class"] in excluding and difference["kind"] == d.ONLY_REFERENCE:
            continue  # the record has the full path
        indices = frozenset(labels.index(label) for label in difference["inventories"])
        expected.add((difference["kind"], name, difference.get("property", ""), indices))
    found = {x for x in found if not (x[0] == d.ONLY_REFERENCE and class_of_path(x[1]) in excluding)}
    yield from difference_between("records", expected, found)
    links = sum(one.get("CLASSNAME") == "KALMO_DeltaClassAssocToDelta" for one in root.iter("INSTANCE"))
    if links != len(records):
        yield f"records: {len(records)} records, but {links} associations"


def class_of_path(path):
    return path.split(".")[0].split(":")[-1]


# Those that read what one run reports.
REPORTS = [
    formats_agree,
    detail_says_what_json_says,
    csv_says_what_json_says,
    groups_hold_the_differences,
    follows_the_schema,
]
ALL = [
    is_what_the_files_say,
    ends_with_the_right_status,
    shows_what_the_files_say,
    equals_itself,
    equals_its_rewritings,
    report_does_not_change,
    means_the_same_if_shown_otherwise,
    survives_writing,
    survives_a_query,
    mirrors,
    many_are_pairs,
    excluding_removes_exactly_that,
    rules_may_be_written_otherwise,
    explain_says_what_is_compared,
    *REPORTS,
]
