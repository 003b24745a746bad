#!/usr/bin/env python3
"""Hands what `kel sources --format edam --tool TOOL` writes to Edalize, which runs simulators, as it stands.

Usage: edalize_test.py KEL      the built command

Exits with 77 where Python finds no Edalize; PYTHONPATH may name a copy of its sources. Else the same as
tools_test.py, whose checks it uses.
"""

import json
import sys

from tools_test import KEL, SAMPLES, Fault, check, failed, run, sources, strictly_valid, unit_of

CALLER = """import json
from edalize.flows.sim import Sim
flow = Sim(json.load(open("edam.json")), ".")
flow.configure()
flow.build()
flow.run()
"""
FOLDERS = {"ghdl": "vhdl", "icarus": "verilog", "verilator": "verilog"}
# A core in both languages that says what it is given; `to_string` is of 2008.
SAY = {"data/say_v2_1_0.qvr": "OPTION HDL = BOTH\nPARAMETER N = 1, DT = integer\nPARAMETER S = no, DT = string\n",
       "data/say_v2_1_0.ldx": "lib say say.vhd\nlib say say.v\n",
       "hdl/vhdl/say.vhd": 'entity say is generic (N : integer := 1; S : string := "no"); end entity;\n'
                           "architecture a of say is begin\n"
                           '  process begin report "PASS " & to_string(N) & S; wait; end process;\nend architecture;\n',
       "hdl/verilog/say.v": 'module say; parameter N = 1; parameter S = "no";\n'
                            'initial begin $display("PASS %0d%0s", N, S); $finish; end\nendmodule\n'}
SAY_WORDS = ["--set", "N=-7", "--set", "S=yes", "--vhdl-standard", "08", "--hdl-library", "say=spoken"]


def simulate(repository, core, tool, words, expected, scratch):
    document = sources(repository, core, "simulation", "edam", "--tool", tool, *words)
    strictly_valid(json.loads(document), "edam")
    (scratch / "edam.json").write_text(document)
    printed = run(sys.executable, "-c", CALLER, cwd=scratch)
    if expected not in printed:
        raise Fault(f"no {expected!r} in {printed[-1500:]!r}")
    return True


def settings(tool, scratch):
    for name, text in SAY.items():
        path = scratch / "ipmods/say_v1_00_a" / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(text)
    return simulate(scratch, "say", tool, SAY_WORDS, "PASS -7yes", scratch)


def main():
    try:
        import edalize.flows.sim
    except ImportError as fault:
        print(f"Edalize is not tried: {fault}")
        sys.exit(77)
    keys = [line.split("\t")[0] for line in run(KEL, "-L", SAMPLES, "list", "--all").splitlines()]
    ran = dict.fromkeys(FOLDERS, 0)
    for tool, folder in FOLDERS.items():
        check(f"{tool}, settings", settings, tool)
        for key in keys:
            bench = f"{unit_of(key)}_tb"
            if list((SAMPLES / "ipmods" / key / "hdl" / folder).glob(f"{bench}.*")):
                ran[tool] += check(f"{tool}, {key}", simulate, SAMPLES, key, tool, ["--top", bench], "PASS")
    print(f"test benches that ran: {ran}")
    sys.exit(1 if failed or ran["ghdl"] < 7 or min(ran.values()) < 3 else 0)


if __name__ == "__main__":
    main()
