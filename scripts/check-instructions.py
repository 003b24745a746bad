#!/usr/bin/env python3
"""Counts the instructions of fixed work and fails when a count is more than a tenth above the one in
bench/instructions.json. Where times can't tell, on a busy machine, counts do: they are the same in each
run of the same build.

usage: check-instructions.py [--update] [BUILD]    BUILD is build/gcc-release by default
"""

import argparse
import json
import os
import re
import subprocess
import sys
import tempfile
from pathlib import Path

HOME = Path(__file__).resolve().parent.parent
FIGURES = HOME / "bench" / "instructions.json"
ROOM = 1.10
WORK = ["FixedWalk", "FixedRequest", "FixedQuestions", "FixedOrder", "FixedLadder"]
# The C library chooses its routines by the processor; without these, it takes the same ones everywhere.
SAME_ROUTINES = "glibc.cpu.hwcaps=-AVX2,-AVX,-AVX2_Usable,-AVX_Usable,-ERMS,-SSSE3,-SSE4_1,-SSE4_2"


def count(program, function, directory):
    environment = dict(os.environ, KEL_BENCH_DIRECTORY=directory, GLIBC_TUNABLES=SAME_ROUTINES)
    subprocess.run([program], check=True, env=environment)  # makes the repository
    result = subprocess.run(
        ["valgrind", "--tool=callgrind", f"--callgrind-out-file={directory}/callgrind.out",
         f"--toggle-collect={function}*", program],
        env=environment, capture_output=True, text=True)
    collected = re.search(r"Collected : (\d+)", result.stderr)
    if result.returncode != 0 or collected is None or int(collected[1]) == 0:
        sys.exit(f"{function} could not be counted:\n{result.stderr}")
    return int(collected[1])


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    parser.add_argument("--update", action="store_true", help="write the counts down")
    parser.add_argument("build", nargs="?", default=HOME / "build" / "gcc-release", type=Path)
    arguments = parser.parse_args()

    subprocess.run(["cmake", "--build", arguments.build, "--target", "kel_fixed_work"],
                   check=True, stdout=subprocess.DEVNULL)
    with tempfile.TemporaryDirectory() as directory:
        counts = {function: count(arguments.build / "bin" / "kel_fixed_work", function, directory)
                  for function in WORK}
    if arguments.update:
        FIGURES.write_text(json.dumps(counts, indent=2) + "\n")
    slower = False
    for function, figure in json.loads(FIGURES.read_text()).items():
        ratio = counts[function] / figure
        slower = slower or ratio > ROOM
        print(f"{function}: {counts[function]} instructions, {ratio:.3f} of the figure")
    if slower:
        sys.exit(f"More than {ROOM} of a figure in {FIGURES.relative_to(HOME)}: make it faster, or, if that is "
                 "what it takes, say why and run check-instructions.py --update")


if __name__ == "__main__":
    main()
