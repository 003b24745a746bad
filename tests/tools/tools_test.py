#!/usr/bin/env python3
"""Gives what `kel sources` and `kel netlists` write to the tools that they are written for.

Usage: tools_test.py KEL      the built command

Needs what scripts/install-dependencies.sh installs for the group `tools`. Prints each check with ok
or what is wrong, and exits with 1 if any failed. Writes nothing outside a temporary directory.
"""

import copy
import json
import os
import pathlib
import pty
import re
import shutil
import subprocess
import sys
import tempfile
import time
import tomllib
import urllib.parse
import xml.etree.ElementTree

import jsonschema

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
SAMPLES = ROOT / "examples/repository"
KEL = pathlib.Path(sys.argv[1]).resolve()
PURPOSES = ["synthesis", "simulation"]
SOURCE_NAMES = ["a b.vhd", "it's one.vhd", 'a "word".vhd', "$HOME$(x)`y`.vhd", "back\\sl\\nash.vhd",
                "[br]ac{k}et.vhd", "star*?;&|<>~.vhd", "ünï.vhd", "del\x7fete.vhd", "top [m]\\$o.v"]
# A schema of SARIF 2.1.0 and a program that reads it.
SARIF_PACKAGES = ["@microsoft/jest-sarif@1.0.0-beta.0", "sarif-junit@1.1.4"]
SARIF_SCHEMA = "@microsoft/jest-sarif/lib/schemas/sarif-2.1.0-rtm.5.json"
GHDL = {"GHDL_FLAGS": "--std=08"}


class Fault(Exception):
    pass


def expect(actual, expected, what):
    if actual != expected:
        raise Fault(f"{what} is\n    {actual!r}, not\n    {expected!r}")


def run(*command, cwd=ROOT, **environment):
    """What the command prints, which must end well."""
    done = subprocess.run([str(word) for word in command], cwd=cwd, timeout=120,
                          env={**os.environ, **environment}, capture_output=True)
    output = done.stdout.decode()
    if done.returncode != 0:
        tail = (output + done.stderr.decode())[-1500:]
        raise Fault(f"{command[0]} exits with {done.returncode}:\n{tail}")
    return output


def sources(repository, key, purpose, form, *words):
    return run(KEL, "-L", repository, "sources", key, "--for", purpose, "--format", form, *words)


def records(document, language=None):
    return [(source["library"], source["language"], source["path"])
            for source in json.loads(document)["sources"] if language in (None, source["language"])]


def unit_of(core):
    return core.rsplit("_v", 1)[0]


def ghdl(repository, core, purpose, scratch):
    """Analyses as the script says, then elaborates the core and runs its test bench. The number of
    test benches that ran."""
    words = ["--relative-to", scratch] if purpose == "synthesis" else []
    (scratch / "analyse.sh").write_text(sources(repository, core, purpose, "ghdl", *words))
    run("sh", "analyse.sh", cwd=scratch, **GHDL)
    flags = [GHDL["GHDL_FLAGS"], f"--work={core}"]
    listing = sources(repository, core, purpose, "list")
    if unit_of(core) != "math_pack":  # a package alone
        run("ghdl", "-e", *flags, unit_of(core), cwd=scratch)
    if f"/{core}/hdl/vhdl/{unit_of(core)}_tb.vhd\n" not in listing:
        return 0
    printed = run("ghdl", "--elab-run", *flags, f"{unit_of(core)}_tb", "--assert-level=error",
                  cwd=scratch)
    if "PASS" not in printed:
        raise Fault(f"the test bench prints {printed!r}")
    return 1


def verilog(core, purpose, scratch):
    """Compiles; a test bench is run, and what is for synthesis is linted. The number of test
    benches that ran."""
    (scratch / "core.f").write_text(sources(SAMPLES, core, purpose, "f"))
    bench = f"{unit_of(core)}_tb"
    has_bench = f"/{core}/hdl/verilog/{bench}.v\n" in (scratch / "core.f").read_text()
    run("iverilog", "-g2005", "-o", "core.vvp", *(["-s", bench] if has_bench else []),
        "-c", "core.f", cwd=scratch)
    if purpose == "synthesis":
        # the boxes are empty, and the Verilog parts of a mixed core have no top of their own
        run("verilator", "--lint-only", "-Wall", "-Wno-style", "-Wno-MULTITOP", "-f", "core.f",
            cwd=scratch)
    if has_bench and "PASS" not in (printed := run("vvp", "-n", "core.vvp", cwd=scratch)):
        raise Fault(f"the test bench prints {printed!r}")
    return has_bench


def wrong_order(scratch):
    """An architecture ahead of its entity can't be analysed, and that is not hidden."""
    core = "scratch_ram_v1_00_a"
    copied = scratch / "repository"
    shutil.copytree(SAMPLES, copied)
    order = copied / "ipmods" / core / "data/scratch_ram_v2_1_0.ldx"
    lines = order.read_text().splitlines(keepends=True)
    at = [n for n, line in enumerate(lines) if re.search(r" scratch_ram(_rtl)?\.vhd", line)]
    expect(len(at), 2, "the number of lines to swap")
    ghdl(copied, core, "synthesis", scratch)
    lines[at[0]], lines[at[1]] = lines[at[1]], lines[at[0]]
    order.write_text("".join(lines))
    (scratch / "anew").mkdir()
    (scratch / "anew/analyse.sh").write_text(sources(copied, core, "synthesis", "ghdl"))
    try:
        run("sh", "analyse.sh", cwd=scratch / "anew", **GHDL)
    except Fault as fault:
        if "scratch_ram_rtl.vhd:" not in str(fault):
            raise
    else:
        raise Fault("the script takes the architecture ahead of its entity")


def parse_edif(text):
    """The nested lists of a file in parentheses."""
    stack = [[]]
    for word in re.findall(r'[()]|"[^"]*"|[^\s()"]+', text):
        if word == "(":
            stack.append([])
        elif word != ")":
            stack[-1].append(word)
        elif len(stack) < 2:
            raise Fault("a parenthesis closes nothing")
        else:
            closed = stack.pop()
            stack[-1].append(closed)
    if len(stack) != 1 or len(stack[0]) != 1:
        raise Fault("the parentheses don't make one list")
    return stack[0][0]


def netlists(key, settings, names, _scratch):
    """EDIF, which Debian's Yosys only writes: the top cell must be there, with its ports."""
    words = [word for setting in settings for word in ("--set", setting)]
    paths = run(KEL, "-L", SAMPLES, "netlists", key, *words).splitlines()
    expect([pathlib.Path(path).name for path in paths], names, "the list of netlists")
    for path in paths:
        top = re.sub(r"_w\d+_.*", "", pathlib.Path(path).stem)
        head, name, *parts = parse_edif(pathlib.Path(path).read_text())
        expect((head, name), ("edif", top), "the head")
        expect(["design", top], next(part[:2] for part in parts if part[0] == "design"), "the top")
        cells = {cell[1]: cell for part in parts if part[0] == "library"
                 for cell in part[2:] if cell[0] == "cell"}
        if "['port', 'clk'," not in str(cells.get(top)):
            raise Fault(f"{path} has no cell {top} with a clock among {list(cells)}")


def netlists_again(scratch):
    for folder in ["examples", "scripts"]:
        shutil.copytree(ROOT / folder, scratch / folder)
    made = sorted((scratch / "examples/repository").rglob("*.edif"))
    expect(len(made), 5, "the number of netlists")
    for path in made:
        path.unlink()
    run("bash", scratch / "scripts/make-netlists.sh", cwd=scratch)
    for path in made:
        if path.read_bytes() != (ROOT / path.relative_to(scratch)).read_bytes():
            raise Fault(f"{path.name} differs")


def unescape(text):
    return re.sub(r"\\(.)", r"\1", text)


def vhdl_ls_records(document):
    for library, entry in tomllib.loads(document)["libraries"].items():
        for pattern in entry["files"]:
            if not re.fullmatch(r"([^*?\[\]]|\[[*?\[\]]\])*", pattern):
                raise Fault(f"{pattern!r} stands for more than one path")
            yield library, "VHDL", re.sub(r"\[(.)\]", r"\1", pattern)


def tcl_lists(document, scratch):
    (scratch / "core.tcl").write_text(document)
    (scratch / "show.tcl").write_text(
        'proc say {text} { puts -nonewline "$text\\0" }\nsource core.tcl\n'
        "foreach s $kel_sources { foreach k {library language path} { say [dict get $s $k] } }\n"
        "say {}\nforeach d $kel_include_directories { say $d }\n")
    fields, directories = run("tclsh", "show.tcl", cwd=scratch).split("\0\0", 1) \
        if "lappend kel_sources" in document else ("", "")
    fields = fields.split("\0") if fields else []
    return list(zip(*[iter(fields)] * 3)), directories.split("\0")[:-1]


def ghdl_calls(document, scratch):
    """What the script calls, told by a `ghdl` that only writes its words down."""
    (scratch / "bin").mkdir(exist_ok=True)
    (scratch / "bin/ghdl").write_text('#!/bin/sh\nprintf "%s\\0" "$@"\n')
    (scratch / "bin/ghdl").chmod(0o755)
    (scratch / "calls.sh").write_text(document)
    path = f"{scratch}/bin:{os.environ['PATH']}"
    words = run("sh", "calls.sh", cwd=scratch, PATH=path, GHDL_FLAGS="-x -y").split("\0")[:-1]
    return list(zip(*[iter(words)] * 5))


def forms(repository, core, purpose, scratch, expected=None):
    """All forms name the same sources, in the same order, with the same libraries."""
    text = {form: sources(repository, core, purpose, form)
            for form in ["list", "json", "f", "ghdl", "edam", "vhdl_ls", "tcl"]}
    data = {form: json.loads(text[form]) for form in ["json", "edam"]}
    wanted = expected or records(text["json"])
    directories = data["json"]["include_directories"]
    vhdl = [record for record in wanted if record[1] == "VHDL"]
    expect(text["list"].splitlines(),
           [re.sub(r"[\x00-\x1f\x7f]", lambda c: f"\\x{ord(c[0]):02x}", path)
            for _, _, path in wanted], "list")
    expect(records(text["json"]), wanted, "json")
    expect(data["json"]["libraries"], list(dict.fromkeys(r[0] for r in wanted)), "its libraries")
    expect(tcl_lists(text["tcl"], scratch), (wanted, directories), "tcl")
    expect(ghdl_calls(text["ghdl"], scratch),
           [("-a", "-x", "-y", f"--work={library}", path) for library, _, path in vhdl], "ghdl")
    expect(list(vhdl_ls_records(text["vhdl_ls"])), vhdl, "vhdl_ls")
    files = data["edam"]["files"]
    language = {"vhdlSource": "VHDL", "verilogSource": "Verilog"}
    expect([(file["logical_name"], language[file["file_type"]], file["name"])
            for file in files if "include_path" not in file], wanted, "edam")
    headers = [file for file in files if "include_path" in file]
    expect(list(dict.fromkeys(file["include_path"] for file in headers)), directories,
           "the include directories of edam")
    if missing := [file["name"] for file in headers if not pathlib.Path(file["name"]).is_file()]:
        raise Fault(f"edam names files that are not there: {missing}")
    if "\n" not in str(repository):  # a file list can't say it
        lines = [line for line in text["f"].splitlines() if not line.startswith("// ")]
        expect([unescape(line) for line in lines],
               [f"+incdir+{path}" for path in directories]
               + [path for _, language, path in wanted if language == "Verilog"], "f")
    for form, name in [("json", "sources"), ("edam", "edam")]:
        strictly_valid(data[form], json.loads((ROOT / f"docs/{name}.schema.json").read_text()))


def strictly_valid(document, schema):
    """Valid, and no longer so without a member or with one more."""
    jsonschema.Draft7Validator.check_schema(schema)
    validator = jsonschema.Draft7Validator(schema)
    if fault := jsonschema.exceptions.best_match(validator.iter_errors(document)):
        raise Fault(f"{list(fault.path)}: {fault.message}")
    records_at = next(name for name in ["files", "sources", "findings"] if name in document)
    for at in [None, *range(len(document[records_at]))]:
        whole = document if at is None else document[records_at][at]
        for name in [*whole, None]:
            if name == "file_type" and "include_path" not in whole:
                continue  # left out for a language that is not known
            changed = copy.deepcopy(document)
            part = changed if at is None else changed[records_at][at]
            part.pop(name) if name else part.update(unknown="x")
            if validator.is_valid(changed):
                raise Fault(f"the schema allows {part}")


def odd_paths(folder, scratch):
    """Names that the shell, Tcl, JSON, TOML, globs and file lists each give a meaning."""
    core, repository = "odd_v1_00_a", scratch / folder
    home = repository / "ipmods" / core
    wanted, order = [], ["vlgincdir odd_v1_00_a \"hdl/in c'lude\"\n"]
    for name in SOURCE_NAMES:
        language = "VHDL" if name.endswith(".vhd") else "Verilog"
        path = home / "hdl" / language.lower() / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text('`include "odd.vh"\nmodule odd; endmodule\n')
        quote = "'" if '"' in name else '"'
        order.append(f"lib {core} {quote}{name}{quote}\n")
        wanted.append((core, language, str(path)))
    (home / "hdl/in c'lude").mkdir()
    (home / "hdl/in c'lude/odd.vh").write_text("// nothing\n")
    (home / "data").mkdir()
    (home / "data/odd_v2_1_0.qvr").write_text("OPTION HDL = BOTH\nOPTION STYLE = HDL\n")
    (home / "data/odd_v2_1_0.ldx").write_text("".join(order))
    for purpose in PURPOSES:
        forms(repository, core, purpose, scratch, wanted)
    if "\n" not in folder:
        (scratch / "odd.f").write_text(sources(repository, core, "synthesis", "f"))
        run("verilator", "--lint-only", "-f", "odd.f", cwd=scratch)


def terminal(scratch):
    """A terminal gets no control character of any file from any verb or format."""
    data = scratch / "ipmods/a_v1_00_a/data"
    data.mkdir(parents=True)
    (data / "a_v2_1_0.qvr").write_text("OPTION STYLE = MIX\nOPTION DESC = \x1b[31m\nPORT p\x1b = \x1b\n")
    (data / "a_v2_1_0.ldx").write_text("lib a x\x1b[2J.vhd\nlib a y\x1b[2J.v Verilog\n")
    (data / "a_v2_1_0.tew").write_text("FILES\nn\x1b.edif\n")
    sourcing = ["sources", "a", "--for", "synthesis", "--format"]
    for words in [["list"], ["show", "a"], ["show", "a", "--json"], ["check"], ["netlists", "a"], ["which", "\x1b"],
                  *[[*sourcing, form] for form in ["list", "json", "f", "ghdl", "edam", "vhdl_ls", "tcl"]]]:
        screen, end = pty.openpty()
        subprocess.run([KEL, "--color", "never", "-L", scratch, *words], stdout=end, stderr=end, timeout=60)
        os.close(end)
        shown = os.read(screen, 65536)
        os.close(screen)
        if not shown or b"\x1b" in shown:
            raise Fault(f"{words} shows {shown}")


def faulty(scratch):
    """A repository with a fault of each kind of place, and the number of its findings."""
    data = scratch / "rep o%/ipmods/ü_v1_00_a/data"
    data.mkdir(parents=True)
    (data / "ü_v2_1_0.qvr").write_text("PORT p = 'ü', DIR = I VEC = [1:0]\nPORT p = q, DIR = O\n")
    return data.parent.parent.parent


def npm(scratch, *words):
    """Runs npm; false if it isn't there or reaches nothing."""
    try:
        run("npm", *words, "--silent", "--fetch-retries=0", cwd=scratch)
        return True
    except (Fault, OSError, subprocess.TimeoutExpired):
        return False


def findings(scratch):
    """The document of a check, and its SARIF: by the schema that others wrote, and their reader."""
    schema = json.loads((ROOT / "docs/check.schema.json").read_text())
    fetched = npm(scratch, "install", "--ignore-scripts", "--no-audit", "--no-fund",
                  "--no-save", *SARIF_PACKAGES)
    if not fetched:
        print("  npm reaches no registry: SARIF is not checked", flush=True)
    for repository, count in [(SAMPLES, 0), (faulty(scratch), 3)]:
        done = {form: subprocess.run([KEL, "-L", repository, "check", "--format", form,
                                      "--relative-to", repository], capture_output=True, timeout=60)
                for form in ["json", "sarif"]}
        document, log = [json.loads(done[form].stdout) for form in ["json", "sarif"]]
        expect(len(document["findings"]), count, "the number of findings")
        expect(done["sarif"].returncode, 1 if count else 0, "the status")
        strictly_valid(document, schema)
        results = log["runs"][0]["results"]
        expect([result["ruleId"] for result in results],
               [finding["code"] for finding in document["findings"]], "the rules")
        addresses = [result["locations"][0]["physicalLocation"]["artifactLocation"]["uri"]
                     for result in results]
        expect([urllib.parse.unquote(address) for address in addresses],
               [finding["file"] for finding in document["findings"]], "the addresses")
        if fetched:
            others_read(log, count, scratch)


def others_read(log, count, scratch):
    modules = scratch / "node_modules"
    schema = json.loads((modules / SARIF_SCHEMA).read_text())
    validator = jsonschema.validators.validator_for(schema)(schema)
    if fault := jsonschema.exceptions.best_match(validator.iter_errors(log)):
        raise Fault(f"{list(fault.path)}: {fault.message}")
    (scratch / "log.sarif").write_text(json.dumps(log))
    run("node", modules / "sarif-junit/bin/sarif-junit.js", "-i", "log.sarif", "-o", "log.xml",
        cwd=scratch)
    cases = xml.etree.ElementTree.parse(scratch / "log.xml").getroot().findall(".//testcase")
    expect(len(cases), count, "the number of findings that a reader finds")


def main():
    failed = 0

    def check(name, function, *words):
        nonlocal failed
        start = time.monotonic()
        result = None
        with tempfile.TemporaryDirectory() as scratch:
            try:
                result = function(*words, pathlib.Path(scratch).resolve())
                verdict = "ok"
            except Exception as fault:  # whatever it is, the other checks still run
                verdict = f"FAILED\n  {type(fault).__name__}: {fault}"
                failed += 1
        print(f"{name}: {verdict} ({time.monotonic() - start:.1f} s)", flush=True)
        return result or 0

    def at_least(count, what, _scratch):
        if count < what:
            raise Fault(f"{count} ran, not {what}")

    keys = [line.split("\t")[0] for line in run(KEL, "-L", SAMPLES, "list", "--all").splitlines()]
    ran = {"VHDL": 0, "Verilog": 0}
    check("the samples are there", at_least, len(keys), 11)
    for key in keys:
        for purpose in PURPOSES:
            check(f"forms, {key}, {purpose}", forms, SAMPLES, key, purpose)
            languages = {record[1] for record in records(sources(SAMPLES, key, purpose, "json"))}
            if "VHDL" in languages:
                ran["VHDL"] += check(f"ghdl, {key}, {purpose}", ghdl, SAMPLES, key, purpose)
            if "Verilog" in languages:
                ran["Verilog"] += check(f"verilog, {key}, {purpose}", verilog, key, purpose)
    check("VHDL test benches", at_least, ran["VHDL"], 7)
    check("Verilog test benches", at_least, ran["Verilog"], 3)
    check("wrong order", wrong_order)
    for mode in ["FAST", "SMALL"]:
        for width in [8, 16]:
            check(f"netlists, {mode} {width}", netlists, "crc_unit",
                  [f"MODE={mode}", f"WIDTH={width}"], [f"crc_unit_w{width}_{mode.lower()}.edif"])
    for scramble, more in [(0, []), (1, ["scrambler.edif"])]:
        check(f"netlists, SCRAMBLE {scramble}", netlists, "link_framer", [f"SCRAMBLE={scramble}"],
              ["crc_unit_w8_small.edif", *more])
    check("netlists again", netlists_again)
    check("odd paths", odd_paths, "o'd \"d\" $x [y] {z} #\\t")
    check("findings", findings)
    check("terminal", terminal)
    check("odd paths with a line break", odd_paths, "new\nline")
    sys.exit(1 if failed else 0)


if __name__ == "__main__":
    main()
