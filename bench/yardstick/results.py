"""Recorded runs: a file of JSON for each machine, and the page that is made of it.

A run has the numbers of its figures as {figure: {measure: {contender: [best, median]}}}, and the figures' titles, so the page can be
made of the file alone.
"""
import json
import pathlib
import re

RATIO_TO = ("before", "flat", "duckdb", "sqlite")  # what a number is set against, in this order of interest


def machine():
    """The processor and the number of cores, as a name for a file."""
    model = "unknown"
    with open("/proc/cpuinfo", encoding="utf-8") as file:
        lines = file.readlines()
    for line in lines:
        if line.startswith("model name"):
            model = line.split(":")[1]
    cores = sum(line.startswith("processor") for line in lines)
    return re.sub(r"[^a-z0-9]+", "-", re.sub(r"\((r|tm)\)", "", f"{model} {cores} cores".lower())).strip("-")


class Results:
    def __init__(self, folder, name):
        self.path = pathlib.Path(folder) / f"{name}.json"
        self.name = name
        self.runs = json.loads(self.path.read_text(encoding="utf-8")) if self.path.exists() else []

    def last(self, figure, sizes):
        """The last recorded run with this figure over inventories of the same sizes, or None."""
        fitting = [run for run in self.runs if figure in run["figures"] and run["sizes"] == sizes]
        return fitting[-1] if fitting else None

    def add(self, run):
        """Records the run. Both files are written beside the old ones first, which stay if that fails."""
        self.runs.append(run)
        _replace(self.path, json.dumps(self.runs, indent=1) + "\n")
        _replace(self.path.with_suffix(".md"), "\n".join(self.page()) + "\n")

    def page(self):
        yield f"# Speed and memory on {self.name}"
        yield ""
        yield ("Made by `./dev bench --record`, from the file of JSON beside it. Medians; in parentheses the ratio to the peer, or to the "
               "build before, that ran in the same rounds. Compare ratios: times vary with what else the machine does.")
        yield ""
        yield "## Which move brought what"
        yield ""
        yield from self._moves()
        for run in reversed(self.runs):
            yield ""
            yield f"## {run['date']}: {run['label']}"
            yield ""
            yield f"Commit {run['commit']}, {run['rounds']} round{'s' if run['rounds'] != 1 else ''}, {run['sizes']['instances']:,} instances."
            yield ""
            yield from _details(run)

    def _moves(self):
        titles = {}
        for run in self.runs:
            for key, figure in run["figures"].items():
                first = next(iter(figure["measures"].values()))
                titles[key] = f"{figure['title']}: {first['title']} ({first['unit']})"
        yield "| run | " + " | ".join(titles.values()) + " |"
        yield "| --- |" + " ---: |" * len(titles)
        for run in self.runs:
            cells = [_cell(run["figures"][key]) if key in run["figures"] else "" for key in titles]
            yield f"| {run['date']}: {run['label']} | " + " | ".join(cells) + " |"


def number(value):
    """Three digits that mean something."""
    if value >= 100:
        return f"{value:,.0f}"
    return f"{value:.1f}" if value >= 10 else f"{value:.2f}"


def ratios(numbers, name):
    """The ratios of a contender's median to those of others: [(other, ratio)]."""
    own = numbers.get(name)
    others = [other for other in RATIO_TO if other != name and other in numbers and numbers[other][1] > 0]
    return [(other, own[1] / numbers[other][1]) for other in others] if own else []


def _cell(figure):
    first = next(iter(figure["measures"].values()))
    if "now" not in first["numbers"]:
        return figure["over"].get("now", "")
    against = ", ".join(f"{ratio:.2f} x {other}" for other, ratio in ratios(first["numbers"], "now")[:2])
    return number(first["numbers"]["now"][1]) + (f" ({against})" if against else "")


def _details(run):
    yield "| figure | contender | best | median | ratio of medians |"
    yield "| --- | --- | ---: | ---: | --- |"
    for figure in run["figures"].values():
        for measure in figure["measures"].values():
            for name, (best, median) in measure["numbers"].items():
                against = ", ".join(f"{ratio:.2f} x {other}" for other, ratio in ratios(measure["numbers"], name) if name in ("now", "before"))
                yield (f"| {figure['title']}: {measure['title']} ({measure['unit']}) | {name} | {number(best)} | {number(median)} | "
                       f"{against} |")
        for name, reason in figure["over"].items():
            yield f"| {figure['title']} | {name} | {reason} | | |"


def _replace(path, text):
    unfinished = path.with_suffix(".unfinished")
    unfinished.write_text(text, encoding="utf-8")
    unfinished.replace(path)
