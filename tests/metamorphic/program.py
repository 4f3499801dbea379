"""Runs cimdelta on documents that are given as bytes."""

import dataclasses
import hashlib
import json
import os
import pathlib
import subprocess


class Refusal(Exception):
    """cimdelta ended with an error, or in a way in which it must not end."""


@dataclasses.dataclass(frozen=True)
class Result:
    status: int
    output: bytes
    messages: str


class Program:
    def __init__(self, path, root, folder):
        self.path = str(path)
        self.environment = dict(os.environ, CIMDELTA_ROOT=str(root))
        self.folder = pathlib.Path(folder)
        self.runs = 0
        self.last = None  # what was run last, for messages
        self.known = {}

    def write(self, documents):
        """A folder with these documents: the same folder for the same documents."""
        digest = hashlib.sha256()
        for name, data in documents:
            digest.update(name.encode() + b"\0" + hashlib.sha256(data).digest())
        folder = self.folder / digest.hexdigest()[:16]
        if not folder.exists():
            folder.mkdir(parents=True)
            for name, data in documents:
                (folder / name).write_bytes(data)
        return folder

    def run(self, arguments, documents):
        """The result of a command over documents [(name, data)], which are files in its folder. Equal runs are made once."""
        folder = self.write(documents)
        asked = (folder, tuple(arguments))
        if asked not in self.known:
            self.runs += 1
            done = subprocess.run([self.path, *arguments], cwd=folder, env=self.environment, capture_output=True, check=False)
            self.known[asked] = Result(done.returncode, done.stdout, done.stderr.decode(errors="replace"))
        self.last = asked
        return self.known[asked]

    def forget(self):
        """Removes the folders of earlier runs."""
        for folder in {asked[0] for asked in self.known} | set(self.folder.iterdir() if self.folder.exists() else ()):
            for path in folder.iterdir():
                path.unlink()
            folder.rmdir()
        self.known.clear()

    def compare(self, inventories, rules=None, output_format="json", options=()):
        """The result of a comparison, even if nothing was compared."""
        documents = list(inventories) + ([("rules.xml", rules)] if rules is not None else [])
        arguments = ["compare", "--allow-empty", "--detail", "-o", output_format, *options, *(["--spec", "rules.xml"] if rules is not None else [])]
        result = self.run([*arguments, *(name for name, _ in inventories)], documents)
        if result.status not in (0, 1):
            raise Refusal(f"compare ended with status {result.status}: {result.messages.strip()[-600:]}")
        return result

    def grouped(self, inventories, rules=None, output_format="text"):
        """The report as it is without --detail."""
        documents = list(inventories) + ([("rules.xml", rules)] if rules is not None else [])
        arguments = ["compare", "--allow-empty", "-o", output_format, *(["--spec", "rules.xml"] if rules is not None else [])]
        return self.run([*arguments, *(name for name, _ in inventories)], documents).output.decode()

    def status(self, inventories, rules=None):
        """The exit status of a comparison without options."""
        documents = list(inventories) + ([("rules.xml", rules)] if rules is not None else [])
        arguments = ["compare", *(["--spec", "rules.xml"] if rules is not None else []), *(name for name, _ in inventories)]
        return self.run(arguments, documents).status

    def report(self, inventories, rules=None, options=()):
        """The JSON report of a comparison."""
        return json.loads(self.compare(inventories, rules, "json", options).output)

    def document(self, arguments, inventory):
        """What a command prints that must end with status 0."""
        result = self.run(arguments, [inventory])
        if result.status != 0:
            raise Refusal(f"{arguments[0]} ended with status {result.status}: {result.messages.strip()[-600:]}")
        return result.output
