"""What differs between inventories, computed by plain code from what inventory.py read."""

import dataclasses

import inventory
import rules
import values

ONLY_REFERENCE, ONLY_OTHERS, CHANGED = "onlyInReference", "onlyInOthers", "changed"


@dataclasses.dataclass(frozen=True)
class Difference:
    kind: str
    class_name: str  # in lower case
    key: frozenset  # of (key name in lower case, canonical value)
    property: str  # in lower case; empty for a whole instance
    index: int  # of the other inventory

    def __str__(self):
        keys = ",".join(f"{name}={value}" for name, value in sorted(self.key, key=repr))
        return f"{self.kind} {self.class_name} {keys} {self.property} [{self.index}]"


class Comparison:
    """`inventories`: the reference first. `rules_data`: the rules as bytes, or None."""

    def __init__(self, inventories, rules_data=None):
        self.inventories = inventories
        self.schema = inventory.Schema()
        for one in inventories:
            self.schema.add(one.schema.classes)
        for one in inventories:
            one.read_instances(self.schema)
        self.rules = rules.Rules(rules_data, self.schema)
        self.indexes = {}  # (inventory, class, excluded keys) -> key -> instances
        self.declared = {}  # class -> properties

    def class_names(self):
        """Classes with instances, in lower case."""
        return sorted({instance.class_name for one in self.inventories for instance in one.instances})

    def count(self, name):
        return [sum(instance.class_name == name for instance in one.instances) for one in self.inventories]

    def properties(self, name):
        """What any of the inventories declares: name in lower case -> Property."""
        if name not in self.declared:
            self.declared[name] = self.schema.properties(name)
        return self.declared[name]

    def by_key(self, index, name, excluded):
        """The instances of a class in one inventory: key -> instances in the order of the file."""
        asked = (index, name, frozenset(excluded))
        if asked not in self.indexes:
            properties = self.inventories[index].schema.properties(name)
            keys = [lower for lower, p in properties.items() if p.is_key and lower not in excluded]
            found = self.indexes[asked] = {}
            for instance in self.inventories[index].instances:
                if instance.class_name == name:
                    key = frozenset((lower, instance.values.get(lower)) for lower in keys)
                    found.setdefault(key, []).append(instance)
        return self.indexes[asked]

    def type_of(self, index, class_name, lower):
        asked = (index, class_name)
        if asked not in self.declared:
            self.declared[asked] = self.inventories[index].schema.properties(class_name)
        declared = self.declared[asked].get(lower)
        return declared.type if declared else None

    def differs(self, index, class_name, lower, one, other, excluded_keys):
        return self.disagree(class_name, lower, (0, one), (index, other), excluded_keys)

    def disagree(self, class_name, lower, one, other, excluded_keys):
        """Whether two instances (inventory, instance) have different values of a property."""
        left, right = one[1].values.get(lower), other[1].values.get(lower)
        if left is None or right is None:
            return left is not right
        types = [self.type_of(index, class_name, lower) for index in (one[0], other[0])]
        if None not in types and types[0].replace("object", "string") != types[1].replace("object", "string"):
            return True
        if excluded_keys and left[0] == right[0] == "reference":
            return without_keys(left, excluded_keys) != without_keys(right, excluded_keys)
        declared = self.properties(class_name).get(lower)
        if declared and declared.is_bag:
            return values.as_bag(left) != values.as_bag(right)
        return left != right

    def positions(self, name):
        """The other inventories that have a part in the comparison of a class: all, except that what cimdelta makes is not compared."""
        others = range(1, len(self.inventories))
        if name != inventory.OPERATING_SYSTEM:
            return list(others)
        counts = self.count(name)
        return [index for index in others if counts[0] and counts[index]]

    def of_class(self, name, properties, excluded_keys):
        """All differences of the instances of one class if these properties count and these keys do not."""
        excluded = {key.lower() for key in excluded_keys}
        reference = self.by_key(0, name, excluded)
        for index in self.positions(name):
            others = self.by_key(index, name, excluded)
            for key in reference.keys() - others.keys():
                yield Difference(ONLY_REFERENCE, name, key, "", index)
            for key, instances in others.items():
                if key not in reference:
                    yield Difference(ONLY_OTHERS, name, key, "", index)
                    continue
                for lower in properties:
                    if any(self.differs(index, name, lower, reference[key][0], other, excluded_keys) for other in instances):
                        yield Difference(CHANGED, name, key, lower, index)

    def value_choices(self, index, name, key, lower, excluded_keys):
        """The values of a property in the instances of one inventory with this key."""
        excluded = {key.lower() for key in excluded_keys}
        return [instance.values.get(lower) for instance in self.by_key(index, name, excluded).get(key, [])]


def without_keys(reference, excluded_keys):
    lower = {key.lower() for key in excluded_keys}
    return ("reference", None, reference[2], frozenset(pair for pair in reference[3] if pair[0] not in lower))
