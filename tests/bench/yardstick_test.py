"""Whether the benchmarks' driver runs every figure, and refuses to set times against each other that belong to different answers.

Usage: yardstick_test.py ROOT PROGRAMS [unittest options]. PROGRAMS is the folder with cimdelta and the programs of bench/.
"""
import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import unittest

ROOT, PROGRAMS = (pathlib.Path(argument).resolve() for argument in sys.argv[1:3])
DRIVER = ROOT / "bench/yardstick"
sys.path.insert(0, str(DRIVER))

import counting  # noqa: E402 (the folder of the driver is known only now)
import figures  # noqa: E402
import measuring  # noqa: E402
import programs  # noqa: E402
import results  # noqa: E402
import rounds  # noqa: E402

LIES = """#!/bin/sh
"$(dirname "$0")/honest" "$@" | sed 's/"differences": \\([0-9]*\\)/"differences": \\11/'
"""

# Runs the program, and says how many instructions it took: 100,000 for each inventory, and as many for a comparison.
CALLGRIND = """#!/bin/sh
shift 2
"$@" || exit
case "$*" in
*--spec*) echo "==1== Collected : 300000" >&2 ;;
*few-1*) echo "==1== Collected : 200000" >&2 ;;
*) echo "==1== Collected : 100000" >&2 ;;
esac
"""


class DriverTest(unittest.TestCase):
    def setUp(self):
        self.folder = pathlib.Path(self.enterContext(tempfile.TemporaryDirectory()))

    def drive(self, *options, build=PROGRAMS, path=""):
        command = [sys.executable, DRIVER, "--quick", "--build", build, "--results", self.folder, *options]
        environment = dict(os.environ, PATH=path + os.environ["PATH"])
        return subprocess.run(command, capture_output=True, text=True, check=False, env=environment)

    def recorded(self, suffix):
        return [path.read_text(encoding="utf-8") for path in self.folder.glob(f"*.{suffix}")]

    def programs_with_a_liar(self):
        """A folder with all programs, of which peer_flat finds ten times as many differences and some."""
        folder = self.folder / "programs"
        folder.mkdir()
        for name in ("cimdelta", "bench_steps", "generate_inventory"):
            (folder / name).symlink_to(PROGRAMS / name)
        (folder / "honest").symlink_to(PROGRAMS / "peer_flat")
        liar = folder / "peer_flat"
        liar.write_text(LIES, encoding="utf-8")
        liar.chmod(0o755)
        return folder

    def test_every_figure_has_numbers_of_every_build_and_is_recorded(self):
        ended = self.drive("--before", str(PROGRAMS), "--record", "a move")
        self.assertEqual(0, ended.returncode, ended.stderr)
        run, = json.loads(self.recorded("json")[0])
        self.assertEqual(9, len(run["figures"]))
        for key, figure in run["figures"].items():
            self.assertEqual({}, figure["over"], key)
            # A ratio is missing if the clock of the processor did not move.
            self.assertLessEqual({"before", "now"}, set().union(*(measure["numbers"] for measure in figure["measures"].values())), key)
            for measure in figure["measures"].values():
                self.assertIn(f"  {measure['title']} ({measure['unit']})\n", ended.stdout)
        self.assertEqual(1, run["rounds"])
        self.assertIn(f"| {run['date']}: a move |", self.recorded("md")[0])

    def test_instructions_are_those_that_callgrind_counts(self):
        valgrind = self.folder / "valgrind"
        valgrind.write_text(CALLGRIND, encoding="utf-8")
        valgrind.chmod(0o755)
        ended = self.drive("--only", "instructions", path=f"{self.folder}:")
        self.assertEqual(0, ended.returncode, ended.stderr)
        self.assertIn("  loading (thousand an instance)\n    flat        2.00     2.00\n    now         2.00     2.00  1.00 x flat\n"
                      "  comparing two (thousand an instance)\n    now         2.00     2.00\n", ended.stdout)

    def test_the_last_recorded_numbers_stand_beside_the_new_ones(self):
        self.assertNotIn("last ", self.drive("--only", "load", "--record", "a move").stdout)
        second = self.drive("--only", "load")
        self.assertRegex(second.stdout, r"\(last recorded: [-0-9]+, a move\)")
        # A clock with coarse steps may say 0, and then there is no ratio.
        self.assertRegex(second.stdout, r"now +[.0-9]+ +[.0-9]+(  [.0-9]+ x flat)? +last +[.0-9]+ +[.0-9]+(  [.0-9]+ x flat)?\n")

    def test_a_peer_with_another_answer_ends_the_run_without_a_number(self):
        ended = self.drive("--only", "report", "load", "--record", "a move", build=self.programs_with_a_liar())
        self.assertEqual(2, ended.returncode)
        self.assertRegex(ended.stderr, r"bench: differences between key-0 and 1 more like key-1: flat \(report\) \d+1, now \(report\) \d+\n")
        self.assertNotIn("best", ended.stdout)
        self.assertEqual([], self.recorded("json"))

    def test_a_folder_without_the_programs_is_refused(self):
        ended = self.drive("--before", str(self.folder))
        self.assertEqual(2, ended.returncode)
        self.assertIn("has no cimdelta", ended.stderr)

    def test_an_inventory_that_cannot_be_made_is_named(self):
        folder = self.programs_with_a_liar()
        (folder / "generate_inventory").unlink()
        ended = self.drive("--only", "load", build=folder)
        self.assertEqual(2, ended.returncode)
        self.assertRegex(ended.stderr, "key-0.xml could not be made: .*No such file")


class GeneratorTest(unittest.TestCase):
    def generate(self, *arguments):
        return subprocess.run([PROGRAMS / "generate_inventory", *arguments], capture_output=True, text=True, check=True).stdout

    def instances(self, *arguments):
        return re.findall(r"<INSTANCE .*?</INSTANCE>", self.generate(*arguments), re.DOTALL)

    def names(self, *arguments):
        return [re.search(r'"Name".*?<VALUE>(.*?)<', instance)[1] for instance in self.instances(*arguments)]

    def test_equal_arguments_give_equal_bytes(self):
        arguments = ("50", "3", "--classes", "7", "--shuffled", "9")
        self.assertEqual(self.generate(*arguments), self.generate(*arguments))

    def test_every_class_has_its_share_of_the_instances(self):
        declared = re.findall('<CLASS NAME="(.*?)"', self.generate("30", "0", "--classes", "10"))
        used = [re.search('CLASSNAME="(.*?)"', instance)[1] for instance in self.instances("30", "0", "--classes", "10")]
        self.assertEqual([f"BENCH_Software{number:03}" for number in range(10)], declared)
        self.assertEqual([name for name in declared for _ in range(3)], used)

    def test_shuffled_inventories_have_the_same_instances_in_another_order(self):
        ordered, shuffled = self.instances("500", "1"), self.instances("500", "1", "--shuffled", "2")
        self.assertNotEqual(ordered, shuffled)
        self.assertEqual(sorted(ordered), sorted(shuffled))
        self.assertNotEqual(shuffled, self.instances("500", "1", "--shuffled", "3"))

    def test_other_states_lack_instances_have_new_ones_and_stay_in_key_order(self):
        reference, other = self.names("2000", "0"), self.names("2000", "1")
        self.assertEqual(sorted(other), other)
        self.assertEqual((9, 9), (len(set(reference) - set(other)), len(set(other) - set(reference))))

    def test_nothing_changes_in_instances_of_both_states_if_no_value_may(self):
        reference, other = self.instances("2000", "0"), self.instances("2000", "1", "--changed", "0")
        self.assertEqual(9, len(set(reference) - set(other)))
        self.assertLess(1000, len(set(reference) - set(self.instances("2000", "1", "--changed", "273"))))


class PeersTest(unittest.TestCase):
    CLASS = '<CLASS NAME="A"><PROPERTY NAME="K"><QUALIFIER NAME="Key"/></PROPERTY></CLASS>'
    REFUSED = (
        ("<CIM>", "no element found"),
        ('<CIM><INSTANCE CLASSNAME="A"/></CIM>', "an instance of A comes before its class"),
        (f'<CIM>{CLASS}<INSTANCE CLASSNAME="A"><PROPERTY NAME="X"/></INSTANCE></CIM>', "property X is not declared"),
    )

    def test_what_a_peer_cannot_read_is_refused_with_the_reason(self):
        with tempfile.NamedTemporaryFile("w", encoding="utf-8") as file:
            for document, reason in self.REFUSED:
                with self.subTest(document=document):
                    file.seek(0)
                    file.truncate()
                    file.write(document)
                    file.flush()
                    ended = subprocess.run([PROGRAMS / "peer_flat", file.name], capture_output=True, text=True, check=False)
                    self.assertEqual((2, f"peer_flat: {file.name}: {reason}\n"), (ended.returncode, ended.stderr))

    def test_a_file_that_is_missing_is_refused(self):
        ended = subprocess.run([PROGRAMS / "bench_steps", "/no/such/file"], capture_output=True, text=True, check=False)
        self.assertEqual(2, ended.returncode)
        self.assertIn("/no/such/file", ended.stderr)


class CountingTest(unittest.TestCase):
    COVERAGE = '{"kind": "coverage", "summary": {"differences": %d}}\n'
    RECORD = '{"kind": "changed", "inventories": ["b", "c"]}\n'
    DAMAGED = (
        ("ndjson", COVERAGE % 1, "the summary counts 1, the list 0"),
        ("ndjson", RECORD, "no line says"),
        ("json", '    "differences": 2,\n  "differences": [\n      "kind": "changed",\n  ],\n      "kind": "changed",\n', "the summary counts 2, the list 1"),
        ("json", '  "differences": [\n      "kind": "changed",\n', "the summary counts None"),
        ("text", "2 differences between a and b\n- X=1\n", "the headline counts 2, the list 1"),
        ("text", "No differences\n", "the headline counts nothing"),
    )

    def count(self, form, text):
        with tempfile.NamedTemporaryFile("w", encoding="utf-8") as file:
            file.write(text)
            file.flush()
            return counting.BY_FORMAT[form](file.name)

    def test_a_difference_counts_once_for_each_inventory(self):
        self.assertEqual(4, self.count("ndjson", self.RECORD * 2 + self.COVERAGE % 2))

    def test_instances_and_values_count_in_text(self):
        text = "3 differences between a and b: ...\n\nC\n- X=1\n~ X=2\n    V: 1 -> 2\n+ X=3\nCompared: 1 class.\n"
        self.assertEqual(3, self.count("text", text))

    def test_a_report_that_contradicts_itself_is_not_counted(self):
        for form, text, message in self.DAMAGED:
            with self.subTest(form=form, text=text), self.assertRaisesRegex(counting.NotCountable, message):
                self.count(form, text)


class MeasuringTest(unittest.TestCase):
    def test_the_printed_line_is_read(self):
        self.assertEqual({"a": 1}, measuring.run(["echo", '{"a": 1}']).printed)

    def test_an_unexpected_status_is_a_failure_with_the_message(self):
        with self.assertRaisesRegex(measuring.ProgramFailure, "ended with 3: no luck"):
            measuring.run(["sh", "-c", "echo no luck >&2; exit 3"], (0, 1))

    def test_a_program_that_is_missing_is_a_failure(self):
        with self.assertRaisesRegex(measuring.ProgramFailure, "No such file"):
            measuring.run(["/no/such/program"])

    def test_a_program_that_takes_too_long_is_ended(self):
        with self.assertRaisesRegex(measuring.OverLimit, "over 1 s"):
            measuring.run(["sh", "-c", "while true; do :; done"], cpu_seconds=1)


class RoundsTest(unittest.TestCase):
    def setUp(self):
        self.log = pathlib.Path(self.enterContext(tempfile.NamedTemporaryFile()).name)

    def rounds(self, *shells, cpu_seconds=None):
        contenders = [figures.Contender(name, False, [programs.Command(("sh", "-c", shell), "how many")]) for name, shell in shells]
        figure = figures.Figure("f", "a figure", contenders, [figures.Measure("m", "m", "", lambda turn: turn[0].printed["differences"])])
        return rounds.Rounds([figure], cpu_seconds, lambda text: None)

    def saying(self, name, number):
        return name, f"""echo {name} >> {self.log}; echo '{{"differences": {number}}}'"""

    def test_each_round_starts_with_another_contender(self):
        run = self.rounds(self.saying("a", 1), self.saying("b", 1))
        run.check()
        run.run(3)
        self.assertEqual(["a b", "a b", "b a", "a b"], [" ".join(pair) for pair in zip(*[iter(self.log.read_text().split())] * 2)])

    def test_an_interrupted_run_has_the_numbers_of_its_complete_rounds(self):
        run = self.rounds(self.saying("a", 1), self.saying("b", 1))
        said = []

        def interrupt_in_the_middle_of_the_second(text):
            said.append(text)
            if len(said) == 4:
                raise KeyboardInterrupt

        run.say = interrupt_in_the_middle_of_the_second
        with self.assertRaises(KeyboardInterrupt):
            run.run(3)
        self.assertEqual(["round 2 of 3, f: b", "round 2 of 3, f: a"], said[2:])
        self.assertEqual((1, {("f", "a", "m"): [1], ("f", "b", "m"): [1]}), (run.complete, run.samples))

    def test_different_answers_are_named(self):
        with self.assertRaisesRegex(rounds.Disagreement, r"differences between how many: a \(f\) 1, c \(f\) 2"):
            self.rounds(self.saying("a", 1), self.saying("b", 1), self.saying("c", 2)).check()

    def test_a_contender_over_the_limit_takes_no_further_part(self):
        run = self.rounds(("slow", f"echo slow >> {self.log}; while true; do :; done"), self.saying("a", 1), cpu_seconds=1)
        run.check()
        run.run(2)
        self.assertEqual({("f", "slow"): "over 1 s"}, run.over)
        self.assertEqual(["slow", "a", "a", "a"], self.log.read_text().split())
        self.assertEqual((1, 1), run.best_and_median(run.figures[0], run.figures[0].contenders[1], run.figures[0].measures[0]))
        self.assertIsNone(run.best_and_median(run.figures[0], run.figures[0].contenders[0], run.figures[0].measures[0]))


class ResultsTest(unittest.TestCase):
    SIZES = {"instances": 1000}

    def run_with(self, label, key, now, sizes=None):
        numbers = {"flat": [2.0, 2.5], "before": [3.5, 4.0], "now": now}
        figure = {"title": key, "measures": {"cpu": {"title": "CPU", "unit": "s", "numbers": numbers}}, "over": {}}
        return {"date": "2026-01-02", "label": label, "commit": "c0", "rounds": 5, "sizes": sizes or self.SIZES, "figures": {key: figure}}

    def results_with(self, *runs):
        recorded = results.Results(self.enterContext(tempfile.TemporaryDirectory()), "machine")
        for run in runs:
            recorded.add(run)
        return recorded

    def test_the_last_run_is_of_the_same_figure_and_sizes(self):
        recorded = self.results_with(self.run_with("one", "load", [1, 2]), self.run_with("two", "load", [3, 4], {"instances": 5}),
                                     self.run_with("three", "report", [5, 6]))
        self.assertEqual("one", recorded.last("load", self.SIZES)["label"])
        self.assertIsNone(recorded.last("load", {"instances": 7}))

    def test_the_page_has_a_row_for_each_move_and_the_ratios(self):
        recorded = self.results_with(self.run_with("one", "load", [1.0, 2.0]), self.run_with("two", "load", [0.5, 1.0]))
        page = recorded.path.with_suffix(".md").read_text(encoding="utf-8")
        self.assertIn("| run | load: CPU (s) |\n| --- | ---: |\n"
                      "| 2026-01-02: one | 2.00 (0.50 x before, 0.80 x flat) |\n"
                      "| 2026-01-02: two | 1.00 (0.25 x before, 0.40 x flat) |\n", page)
        self.assertIn("| load: CPU (s) | flat | 2.00 | 2.50 |  |\n", page)
        self.assertIn("| load: CPU (s) | before | 3.50 | 4.00 | 1.60 x flat |\n", page)

    def test_recorded_runs_are_read_again(self):
        recorded = self.results_with(self.run_with("one", "load", [1, 2]))
        self.assertEqual(recorded.runs, results.Results(recorded.path.parent, "machine").runs)


if __name__ == "__main__":
    unittest.main(argv=[sys.argv[0], *sys.argv[3:]])
