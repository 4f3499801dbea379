"""Reads a CIM-XML inventory with libxml2 into plain classes and instances with canonical values (values.py).

An independent reading: it follows the documents about cimdelta and the format, not cimdelta. It knows declarations in every kind of group
and recorded responses. It does not look for mistakes; the inventories are ones that cimdelta accepts.
"""

import dataclasses
import gzip
import lzma

from lxml import etree

import paths
import values

XML = etree.XMLParser(huge_tree=True, no_network=True, remove_comments=True, remove_pis=True)
OPERATING_SYSTEM = "kalmo_operatingsystem"


@dataclasses.dataclass
class Property:
    name: str
    type: str  # with [] for an array
    is_key: bool = False
    is_bag: bool = False
    says_order: bool = True  # an override that says nothing of the order of elements inherits it
    is_static: bool = False
    static_value: object = None


@dataclasses.dataclass
class Class:
    name: str
    superclass: str  # in lower case; empty for a top-level class
    own: dict = dataclasses.field(default_factory=dict)  # name in lower case -> Property


@dataclasses.dataclass
class Instance:
    class_name: str  # in lower case
    values: dict  # property in lower case -> canonical value; an absent one is null


class Schema:
    """Classes of one or more inventories. What an earlier inventory declares counts."""

    def __init__(self):
        self.classes = {}
        self.known = {}  # class -> all its properties

    def add(self, classes):
        self.known = {}
        for lower, cls in classes.items():
            if lower not in self.classes:
                self.classes[lower] = Class(cls.name, cls.superclass, dict(cls.own))
            else:
                for name, declared in cls.own.items():
                    if name not in self.properties(lower):
                        self.classes[lower].own[name] = declared
                        self.known = {}

    def ancestry(self, name):
        """The class and its superclasses, in lower case, the topmost first."""
        found, name = [], name.lower()
        while name in self.classes and name not in found:
            found.insert(0, name)
            name = self.classes[name].superclass
        return found

    def properties(self, name):
        """All properties of a class, inherited ones included: name in lower case -> Property."""
        name = name.lower()
        if name in self.known:
            return self.known[name]
        found = {}
        for ancestor in self.ancestry(name):
            for lower, declared in self.classes[ancestor].own.items():
                inherited = found.get(lower)
                if inherited:
                    declared = dataclasses.replace(
                        declared,
                        is_key=declared.is_key or inherited.is_key,
                        is_bag=declared.is_bag if declared.says_order else inherited.is_bag,
                        says_order=declared.says_order or inherited.says_order,
                    )
                found[lower] = declared
        self.known[name] = found
        return found

    def children(self, name):
        return [lower for lower, cls in self.classes.items() if cls.superclass == name.lower()]

    def key_value(self, class_name, key, form, text):
        """The value of a key binding that is given as text, by the type that its class declares."""
        declared = self.properties(class_name).get(key.lower())
        if declared is None:
            return paths.untyped(form, text)
        if not form and text == "NULL":
            return None
        try:
            if declared.type == "reference":
                return paths.canonical(text, self)
            if declared.type == "object":
                return embedded(text, self)
            return values.scalar(declared.type, text)
        except (ValueError, IndexError, etree.XMLSyntaxError):  # a path may have keys that its class cannot have
            return paths.untyped(form, text)


def decompressed(data):
    if data.startswith(b"\x1f\x8b"):
        return gzip.decompress(data)
    if data.startswith(b"\xfd7zXZ"):
        return lzma.decompress(data)
    return data


def flag(element, qualifier):
    return (qualifier_text(element, qualifier) or "").strip().lower() == "true"


def qualifier_text(element, qualifier):
    for found in element.iterchildren("QUALIFIER"):
        if found.get("NAME").lower() == qualifier:
            return found.findtext("VALUE") or ""
    return None


def holds_objects(element):
    attributes = {name.lower() for name in element.attrib}
    return "embeddedobject" in attributes or flag(element, "embeddedobject") or qualifier_text(element, "embeddedinstance") is not None


def type_of(element):
    if element.tag == "PROPERTY.REFERENCE":
        return "reference"
    base = "object" if holds_objects(element) else element.get("TYPE")
    return base + "[]" if element.tag == "PROPERTY.ARRAY" else base


def embedded(text, schema):
    root = etree.fromstring(text.encode(), XML)
    properties = []
    for element in root:
        if element.tag.startswith("PROPERTY"):
            type_name = type_of(element)
            value = value_of(element, type_name, schema, None)
            if value is not None:  # as an absent one
                properties.append((element.get("NAME").lower(), type_name.replace("object", "string"), value))
    return ("object", root.tag, (root.get("CLASSNAME") or root.get("NAME")).lower(), frozenset(properties))


def text_of(element):
    return "".join(element.itertext())


def single(base, text, schema):
    return embedded(text, schema) if base == "object" else values.scalar(base, text)


def value_of(element, type_name, schema, home):
    """The value of a PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE; None for null."""
    base = type_name.replace("[]", "")
    for child in element:
        if child.tag == "VALUE":
            return single(base, text_of(child), schema)
        if child.tag == "VALUE.ARRAY":
            return ("array", tuple(None if item.tag == "VALUE.NULL" else single(base, text_of(item), schema) for item in child))
        if child.tag == "VALUE.REFERENCE":
            return reference_of(child, schema, home)
    return None


def place_of(path):
    """(host, namespace) that the element of a path names, or None."""
    steps = path.find("NAMESPACEPATH/LOCALNAMESPACEPATH")
    if steps is None:
        steps = path if path.tag == "LOCALNAMESPACEPATH" else path.find("LOCALNAMESPACEPATH")
    if steps is None:
        return None
    return paths.place(path.findtext("NAMESPACEPATH/HOST"), "/".join(step.get("NAME") for step in steps))


def reference_of(element, schema, home):
    """A VALUE.REFERENCE. `home` is where its inventory is; a reference into it has no place."""
    target = element[0]
    where = None
    if target.tag.endswith("PATH"):
        where = place_of(target)
        target = target[-1]
    if where and home and where[1] == home[1] and (where[0] == home[0] or "" in (where[0], home[0])):
        where = None
    name = target.get("CLASSNAME") or target.get("NAME")  # a class is referred to like an instance without keys
    return ("reference", where, name.lower(), frozenset(bindings_of(target, schema, home)))


def bindings_of(instance_name, schema, home):
    for binding in instance_name.iterchildren("KEYBINDING"):
        key, value = binding.get("NAME"), binding[0]
        if value.tag == "VALUE.REFERENCE":
            yield key.lower(), reference_of(value, schema, home)
            continue
        form = "" if value.get("VALUETYPE", "string") != "string" else '"'
        declared = schema.properties(instance_name.get("CLASSNAME")).get(key.lower())
        if declared is None and value.get("TYPE"):
            yield key.lower(), values.scalar(value.get("TYPE"), text_of(value))
        else:
            yield key.lower(), schema.key_value(instance_name.get("CLASSNAME"), key, form, text_of(value))


class Inventory:
    """One document. `schema` holds its own classes; the instances are read with the classes of all inventories that are compared."""

    def __init__(self, data):
        self.root = etree.fromstring(decompressed(data), XML)
        self.schema = Schema()
        self.schema.add({element.get("NAME").lower(): class_of(element) for element in self.root.iter("CLASS")})
        self.find_objects()
        self.home = self.find_home(self.root)
        self.instances = []

    def find_objects(self):
        """A property declared as plain text holds objects if an instance says so."""
        for element in self.root.iter("INSTANCE"):
            for child in element.iterchildren("PROPERTY", "PROPERTY.ARRAY"):
                for ancestor in self.schema.ancestry(element.get("CLASSNAME")) if holds_objects(child) else ():
                    declared = self.schema.classes[ancestor].own.get(child.get("NAME").lower())
                    if declared:
                        declared.type = declared.type.replace("string", "object")
        self.schema.known = {}

    def read_instances(self, schema):
        for element in self.root.iter("CLASS"):
            self.add_static_values(element, schema)
        for element in self.root.iter("INSTANCE"):
            self.add_instance(element, schema)
        return self

    def find_home(self, root):
        """Where the inventory is: what its declarations name, or what all its references name."""
        for element in root.iter("CLASSPATH", "LOCALCLASSPATH", "INSTANCEPATH", "LOCALINSTANCEPATH", "IMETHODCALL"):
            if element.getparent().tag != "VALUE.REFERENCE" and place_of(element):
                return place_of(element)
        references = [reference[0] for reference in root.iter("VALUE.REFERENCE")]
        named = {place_of(target) for target in references}
        places = named - {None}
        if len(places) != 1 or (None in named and not self.leads_here(references)):
            return ("", "root/cimv2")
        return places.pop()

    def leads_here(self, references):
        """Whether any reference that names its place leads to an instance of the document."""
        there = set()
        for element in self.root.iter("INSTANCE"):
            name = element.get("CLASSNAME").lower()
            keys = {lower: p.type for lower, p in self.schema.properties(name).items() if p.is_key}
            given = {child.get("NAME").lower(): child for child in element if child.tag.startswith("PROPERTY")}
            there.add((name, frozenset((lower, value_of(given[lower], type_name, self.schema, None))
                                       for lower, type_name in keys.items() if lower in given)))
        targets = [target[-1] for target in references if place_of(target)]
        return any((target.get("CLASSNAME", "").lower(), frozenset(bindings_of(target, self.schema, None))) in there
                   for target in targets)

    def add_static_values(self, element, schema):
        own = self.schema.classes[element.get("NAME").lower()].own
        for child in element:
            if child.tag.startswith("PROPERTY") and own[child.get("NAME").lower()].is_static:
                declared = own[child.get("NAME").lower()]
                self.schema.known = {}
                declared.static_value = value_of(child, declared.type, schema, self.home)

    def add_instance(self, element, schema):
        name = element.get("CLASSNAME").lower()
        declared = self.schema.properties(name)
        found = {}
        for instance_name in element.itersiblings("INSTANCENAME", "INSTANCEPATH", "LOCALINSTANCEPATH", preceding=True):
            instance_name = instance_name if instance_name.tag == "INSTANCENAME" else instance_name.find("INSTANCENAME")
            found.update(bindings_of(instance_name, schema, self.home))
        for child in element:
            if child.tag.startswith("PROPERTY"):
                lower = child.get("NAME").lower()
                type_name = declared[lower].type if lower in declared else type_of(child)
                if holds_objects(child):
                    type_name = type_name.replace("string", "object")
                found[lower] = value_of(child, type_name, schema, self.home)
        found.update({lower: p.static_value for lower, p in declared.items() if p.is_static})
        self.instances.append(Instance(name, found))


def class_of(element):
    cls = Class(element.get("NAME"), (element.get("SUPERCLASS") or "").lower())
    for child in element:
        if child.tag.startswith("PROPERTY"):
            type_name = type_of(child)
            order = qualifier_text(child, "arraytype")
            is_octets = flag(child, "octetstring")
            cls.own[child.get("NAME").lower()] = Property(
                child.get("NAME"),
                type_name,
                is_key=flag(child, "key"),
                is_bag=type_name.endswith("[]") and (order or "Bag").strip().lower() == "bag" and not is_octets,
                says_order=order is not None or is_octets,
                is_static=flag(child, "static"),
            )
    return cls
