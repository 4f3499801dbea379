"""Fails if an example in a document is not what cimdelta prints.

Arguments: ROOT CIMDELTA. An example is a code block that begins with a line `$ cimdelta ...`. The command runs in the folder that EXAMPLES names
for the document. The rest of the block must be all that the command prints to standard output; a line `...` stands for lines that were left out.
Each document must have an example.
"""

import os
import pathlib
import re
import shlex
import subprocess
import sys

EXAMPLES = {"README.md": ".", "docs/client.md": "tests/client/data"}
BLOCK = re.compile(r"^```\n\$ cimdelta ([^\n]*)\n(.*?)^```$", re.M | re.S)
LEFT_OUT = "..."


def output(root, cimdelta, folder, arguments):
    """What the command prints. Ends this program if the status is neither 0 (no differences) nor 1 (differences)."""
    environment = dict(os.environ, CIMDELTA_ROOT=str(root))
    result = subprocess.run([cimdelta, *shlex.split(arguments)], cwd=root / folder, env=environment, stdout=subprocess.PIPE, check=False)
    if result.returncode not in (0, 1):
        sys.exit(f"cimdelta {arguments}: ended with status {result.returncode}")
    return result.stdout.decode().replace("\r\n", "\n")  # CSV ends lines so


def pattern(lines):
    """A pattern for the whole output: every line as it is, except that `...` stands for any lines."""
    return "".join("(?:.*\n)*?" if line == LEFT_OUT else re.escape(line) + "\n" for line in lines)


def faults(root, cimdelta):
    for document, folder in EXAMPLES.items():
        blocks = BLOCK.findall((root / document).read_text(encoding="utf-8"))
        if not blocks:
            yield f"{document}: has no example"
        for arguments, shown in blocks:
            printed = output(root, cimdelta, folder, arguments)
            if not re.fullmatch(pattern(shown.splitlines()), printed):
                yield f"{document}: cimdelta {arguments} prints something else:\n{printed}"


def main():
    found = list(faults(pathlib.Path(sys.argv[1]).resolve(), pathlib.Path(sys.argv[2]).resolve()))
    print("\n".join(found) if found else "every example is what cimdelta prints")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
