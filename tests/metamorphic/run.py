"""Runs the relations over random inventories, over inventories of this repository and over the random sets of the engine's tests.

    run.py PART --program CIMDELTA --root ROOT [--seed N] [--count N] [--features LIST] [--only NAME] [--thorough] [--keep FOLDER]
    run.py compare --program CIMDELTA --root ROOT [--rules RULES] REFERENCE OTHER...

PART is `random`, `rules` (random inventories with random rules), `files`, `reports` (the test data of the client), `sets` (needs --sets), or `lies` (the relations themselves, on wrong
results). `compare` checks the report on the inventories that follow. A failure prints the seed, what is wrong and the smallest documents that show
it, and keeps them in a folder. The exit status is 0 if nothing was wrong and 1 if something was, or if the run could not be made.
"""

import argparse
import dataclasses
import itertools
import pathlib
import subprocess
import sys
import tempfile
import traceback

try:
    import jsonschema  # noqa: F401, first of all, for a message that says what to do
    import lxml.etree  # noqa: F401
except ImportError:
    sys.exit("tests/metamorphic needs lxml and jsonschema: apt-get install python3-lxml python3-jsonschema, and run it with /usr/bin/python3")

import differences
import generator
import inventory
import lies
import program
import relations
import shrinking

COUNTS = {"random": 24, "rules": 24, "sets": 150, "files": 1}
FIRST_SEED = 1
LIE_SEEDS = 12  # within so many cases a lie must be noticed
MAY_OCCUR = ("schemas", "types", "systems", "statics", "moments", "objects", "orders", "keyless", "places")
SHOWN_BYTES = 6000
FAULTS_SHOWN = 5


class Runner:
    def __init__(self, arguments, scratch):
        self.arguments = arguments
        self.run = program.Program(arguments.program, arguments.root, scratch)
        self.keep = pathlib.Path(arguments.keep)
        self.failures = 0
        self.cases = 0

    def relations(self):
        return [one for one in relations.ALL if self.arguments.only in (None, one.__name__)]

    def faults(self, relation, case):
        try:
            return list(relation(case))
        except program.Refusal as refusal:
            return [f"refused: {refusal}"]
        except Exception:  # the checker met what it does not know; that is a fault too, of one of the two
            return [f"the checker failed: {traceback.format_exc(limit=-3)}"]

    def case(self, name, documents, rules, seed, chosen=None):
        self.cases += 1
        case = relations.Case(self.run, documents, rules, seed, self.arguments.thorough)
        for relation in chosen or self.relations():
            found = self.faults(relation, case)
            if found:
                self.report(name, case, relation, found)
        self.run.forget()

    def report(self, name, case, relation, found):
        self.failures += 1
        print(f"{name}: {relation.__name__}:")
        for fault in found[:FAULTS_SHOWN]:
            print(f"    {fault[:1500]}")
        kind = kind_of(found[0])

        def fails(documents, rules):
            smaller = dataclasses.replace(case, documents=documents, rules=rules)
            return any(kind_of(fault) == kind for fault in self.faults(relation, smaller))

        documents = shrinking.Shrinker(fails).shrink(case.documents, case.rules)
        folder = self.keep / f"{name}-{relation.__name__}".replace("/", "-").replace(" ", "-")
        folder.mkdir(parents=True, exist_ok=True)
        files = documents + ([("rules.xml", case.rules)] if case.rules is not None else [])
        print(f"    the smallest documents that show it, in {folder}:")
        for file_name, data in files:
            (folder / file_name).write_bytes(data)
            print(f"    {file_name}: {data[:SHOWN_BYTES].decode(errors='replace')}")
        for fault in self.faults(relation, dataclasses.replace(case, documents=documents))[:FAULTS_SHOWN]:
            print(f"    then: {fault[:1500]}")

    # Parts.

    def random_inventories(self, with_rules):
        first, count = self.arguments.seed, self.arguments.count
        for seed in range(first, first + count):
            made = generator.Generator(seed, self.arguments.features)
            documents = [(f"{chr(97 + index)}.xml", data) for index, data in enumerate(made.make_documents(2 + seed % 3))]
            self.case(f"seed {seed}", documents, made.make_rules() if with_rules else None, seed)

    def files(self):
        for names, rules in FILES:
            documents = [(f"{number}{pathlib.Path(name).name}", (self.arguments.root / name).read_bytes()) for number, name in enumerate(names)]
            self.case(" ".join(names), documents, (self.arguments.root / rules).read_bytes() if rules else None, self.arguments.seed)

    def reports(self):
        """The formats against each other, over all pairs and some trios of the client's own test data."""
        for names in [*itertools.permutations(CLIENT_FILES, 2), *itertools.combinations(CLIENT_FILES, 3)]:
            documents = [(f"{name}.xml", (self.arguments.root / CLIENT / f"{name}.xml").read_bytes()) for name in names]
            has_classes_of_rules = any(name.startswith("web") for name in names)
            rules = (self.arguments.root / CLIENT / "rules.xml").read_bytes() if has_classes_of_rules and names[0] < names[-1] else None
            self.case(" ".join(names), documents, rules, self.arguments.seed, relations.REPORTS)

    def sets(self):
        """What the engine's random tests compare, as files."""
        first, count = self.arguments.seed, self.arguments.count
        with tempfile.TemporaryDirectory(prefix="cimdelta-sets-") as folder:
            subprocess.run([self.arguments.sets, folder, str(first), str(count)], check=True)
            for seed in range(first, first + count):
                paths = sorted((pathlib.Path(folder) / str(seed)).glob("[0-9]*.xml"))
                documents = [(path.name, path.read_bytes()) for path in paths]
                rules = (pathlib.Path(folder) / str(seed) / "rules.xml").read_bytes()
                if can_be_compared(documents, rules):
                    self.case(f"set {seed}", documents, rules, seed, [relations.is_what_the_files_say, *relations.REPORTS])

    def lies(self):
        """Each relation fails for a program that is wrong in its way."""
        noticed = {relation for _, relation, _, _ in lies.LIES}
        self.failures += len(set(relations.ALL) - noticed)
        for relation in set(relations.ALL) - noticed:
            print(f"{relation.__name__}: no lie shows that it can fail")
        for name, relation, kind, lie in lies.LIES:
            self.cases += 1
            if not self.is_noticed(relation, kind, lie):
                self.failures += 1
                print(f"{name}: {relation.__name__} does not notice")

    def is_noticed(self, relation, kind, lie):
        told = 0
        for seed in range(self.arguments.seed, self.arguments.seed + LIE_SEEDS):
            made = generator.Generator(seed, MAY_OCCUR)
            documents = [(f"{chr(97 + index)}.xml", data) for index, data in enumerate(made.make_documents(3))]
            liar = kind(self.arguments.program, self.arguments.root, self.run.folder / "lies", lie)
            case = relations.Case(liar, documents, made.make_rules() if seed % 2 else None, seed)
            faults = self.faults(relation, case)
            self.run.runs += liar.runs
            told += liar.told
            liar.forget()
            if faults and told and "the checker failed" not in faults[0] and not faults[0].startswith("refused"):
                return True
        return False

    def given(self):
        """The inventories of the command line."""
        documents = [(f"{number}-{path.name}", path.read_bytes()) for number, path in enumerate(self.arguments.inventories)]
        rules = self.arguments.rules.read_bytes() if self.arguments.rules else None
        chosen = None if self.arguments.only else [relations.is_what_the_files_say]
        self.case("these inventories", documents, rules, self.arguments.seed, chosen)


FILES = [
    (["data/examples/bookworm.xml", "data/examples/bookworm-updates.xml.xz", "data/examples/trixie.xml.xz"], "data/examples/rules.xml"),
    (["tests/data/typepair/A.xml", "tests/data/typepair/B.xml"], None),
    (["tests/data/interchange-pywbem/04-all-in-one.xml", "tests/data/interchange-pywbem/05-withname.xml"], None),
    (["tests/data/interchange-openpegasus/root_tstdev/inventory.xml", "tests/data/interchange-pywbem/04-all-in-one.xml"], None),
]

CLIENT = pathlib.Path("tests/client/data")
CLIENT_FILES = ["web01", "web01-again", "web02", "web03", "two-boots", "other-schema", "other-types", "empty-classes"]


def can_be_compared(documents, rules_data):
    """A set may have one namespace only, rules for what none declares, or no operating system whose type cimdelta could make up."""
    read = [inventory.Inventory(data) for _, data in documents]
    declared = differences.Comparison(read).schema
    named = lxml.etree.fromstring(rules_data).iterchildren("class")
    known = all(one.get("name").lower() in declared.classes and names(one) <= declared.properties(one.get("name")).keys() for one in named)
    return len(documents) > 1 and known and any(one.class_name == inventory.OPERATING_SYSTEM for one in read[0].instances)


def names(element):
    return {value.text.lower() for value in element.iter("value")}


def kind_of(fault):
    """What must stay the same while documents shrink: the beginning of the text, and its end if cimdelta refused."""
    words = fault.split()
    return " ".join([word for word in words[:8] if "=" not in word] + (words[-5:] if words[0] == "refused:" else []))


def read_arguments():
    parser = argparse.ArgumentParser(description="Relations between runs of cimdelta")
    parser.add_argument("part", choices=["random", "rules", "files", "reports", "sets", "lies", "compare"])
    parser.add_argument("inventories", nargs="*", type=pathlib.Path)
    parser.add_argument("--program", required=True, type=pathlib.Path)
    parser.add_argument("--root", required=True, type=pathlib.Path)
    parser.add_argument("--sets", help="the program write_random_sets")
    parser.add_argument("--rules", type=pathlib.Path)
    parser.add_argument("--seed", type=int, default=FIRST_SEED)
    parser.add_argument("--count", type=int)
    parser.add_argument("--features", type=lambda text: tuple(text.split(",")), default=MAY_OCCUR, help="what generator.py lists")
    parser.add_argument("--thorough", action="store_true", help="all rewritings of each document, not a few")
    parser.add_argument("--only", help="one relation by its name")
    parser.add_argument("--keep", default=pathlib.Path(tempfile.gettempdir()) / "cimdelta-metamorphic", help="where failing documents are kept")
    arguments = parser.parse_intermixed_args()
    arguments.count = arguments.count or COUNTS.get(arguments.part, 1)
    arguments.program, arguments.root = arguments.program.resolve(), arguments.root.resolve()
    return arguments


def main():
    arguments = read_arguments()
    with tempfile.TemporaryDirectory(prefix="cimdelta-metamorphic-") as scratch:
        runner = Runner(arguments, scratch)
        parts = {
            "random": lambda: runner.random_inventories(False),
            "rules": lambda: runner.random_inventories(True),
            "files": runner.files,
            "reports": runner.reports,
            "lies": runner.lies,
            "sets": runner.sets,
            "compare": runner.given,
        }
        parts[arguments.part]()
    if not runner.cases or not runner.run.runs:
        sys.exit("no case was run")
    print(f"{arguments.part}: {runner.cases} cases, {runner.run.runs} runs of cimdelta, {runner.failures} relations that do not hold")
    return 1 if runner.failures else 0


if __name__ == "__main__":
    sys.exit(main())
