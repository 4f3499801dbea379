"""Other documents that say the same: each function takes an inventory as bytes and returns one that must compare as equal to it.

A rewriting gets a random source of its own, so a case can be repeated. DISPLAY names those that change how values are shown.
"""

import gzip
import lzma
import struct

from lxml import etree

import inventory

TEXT_TAGS = ("VALUE", "KEYVALUE", "HOST", "value")  # value is an element of rules
NAME_ATTRIBUTES = ("NAME", "CLASSNAME", "SUPERCLASS", "REFERENCECLASS", "CLASSORIGIN")
KEEPS_CASE = ("NAMESPACE", "IMETHODCALL", "METHODCALL", "IPARAMVALUE", "PARAMVALUE", "IMETHODRESPONSE", "ERROR")


def tree(data):
    return etree.fromstring(inventory.decompressed(data), inventory.XML)


class Style:
    """How a document is written. Everything that XML leaves free may vary."""

    def __init__(self, random, spaces=False, references=False, sections=False, comments=False, attributes=False, entities=False):
        self.random = random
        self.spaces, self.references, self.sections, self.comments = spaces, references, sections, comments
        self.attributes, self.entities = attributes, entities

    def chance(self, wanted, one_in=3):
        return wanted and self.random.randrange(one_in) == 0

    def gap(self):
        gap = self.random.choice(["\n", " ", "\t", "\n  ", "\r\n", ""]) if self.spaces else ""
        if self.chance(self.comments, 8):
            gap += self.random.choice(["<!-- <VALUE>x</VALUE> -->", "<?target some text?>", "<!---->"])
        return gap

    def character(self, c, in_attribute):
        code = ord(c)
        if c in "<&" or code < 32 and c not in "\n\t" or c in "\n\t" and in_attribute or c == "\r" or (c == ">" and not in_attribute) or c in "\"'":
            named = {"<": "&lt;", "&": "&amp;", ">": "&gt;", '"': "&quot;", "'": "&apos;"}
            return named[c] if c in named and not self.chance(self.references) else f"&#{code};"
        if self.chance(self.references, 4):
            return self.random.choice([f"&#{code};", f"&#x{code:x};", f"&#x{code:04X};"])
        return c

    def text(self, text):
        if self.entities and text == "a" and self.chance(True, 2):
            return "&letter;"
        if self.chance(self.sections, 2) and "]]>" not in text and "\r" not in text:  # a section has no references
            middle = self.random.randint(0, len(text))
            return f"<![CDATA[{text[:middle]}]]>" + (f"<![CDATA[{text[middle:]}]]>" if self.chance(True, 2) else self.plain(text[middle:]))
        return self.plain(text)

    def plain(self, text):
        parts = [self.character(c, False) for c in text]
        if self.chance(self.comments, 8) and parts:
            parts.insert(self.random.randint(0, len(parts)), "<!-- x -->")
        return "".join(parts)

    def element(self, element):
        pairs = list(element.attrib.items())
        quote = '"'
        if self.attributes:
            self.random.shuffle(pairs)
            quote = self.random.choice("\"'")
        between = self.random.choice([" ", "\n", "  "]) if self.attributes else " "
        head = element.tag + "".join(f"{between}{name}={quote}{''.join(self.character(c, True) for c in value)}{quote}" for name, value in pairs)
        if element.tag in TEXT_TAGS:
            inner = self.text("".join(element.itertext()))
        else:
            inner = "".join(self.gap() + self.element(child) for child in element)
            inner += self.gap() if len(element) else ""
        if not inner and not self.chance(self.attributes, 2):
            return f"<{head}/>"
        return f"<{head}>{inner}</{element.tag}>"

    def document(self, root, encoding="utf-8"):
        doctype = '<!DOCTYPE CIM [<!ENTITY letter "a">]>' if self.entities else ""
        return f'<?xml version="1.0" encoding="{encoding}"?>{doctype}{self.gap()}{self.element(root)}{self.gap()}'


def written(root, random, encoding="utf-8", **how):
    return Style(random, **how).document(root, encoding)


# Other spellings of the same XML.


def white_space(data, random):
    return written(tree(data), random, spaces=True).encode()


def character_references(data, random):
    return written(tree(data), random, references=True).encode()


def sections(data, random):
    return written(tree(data), random, sections=True).encode()


def comments(data, random):
    return written(tree(data), random, comments=True).encode()


def attributes(data, random):
    return written(tree(data), random, attributes=True).encode()


def entities(data, random):
    return written(tree(data), random, entities=True).encode()


def everything(data, random):
    return written(tree(data), random, spaces=True, references=True, sections=True, comments=True, attributes=True).encode()


def utf16(data, random):
    return written(tree(data), random, "UTF-16").encode(random.choice(["utf-16"]))


def utf16_big(data, random):
    return b"\xfe\xff" + written(tree(data), random, "UTF-16").encode("utf-16-be")


def utf8_with_mark(data, random):
    return b"\xef\xbb\xbf" + written(tree(data), random).encode()


def latin1(data, random):
    return written(tree(data), random, "ISO-8859-1").encode("iso-8859-1", "xmlcharrefreplace")


def ascii_only(data, random):
    return written(tree(data), random, "US-ASCII").encode("ascii", "xmlcharrefreplace")


# Compression.


def gzipped(data, random):
    return gzip.compress(inventory.decompressed(data), random.choice([1, 9]), mtime=0)


def xz(data, random):
    return lzma.compress(inventory.decompressed(data), check=random.choice([lzma.CHECK_CRC32, lzma.CHECK_CRC64, lzma.CHECK_NONE]))


def zstd(data, _random):
    """A frame of raw blocks: no library is needed to write one."""
    data = inventory.decompressed(data)
    blocks = [data[at : at + 100000] for at in range(0, len(data), 100000)]
    frame = struct.pack("<IBI", 0xFD2FB528, 0xA0, len(data))
    for number, block in enumerate(blocks):
        frame += struct.pack("<I", len(block) << 3 | (number == len(blocks) - 1))[:3] + block
    return frame


# Another order.


def shuffle(random, parent, chosen):
    """Puts the chosen children of an element in another order; the others keep their places."""
    places = [index for index, child in enumerate(parent) if chosen(child)]
    children = [parent[index] for index in places]
    random.shuffle(children)
    all_children = list(parent)
    for index, child in zip(places, children):
        all_children[index] = child
    parent[:] = all_children


def declarations_in_another_order(data, random):
    root = tree(data)
    for group in root.iter("DECLGROUP", "DECLGROUP.WITHNAME", "DECLGROUP.WITHPATH", "IRETURNVALUE"):
        shuffle(random, group, lambda child: True)
    return written(root, random).encode()


def within_embedded(root, change):
    """Applies a change to the embedded objects in the texts of values too."""
    change(root)
    for element in root.iter("VALUE"):
        text = "".join(element.itertext())
        holder = element.getparent() if element.getparent().tag != "VALUE.ARRAY" else element.getparent().getparent()
        if inventory.holds_objects(holder) and text.lstrip().startswith("<"):
            inner = etree.fromstring(text.encode(), inventory.XML)
            within_embedded(inner, change)
            element.text = etree.tostring(inner, encoding="unicode")


def properties_in_another_order(data, random):
    def change(root):
        for element in root.iter("INSTANCE", "CLASS"):
            shuffle(random, element, lambda child: child.tag.startswith("PROPERTY"))
        for element in root.iter("INSTANCENAME"):
            shuffle(random, element, lambda child: child.tag == "KEYBINDING")
        for element in root.iter("PROPERTY", "PROPERTY.ARRAY", "PROPERTY.REFERENCE"):
            shuffle(random, element, lambda child: child.tag == "QUALIFIER")

    root = tree(data)
    within_embedded(root, change)
    return written(root, random).encode()


def bags_in_another_order(data, random):
    root = tree(data)
    schema = inventory.Inventory(data).schema
    for instance in root.iter("INSTANCE"):
        declared = schema.properties(instance.get("CLASSNAME"))
        for element in instance.iterchildren("PROPERTY.ARRAY"):
            found = declared.get(element.get("NAME").lower())
            if found and found.is_bag:
                for array in element.iterchildren("VALUE.ARRAY"):
                    shuffle(random, array, lambda child: True)
    return written(root, random).encode()


# Other spellings of names and values.


def names_in_another_case(data, random):
    """Each name gets one other spelling throughout the document, as one that another server wrote would have."""
    spelling = {}

    def other(name):
        if name.lower() not in spelling:
            spelling[name.lower()] = random.choice([str.upper, str.lower, str.swapcase, str])(name)
        return spelling[name.lower()]

    def change(root):
        for element in root.iter():
            if element.tag not in KEEPS_CASE:
                for attribute in NAME_ATTRIBUTES:
                    if attribute in element.attrib:
                        element.set(attribute, other(element.get(attribute)))

    root = tree(data)
    within_embedded(root, change)
    return written(root, random).encode()


def nulls_left_out(data, random):
    """A property without a value and an absent one are both null."""
    root = tree(data)
    for instance in root.iter("INSTANCE"):
        for element in list(instance):
            if element.tag.startswith("PROPERTY") and not any(c.tag.startswith("VALUE") for c in element) and random.randrange(2):
                instance.remove(element)
    return written(root, random).encode()


def other_moment(text, random):
    """A timestamp with another offset from UTC, if it can be written with one."""
    if "*" in text[:14] or text[21] == ":" or "*" in text[22:]:
        return text
    hour, offset = int(text[8:10]), int(text[21:25])
    hours = random.choice([h for h in (-2, -1, 1, 2) if 0 <= hour + h <= 23])
    return f"{text[:8]}{hour + hours:02}{text[10:21]}{offset + hours * 60:+04}"


def other_literal(type_name, text, random):
    if type_name == "boolean":
        return random.choice([text.upper(), text.lower()])
    if type_name == "datetime":
        return other_moment(text, random)
    if type_name in ("real32", "real64") and text[-1:].isdigit() and "." in text and "E" not in text.upper():
        return text + "0"
    return text


def values_in_another_spelling(data, random):
    root = tree(data)
    schema = inventory.Inventory(data).schema
    for instance in root.iter("INSTANCE"):
        declared = schema.properties(instance.get("CLASSNAME"))
        for element in instance.iterchildren("PROPERTY", "PROPERTY.ARRAY"):
            for value in element.iter("VALUE"):
                if not declared[element.get("NAME").lower()].is_key:
                    value.text = other_literal(element.get("TYPE"), "".join(value.itertext()), random)
    return written(root, random).encode()


XML_ONLY = [white_space, character_references, sections, comments, attributes, entities, everything]
ENCODINGS = [utf16, utf16_big, utf8_with_mark, latin1, ascii_only]
COMPRESSIONS = [gzipped, xz, zstd]
ALIKE = XML_ONLY + ENCODINGS + COMPRESSIONS + [declarations_in_another_order, nulls_left_out]  # the report stays the same, byte for byte
DISPLAY = [properties_in_another_order, bags_in_another_order, names_in_another_case, values_in_another_spelling]
ALL = ALIKE + DISPLAY
RULES = XML_ONLY[:-1] + ENCODINGS  # what rules can be written as
