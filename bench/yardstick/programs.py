"""The programs that take part: builds of cimdelta with their bench_steps, and the peers."""
import dataclasses
import pathlib
import subprocess

import counting
import measuring

DIFFERENCES = 1  # the exit status of cimdelta if there are some
NOT_BUILT = 3    # the exit status of peer_database without the database


@dataclasses.dataclass(frozen=True)
class Command:
    """One program to run. Commands with the same question must find the same number of differences."""
    arguments: tuple
    question: str = ""
    format: str = ""    # of the report; empty if the program prints the number
    output: str = ""
    statuses: tuple = (0,)

    def counted(self):
        """The same, with its instructions counted."""
        return dataclasses.replace(self, arguments=("valgrind", "--tool=callgrind", "--callgrind-out-file=/dev/null", *self.arguments))

    def differences(self, sample):
        """The number of differences that the last run found."""
        if self.format:
            return counting.BY_FORMAT[self.format](self.output)
        return sample.printed["differences"]


@dataclasses.dataclass(frozen=True)
class Build:
    """A build of cimdelta: the folder of its programs."""
    name: str
    folder: pathlib.Path

    def check(self):
        for program in ("cimdelta", "bench_steps"):
            if not (self.folder / program).is_file():
                raise measuring.ProgramFailure(f"{self.folder} has no {program}; bench/README.md says how to make it")

    def report(self, files, output, form="ndjson"):
        output = f"{output}-{pathlib.Path(files[0]).stem}.{self.name}.{form}"
        arguments = (self.folder / "cimdelta", "compare", "-o", form, *self._detail(form), "--output", output, *files)
        return Command(_texts(arguments), _question(files), form, output, (DIFFERENCES,))

    def _detail(self, form):
        """The option that makes a text show every difference, as other formats do. Earlier builds have no other text."""
        if form != "text":
            return ()
        told = subprocess.run([self.folder / "cimdelta", "help", "compare"], stdout=subprocess.PIPE, text=True, check=True).stdout
        return ("--detail",) if "--detail" in told else ()

    def compare(self, files, rules):
        return Command(_texts((self.folder / "bench_steps", "--spec", rules, *files)), _question(files))

    def load(self, files):
        return Command(_texts((self.folder / "bench_steps", *files)))


@dataclasses.dataclass(frozen=True)
class FlatPeer:
    """Expat and tables of text."""
    folder: pathlib.Path
    name: str = "flat"

    def report(self, files, output):
        return Command(_texts((self.folder / "peer_flat", "--output", f"{output}.{self.name}", *files)), _question(files))

    def load(self, files):
        return Command(_texts((self.folder / "peer_flat", *files)))


@dataclasses.dataclass(frozen=True)
class DatabasePeer:
    folder: pathlib.Path
    name: str

    def is_built(self):
        program = self.folder / "peer_database"
        if not program.is_file():
            return False
        return measuring.run(_texts((program, self.name)), (0, NOT_BUILT)).printed != {}

    def compare(self, files):
        return Command(_texts((self.folder / "peer_database", self.name, *files)), _question(files))


def _texts(arguments):
    return tuple(str(argument) for argument in arguments)


def _question(files):
    return f"{pathlib.Path(files[0]).stem} and {len(files) - 1} more like {pathlib.Path(files[-1]).stem}"
