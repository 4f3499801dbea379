"""Checks a JSON report of cimdelta against the files that it is about.

Every difference in the files must be reported, or the report must name what was not compared. Nothing may be reported that is not in the files.
"""

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
        self.compares_everything = rules_data is None

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
        made = {name for name, one in self.coverage.items() if one["state"] == "madeByCimdelta"}
        for name in sorted(names ^ (self.coverage.keys() - made - {inventory.OPERATING_SYSTEM})):
            if name != inventory.OPERATING_SYSTEM:
                yield f"coverage: class {name} has instances in the files or in the coverage, but not in both"
        for name in sorted(names & self.coverage.keys()):
            yield from self.class_faults(name, self.coverage[name])
        yield from self.completeness_faults(names)

    def class_faults(self, name, covered):
        compared = self.comparison.rules.compared(name)
        is_compared = covered["state"] == "compared"
        if is_compared != bool(compared) and name != inventory.OPERATING_SYSTEM:
            yield f"coverage: {name} is {covered['state']}, but the rules compare {sorted(compared)}"
        if name != inventory.OPERATING_SYSTEM and covered["instances"] != self.comparison.count(name):
            yield f"coverage: {name} has {self.comparison.count(name)} instances, not {covered['instances']}"
        if not is_compared:
            return
        left_out = {p.lower() for p in covered["propertiesLeftOut"]}
        if left_out != set(self.comparison.properties(name)) - compared:
            yield f"coverage: properties of {name} left out: {sorted(set(self.comparison.properties(name)) - compared)}, not {sorted(left_out)}"
        keys = {lower for lower, p in self.comparison.properties(name).items() if p.is_key}
        excluded = {k.lower() for k in self.comparison.rules.excluded_keys(name)} & keys
        if {k.lower() for k in covered["excludedKeys"]} & keys != excluded:
            yield f"coverage: excluded keys of {name}: {sorted(excluded)}, not {covered['excludedKeys']}"
        sharing = self.comparison.sharing(name, excluded)
        if name != inventory.OPERATING_SYSTEM and covered["sharingKeys"] != sharing:
            yield f"coverage: instances of {name} that share a key: {sharing}, not {covered['sharingKeys']}"

    def completeness_faults(self, names):
        """everythingCompared is a promise: nothing at all was left out."""
        if not self.report["summary"]["everythingCompared"]:
            return
        for name in sorted(names):
            covered = self.coverage.get(name)
            if covered is None or covered["state"] != "compared":
                if name != inventory.OPERATING_SYSTEM or covered is None:
                    yield f"coverage: everything was compared, but {name} was not"
            elif covered["propertiesLeftOut"] or any(covered["sharingKeys"]):
                yield f"coverage: everything was compared, but something of {name} was not"
            elif self.dropped_from_references(name, covered):
                yield f"coverage: everything was compared, but parts of references of {name} were not"

    def dropped_from_references(self, name, covered):
        """Whether references of this class differ in the files and count as equal because keys are excluded."""
        excluded, properties = covered["excludedKeys"], set(self.comparison.properties(name))
        if not excluded:
            return False
        lower = {k.lower() for k in excluded}
        for index in range(1, len(self.comparison.inventories)):
            reference = self.comparison.by_key(0, name, lower)
            for key, instances in self.comparison.by_key(index, name, lower).items():
                for one in reference.get(key, [])[:1]:
                    pairs = [(one.values.get(p), other.values.get(p)) for p in properties for other in instances]
                    if any(a and b and a != b and a[0] == b[0] == "reference" and d.without_keys(a, excluded) == d.without_keys(b, excluded) for a, b in pairs):
                        return True
        return False

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
            return inventory.embedded(value, self.schema)
        if type_name == "reference":
            return paths.canonical(value, self.schema)
        if isinstance(value, bool):
            return ("truth", value)
        if type_name in values.INTEGERS:
            return ("number", value) if isinstance(value, int) else ("not exact", value)
        return values.scalar(type_name, str(value))

    def value_faults(self, one, difference):
        if one.kind != d.CHANGED:
            return
        shown = [other for other in difference["others"] if self.labels[one.index] in other["inventories"]]
        excluded = self.coverage[one.class_name]["excludedKeys"]
        yield from self.side_faults(one, 0, [difference["reference"]], excluded)
        yield from self.side_faults(one, one.index, shown, excluded)

    def side_faults(self, one, index, shown, excluded):
        """Whether the values shown for one inventory are its own."""
        declared = self.comparison.type_of(index, one.class_name, one.property) or self.comparison.properties(one.class_name)[one.property].type
        choices = self.comparison.value_choices(index, one.class_name, one.key, one.property, excluded)
        if not shown:
            yield f"no value for inventory {index}: {one}"
        for side in shown:
            if self.canonical(declared, side["value"]) not in (choices[:1] if index == 0 else choices):
                yield f"value of inventory {index} is {choices}, not {side['value']!r}: {one}"
            if "object" not in declared and side["type"] != declared:
                yield f"type in inventory {index} is {declared}, not {side['type']}: {one}"

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
