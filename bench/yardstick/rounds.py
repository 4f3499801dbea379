"""Runs the contenders of the figures in turn, after it has made sure that all of them find the same differences."""
import statistics

import measuring


class Disagreement(Exception):
    """Contenders found different numbers of differences for one question, so their times cannot be compared."""


class Rounds:
    """The samples of a run: of each figure, contender and measure."""

    def __init__(self, figures, cpu_seconds, say):
        self.figures = figures
        self.cpu_seconds = cpu_seconds
        self.say = say
        self.over = {}        # (figure, contender) -> why it takes no part
        self.answers = {}     # question -> {number: who found it}
        self.samples = {}     # (figure, contender, measure) -> numbers

    def check(self):
        """Runs every contender once and throws Disagreement if two answer a question differently. These runs are not counted."""
        for figure in self.figures:
            for contender in figure.contenders:
                self.say(f"checking {figure.key}: {contender.name}")
                for command, sample in zip(contender.commands, self._turn(figure, contender) or ()):
                    if command.question:
                        found = self.answers.setdefault(command.question, {})
                        found.setdefault(command.differences(sample), f"{contender.name} ({figure.key})")
        for question, found in self.answers.items():
            if len(found) > 1:
                answers = ", ".join(f"{who} {number}" for number, who in found.items())
                raise Disagreement(f"differences between {question}: {answers}")

    def run(self, count):
        """Each round starts with another contender, because the first of a series often has an advantage."""
        for number in range(count):
            for figure in self.figures:
                first = number % len(figure.contenders)
                for contender in [*figure.contenders[first:], *figure.contenders[:first]]:
                    self.say(f"round {number + 1} of {count}, {figure.key}: {contender.name}")
                    turn = self._turn(figure, contender)
                    if turn is not None:
                        self._note(figure, contender, turn)

    def best_and_median(self, figure, contender, measure):
        """Two numbers, or None if there are no samples."""
        samples = self.samples.get((figure.key, contender.name, measure.key))
        return (min(samples), statistics.median(samples)) if samples else None

    def _note(self, figure, contender, turn):
        for measure in figure.measures:
            number = None if measure.builds_only and contender.is_peer else measure.of(turn)
            if number is not None:
                self.samples.setdefault((figure.key, contender.name, measure.key), []).append(number)

    def _turn(self, figure, contender):
        """The samples of the contender's commands. None if one of them took too long, now or before."""
        if (figure.key, contender.name) in self.over:
            return None
        try:
            return [measuring.run(command.arguments, command.statuses, self.cpu_seconds) for command in contender.commands]
        except measuring.OverLimit as reason:
            self.over[figure.key, contender.name] = str(reason)
            return None
