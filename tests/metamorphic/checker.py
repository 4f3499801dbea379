"""Checks a JSON report of cimdelta against the files that it is about.

Every difference in the files must be reported, or the report must name what was not compared. Nothing may be reported that is not in the files.
"""

from lxml import etree

import differences as d
import inventory
import paths
import values


class Checker:
    def __init__(self, documents, rules_data, report):
        """`documents`: the inventories as bytes, the reference first."""
        self.report = report
        self.comparison = d.Comparison([inventory.Inventory(data) for data in documents], rules_data)
        self.schema = self.comparison.schema
        self.labels = [one["label"] for one in report["inventories"]]
        self.coverage = {one["class"].lower(): one for one in report["coverage"]["classes"]}

    def faults(self):
        """What is wrong, one text each; empty if the report is right."""
        yield from self.coverage_faults()
        expected = set(self.differences_in_files())
        reported = {}
        for difference in self.report["differences"]:
            for one in self.flattened(difference):
                if one in reported:
                    yield f"reported twice: {one}"
                reported[one] = difference
        yield from (f"not reported: {one}" for one in sorted(map(str, expected - reported.keys())))
        yield from (f"reported, but not in the files: {one}" for one in sorted(map(str, reported.keys() - expected)))
        for one in expected & reported.keys():
            yield from self.value_faults(one, reported[one])
        yield from self.summary_faults()
        yield from self.text_faults()

    def differences_in_files(self):
        """What the report must hold, going by what it says was not compared."""
        for name in self.comparison.class_names():
            covered = self.coverage.get(name)
            if covered is None or covered["state"] != "compared":
                continue
            left_out = {p.lower() for p in covered["propertiesLeftOut"]}
            properties = set(self.comparison.properties(name)) - left_out
            yield from self.comparison.of_class(name, properties, covered["excludedKeys"])

    # What the report says was compared.

    def coverage_faults(self):
        names = set(self.comparison.class_names())
        if any(not count for count in self.comparison.count(inventory.OPERATING_SYSTEM)):
            names.add(inventory.OPERATING_SYSTEM)  # one was made
        for name in sorted(names ^ self.coverage.keys()):
            yield f"coverage: class {name} has instances in the files or in the coverage, but not in both"
        for name in sorted(names & self.coverage.keys()):
            yield from self.class_faults(name, self.coverage[name])
        empty = len(self.schema.classes.keys() - names)
        if self.report["coverage"]["classesWithoutInstances"] != empty:
            yield f"coverage: {empty} classes have no instances, not {self.report['coverage']['classesWithoutInstances']}"
        yield from self.completeness_faults(names)

    def expected_state(self, name):
        rules, properties = self.comparison.rules, self.comparison.properties(name)
        counts = self.comparison.count(name)
        if name == inventory.OPERATING_SYSTEM and not (counts[0] and any(counts[1:])):
            return "madeByCimdelta"
        if not rules.is_reached(name):
            return "reachedByNoElement"
        if rules.compared(name):
            return "compared"
        return "nothingToCompare" if set(properties) <= {"datetimeofcollection"} and rules.of(name).includes else "excludedByRules"

    def class_faults(self, name, covered):
        yield from self.fault(name, "state", covered["state"], self.expected_state(name))
        counts = self.comparison.count(name)
        made = [label for label, count in zip(self.labels, counts) if not count and name == inventory.OPERATING_SYSTEM]
        yield from self.fault(name, "madeIn", covered.get("madeIn", []), made)
        yield from self.fault(name, "instances", covered["instances"], counts)
        if covered["state"] != "compared":
            return
        properties = self.comparison.properties(name)
        left_out = sorted(set(properties) - self.comparison.rules.compared(name))
        yield from self.fault(name, "propertiesLeftOut", sorted(p.lower() for p in covered["propertiesLeftOut"]), left_out)
        excluded = self.comparison.rules.excluded_keys(name)
        ignored = {lower for lower, p in properties.items() if p.is_key and p.name in excluded}
        yield from self.fault(name, "excludedKeys", sorted(covered["excludedKeys"]), sorted(excluded))
        yield from self.fault(name, "ignoredKeys", sorted(k.lower() for k in covered["ignoredKeys"]), sorted(ignored))
        yield from self.key_faults(name, covered, ignored)
        is_reduced, keys = self.dropped_from_references(name, excluded)
        if is_reduced and not covered["referencesReduced"] or keys - {k.lower() for k in covered["referenceKeysLeftOut"]}:
            yield f"coverage: {name}: references differ in what was left out of them ({sorted(keys)}), and it is not said"

    def key_faults(self, name, covered, ignored):
        indexes = [self.comparison.by_key(index, name, ignored) for index in range(len(self.labels))]
        shares = [sum(len(same) - 1 for same in index.values()) for index in indexes]
        alone = [sum(len(same) - 1 for key, same in index.items() if key not in indexes[0]) for index in indexes]
        took_part = [0, *self.comparison.positions(name)]
        compared = [len(indexes[0])] + [sum(map(len, index.values())) for index in indexes[1:]]
        compared = [count if index in took_part else 0 for index, count in enumerate(compared)]
        yield from self.fault(name, "sharingKeys", covered["sharingKeys"], shares)
        yield from self.fault(name, "sharingKeysWithoutPartner", covered["sharingKeysWithoutPartner"], alone)
        yield from self.fault(name, "instancesCompared", covered["instancesCompared"], compared)

    @staticmethod
    def fault(name, field, said, right):
        if said != right:
            yield f"coverage: {name}: {field} is {said}, not {right}"

    def completeness_faults(self, names):
        """everythingCompared is a promise: nothing at all was left out."""
        left_out = []
        for name in sorted(names):
            covered = self.coverage.get(name, {"state": "not mentioned"})
            if covered["state"] == "madeByCimdelta" and not any(self.comparison.count(name)):
                continue  # no inventory has one
            if covered["state"] != "compared":
                left_out.append(name)
            elif covered["propertiesLeftOut"] or covered["sharingKeys"][0] or covered["referencesReduced"] or covered.get("madeIn"):
                left_out.append(f"part of {name}")
        is_complete = not left_out and not self.report["summary"]["nothingCompared"]
        if self.report["summary"]["everythingCompared"] and not is_complete:
            yield f"coverage: everything was compared, but not {left_out}"
        if not self.report["summary"]["everythingCompared"] and is_complete and not any(any(c["sharingKeys"]) for c in self.coverage.values()):
            yield "coverage: not everything was compared, but nothing is named"
        compared = sum(sum(c.get("instancesCompared", [])) for c in self.coverage.values() if c["state"] == "compared")
        if self.report["summary"]["nothingCompared"] != (compared == 0):
            yield f"coverage: nothingCompared is {self.report['summary']['nothingCompared']}, but {compared} instances were compared"

    def dropped_from_references(self, name, excluded):
        """Whether references of this class differ in the files and count as equal because keys are excluded; the keys that differ."""
        lower = {key.lower() for key in excluded}
        keys, is_reduced = set(), False
        for index in self.comparison.positions(name) if excluded else ():
            reference = self.comparison.by_key(0, name, lower)
            for key, instances in self.comparison.by_key(index, name, lower).items():
                for left, right in self.references(name, reference.get(key, [])[:1], instances):
                    if left != right and d.without_keys(left, excluded) == d.without_keys(right, excluded):
                        is_reduced = True
                        keys |= {binding[0] for binding in left[3] ^ right[3]}
        return is_reduced, keys

    def references(self, name, some, others):
        """The pairs of references that were compared."""
        for one in some:
            for other in others:
                for lower in self.comparison.rules.compared(name):
                    left, right = one.values.get(lower), other.values.get(lower)
                    if left and right and left[0] == right[0] == "reference":
                        yield left, right

    # What the report says differs.

    def flattened(self, difference):
        """One Difference for each inventory that the reported one holds for."""
        name = difference["class"].lower()
        key = frozenset(
            (lower.lower(), self.canonical(self.key_type(name, lower.lower()), value)) for lower, value in difference["keys"].items()
        )
        for label in difference["inventories"]:
            yield d.Difference(difference["kind"], name, key, difference.get("property", "").lower(), self.labels.index(label))

    def key_type(self, name, lower):
        declared = self.comparison.properties(name).get(lower)
        return declared.type if declared else "string"

    def canonical(self, type_name, value):
        """The canonical form of a value in a report. `type_name` is the declared type."""
        if value is None:
            return None
        if isinstance(value, list):
            base = type_name.replace("[]", "")
            return ("array", tuple(self.canonical(base, item) for item in value))
        if type_name == "object":
            try:
                return inventory.embedded(value, self.schema)
            except etree.XMLSyntaxError:
                return ("text", value)  # beside objects
        if type_name == "reference":
            return paths.canonical(value, self.schema)
        if isinstance(value, bool):
            return ("truth", value)
        if type_name in values.INTEGERS:
            return ("number", value) if isinstance(value, int) else ("not exact", value)
        return values.scalar(type_name, str(value))

    def value_faults(self, one, difference):
        if one.kind == d.ONLY_OTHERS:
            yield from self.disagreement_faults(one, difference)
        if one.kind != d.CHANGED:
            return
        shown = [other for other in difference["others"] if self.labels[one.index] in other["inventories"]]
        excluded = self.coverage[one.class_name]["excludedKeys"]
        yield from self.side_faults(one, 0, [difference["reference"]], excluded)
        yield from self.side_faults(one, one.index, shown, excluded)

    def disagreement_faults(self, one, difference):
        """Instances that the reference lacks are compared with one another."""
        covered = self.coverage[one.class_name]
        properties = set(self.comparison.properties(one.class_name)) - {p.lower() for p in covered["propertiesLeftOut"]}
        indices = [self.labels.index(label) for label in difference["inventories"]]
        expected = set()
        for lower in properties:
            found = [(i, v) for i in indices for v in self.instances(one, i)]
            if any(self.comparison.disagree(one.class_name, lower, a, b, covered["excludedKeys"]) for a in found for b in found):
                expected.add(lower)
        said = {x["property"].lower() for x in difference.get("disagreements", [])}
        if said != expected:
            yield f"disagreements: {sorted(expected)}, not {sorted(said)}: {one}"

    def instances(self, one, index):
        excluded = {k.lower() for k in self.coverage[one.class_name]["excludedKeys"]}
        return self.comparison.by_key(index, one.class_name, excluded).get(one.key, [])

    def side_faults(self, one, index, shown, excluded):
        """Whether the values shown for one inventory are its own."""
        declared = self.comparison.type_of(index, one.class_name, one.property) or self.comparison.properties(one.class_name)[one.property].type
        choices = self.comparison.value_choices(index, one.class_name, one.key, one.property, excluded)
        if not shown:
            yield f"no value for inventory {index}: {one}"
        for side in shown:
            value = self.canonical(declared, side["value"])
            if not any(self.are_one(one, value, choice, excluded) for choice in (choices[:1] if index == 0 else choices)):
                yield f"value of inventory {index} is {choices}, not {side['value']!r}: {one}"
            if side["value"] is not None and "object" not in declared and side["type"] != declared:
                yield f"type in inventory {index} is {declared}, not {side['type']}: {one}"

    def are_one(self, one, value, choice, excluded):
        """Whether a value may be shown for another: it stands for all that the comparison takes for equal."""
        if value and choice and excluded and value[0] == choice[0] == "reference":
            return d.without_keys(value, excluded) == d.without_keys(choice, excluded)
        if self.comparison.properties(one.class_name)[one.property].is_bag:
            return values.as_bag(value) == values.as_bag(choice)
        return value == choice

    def summary_faults(self):
        summary, found = self.report["summary"], self.report["differences"]
        kinds = [difference["kind"] for difference in found]
        counted = {
            "differences": len(found),
            "onlyInReference": kinds.count(d.ONLY_REFERENCE),
            "onlyInOthers": kinds.count(d.ONLY_OTHERS),
            "changedValues": kinds.count(d.CHANGED),
            "changedInstances": len({(x["class"], x["instance"]) for x in found if x["kind"] == d.CHANGED}),
        }
        for field, count in counted.items():
            if summary[field] != count:
                yield f"summary: {field} is {summary[field]}, but {count} are listed"
        least, most = self.only_in_others()
        if not least <= summary["instancesOnlyInOthers"] <= most:
            yield f"summary: instancesOnlyInOthers is {summary['instancesOnlyInOthers']}, not {least} to {most}"

    def only_in_others(self):
        """How many instances only others have: at least and at most, because one in several inventories may count once."""
        least = most = 0
        for difference in self.report["differences"]:
            if difference["kind"] == d.ONLY_OTHERS:
                counts = [len(self.instances(one, one.index)) for one in self.flattened(difference)]
                least, most = least + max(counts), most + sum(counts)
        return least, most

    def text_faults(self):
        """Equal keys have equal text, and other keys another text."""
        texts = {}
        for difference in self.report["differences"]:
            for one in self.flattened(difference):
                texts.setdefault((one.class_name, one.key), set()).add(difference["instance"])
        owners = {}
        for (name, key), shown in sorted(texts.items(), key=repr):
            if len(shown) > 1:
                yield f"one key of {name} has the texts {sorted(shown)}"
            for text in shown:
                if owners.setdefault(text, (name, key)) != (name, key):
                    yield f"two keys of {name} have the text {text}"


def check(program, documents, rules_data=None):
    """Compares documents [(name, data)] and returns what is wrong with the report."""
    report = program.report(documents, rules_data)
    return list(Checker([data for _, data in documents], rules_data, report).faults())
