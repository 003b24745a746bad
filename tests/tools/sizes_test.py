#!/usr/bin/env python3
"""Gives the command files of unreasonable size: each ends in time, with memory in proportion to its
file, and with a stack as for a small one.

usage: sizes_test.py KEL
"""

import os
import resource
import sys
import tempfile
import time
from pathlib import Path

MIB = 1 << 20
STACK = 256 * 1024
# A chain of includes is left behind the level 1,000, and each level takes 1.5 KiB.
STACK_OF_A_CHAIN = 3 * MIB
SECONDS = 60
FAST = "/dev/shm"
SMALL = 24 * MIB  # what a process may take for any file


class Repository:
    def __init__(self, root):
        self.root = Path(root)
        self.size = 0

    def write(self, core, extension, chunks):
        data = self.root / "ipmods" / f"{core}_v1_00_a" / "data"
        data.mkdir(parents=True, exist_ok=True)
        with open(data / f"{core}_v2_1_0.{extension}", "wb") as file:
            for chunk in chunks:
                file.write(chunk)
                self.size += len(chunk)


def long_line(repository):
    repository.write("core", "qvr", [b"OPTION DESC = ", b"x" * (256 * MIB), b"\nPORT a = b\n"])


def long_bad_line(repository):
    repository.write("core", "qvr", [b"OPTION STYLE ", b"x" * (256 * MIB), b"\n"])


def many_lines(repository):
    repository.write("core", "qvr", [b"PORT\n" * 10_000_000])


def many_brackets(repository):
    million = 1_000_000
    repository.write("core", "qvr", [b"PARAMETER P = ", b"(" * million, b")" * million, b"\n",
                                     b"PARAMETER Q = ", b"[(" * million, b"\n"])


def many_digits(repository):
    repository.write("core", "qvr", [b"OPTION HDL = VHDL\n"])
    repository.write("core", "ldx", [b"lib core_v", b"9" * 1_000_000, b"_00_a all\n"])


def long_chain(repository):
    count = 100_000
    repository.write("core", "qvr", [b"OPTION HDL = VHDL\n"])
    repository.write("core", "ldx", [b"lib core0_v1_00_a all\n"])
    for i in range(count):
        repository.write(f"core{i}", "ldx", [b"lib core%d_v1_00_a all\n" % (i + 1)])


def long_include_list(repository):
    repository.write("core", "qvr", [b"OPTION HDL = VHDL\n"])
    repository.write("core", "ldx", [b"lib other_v1_00_a all\n" * 100_000])
    repository.write("other", "ldx", [b"lib other_v1_00_a a.vhd\n"])


def wide_table(repository):
    names = [b"P%d" % i for i in range(10_000)]
    repository.write("core", "qvr", [b"OPTION STYLE = BLACKBOX\n"] + [b"PARAMETER %s = 1\n" % name for name in names])
    repository.write("core", "tew", [b" ".join(names), b" FILES\n", b"1 " * 10_000, b"a.edif\n"])


VERBS = {"list": ["list"], "sources": ["sources", "core_v1_00_a", "--for", "synthesis"],
         "netlists": ["netlists", "core_v1_00_a"]}

# What is made, what is asked, the status, bytes of memory for each of the file, and the stack.
ROWS = [
    (long_line, "sources", 1, 6, STACK),
    (long_bad_line, "list", 1, 6, STACK),
    (many_lines, "list", 0, 3, STACK),
    (many_brackets, "netlists", 1, 8, STACK),
    (many_digits, "sources", 1, 8, STACK),
    (long_chain, "sources", 1, 60, STACK_OF_A_CHAIN),
    (long_include_list, "sources", 0, 8, STACK),
    (wide_table, "netlists", 0, 60, STACK),
]


def run(words, stack):
    """The exit status, the seconds and the most bytes that the process took."""
    begin = time.monotonic()
    child = os.fork()
    if child == 0:
        null = os.open(os.devnull, os.O_WRONLY)
        os.dup2(null, 1)
        os.dup2(null, 2)
        resource.setrlimit(resource.RLIMIT_STACK, (stack, stack))
        resource.setrlimit(resource.RLIMIT_CPU, (SECONDS, SECONDS))
        os.execv(words[0], words)
    _, status, usage = os.wait4(child, 0)
    return os.waitstatus_to_exitcode(status), time.monotonic() - begin, usage.ru_maxrss * 1024


def check(row, kel):
    make, verb, expected, factor, stack = row
    with tempfile.TemporaryDirectory(dir=FAST if os.path.isdir(FAST) else None) as root:
        repository = Repository(root)
        make(repository)
        words = [kel, "--quiet", "-L", root] + VERBS[verb]
        status, seconds, memory = run(words, stack)
    ratio = max(0, memory - SMALL) / repository.size
    good = status == expected and ratio <= factor
    print(f"{'ok  ' if good else 'FAIL'} {make.__name__}: status {status}, {seconds:.1f} s, "
          f"{memory // MIB} MiB for {repository.size // MIB} MiB of files, ratio {ratio:.1f} of {factor}", flush=True)
    return good


def main():
    results = [check(row, sys.argv[1]) for row in ROWS]
    sys.exit(0 if all(results) else 1)


if __name__ == "__main__":
    main()
