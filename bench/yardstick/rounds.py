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
        self.samples = {}     # (figure, contender, measure) -> numbers, one for each complete round
        self.complete = 0     # rounds

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
        """Adds the samples of each round when it is complete, so an interrupted run has those of the rounds before."""
        for number in range(count):
            for key, sample in self._round(number, f"round {number + 1} of {count}"):
                self.samples.setdefault(key, []).append(sample)
            self.complete += 1

    def _round(self, number, name):
        """Each round starts with another contender, because the first of a series often has an advantage."""
        found = []
        for figure in (figure for figure in self.figures if number == 0 or not figure.once):
            first = number % len(figure.contenders)
            for contender in [*figure.contenders[first:], *figure.contenders[:first]]:
                self.say(f"{name}, {figure.key}: {contender.name}")
                found.extend(_numbers(figure, contender, self._turn(figure, contender)))
        return found

    def best_and_median(self, figure, contender, measure):
        """Two numbers, or None if there are no samples."""
        samples = self.samples.get((figure.key, contender.name, measure.key))
        return (min(samples), statistics.median(samples)) if samples else None

    def _turn(self, figure, contender):
        """The samples of the contender's commands. None if one of them took too long, now or before."""
        if (figure.key, contender.name) in self.over:
            return None
        try:
            return [measuring.run(command.arguments, command.statuses, self.cpu_seconds) for command in contender.commands]
        except measuring.OverLimit as reason:
            self.over[figure.key, contender.name] = str(reason)
            return None


def _numbers(figure, contender, turn):
    """Keys and numbers of what was measured in a turn."""
    for measure in figure.measures:
        number = None if turn is None or (measure.builds_only and contender.is_peer) else measure.of(turn)
        if number is not None:
            yield (figure.key, contender.name, measure.key), number
