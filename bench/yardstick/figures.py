"""The figures: which programs run for each, and what is read from their runs.

Every contender of a figure has one or more commands, which run one after the other; together they are its turn. A measure makes one
number of a turn. The first measure of a figure is the one that the table of moves shows.
"""
import dataclasses
import typing

from programs import Command


@dataclasses.dataclass(frozen=True)
class Measure:
    key: str
    title: str
    unit: str
    of: typing.Callable            # from the samples of a turn to a number, or to None if they give none
    builds_only: bool = False      # peers have no such number


@dataclasses.dataclass(frozen=True)
class Contender:
    name: str
    is_peer: bool
    commands: typing.Sequence[Command]


@dataclasses.dataclass(frozen=True)
class Figure:
    key: str
    title: str
    contenders: typing.Sequence[Contender]
    measures: typing.Sequence[Measure]
    once: bool = False             # repeating it gives the same numbers


def _quotient(number, other):
    """None if a clock has not moved, which happens if there is next to nothing to do."""
    return number / other if other else None


def _cpu():
    return Measure("cpu", "CPU", "s", lambda turn: turn[0].cpu)


def _wall():
    return Measure("wall", "wall", "s", lambda turn: turn[0].wall)


def _peak():
    return Measure("peak", "peak memory", "MB", lambda turn: turn[0].peak / 1e6)


def _printed(key, name, title, unit="ms"):
    return Measure(key, title, unit, lambda turn: turn[0].printed[name])


class Figures:
    """Makes the figures of a run. `flat` is the peer with tables of text, `databases` are those that are built."""

    def __init__(self, builds, flat, databases, inventories):
        self.builds = builds
        self.flat = flat
        self.databases = databases
        self.inventories = inventories
        self.sizes = inventories.sizes
        self.output = str(inventories.folder / "report")

    def makers(self):
        """From the key of each figure to the function that makes it, and its inventories."""
        return {"report": self._report, "report-shuffled": self._report_shuffled, "load": self._load, "compare": self._compare,
                "compare-shuffled": self._compare_shuffled, "further": self._further, "many": self._many,
                "formats": self._formats, "large": self._large, "instructions": self._instructions}

    def _report(self):
        return self._report_of("report", "two files to report, key order", self.inventories.in_key_order())

    def _report_shuffled(self):
        return self._report_of("report-shuffled", "two files to report, shuffled", self.inventories.shuffled())

    def _report_of(self, key, title, files):
        peer = Contender(self.flat.name, True, [self.flat.report(files, self.output)])
        return Figure(key, title, [peer, *self._each(lambda build: [build.report(files, self.output)])], [_cpu(), _wall(), _peak()])

    def _load(self):
        files = self.inventories.in_key_order()[:1]
        peer = Contender(self.flat.name, True, [self.flat.load(files)])
        heap = Measure("heap", "memory of an instance", "B", lambda turn: turn[0].printed["heap_bytes"] / self.sizes.instances, True)
        return Figure("load", "loading one file", [peer, *self._each(lambda build: [build.load(files)])],
                      [_printed("cpu", "load_cpu_ms", "CPU"), heap])

    def _compare(self):
        return self._compare_of("compare", "comparing two, key order", self.inventories.in_key_order())

    def _compare_shuffled(self):
        return self._compare_of("compare-shuffled", "comparing two, shuffled", self.inventories.shuffled())

    def _compare_of(self, key, title, files):
        return Figure(key, title, self._comparing(lambda how: [how(files)]), [_printed("cpu", "compare_cpu_ms", "CPU")])

    def _further(self):
        count = self.sizes.further
        files = self.inventories.in_key_order(count + 1)
        per_other = Measure("per_other", f"CPU per further inventory, {count + 1} against 2", "x",
                            lambda turn: _quotient(turn[0].printed["compare_cpu_ms"] / count, turn[1].printed["compare_cpu_ms"]))
        return Figure("further", f"comparing {count + 1} inventories", self._comparing(lambda how: [how(files), how(files[:2])]),
                      [per_other, _printed("cpu", "compare_cpu_ms", "CPU")])

    def _many(self):
        files = self.inventories.many()
        title = f"{len(files):,} inventories of {self.sizes.classes} classes to report"
        peer = Contender(self.flat.name, True, [self.flat.report(files, self.output)])
        return Figure("many", title, [peer, *self._each(lambda build: [build.report(files, self.output)])], [_cpu(), _wall(), _peak()])

    def _formats(self):
        """Many differences: peak memory of a report against that of the two inventories, loaded."""
        files = self.inventories.much_changed()
        forms = ("ndjson", "text", "json")
        contenders = self._each(lambda build: [build.load(files), *(build.report(files, self.output, form) for form in forms)])
        measures = []
        for place, form in enumerate(forms, start=1):
            measures.append(Measure(f"{form}_peak", f"{form}, peak against the two loaded", "x",
                                    lambda turn, place=place: turn[place].peak / turn[0].peak))
            measures.append(Measure(f"{form}_cpu", f"{form}, CPU", "s", lambda turn, place=place: turn[place].cpu))
        measures.append(Measure("loaded", "the two loaded, peak", "MB", lambda turn: turn[0].peak / 1e6))
        title = f"two inventories with {self.sizes.instances * 11 * self.sizes.changed // 1000:,} changed values"
        return Figure("formats", title, contenders, measures)

    def _large(self):
        small, large = self.inventories.in_key_order(), self.inventories.large()
        growth = f"{self.sizes.instances * self.sizes.times:,} against {self.sizes.instances:,} instances"
        measures = [Measure("cpu", "CPU", "x", lambda turn: _quotient(turn[1].cpu, turn[0].cpu)),
                    Measure("peak", "peak memory", "x", lambda turn: turn[1].peak / turn[0].peak),
                    Measure("seconds", "CPU of the larger", "s", lambda turn: turn[1].cpu)]
        both = (small, large)
        peer = Contender(self.flat.name, True, [self.flat.report(files, self.output) for files in both])
        builds = self._each(lambda build: [build.report(files, self.output) for files in both])
        return Figure("large", f"two files to report, {growth}", [peer, *builds], measures)

    def _instructions(self):
        """What a shared machine does not disturb."""
        files = self.inventories.few()
        peer = Contender(self.flat.name, True, [self.flat.load(files[:1]).counted()])
        builds = self._each(lambda build: [build.load(files[:1]).counted(), build.load(files).counted(),
                                           build.compare(files, self.inventories.rules).counted()])
        measures = [Measure("load", "loading", "thousand an instance", lambda turn: turn[0].instructions / self.sizes.few / 1e3),
                    Measure("compare", "comparing two", "thousand an instance",
                            lambda turn: (turn[2].instructions - turn[1].instructions) / self.sizes.few / 1e3, True)]
        return Figure("instructions", f"instructions, {self.sizes.few:,} instances", [peer, *builds], measures, once=True)

    def _each(self, commands):
        return [Contender(build.name, False, commands(build)) for build in self.builds]

    def _comparing(self, commands):
        """Databases and builds; `commands` gets the function that makes a command of each."""
        peers = [Contender(peer.name, True, commands(peer.compare)) for peer in self.databases]
        return peers + self._each(lambda build: commands(lambda files: build.compare(files, self.inventories.rules)))
