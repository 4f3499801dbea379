"""Fails if a document names a file, folder, type or heading that does not exist, or a function that the named file does not hold.

Argument: ROOT. The script checks words in backticks that begin with a top-level folder or are the name of a source or a type, the word
in backticks that follows a path and a comma, and links between documents. A name with Xxx in it stands for many.
"""

import pathlib
import re
import sys

DOCUMENTS = ["*.md", "docs/*.md", "fuzz/*.md", "fuzz/*/*.md", "tests/**/*.md", "bench/*.md", "data/**/*.md"]
WORD = re.compile(r"`([^`\s]+)`")
SOURCE = re.compile(r"[A-Z]\w*\.(?:h|cpp)")
TYPE = re.compile(r"[TI][A-Z][a-z]\w+")
LINK = re.compile(r"\]\(([^)#\s]*)(?:#([^)\s]*))?[^)]*\)")
FENCED = re.compile(r"^ *(```+).*?^ *\1", re.M | re.S)
HEADING = re.compile(r"^#+ (.*)$", re.M)
FUNCTION = re.compile(r"`([^`\s]+\.(?:h|cpp))`, `(\w+)`")


def tops(root):
    """The folders that a path may begin with."""
    return {path.name for path in root.iterdir() if path.is_dir() and not path.name.startswith(".") and path.name != "build"}


def exists(root, name):
    name = name.rstrip("/")
    if "*" in name:
        return any(root.glob(name))
    return (root / name).exists() or any(root.glob(name + ".*"))


def sources(root, folders):
    """The names of all sources, and of the types that headers are named after."""
    names = {path.name for folder in folders for path in (root / folder).rglob("*") if path.suffix in {".h", ".cpp"}}
    return names, {pathlib.PurePath(name).stem for name in names}


def anchors(document):
    """What a link may have behind #, as the pages of the forge name headings."""
    headings = HEADING.findall(FENCED.sub("", document.read_text(encoding="utf-8")))
    return {re.sub(r"[^\w -]", "", heading.strip().lower()).replace(" ", "-") for heading in headings}


def link_fault(document, link, anchor):
    target = document.parent / link if link else document
    if not target.exists():
        return f"links to {link}, which does not exist"
    if anchor and target.suffix == ".md" and anchor not in anchors(target):
        return f"links to {link}#{anchor}, but that document has no such heading"
    return None


def faults(root):
    folders = tops(root)
    names, types = sources(root, folders)
    checked = 0
    for pattern in DOCUMENTS:
        for document in sorted(root.glob(pattern)):
            text = document.read_text(encoding="utf-8")
            shown = document.relative_to(root)
            for word in WORD.findall(text):
                first, slash, _ = word.partition("/")
                if slash and first in folders and "..." not in word and re.fullmatch(r"[\w./*+-]+", word):
                    checked += 1
                    if not exists(root, word):
                        yield f"{shown}: names {word}, which does not exist"
                known = names if SOURCE.fullmatch(word) else types if TYPE.fullmatch(word) else {word}
                if word not in known and "Xxx" not in word:
                    yield f"{shown}: names {word}, which does not exist"
            for link, anchor in LINK.findall(text):
                if "://" not in link:
                    checked += 1
                    fault = link_fault(document, link, anchor)
                    if fault:
                        yield f"{shown}: {fault}"
            for path, function in FUNCTION.findall(text):
                if (root / path).is_file() and not re.search(rf"\b{function}\b", (root / path).read_text(encoding="utf-8")):
                    yield f"{shown}: {path} holds no {function}"
    if checked < 50:
        yield f"only {checked} paths were found in the documents: is this the root of the tree?"


def main():
    found = list(faults(pathlib.Path(sys.argv[1]).resolve()))
    print("\n".join(found) if found else "every path in the documents exists")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
