#!/usr/bin/env python3
"""Lets calls to the system fail below the command: whoever gets status 0 has the answer of an
undisturbed run, or a message that such a run does not have.

usage: failing_calls_test.py KEL PRELOAD     the built command, and the library of FailingCalls.cpp

Each call fails alone, and some of them together. Prints each breach with the calls that failed, and
exits with 1 if there was any.
"""

import collections
import errno
import json
import os
import random
import subprocess
import sys
import tempfile
import time
from pathlib import Path

SECONDS = 20
TOGETHER = 10  # runs of each question with several calls that fail
ERRORS = [errno.EIO, errno.EACCES]

VHDL = "OPTION HDL = VHDL\n"
# What each check of the last three repositories finds is no error.
FILES = {
    "main/words_v1_00_a/data/words_v2_1_0.qvr": VHDL,
    "main/words_v1_00_a/data/words_v2_1_0.ldx": "lib words_v1_00_a words_pack\n",
    "main/words_v1_01_a/data/words_v2_1_0.qvr": VHDL,
    "overlay/words_v1_01_a/data/words_v2_1_0.qvr": "OPTION DESC = Seen\n" + VHDL,
    "overlay/words_v1_01_a/data/words_v2_1_0.ldx": "lib words words_pack\n",
    "main/fifo_v1_00_a/data/fifo_v2_1_0.qvr": "OPTION HDL = Verilog\n",
    "main/fifo_v1_00_a/data/fifo_v2_1_0.ldx":
        "vlgincdir fifo hdl/verilog/include\nlib fifo fifo.v\n",
    "main/top_v1_00_a/data/top_v2_1_0.qvr":
        "OPTION HDL = MIXED\nOPTION STYLE = MIX\nBUS_INTERFACE BUS = B, BUS_TYPE = RECEIVER\n"
        'PARAMETER WIDTH = 8\nPORT clk = "", DIR = I, BUS = B\n',
    "main/top_v1_00_a/data/top_v2_1_0.ldx":
        "lib words all\nlib fifo_v1_00_a all\nlib top top.vhd\n"
        "simlib top x/../bench.vhd\nvlgincdir top hdl/verilog/../include\nlib top part.v Verilog\n",
    "main/top_v1_00_a/data/top_v2_1_0.tew":
        "WIDTH FILES\n8 top_8.edif\n16 top_16.edif, fifo_v1_00_a:fifo.edif\n",
    "no_key/one/data/one_v2_1_0.qvr": VHDL,
    **{f"{name}/one_v1_00_a/data/one_v2_1_0.{extension}": text
       for name in ["no_key", "unlisted"]
       for extension, text in [("qvr", VHDL), ("ldx", "lib one one.vhd\n")]},
    **{f"conflict/{core}/data/{core[0]}_v2_1_0.qvr": VHDL
       for core in ["a_v1_00_a", "b_v1_00_a", "c_v1_00_a", "d_v1_00_a", "d_v2_00_a"]},
    "conflict/a_v1_00_a/data/a_v2_1_0.ldx": "lib b_v1_00_a all\nlib c_v1_00_a all\n",
    "conflict/b_v1_00_a/data/b_v2_1_0.ldx": "lib d_v1_00_a all\n",
    "conflict/c_v1_00_a/data/c_v2_1_0.ldx": "lib d_v2_00_a all\n",
    "conflict/d_v1_00_a/data/d_v2_1_0.ldx": "lib d d.vhd\n",
    "conflict/d_v2_00_a/data/d_v2_1_0.ldx": "lib d d.vhd\n",
    **dict.fromkeys(["overlay/words_v1_01_a/hdl/vhdl/words_pack.vhd",
                     "main/words_v1_00_a/hdl/vhdl/words_pack.vhd",
                     *(f"main/fifo_v1_00_a/hdl/verilog/{name}"
                       for name in ["fifo.v", "include/a.vh", "include/b.vh"]),
                     *(f"main/top_v1_00_a/{name}"
                       for name in ["hdl/vhdl/top.vhd", "hdl/vhdl/bench.vhd", "hdl/vhdl/x/more.txt",
                                    "hdl/verilog/part.v", "hdl/include/top.vh",
                                    "netlist/top_8.edif", "netlist/top_16.edif"]),
                     "main/fifo_v1_00_a/netlist/fifo.edif",
                     "no_key/one_v1_00_a/hdl/vhdl/one.vhd", "unlisted/one_v1_00_a/hdl/vhdl/one.vhd",
                     "unlisted/one_v1_00_a/hdl/vhdl/deep/two.vhd",
                     "conflict/d_v1_00_a/hdl/vhdl/d.vhd", "conflict/d_v2_00_a/hdl/vhdl/d.vhd"], "")}

BOTH = "overlay;main"
ASKED = [(BOTH, words) for words in [
    "list", "list --all", "which top words fifo_v1_00_a", "show top", "show words", "netlists top",
    "netlists top --set WIDTH=16", "netlists top --table", "check", "check t*", "check [ft]*"]]
ASKED += [(name, "check") for name in ["no_key", "unlisted", "conflict"]]
ASKED += [("conflict", "check a*")]
SOURCES = [(BOTH, f"sources {core} --for {purpose}")
           for core in ["top", "fifo"] for purpose in ["synthesis", "simulation"]]
QUESTIONS = [(name, words + end) for name, words in ASKED + SOURCES for end in ["", " --json"]]
QUESTIONS += [(name, f"{words} --format {form}") for name, words in SOURCES
              for form in ["f", "ghdl", "edam", "vhdl_ls", "tcl"]]
QUESTIONS += [("unlisted", "check --format sarif"), ("conflict", "check --excerpts")]
IS_JSON = ("--json", "edam", "sarif")

Answer = collections.namedtuple("Answer", "status output messages calls")


def ask(root, question, failing=(), error=0):
    log = root / "log"
    log.write_text("")
    libraries = ";".join(str(root / "below" / name) for name in question[0].split(";"))
    done = subprocess.run(
        [sys.argv[1], "-L", libraries, *question[1].split()], capture_output=True, timeout=60,
        env={**os.environ, "LD_PRELOAD": sys.argv[2], "FAILING_BELOW": str(root / "below"),
             "FAILING_CALLS": " ".join(map(str, failing)), "FAILING_ERROR": str(error),
             "FAILING_LOG": str(log)})
    return Answer(done.returncode, done.stdout, done.stderr, log.read_text().splitlines())


def fault(question, answer, good):
    """What breaks the law, or nothing."""
    if answer.status not in (0, 1, 3):
        return f"the status is {answer.status}"
    try:
        if question[1].endswith(IS_JSON) and answer.output:
            json.loads(answer.output)
    except ValueError:
        return "standard output is no JSON"
    silent = answer.messages in (b"", good.messages)
    if answer.status == 0 and answer.output != good.output and silent:
        return "status 0 comes with another answer, and no message tells it"
    return None


def trials(root, chance):
    """Each question, the answer of an undisturbed run, and calls that are to fail with an error."""
    rows = []
    for question in QUESTIONS:
        good = ask(root, question)
        numbers = range(1, len(good.calls) + 1)
        sets = [[number] for number in numbers]
        sets += [chance.sample(numbers, chance.randint(2, 9)) for _ in range(TOGETHER)]
        rows += [(question, good, failing, chance.choice(ERRORS)) for failing in sets]
    chance.shuffle(rows)
    return rows


def check(root):
    rows = trials(root, random.Random(1))
    end = time.monotonic() + SECONDS
    runs = breaches = 0
    for question, good, failing, error in rows:
        if time.monotonic() > end:
            break
        answer = ask(root, question, failing, error)
        runs += 1
        if what := fault(question, answer, good):
            breaches += 1
            failed = [answer.calls[n - 1] for n in sorted(failing) if n <= len(answer.calls)]
            print(f"-L {question[0]} {question[1]}: {what}, as these fail with "
                  f"{errno.errorcode[error]}: {', '.join(failed)}".replace(f"{root}/below/", ""))
    print(f"{runs} of {len(rows)} runs of {len(QUESTIONS)} questions, {breaches} breaches")
    return 1 if breaches else 0


def main():
    if not Path(sys.argv[2]).is_file():
        sys.exit(f"{sys.argv[2]} is no library")
    with tempfile.TemporaryDirectory() as name:
        root = Path(name).resolve()
        for file, text in FILES.items():
            repository, rest = file.split("/", 1)
            path = root / "below" / repository / "ipmods" / rest
            path.parent.mkdir(parents=True, exist_ok=True)
            path.write_text(text)
        first = ask(root, (BOTH, "list"))
        if first.status == 0 and first.calls:
            return check(root)
        print(f"skipped, since nothing can be preloaded here: {first.messages.decode()}")
        return 0


if __name__ == "__main__":
    sys.exit(main())
