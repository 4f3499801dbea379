#!/usr/bin/env python3
"""Changes the plug-in's sources one small thing at a time and lists the changes that no test notices.

Usage: mutate.py [--limit N] [--seed N] [--jobs N] [--only PATH-PREFIX] [--report FILE]

Works on copies of the tree below build/mutate, one for each job. A mutant is killed if a test fails or crashes. It is counted separately if a test runs too
long, and not at all if it does not compile. Survivors that are known to change nothing are in accepted.tsv (path, text before, text after, reason). Any other
survivor makes the run fail, and so does a build that fails without an error of the compiler or the linker.
"""
import argparse
import csv
import os
import pathlib
import queue
import random
import re
import shutil
import subprocess
import sys
import threading
import time

from operators import mutants_of

ROOT = pathlib.Path(__file__).resolve().parents[2]
FOLDERS = ("provider", "spec", "engine")
# The quick programs, and of the tests that make allocations fail only those that no quick test replaces.
TESTS = {"tests_spec": "*", "tests_engine": "*", "tests_provider": "*", "tests_provider_start": "*", "tests_host_process": "*",
         "tests_faults": "Faults/OutOfMemory.*"}
TEST_SECONDS = 60


class BuildFailure(Exception):
    """The tools failed, not the code."""


def run(command, folder, seconds=None):
    """Runs the command. Returns its exit status (None if it took too long) and what it printed."""
    environment = dict(os.environ, CIMDELTA_ROOT=str(folder), CCACHE_BASEDIR=str(folder), CCACHE_NOHASHDIR="1")
    try:
        result = subprocess.run(command, cwd=folder, env=environment, timeout=seconds, stdout=subprocess.PIPE, stderr=subprocess.STDOUT)
    except subprocess.TimeoutExpired:
        return None, ""
    return result.returncode, result.stdout.decode(errors="replace")


class Workshop:
    """A copy of the tree, built once, for trying mutants one after the other."""

    def __init__(self, number):
        self.folder = ROOT / "build" / "mutate" / str(number)
        shutil.rmtree(self.folder, ignore_errors=True)
        self.folder.mkdir(parents=True)
        files = subprocess.run(["git", "ls-files", "-z"], cwd=ROOT, stdout=subprocess.PIPE, check=True).stdout.decode().split("\0")
        for name in filter(None, files):
            target = self.folder / name
            target.parent.mkdir(parents=True, exist_ok=True)
            shutil.copyfile(ROOT / name, target)
        configure = ["cmake", "-S", ".", "-B", "out", "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Debug", "-DCMAKE_CXX_FLAGS_DEBUG=-O0",
                     "-DCMAKE_LINK_DEPENDS_NO_SHARED=ON"]
        if shutil.which("ccache"):
            configure.append("-DCMAKE_CXX_COMPILER_LAUNCHER=ccache")
        if run(configure, self.folder)[0] != 0 or not self.compiles(os.cpu_count()) or self.test() != "survived":
            sys.exit("mutate: the unchanged tree does not build or does not pass its tests")

    def compiles(self, jobs=1):
        status, output = run(["ninja", "-C", "out", f"-j{jobs}", "delta", *TESTS], self.folder)
        if status != 0 and not re.search(r"error: |undefined reference", output):
            raise BuildFailure(output)
        return status == 0

    def test(self):
        for test, names in TESTS.items():
            status, _ = run([f"out/bin/{test}", f"--gtest_filter={names}", "--gtest_fail_fast", "--gtest_brief=1"], self.folder,
                            TEST_SECONDS)
            if status != 0:
                return "too long" if status is None else "killed"
        return "survived"

    def verdict(self, mutant):
        path = self.folder / mutant.path
        original = path.read_text()
        lines = original.split("\n")
        lines[mutant.line - 1] = mutant.after
        path.write_text("\n".join(lines))
        try:
            return self.test() if self.compiles() else "invalid"
        finally:
            path.write_text(original)


def all_mutants(only):
    for folder in FOLDERS:
        for path in sorted((ROOT / folder).glob("*.[ch]*")):
            name = str(path.relative_to(ROOT))
            if name.startswith(only):
                yield from mutants_of(name, path.read_text())


def accepted():
    with open(pathlib.Path(__file__).with_name("accepted.tsv"), newline="", encoding="utf-8") as table:
        return {(row[0], row[1], row[2]): row[3] for row in csv.reader(table, delimiter="\t", quoting=csv.QUOTE_NONE) if row}


def try_all(mutants, jobs):
    waiting, results, lock = queue.Queue(), [], threading.Lock()
    for mutant in mutants:
        waiting.put(mutant)
    workshops = [Workshop(number) for number in range(jobs)]

    def work(workshop):
        while True:
            try:
                mutant = waiting.get_nowait()
            except queue.Empty:
                return
            verdict = workshop.verdict(mutant)
            with lock:
                results.append((mutant, verdict))
                print(f"{len(results)}/{len(mutants)} {verdict}: {mutant.path}:{mutant.line} {mutant.operator}", flush=True)

    threads = [threading.Thread(target=work, args=(workshop,)) for workshop in workshops]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    if len(results) != len(mutants):
        sys.exit("mutate: a build failed for another reason than the change; see above")
    return results


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument("--limit", type=int, default=0, help="try this many mutants, chosen at random (default: all)")
    parser.add_argument("--seed", type=int, default=1)
    parser.add_argument("--jobs", type=int, default=os.cpu_count())
    parser.add_argument("--only", default="", help="the beginning of a path: try only mutants of such files")
    parser.add_argument("--report", default=str(ROOT / "build" / "mutate" / "report.tsv"))
    options = parser.parse_args()

    mutants = list(all_mutants(options.only))
    if options.limit and options.limit < len(mutants):
        mutants = random.Random(options.seed).sample(mutants, options.limit)
    started = time.time()
    results = sorted(try_all(mutants, options.jobs), key=lambda result: (result[0].path, result[0].line, result[0].after))

    known = accepted()
    with open(options.report, "w", encoding="utf-8") as report:
        for mutant, verdict in results:
            report.write("\t".join([verdict, mutant.path, str(mutant.line), mutant.operator, mutant.before.strip(), mutant.after.strip()]) + "\n")
    counts = {name: sum(1 for _, verdict in results if verdict == name) for name in ("killed", "too long", "survived", "invalid")}
    unexplained = [mutant for mutant, verdict in results if verdict == "survived" and mutant.key() not in known]
    print(f"{counts['killed']} killed, {counts['too long']} ran too long, {counts['survived']} survived ({counts['survived'] - len(unexplained)} of them known to change nothing), "
          f"{counts['invalid']} did not compile; {time.time() - started:.0f} s; report: {options.report}")
    for mutant in unexplained:
        print(f"SURVIVED {mutant.path}:{mutant.line} {mutant.operator}\n  - {mutant.before.strip()}\n  + {mutant.after.strip()}")
    return 1 if unexplained else 0


if __name__ == "__main__":
    sys.exit(main())
