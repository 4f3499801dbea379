"""Inventories as they are generated, and how they are written as CIM-XML.

A literal is None, the text of a value, a list of these, a Reference or an Embedded.
"""

import dataclasses

from lxml import etree

import inventory

GROUPS = {
    "plain": ("DECLGROUP", "VALUE.OBJECT"),
    "named": ("DECLGROUP.WITHNAME", "VALUE.NAMEDOBJECT"),
    "local": ("DECLGROUP.WITHPATH", "VALUE.OBJECTWITHLOCALPATH"),
}
QUALIFIERS = [(name, "boolean", "FALSE") for name in ("Key", "Static", "EmbeddedObject", "Association")] + [("ArrayType", "string", "Bag")]
NUMBERS = (*inventory.values.INTEGERS, *inventory.values.REALS)


@dataclasses.dataclass
class Reference:
    class_name: str
    place: tuple  # (host, namespace), or None
    keys: list  # [(name, type, literal)]


@dataclasses.dataclass
class Embedded:
    class_name: str
    properties: list  # [(Property, literal)]


@dataclasses.dataclass
class Property:
    name: str
    type: str  # of an element for an array
    is_array: bool = False
    is_key: bool = False
    order: str = ""  # the qualifier ArrayType, or "OctetString"
    static: object = None  # a literal: the property is static and has this value
    default: object = None  # a literal that the declaration has and that no instance takes


@dataclasses.dataclass
class Class:
    name: str
    superclass: str
    own: list


@dataclasses.dataclass
class Document:
    classes: list  # superclasses first
    instances: list  # [(class name, {property name: literal})]
    style: str = "plain"
    place: tuple = None

    def find(self, name):
        return next((cls for cls in self.classes if cls.name == name), None)

    def properties(self, name):
        cls = self.find(name)
        return (self.properties(cls.superclass) if cls.superclass else []) + cls.own if cls else []


def sub(parent, tag, text=None, **attributes):
    element = etree.SubElement(parent, tag, {name.upper() if name != "EmbeddedObject" else name: value for name, value in attributes.items()})
    element.text = text
    return element


def qualifier(element, name, type_name, text):
    sub(sub(element, "QUALIFIER", name=name, type=type_name), "VALUE", text)


def property_element(parent, declared, literal, is_declaration=False):
    type_name = "string" if declared.type == "object" else declared.type
    if declared.type == "reference":
        element = sub(parent, "PROPERTY.REFERENCE", name=declared.name)
    else:
        element = sub(parent, "PROPERTY.ARRAY" if declared.is_array else "PROPERTY", name=declared.name, type=type_name)
    if declared.type == "object" and not is_declaration:
        element.set("EmbeddedObject", "instance")
    if is_declaration:
        for condition, name, kind, text in (
            (declared.is_key, "Key", "boolean", "TRUE"),
            (declared.order, "ArrayType", "string", declared.order),
            (declared.type == "object", "EmbeddedObject", "boolean", "TRUE"),
            (declared.static is not None, "Static", "boolean", "TRUE"),
        ):
            if condition:
                qualifier(element, name, kind, text)
    if literal is None:
        return
    if isinstance(literal, list):
        array = sub(element, "VALUE.ARRAY")
        for item in literal:
            if item is None:
                sub(array, "VALUE.NULL")
            else:
                sub(array, "VALUE", text_of(item))
    elif isinstance(literal, Reference):
        reference_element(element, literal)
    else:
        sub(element, "VALUE", text_of(literal))


def text_of(literal):
    if not isinstance(literal, Embedded):
        return literal
    root = etree.Element("INSTANCE", CLASSNAME=literal.class_name)
    for declared, value in literal.properties:
        property_element(root, declared, value)
    return etree.tostring(root, encoding="unicode")


def namespace_path(parent, namespace):
    path = sub(parent, "LOCALNAMESPACEPATH")
    for step in namespace.split("/"):
        sub(path, "NAMESPACE", name=step)


def reference_element(parent, reference):
    holder = sub(parent, "VALUE.REFERENCE")
    if reference.place:
        host, namespace = reference.place
        holder = sub(holder, "INSTANCEPATH" if host else "LOCALINSTANCEPATH")
        inner = sub(holder, "NAMESPACEPATH") if host else holder
        if host:
            sub(inner, "HOST", host)
        namespace_path(inner, namespace)
    name_element(holder, reference.class_name, reference.keys)


def name_element(parent, class_name, keys):
    element = sub(parent, "INSTANCENAME", classname=class_name)
    for name, type_name, literal in keys:
        binding = sub(element, "KEYBINDING", name=name)
        if isinstance(literal, Reference):
            reference_element(binding, literal)
            continue
        kind = "boolean" if type_name == "boolean" else "numeric" if type_name in NUMBERS else "string"
        sub(binding, "KEYVALUE", text_of(literal), valuetype=kind)


def class_element(parent, cls):
    element = sub(parent, "CLASS", name=cls.name)
    if cls.superclass:
        element.set("SUPERCLASS", cls.superclass)
    if any(p.type == "reference" for p in cls.own):
        qualifier(element, "Association", "boolean", "TRUE")
    for declared in cls.own:
        property_element(element, declared, declared.static or declared.default, True)


def place_element(parent, document, tag):
    holder = sub(parent, tag)
    namespace_path(holder, document.place[1])
    return holder


def tree_of(document):
    """The document as XML."""
    root = etree.Element("CIM", CIMVERSION="2.0", DTDVERSION="2.0")
    group_tag, tag = GROUPS[document.style]
    group = sub(sub(root, "DECLARATION"), group_tag)
    for name, type_name, default in QUALIFIERS:
        sub(sub(group, "QUALIFIER.DECLARATION", name=name, type=type_name), "VALUE", default)
    for cls in document.classes:
        holder = sub(group, tag)
        if document.style == "local":
            sub(place_element(holder, document, "LOCALCLASSPATH"), "CLASSNAME", name=cls.name)
        class_element(holder, cls)
    for class_name, literals in document.instances:
        holder = sub(group, tag)
        keys = [(p.name, p.type, literals[p.name]) for p in document.properties(class_name) if p.is_key]
        if document.style == "named":
            name_element(holder, class_name, keys)
        if document.style == "local":
            name_element(place_element(holder, document, "LOCALINSTANCEPATH"), class_name, keys)
        instance = sub(holder, "INSTANCE", classname=class_name)
        for declared in document.properties(class_name):
            if declared.name in literals:
                property_element(instance, declared, literals[declared.name])
    return root


def without_repeated_keys(document):
    """The document as bytes. Of several instances with the same key only the first is kept."""
    root = tree_of(document)
    read = inventory.Inventory(etree.tostring(root))
    read.read_instances(read.schema)
    seen = set()
    for element, instance in zip(list(root.iter("INSTANCE")), read.instances):
        keys = [lower for lower, p in read.schema.properties(instance.class_name).items() if p.is_key]
        key = (instance.class_name, frozenset((lower, instance.values.get(lower)) for lower in keys))
        if key in seen:
            holder = element.getparent()
            holder.getparent().remove(holder)
        seen.add(key)
    return etree.tostring(root, encoding="utf-8", xml_declaration=True)
