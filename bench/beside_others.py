#!/usr/bin/env python3
"""Runs kel beside other tools with the same cores, and prints medians and ratios as compare.py does.

usage: beside_others.py BIN [ROUNDS]

BIN holds the built kel. Each tool gets a library of its own format with the same cores: five parameters and
ten sources each, of which the first ones make a tree where each core needs up to two others. Before anything
is measured, both sides of each row must give the same cores or sources, in any order. A tool is taken from
the path, or called as KEL_BENCH_FUSESOC or KEL_BENCH_FLGEN says; one that is not there is left out.
"""

import os
import re
import shutil
import sys
import tempfile
from pathlib import Path
from typing import NamedTuple

from compare import Command, call_of, compare_all, in_directory

PARAMETERS = [f"WIDTH_{i}" for i in range(5)]


class Core:
    """A core by its number; only the first `tree` cores need others."""

    def __init__(self, number, tree):
        self.name = f"core{number}"
        self.sources = [f"{self.name}_source{i}.v" for i in range(10)]
        self.needs = [f"core{i}" for i in (2 * number + 1, 2 * number + 2) if i < tree]

    def write_sources(self, directory):
        """Each has a text of its own, since some tools leave out files that are equal."""
        directory.mkdir(parents=True)
        for source in self.sources:
            (directory / source).write_text(f"// {source}\n")


def write_for_kel(library, core):
    version = library / "ipmods" / f"{core.name}_v1_00_a"
    core.write_sources(version / "hdl/verilog")
    lines = ["OPTION DESC = Generated core", "OPTION HDL = Verilog"]
    lines += [f'PARAMETER {name} = 8, DT = integer, DESC = "Width"' for name in PARAMETERS]
    order = [f"lib {need}_v1_00_a all" for need in core.needs]
    order += [f"lib {core.name}_v1_00_a {source}" for source in core.sources]
    (version / "data").mkdir()
    for extension, text in ("qvr", lines), ("ldx", order):
        (version / f"data/{core.name}_v2_1_0.{extension}").write_text("\n".join(text) + "\n")


def write_for_fusesoc(library, core):
    core.write_sources(library / core.name)
    needs = ", ".join(f'"::{need}:1.0"' for need in core.needs)
    lines = ["CAPI=2:", f"name: ::{core.name}:1.0", "description: Generated core", "filesets:", "  rtl:",
             "    file_type: verilogSource", f"    files: [{', '.join(core.sources)}]",
             f"    depend: [{needs}]", "parameters:"]
    lines += [f"  {name}: {{datatype: int, default: 8, paramtype: vlogparam, description: Width}}"
              for name in PARAMETERS]
    lines += ["targets:", "  default:", "    filesets: [rtl]", f"    parameters: [{', '.join(PARAMETERS)}]",
              f"    toplevel: {core.name}", "    flow: lint", "    flow_options: {tool: verilator}"]
    (library / core.name / f"{core.name}.core").write_text("\n".join(lines) + "\n")


def write_for_flgen(library, core):
    core.write_sources(library / core.name)
    lines = [f"file_list '../{need}/{need}.list.rb', from: :current" for need in core.needs]
    lines += [f"source_file '{source}'" for source in core.sources]
    (library / core.name / f"{core.name}.list.rb").write_text("\n".join(lines) + "\n")


WRITERS = {"kel": write_for_kel, "fusesoc": write_for_fusesoc, "flgen": write_for_flgen}


def make_library(tool, cores, tree):
    library = Path(in_directory(f"DIR/{tool}-{cores}-{tree}"))
    if library.exists():
        return
    unfinished = library.with_suffix(".unfinished")
    shutil.rmtree(unfinished, ignore_errors=True)
    for number in range(cores):
        WRITERS[tool](unfinished, Core(number, tree))
    unfinished.rename(library)


class Row(NamedTuple):
    """What both sides are asked about a library, and how their answers are known to be the same."""

    cores: int
    tree: int
    other: Command
    kel: Command
    names: str  # an expression for what both answers must name
    number: int  # how many of them there must be
    file: str = ""  # where the other tool leaves its answer, if it doesn't print it


# A configuration of its own: nobody's libraries and settings count, and nothing is left in a home directory.
FUSESOC = ["fusesoc", "--config", "DIR/fusesoc.conf", "--cores-root"]
SOURCE = r"core\d+_source\d+\.v\b"


def starts():
    """No core is named: this tells how much of the others' time is their start."""
    return Row(1, 1, Command("fusesoc", "--version"), Command("kel", "--version"), SOURCE, 0)


def lists(cores, tree):
    return Row(cores, tree, Command(*FUSESOC, f"DIR/fusesoc-{cores}-{tree}", "core", "list"),
               Command("kel", "-L", f"DIR/kel-{cores}-{tree}", "list"), r"(?m)^:*(core\d+)[_:]", cores)


def kel_sources(cores, tree, form):
    return Command("kel", "-L", f"DIR/kel-{cores}-{tree}", "sources", "core0", "--for", "synthesis", "--format", form)


def sets_up(cores, tree, *options):
    work = f"DIR/work-{cores}-{tree}"
    run = Command(*FUSESOC, f"DIR/fusesoc-{cores}-{tree}", "run", "--setup", "--no-export", *options,
                  "--work-root", work, "::core0:1.0")
    return Row(cores, tree, run, kel_sources(cores, tree, "edam"), SOURCE, 10 * tree, f"{work}/core0_1.0.eda.yml")


def writes_file_list(cores, tree):
    return Row(cores, tree, Command("flgen", f"DIR/flgen-{cores}-{tree}/core0/core0.list.rb"),
               kel_sources(cores, tree, "f"), SOURCE, 10 * tree)


ROWS = [starts(), lists(1000, 100), lists(5000, 100),
        sets_up(1000, 100, "--clean"), sets_up(1000, 100), sets_up(5000, 100, "--clean"),
        sets_up(1000, 1000, "--clean"), writes_file_list(1000, 100)]


def named(row, command, programs):
    """What a command's answer names, in order; ends the script if it fails."""
    done = command.run(programs, capture_output=True)
    if done.returncode:
        sys.exit(f"{command}\n{done.stderr}")
    is_filed = command is row.other and row.file
    text = Path(in_directory(row.file)).read_text() if is_filed else done.stdout
    return re.findall(row.names, text)


def check(row, programs):
    one, other = (named(row, command, programs) for command in (row.kel, row.other))
    if sorted(one) != sorted(other) or len(one) != row.number:
        sys.exit(f"{row.kel}: {len(one)} names, but {row.number} expected\n{row.other}: {len(other)} names")


def is_there(tool, programs):
    there = shutil.which(call_of(tool, programs)[0]) is not None
    if not there:
        print(f"{tool} is not there and left out; KEL_BENCH_{tool.upper()} may tell how to call it.\n")
    return there


def measure(programs, runs):
    tools = [tool for tool in ("fusesoc", "flgen") if is_there(tool, programs)]
    rows = [row for row in ROWS if row.other.words[0] in tools]
    Path(in_directory("DIR/fusesoc.conf")).write_text(in_directory("[main]\ncache_root = DIR/cache\n"))
    for row in rows:
        for tool in "kel", row.other.words[0]:
            make_library(tool, row.cores, row.tree)
        check(row, programs)
    if rows:
        compare_all([(row.other, row.kel, None) for row in rows], programs, runs)


def main():
    programs = Path(sys.argv[1]).resolve()
    with tempfile.TemporaryDirectory() as scratch:
        os.environ.setdefault("KEL_BENCH_DIRECTORY", scratch)
        measure(programs, int(sys.argv[2]) if len(sys.argv) > 2 else 9)


if __name__ == "__main__":
    main()
