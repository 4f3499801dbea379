"""Makes the documents of a failing case smaller for as long as it fails in the same way."""

import copy
import time

from lxml import etree

import inventory

PARTS = ("INSTANCE", "CLASS", "PROPERTY", "PROPERTY.ARRAY", "PROPERTY.REFERENCE", "METHOD", "QUALIFIER.DECLARATION", "QUALIFIER", "VALUE.REFERENCE")
SECONDS = 20  # for one failure


def removable(root):
    """What may be taken out of a document, large parts first."""
    found = []
    for tag in PARTS:
        for element in root.iter(tag):
            if tag in ("INSTANCE", "CLASS"):
                element = element.getparent()
            if element.getparent() is not None:
                found.append(element)
    return found


def without(root, first, count):
    """A copy of the document without some of its removable parts; None if there are none there."""
    smaller = copy.deepcopy(root)
    parts = removable(smaller)[first : first + count]
    for part in parts:
        parent = part.getparent()
        if parent is not None:
            parent.remove(part)
    return smaller if parts else None


def written(root):
    return etree.tostring(root, encoding="utf-8", xml_declaration=True)


class Shrinker:
    """`fails(documents, rules)` says whether the case still fails in the same way. Documents are [(name, bytes)]."""

    def __init__(self, fails):
        self.fails = fails
        self.until = time.monotonic() + SECONDS

    def shrink(self, documents, rules):
        documents = self.fewer(documents, rules)
        for index in range(len(documents) - 1, -1, -1):
            documents = self.smaller(documents, rules, index)
        for index in range(len(documents)):
            documents = self.smaller(documents, rules, index)
        return documents

    def fewer(self, documents, rules):
        """Without inventories that do not matter."""
        for index in range(len(documents) - 1, 0, -1):
            rest = documents[:index] + documents[index + 1 :]
            if len(documents) > 2 and self.fails(rest, rules):
                documents = rest
        return documents

    def smaller(self, documents, rules, index):
        name, data = documents[index]
        try:
            root = etree.fromstring(inventory.decompressed(data), inventory.XML)
        except etree.XMLSyntaxError:
            return documents
        plain = documents[:index] + [(name, written(root))] + documents[index + 1 :]
        if not self.fails(plain, rules):
            return documents
        documents = plain
        chunk = max(1, len(removable(root)) // 4)
        while chunk:
            first = 0
            while time.monotonic() < self.until:
                candidate = without(root, first, chunk)
                if candidate is None:
                    break
                attempt = documents[:index] + [(name, written(candidate))] + documents[index + 1 :]
                if self.fails(attempt, rules):
                    documents, root = attempt, candidate
                else:
                    first += chunk
            chunk //= 2
        return documents
