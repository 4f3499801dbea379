"""Fails if a document names a file or folder of this tree that does not exist, or a function that the named file does not hold.

Argument: ROOT. Looked at are words in backticks that begin with a top-level folder, links between documents, and, in docs/where.md, the
word in backticks that follows a path after a comma.
"""

import pathlib
import re
import sys

DOCUMENTS = ["*.md", "docs/*.md", "fuzz/*.md", "fuzz/*/*.md", "tests/**/*.md", "bench/*.md", "data/**/*.md"]
WORD = re.compile(r"`([^`\s]+)`")
LINK = re.compile(r"\]\(([^)#\s]+)[^)]*\)")
FUNCTION = re.compile(r"`([^`\s]+\.(?:h|cpp))`, `(\w+)`")


def tops(root):
    """The folders that a path may begin with."""
    return {path.name for path in root.iterdir() if path.is_dir() and not path.name.startswith(".") and path.name != "build"}


def exists(root, name):
    name = name.rstrip("/")
    if "*" in name:
        return any(root.glob(name))
    return (root / name).exists() or any(root.glob(name + ".*"))


def faults(root):
    folders = tops(root)
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
            for link in LINK.findall(text):
                if "://" not in link:
                    checked += 1
                    if not (document.parent / link).exists():
                        yield f"{shown}: links to {link}, which does not exist"
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
