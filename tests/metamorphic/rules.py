"""Rules of a comparison, read with libxml2 and applied to the classes of the inventories.

What results for a class: which properties are compared, and which keys do not count when instances are matched.
"""

import dataclasses

from lxml import etree

ROOT = "<root>"
COLLECTION_TIME = "datetimeofcollection"


@dataclasses.dataclass
class ClassRules:
    includes: bool = False
    listed: dict = dataclasses.field(default_factory=dict)  # property -> whether it is compared
    excluded_keys: tuple = ()
    is_final: bool = False

    def merge(self, other):
        self.includes = other.includes
        self.listed.update(other.listed)


class Rules:
    def __init__(self, data, schema):
        """`data` may be None: everything is compared."""
        self.schema = schema
        self.by_class = {}
        if data is None:
            self.by_class = {name: ClassRules(True) for name in schema.classes}
            return
        for element in etree.fromstring(data).iterchildren("class"):
            self.close(element)

    def is_reached(self, name):
        return name in self.by_class

    def close(self, element):
        rules = ClassRules(element.get("default") == "include", {}, tuple((element.get("excludekeys") or "").split()))
        for value in element.iter("value"):
            rules.listed.setdefault(value.text, value.getparent().tag == "includelist")
        name = element.get("name").lower()
        self.add(name, rules, True)
        self.push_down(name)

    def add(self, name, rules, is_own):
        entry = self.by_class.get(name)
        if entry is None:
            self.by_class[name] = ClassRules(rules.includes, dict(rules.listed), rules.excluded_keys)
        elif not entry.is_final:
            entry.merge(rules)
            entry.is_final = is_own

    def push_down(self, name):
        for child in self.schema.children("" if name == ROOT else name):
            self.add(child, self.by_class[name], False)
            self.push_down(child)

    def of(self, name):
        return self.by_class.get(name.lower(), ClassRules())

    def compared(self, name):
        """The properties of a class that are compared, in lower case."""
        rules = self.of(name)
        names = [declared.name for declared in self.schema.properties(name).values()]
        if not rules.includes:
            return {listed.lower() for listed, is_compared in rules.listed.items() if is_compared}
        return {p.lower() for p in names if p.lower() != COLLECTION_TIME and rules.listed.get(p, True)}

    def excluded_keys(self, name):
        return set(self.of(name).excluded_keys)
