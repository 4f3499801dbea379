"""Shows how time and memory of cimdelta grow.

Each case writes inventories and rules of size n, 2n and 4n and runs one command on each. The exponents are the slopes from n to 2n
and from 2n to 4n: 1 is proportional, 2 quadratic. Times and peaks are those of 4n, without what starting the program takes: the
least CPU time of all rounds.

    python3 bench/growth [--cimdelta PROGRAM] [--rounds N] [CASE ...]

Without CASE all run, which takes some minutes; --list shows them.
"""
import argparse
import concurrent.futures
import math
import os
import subprocess
import sys
import tempfile

from cases import CASES


def run(program, arguments, folder):
    """CPU seconds and peak memory in MB."""
    with tempfile.TemporaryFile() as err:
        process = subprocess.Popen([program, *arguments], cwd=folder, stdout=subprocess.DEVNULL, stderr=err)
        _, status, usage = os.wait4(process.pid, 0)
        process.returncode = os.waitstatus_to_exitcode(status)
        if process.returncode not in (0, 1):
            err.seek(max(0, err.seek(0, os.SEEK_END) - 500))
            sys.exit(f'{" ".join(arguments[:6])} ... ended with {process.returncode}: {err.read().decode(errors="replace")}')
    return usage.ru_utime + usage.ru_stime, usage.ru_maxrss / 1024


def write(name, size, folder):
    """Writes the files of a case and returns the arguments of its command."""
    make, _, arguments = CASES[name]
    files, arguments = make(size, arguments)
    for file_name, content in files.items():
        with open(os.path.join(folder, file_name), 'w') as file:
            file.write(content)
    return arguments


def write_apart(name, size, folder):
    """The same in a process of its own, because the peak of a program includes that of the process that started it."""
    with concurrent.futures.ProcessPoolExecutor(1) as writer:
        return writer.submit(write, name, size, folder).result()


def exponent(smaller, larger):
    """Empty if the numbers are too small to mean anything."""
    return f'{math.log2(larger / smaller):.1f}' if smaller > 0 and larger > 0 else ''


def measure(name, size, options, idle):
    times, peaks = [], []
    for factor in (1, 2, 4):
        with tempfile.TemporaryDirectory() as folder:
            arguments = write_apart(name, size * factor, folder)
            samples = [run(options.cimdelta, arguments, folder) for _ in range(options.rounds)]
        times.append(min(sample[0] for sample in samples) - idle[0])
        peaks.append(min(sample[1] for sample in samples) - idle[1])
    print(f'| {name} | {size * 4:,} | {times[2]:.2f} s | {exponent(*times[:2])} | {exponent(*times[1:])} | {peaks[2]:.0f} MB | '
          f'{exponent(*peaks[1:])} |', flush=True)


def main():
    parser = argparse.ArgumentParser(prog='bench/growth', description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument('--cimdelta', default='build/release/bin/cimdelta')
    parser.add_argument('--rounds', type=int, default=3)
    parser.add_argument('--quick', action='store_true', help='tiny sizes, to see that everything works; the numbers mean nothing')
    parser.add_argument('--list', action='store_true')
    parser.add_argument('cases', nargs='*', metavar='CASE')
    options = parser.parse_args()
    if options.list:
        print('\n'.join(CASES))
        return
    unknown = [name for name in options.cases if name not in CASES]
    if unknown:
        sys.exit(f'no case {unknown[0]}; --list shows them')
    options.cimdelta = os.path.abspath(options.cimdelta)
    if options.quick:
        options.rounds = 1
    idle = min(run(options.cimdelta, ['--version'], '.') for _ in range(5))
    print('| what grows | to | time | exponents | | memory | exponent |\n| --- | ---: | ---: | ---: | ---: | ---: | ---: |')
    for name in options.cases or CASES:
        measure(name, 2 if options.quick else CASES[name][1], options, idle)


if __name__ == '__main__':
    main()
