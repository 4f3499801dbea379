"""Random inventories and rules. The same seed gives the same documents.

A reference with a small class tree, then inventories that are copies of it with changes: instances and values that are new, gone or
different, now and then another schema. Values come from small pools, so that equal values in other spellings, values that look alike and
keys that agree are frequent.
"""

import copy
import dataclasses
import random

from lxml import etree

from documents import Class, Document, Embedded, Property, Reference, without_repeated_keys

INTEGER_BOUNDS = {
    "uint8": (0, 255),
    "sint8": (-128, 127),
    "uint16": (0, 65535),
    "sint16": (-32768, 32767),
    "uint32": (0, 4294967295),
    "sint32": (-2147483648, 2147483647),
    "uint64": (0, 18446744073709551615),
    "sint64": (-9223372036854775808, 9223372036854775807),
}
REALS = ["0", "-0.0", "1.5", "15E-1", "1.50", "0.1", "0.10000000149011612", "1E+30", "-1.5", "NaN", "INF", "-INF"]
TEXTS = ["", " ", "a", "A", "a ", " a", "NULL", "TRUE", "5", "05", 'q"q', "b\\", "\\", "x,Id=\"y\"", "{a, b}", "a -> b", "<x>&amp;", "]]>"]
TEXTS += ["two\nlines", "tab\there", "\u00e4", "a\u0308", "\U0001d11e", "\u00a0", "'", "//h/n:C.K=1", "20240229110000.000000+000"]
POOLS = {
    "boolean": ["TRUE", "FALSE", "true"],
    "real32": REALS,
    "real64": REALS + ["1E+300", "5E-324", "0.30000000000000004", "0.3"],
    "char16": ["a", "A", "'", "\\", "\u20ac", '"', "5"],
    "string": TEXTS,
    "datetime": [
        "20240229120000.000000+060",
        "20240229110000.000000+000",
        "20240229110000.000001+000",
        "20240228233000.000000-690",
        "20240229110000.******+000",
        "20240229120000.******+060",
        "20240229110000.00000*+000",
        "20241231233000.000000-060",
        "20250101003000.000000+000",
        "00000001000000.000000:000",
        "00000000000001.000000:000",
        "00000001000000.******:000",
    ],
}
POOLS.update({name: [str(low), "0", "1", "2", str(high)] for name, (low, high) in INTEGER_BOUNDS.items()})
KEY_TYPES = [*POOLS, "reference", "string", "string", "uint32"]
VALUE_TYPES = [*POOLS, "reference", "object"]
OPERATING_SYSTEM = "KALMO_OperatingSystem"


class Generator:
    """`features`: what may occur besides plain inventories.

    schemas   a class or a property that only some inventories declare
    types     a property of another type in another inventory
    systems   an inventory without an operating system beside others with one
    statics   static properties
    moments   datetime keys that are the same moment in other spellings
    objects   embedded objects as keys
    orders    an array that is a bag in one inventory and ordered in another
    keyless   classes without keys
    places    references whose namespaces differ only in letter case
    """

    def __init__(self, seed, features=("schemas",)):
        self.random = random.Random(seed)
        self.features = set(features)
        self.added = 0

    def one_in(self, count):
        return self.random.randrange(count) == 0

    # Schemas.

    def make_classes(self):
        classes = [Class(OPERATING_SYSTEM, "", [Property("Name", "string", is_key=True), Property("OSType", "uint16")])]
        for number in range(self.random.randint(1, 4)):
            own = []
            superclass = ""
            if number and not self.one_in(3):
                superclass = self.random.choice(classes[1:]).name
            else:
                counts = (0, 1, 1, 2, 3) if "keyless" in self.features else (1, 1, 2, 3)
                for key in range(self.random.choice(counts)):
                    types = KEY_TYPES + (["object"] if "objects" in self.features else [])
                    own.append(Property(f"Key{key}of{number}", self.random.choice(types), is_key=True))
            for value in range(self.random.randint(1, 5)):
                own.append(self.make_property(f"Value{value}of{number}"))
            if self.one_in(6) and not superclass:
                own.append(Property("DateTimeOfCollection", "datetime"))
            classes.append(Class(f"TST_C{number}", superclass, own))
        return classes

    def make_property(self, name):
        made = Property(name, self.random.choice(VALUE_TYPES))
        if made.type != "reference" and self.one_in(3):
            made.is_array = True
            made.order = self.random.choice(["", "", "Bag", "Ordered", "Indexed"])
        if "statics" in self.features and self.one_in(8) and made.type not in ("reference", "object"):
            made.static = self.make_value(None, made, 0)
        elif self.one_in(6) and made.type not in ("reference", "object"):
            made.default = self.make_value(None, made, 0)
        return made

    # Values.

    def make_value(self, document, declared, depth):
        if not declared.is_key and self.one_in(6):
            return None
        if declared.is_array:
            return [None if self.one_in(8) else self.make_single(document, declared.type, depth) for _ in range(self.random.randint(0, 3))]
        if declared.is_key:
            return self.make_key(document, declared.type, depth)
        return self.make_single(document, declared.type, depth)

    def make_key(self, document, type_name, depth):
        if type_name == "datetime" and "moments" not in self.features:
            return self.random.choice([moment for moment in POOLS["datetime"] if moment.endswith(("+000", ":000"))])
        return self.make_single(document, type_name, depth)

    def make_single(self, document, type_name, depth):
        if type_name == "reference":
            return self.make_reference(document, depth)
        if type_name == "object":
            return self.make_embedded(document, depth)
        return self.random.choice(POOLS[type_name])

    def make_reference(self, document, depth):
        ends = [cls for cls in document.classes if not any(p.type == "reference" and p.is_key for p in document.properties(cls.name))]
        target = self.random.choice(document.classes if depth < 2 else ends).name
        keys = [(p.name, p.type, self.make_key(document, p.type, depth + 1)) for p in document.properties(target) if p.is_key]
        self.random.shuffle(keys)
        place = None
        if document.place and self.one_in(4):
            place = self.random.choice([("", "root/other"), ("far", "root/other"), document.place])
            if "places" in self.features and self.one_in(2):
                place = (place[0].upper(), place[1].upper())
        return Reference(target, place, keys)

    def make_embedded(self, document, depth):
        target = self.random.choice(document.classes).name
        chosen = []
        for declared in document.properties(target):
            if declared.static is None and declared.type != "reference" and not (declared.type == "object" and depth) and not self.one_in(3):
                chosen.append((declared, self.make_value(document, declared, depth + 1)))
        self.random.shuffle(chosen)
        return Embedded(target, chosen)

    # Documents.

    def make_instance(self, document, class_name):
        return (class_name, {p.name: self.make_value(document, p, 0) for p in document.properties(class_name) if p.static is None})

    def make_reference_document(self):
        document = Document(self.make_classes(), [])
        self.choose_style(document)
        for cls in document.classes[1:]:
            document.instances += [self.make_instance(document, cls.name) for _ in range(self.random.randint(0, 4))]
        if not document.instances:
            document.instances.append(self.make_instance(document, document.classes[1].name))
        document.instances.append((OPERATING_SYSTEM, {"Name": self.random.choice(["os", "OS"]), "OSType": "36"}))
        return document

    def choose_style(self, document):
        document.style = self.random.choice(["plain", "plain", "named", "local"])
        document.place = ("", self.random.choice(["root/cimv2", "root/inventory"])) if document.style == "local" else None

    def make_other(self, reference):
        """A copy of the reference with changes."""
        other = copy.deepcopy(reference)
        style = (other.style, other.place)
        self.choose_style(other)
        if style[1] or other.place:  # references may name the reference's place
            other.style, other.place = style
        if "schemas" in self.features and self.one_in(3):
            self.change_schema(other)
        if "types" in self.features and self.one_in(2):
            self.change_type(other)
        if "statics" in self.features:
            self.change_statics(other)
        if "orders" in self.features:
            self.change_orders(other)
        changed = []
        for class_name, literals in other.instances:
            if self.one_in(6) and class_name != OPERATING_SYSTEM:
                continue
            for declared in other.properties(class_name):
                if declared.static is None and (not declared.is_key and self.one_in(4)):
                    literals[declared.name] = self.make_value(other, declared, 0)
            if class_name == OPERATING_SYSTEM:
                literals["OSType"] = "36"
            changed.append((class_name, literals))
        for cls in other.classes[1:]:
            if self.one_in(3):
                changed.append(self.make_instance(other, cls.name))
        self.random.shuffle(changed)
        if "systems" in self.features and self.one_in(3):
            changed = [one for one in changed if one[0] != OPERATING_SYSTEM]
        other.instances = changed
        return other

    def change_schema(self, document):
        """One property that is no key, or a class without subclasses, is gone; or one is new."""
        cls = self.random.choice(document.classes[1:])
        removable = [p for p in cls.own if not p.is_key]
        choice = self.random.randrange(3)
        if choice == 0:
            self.added += 1
            cls.own.append(self.make_property(f"ValueNew{self.added}"))
        elif choice == 1 and removable:
            cls.own.remove(self.random.choice(removable))
        elif not any(c.superclass == cls.name for c in document.classes) and len(document.classes) > 2:
            document.classes.remove(cls)
            document.instances = [one for one in document.instances if one[0] != cls.name]
        for class_name, literals in document.instances:
            names = {p.name for p in document.properties(class_name)}
            for name in set(literals) - names:
                del literals[name]

    def change_type(self, document):
        cls = self.random.choice(document.classes[1:])
        chosen = [p for p in cls.own if not p.is_key and p.static is None]
        if chosen:
            old = self.random.choice(chosen)
            declared = Property(old.name, self.random.choice(VALUE_TYPES))  # embedded objects keep the old one
            cls.own[cls.own.index(old)] = declared
            for class_name, literals in document.instances:
                if any(p is declared for p in document.properties(class_name)):
                    literals[declared.name] = self.make_value(document, declared, 0)

    def change_statics(self, document):
        for cls in document.classes:
            for declared in cls.own:
                if declared.static is not None and self.one_in(2):
                    declared.static = self.make_value(None, dataclasses.replace(declared, static=None), 0)

    def change_orders(self, document):
        for cls in document.classes:
            for index, declared in enumerate(cls.own):
                if declared.is_array and self.one_in(2):
                    cls.own[index] = dataclasses.replace(declared, order=self.random.choice(["", "Bag", "Ordered", "Indexed"]))

    def make_documents(self, count):
        """`count` inventories as bytes, the reference first."""
        documents = [self.make_reference_document()]
        documents += [self.make_other(documents[0]) for _ in range(count - 1)]
        if self.one_in(5):  # no inventory has an operating system
            for document in documents:
                document.instances = [one for one in document.instances if one[0] != OPERATING_SYSTEM]
        self.last = documents
        return [without_repeated_keys(document) for document in documents]

    # Rules.

    def make_rules(self):
        """Rules for the documents that were made last."""
        document = self.last[0]
        root = etree.Element("DifftoolSpec", version="1.0")
        for _ in range(self.random.randint(1, 4)):
            cls = self.random.choice(document.classes)
            element = etree.SubElement(root, "class", name=cls.name)
            if not self.one_in(5):
                element.set("default", self.random.choice(["include", "include", "exclude"]))
            properties = [p.name for p in document.properties(cls.name)]
            keys = [p.name for p in document.properties(cls.name) if p.is_key and self.one_in(4)]
            if keys:
                element.set("excludekeys", " ".join(keys))
            for name in properties:
                if self.one_in(3):
                    part = etree.SubElement(element, self.random.choice(["includelist", "excludelist"]))
                    etree.SubElement(part, "value").text = name
        return etree.tostring(root)
