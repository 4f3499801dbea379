"""Reads the #include lines of every source and fails on an arrow between folders that is not in the list of allowed ones.

Arguments: ROOT LIST. A line of the list is `folder: what it may include`; a folder may always include itself. A name in the list stands
for that folder alone; `name/` stands for the folder and everything below it.
"""

import pathlib
import re
import sys

INCLUDE = re.compile(r'^\s*#\s*include\s*"([^"]+)"', re.M)
NOT_OURS = {"build", ".git"}


def read_list(path):
    allowed = {}
    for line in pathlib.Path(path).read_text().splitlines():
        line = line.split("#")[0].strip()
        if line:
            folder, targets = line.split(":")
            allowed[folder.strip()] = targets.split()
    return allowed


def covers(name, folder):
    return folder == name or (name.endswith("/") and (folder + "/").startswith(name))


def rule_for(folder, allowed):
    """The most exact entry of the list for a folder; None if there is none."""
    fitting = [name for name in allowed if covers(name, folder)]
    return max(fitting, key=len) if fitting else None


def sources(root):
    for path in sorted(root.rglob("*")):
        parts = path.relative_to(root).parts
        if path.suffix in {".h", ".cpp"} and not any(part in NOT_OURS for part in parts):
            yield path


def faults(root, allowed):
    seen = 0
    used = set()
    for path in sources(root):
        name = path.relative_to(root)
        folder = name.parent.as_posix()
        rule = rule_for(folder, allowed)
        if rule is None:
            yield f"{name}: folder {folder} is not in the list"
            continue
        for match in INCLUDE.finditer(path.read_text(encoding="utf-8")):
            seen += 1
            target = pathlib.PurePosixPath(match[1]).parent.as_posix()
            if not (root / match[1]).is_file():
                yield f"{name}: includes \"{match[1]}\", which is no file of this tree"
            if target == folder or (rule.endswith("/") and covers(rule, target)):
                continue
            fitting = [entry for entry in allowed[rule] if covers(entry, target)]
            used.update((rule, entry) for entry in fitting)
            if not fitting:
                yield f"{name}: includes \"{match[1]}\"; {rule} may not include {target}"
    if seen == 0:
        yield "no #include line was found: is this the root of the tree?"
    for rule, entries in allowed.items():
        for entry in entries:
            if (rule, entry) not in used:
                yield f"the list allows {rule} -> {entry}, which nothing uses; take it out"


def main():
    root, list_file = sys.argv[1:]
    found = list(faults(pathlib.Path(root).resolve(), read_list(list_file)))
    print("\n".join(found) if found else "every include follows an allowed arrow")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
