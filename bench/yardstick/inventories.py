"""Generated inventories, written when a figure first asks for them."""
import dataclasses
import pathlib
import subprocess

import measuring

RULES = '<DifftoolSpec><class name="&lt;root&gt;" default="include"/></DifftoolSpec>\n'


@dataclasses.dataclass(frozen=True)
class Sizes:
    instances: int = 100_000
    classes: int = 200
    further: int = 7     # inventories beside the reference, for the growth with their number
    many: int = 1_000    # inventories with one instance of each class
    few: int = 3_000     # instances, for counting instructions
    times: int = 10      # how much larger the largest inventories are
    changed: int = 273   # values that change, per mille, in the inventories with many differences: 300,000 of 1,100,000


QUICK = Sizes(instances=300, classes=10, further=3, many=5, few=50, times=2)


class Inventories:
    def __init__(self, generator, folder, sizes):
        self.generator = generator
        self.folder = pathlib.Path(folder)
        self.sizes = sizes
        self.rules = self.folder / "rules.xml"
        self.rules.write_text(RULES, encoding="utf-8")

    def in_key_order(self, count=2):
        return [self._file("key", self.sizes.instances, state) for state in range(count)]

    def shuffled(self):
        return [self._file("shuffled", self.sizes.instances, state, "--shuffled", str(state + 7)) for state in range(2)]

    def much_changed(self):
        return [self._file("changed", self.sizes.instances, state, "--changed", str(self.sizes.changed)) for state in range(2)]

    def few(self):
        return [self._file("few", self.sizes.few, state) for state in range(2)]

    def large(self):
        return [self._file("large", self.sizes.instances * self.sizes.times, state) for state in range(2)]

    def many(self):
        return [self._file("many", self.sizes.classes, state) for state in range(self.sizes.many)]

    def _file(self, name, instances, state, *options):
        path = self.folder / f"{name}-{state}.xml"
        if not path.exists():
            command = [self.generator, str(instances), str(state), "--classes", str(self.sizes.classes), *options]
            try:
                with open(path, "wb") as file:
                    subprocess.run(command, stdout=file, check=True)
            except (OSError, subprocess.CalledProcessError) as fault:
                raise measuring.ProgramFailure(f"{path} could not be made: {fault}") from fault
        return str(path)
