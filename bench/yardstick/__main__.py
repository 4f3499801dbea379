#!/usr/bin/env python3
"""Measures a build of cimdelta beside its peers, and beside an earlier build, in rounds that alternate.

bench/README.md explains the figures. Ends with status 2 if the contenders do not find the same differences.
"""
import argparse
import dataclasses
import datetime
import pathlib
import subprocess
import sys
import tempfile

import counting
import inventories
import measuring
import programs
import results
from figures import Figures
from rounds import Disagreement, Rounds

ROOT = pathlib.Path(__file__).resolve().parents[2]
FIGURES = ("report", "report-shuffled", "load", "compare", "compare-shuffled", "further", "many", "formats", "large")
ON_DEMAND = ("instructions",)


def parse():
    parser = argparse.ArgumentParser(prog="./dev bench", description=__doc__.splitlines()[0])
    parser.add_argument("--build", type=pathlib.Path, default=ROOT / "build/release/bin", help="folder of the programs to measure")
    parser.add_argument("--before", type=pathlib.Path, help="folder of an earlier build's cimdelta and bench_steps")
    parser.add_argument("--rounds", type=int, default=5, help="default: 5")
    parser.add_argument("--only", nargs="+", choices=FIGURES + ON_DEMAND, default=FIGURES,
                        help="some of the figures; instructions are counted on demand only, and take valgrind")
    parser.add_argument("--instances", type=int, help="in an inventory; default: 100,000")
    parser.add_argument("--limit", type=int, default=120, help="seconds of CPU that one program may take; default: 120")
    parser.add_argument("--quick", action="store_true", help="one round over tiny inventories, to see that everything runs")
    parser.add_argument("--record", metavar="LABEL", help="add the numbers to the results of this machine; say what was changed")
    parser.add_argument("--results", type=pathlib.Path, default=ROOT / "bench/results", help="folder of the recorded results")
    options = parser.parse_args()
    options.rounds = 1 if options.quick else options.rounds
    if options.rounds < 1:
        parser.error("--rounds takes a number from 1")
    return options


def sizes_of(options):
    sizes = inventories.QUICK if options.quick else inventories.Sizes()
    return dataclasses.replace(sizes, instances=options.instances) if options.instances else sizes


def databases_of(folder):
    databases = [programs.DatabasePeer(folder, name) for name in ("duckdb", "sqlite")]
    built = [database for database in databases if database.is_built()]
    for database in databases:
        if database not in built:
            print(f"{database.name}: not installed when this was built, so it takes no part; see bench/README.md")
    return built


def commit():
    described = subprocess.run(["git", "-C", ROOT, "describe", "--always", "--dirty"], capture_output=True, text=True, check=False)
    return described.stdout.strip() or "unknown"


def run_of(options, sizes, figures, rounds):
    """The form in which a run is recorded."""
    found = {}
    for figure in figures:
        measures = {}
        for measure in figure.measures:
            numbers = {contender.name: rounds.best_and_median(figure, contender, measure) for contender in figure.contenders}
            measures[measure.key] = {"title": measure.title, "unit": measure.unit,
                                     "numbers": {name: both for name, both in numbers.items() if both}}
        over = {name: reason for (key, name), reason in rounds.over.items() if key == figure.key}
        found[figure.key] = {"title": figure.title, "measures": measures, "over": over}
    return {"date": datetime.date.today().isoformat(), "label": options.record or "", "commit": commit(), "rounds": rounds.complete,
            "sizes": dataclasses.asdict(sizes), "figures": found}


def show(run, recorded):
    """Prints the numbers, with those of the last recorded run beside them."""
    for key, figure in run["figures"].items():
        last = recorded.last(key, run["sizes"])
        print(f"\n{figure['title']}" + (f"    (last recorded: {last['date']}, {last['label']})" if last else ""))
        for measure_key, numbers in figure["measures"].items():
            print(f"  {numbers['title']} ({numbers['unit']})")
            earlier = last["figures"][key]["measures"].get(measure_key, {}).get("numbers", {}) if last else {}
            for name in numbers["numbers"]:
                print(f"    {name:7} {shown(numbers['numbers'], name):52} {'last ' + shown(earlier, name) if name in earlier else ''}".rstrip())
        for name, reason in figure["over"].items():
            print(f"    {name:7} {reason}")


def shown(numbers, name):
    """Best and median of a contender; for a build also its ratios to the others."""
    best, median = numbers[name]
    against = results.ratios(numbers, name) if name in ("now", "before") else []
    return f"{results.number(best):>8} {results.number(median):>8}  " + ", ".join(f"{ratio:.2f} x {other}" for other, ratio in against)


def measure(options, folder):
    sizes = sizes_of(options)
    builds = [programs.Build("before", options.before)] if options.before else []
    builds.append(programs.Build("now", options.build))
    for build in builds:
        build.check()
    files = inventories.Inventories(options.build / "generate_inventory", folder, sizes)
    makers = Figures(builds, programs.FlatPeer(options.build), databases_of(options.build), files).makers()
    figures = [makers[key]() for key in FIGURES + ON_DEMAND if key in options.only]
    rounds = Rounds(figures, options.limit, lambda text: print(text, file=sys.stderr))
    rounds.check()
    try:
        rounds.run(options.rounds)
    except KeyboardInterrupt:
        if rounds.complete == 0:
            raise
    return run_of(options, sizes, figures, rounds)


def main():
    options = parse()
    recorded = results.Results(options.results, results.machine())
    try:
        with tempfile.TemporaryDirectory(prefix="yardstick-", dir=options.build) as folder:
            run = measure(options, folder)
    except (Disagreement, counting.NotCountable, measuring.ProgramFailure) as fault:
        print(f"bench: {fault}", file=sys.stderr)
        return 2
    except KeyboardInterrupt:
        return 130
    print("best and median; for a build the ratios of medians")
    show(run, recorded)
    if options.record:
        recorded.add(run)
    return 0


if __name__ == "__main__":
    sys.exit(main())
