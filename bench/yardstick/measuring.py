"""Runs a program and says what it took."""
import dataclasses
import json
import os
import re
import resource
import signal
import subprocess
import tempfile
import time


class ProgramFailure(Exception):
    """A program could not be started, or ended with a status that it should not."""


class OverLimit(Exception):
    """A program took more CPU time than it may."""


@dataclasses.dataclass(frozen=True)
class Sample:
    cpu: float      # seconds, user and system
    wall: float     # seconds
    peak: int       # bytes of resident memory
    printed: dict   # the line of JSON on standard output; empty if there is none
    instructions: int = 0   # under callgrind


def run(arguments, statuses=(0,), cpu_seconds=None):
    """Runs the program and returns its Sample. A program inherits this process's peak, which is therefore kept small."""
    with tempfile.TemporaryFile() as out, tempfile.TemporaryFile() as err:
        start = time.monotonic()
        try:
            process = subprocess.Popen(arguments, stdin=subprocess.DEVNULL, stdout=out, stderr=err)
        except OSError as error:
            raise ProgramFailure(f"{arguments[0]}: {error.strerror}") from error
        if cpu_seconds is not None:
            resource.prlimit(process.pid, resource.RLIMIT_CPU, (cpu_seconds, cpu_seconds + 1))
        try:
            _, status, usage = os.wait4(process.pid, 0)
        except KeyboardInterrupt:
            process.kill()
            process.wait()
            raise
        wall = time.monotonic() - start
        process.returncode = os.waitstatus_to_exitcode(status)
        if process.returncode == -signal.SIGXCPU:
            raise OverLimit(f"over {cpu_seconds} s")
        if process.returncode not in statuses:
            raise ProgramFailure(f"{' '.join(arguments[:6])} ... ended with {process.returncode}: {_end_of(err)}")
        return Sample(usage.ru_utime + usage.ru_stime, wall, usage.ru_maxrss * 1024, _printed(out), _instructions(err))


def _printed(file):
    file.seek(0)
    line = file.read(4096)
    return json.loads(line) if line.startswith(b"{") else {}


def _instructions(file):
    found = re.search(r"^==\d+== Collected : (\d+)", _end_of(file), re.MULTILINE)
    return int(found[1]) if found else 0


def _end_of(file):
    file.seek(max(0, file.seek(0, os.SEEK_END) - 500))
    return file.read().decode(errors="replace").strip()
