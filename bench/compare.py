#!/usr/bin/env python3
"""Runs what performance.md states, side by side, and prints medians and ratios.

usage: compare.py BIN JSON [RUNS]

BIN holds the built programs; all samples go to the file JSON. The two sides of a comparison take
turns, and each round begins with the side that ended the one before, so that a machine that
slows down slows down both. A ratio is the median of the ratios of the rounds.
"""

import json
import os
import re
import shlex
import statistics
import subprocess
import sys
import time
from pathlib import Path


class Measured:
    """A benchmark by its program and name; `per` divides its time, to compare what each of many costs."""

    def __init__(self, program, name, per=1):
        self.program, self.name, self.per = program, name, per

    def __str__(self):
        return self.name

    def run(self, programs):
        output = subprocess.run(
            [programs / f"kel_{self.program}_bench", f"--benchmark_filter=^{re.escape(self.name)}(/|$)",
             "--benchmark_format=json", "--benchmark_min_time=0.2"],
            check=True, capture_output=True, text=True).stdout
        return json.loads(output)["benchmarks"][0]

    def milliseconds(self, programs):
        result = self.run(programs)
        return result["real_time"] * {"ns": 1e-6, "us": 1e-3, "ms": 1}[result["time_unit"]] / self.per


def in_directory(text):
    """A word or path with the directory of the repositories for DIR."""
    return text.replace("DIR", os.environ["KEL_BENCH_DIRECTORY"])


def call_of(tool, programs):
    """The words that call a tool: kel is the one that was built, and KEL_BENCH_TOOL may tell those of another."""
    return [programs / "kel"] if tool == "kel" else shlex.split(os.environ.get(f"KEL_BENCH_{tool.upper()}", tool))


class Command:
    """A whole command, start included; DIR stands for the directory of the repositories."""

    def __init__(self, *words):
        self.words = words

    def __str__(self):
        return " ".join(self.words)

    def run(self, programs, **where):
        words = call_of(self.words[0], programs) + [in_directory(word) for word in self.words[1:]]
        return subprocess.run(words, text=True, **where)

    def milliseconds(self, programs):
        begin = time.perf_counter()
        self.run(programs, check=True, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        return (time.perf_counter() - begin) * 1000


class OnSlowDisk(Command):
    """The same where each look at a path takes half a millisecond longer, as over a network."""

    def __str__(self):
        return super().__str__() + ", slow disk"

    def run(self, programs, **where):
        preload = programs.parent / "lib" / "libkel_failing_calls.so"
        slow = {"LD_PRELOAD": str(preload), "FAILING_DELAY": "500", "FAILING_BELOW": in_directory("DIR")}
        return super().run(programs, env={**os.environ, **slow}, **where)


def walk(versions, per=1):
    return Measured("library", f"Walk/{versions}", per)


def read(versions, per=1):
    return Measured("library", f"ReadPlainly/{versions}", per)


def description(name, ports):
    return Measured("description", f"{name}/{ports}")


def netlists(name, size):
    return Measured("netlist", f"{name}/{size}")


def order(name, cores, per=1):
    return Measured("order", f"{name}/{cores}", per)


def kel_list(versions, command=Command):
    return command("kel", "-L", f"DIR/described-{versions}", "list")


def grep(versions, command=Command):
    return command("grep", "-rh", "^OPTION", f"DIR/described-{versions}")


# What is compared with what, and the most that the ratio may be, if there is such a limit.
COMPARISONS = [
    (walk(10000), read(10000), 2.5),
    (walk(10000), grep(10000), 1),
    (walk(50000, 50000), walk(1000, 1000), 1.2),
    (read(50000, 50000), read(1000, 1000), None),
    (description("Open", 7142), description("CutLines", 7142), 3),
    (description("AskEverything", 100), description("Open", 100), None),
    (description("AskEverything", 1000), description("Open", 1000), None),
    (description("AskEverything", 5000), description("Open", 5000), 4),
    (description("AskMembers", 2000), description("OpenInterfaces", 2000), 1),
    (netlists("AskColumns", 10000), netlists("OpenColumns", 10000), 1),
    (netlists("AskNetlists", 5000), netlists("OpenNetlists", 5000), 1),
    (order("AnalyseTree", 2000), order("ScanTree", 2000), 4),
    (order("AnalyseTree", 8000, 80000), order("AnalyseTree", 500, 5000), 1.15),
    (order("ScanTree", 8000, 80000), order("ScanTree", 500, 5000), None),
    (order("AnalyseLadder", 25), order("AnalyseChain", 50), 3),
    (order("AnalyseChain", 1000), order("AnalyseChain", 500), 2.2),
    (Measured("check", "CheckLibrary"), Measured("check", "OpenAndList"), 3),
    (Measured("library", "Add/newest_last/5000"), Measured("library", "Add/many_cores/5000"), 3),
    (kel_list(1000), Command("ls", "-R", "DIR/described-1000"), None),
    (kel_list(1000, OnSlowDisk), grep(1000, OnSlowDisk), None),
    (kel_list(10000, OnSlowDisk), grep(10000, OnSlowDisk), None),
]


def sample(sides, programs, runs):
    """The times of both sides, a pair for each round."""
    for side in sides:
        side.milliseconds(programs)  # makes what is missing and warms the caches
    rounds = []
    for number in range(runs):
        turn = sides if number % 2 == 0 else sides[::-1]
        times = {side: side.milliseconds(programs) for side in turn}
        rounds.append([times[side] for side in sides])
    return rounds


def compare(row, programs, runs):
    one, other, limit = row
    rounds = sample([one, other], programs, runs)
    ratios = [first / second for first, second in rounds]
    return {"what": str(one), "beside": str(other), "at most": limit, "rounds": rounds,
            "medians": [statistics.median(times) for times in zip(*rounds)],
            "ratio": statistics.median(ratios), "ratios from": min(ratios), "to": max(ratios)}


def report(row):
    limit = "" if row["at most"] is None else f"{row['at most']:g}"
    over = " (over)" if limit and row["ratio"] > row["at most"] else ""
    first, second = row["medians"]
    print(f"| {row['what']} | {row['beside']} | {first:.4g} | {second:.4g} | "
          f"{row['ratio']:.2f}{over} | {row['ratios from']:.2f} to {row['to']:.2f} | {limit} |", flush=True)


def measure_memory(programs):
    result = Measured("library", "Memory/50000").run(programs)
    return {key: result[key] for key in ("KiB/version", "MiB above the end")}


def compare_all(comparisons, programs, runs):
    """Prints the table, each row as soon as it is measured, and gives the rows with their samples."""
    print(f"Medians of {runs} rounds, in milliseconds.\n")
    print("| what | beside | median | median | ratio | rounds | at most |")
    print("|---|---|---:|---:|---:|---|---:|")
    rows = []
    for row in comparisons:
        rows.append(compare(row, programs, runs))
        report(rows[-1])
    return rows


def main():
    programs, target = Path(sys.argv[1]).resolve(), Path(sys.argv[2])
    runs = int(sys.argv[3]) if len(sys.argv) > 3 else 9
    rows = compare_all(COMPARISONS, programs, runs)
    memory = measure_memory(programs)
    print(f"\nMemory of an index of 50,000 versions: {memory['KiB/version']:.2f} KiB a version; the most "
          f"during the walk was {memory['MiB above the end']:.1f} MiB above that at its end.")
    target.write_text(json.dumps({"comparisons": rows, "memory": memory}, indent=1) + "\n")


if __name__ == "__main__":
    main()
