#!/usr/bin/env python3
"""Gives what `kel sources` and `kel check` write to the tools that they are written for.

Usage: tools_test.py KEL      the built command

Needs what scripts/install-dependencies.sh installs for the group `tools`. Prints each check with ok
or what is wrong, and exits with 1 if any failed. Writes nothing outside a temporary directory.
"""

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
# What EDAM may leave out.
OPTIONAL = ["version", "toplevel", "parameters", "flow_options", "logical_name", "include_path"]

failed = []


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


# Of `kel sources`.
FORMATS = [line.split("\t")[0] for line in run(KEL, "__complete", "sources", "--format", "").splitlines()]


def sources(repository, key, purpose, form, *words):
    return run(KEL, "-L", repository, "sources", key, "--for", purpose, "--format", form, *words)


def records(document):
    return [(source["logical_name"], source["language"], source["path"]) for source in json.loads(document)["sources"]]


def unit_of(core):
    return core.rsplit("_v", 1)[0]


def ghdl(core, purpose, scratch):
    """Analyses as the script says, then elaborates the core or runs its test bench, if it has one."""
    bench = f"{unit_of(core)}_tb"
    has_bench = f"/{core}/hdl/vhdl/{bench}.vhd\n" in sources(SAMPLES, core, purpose, "list")
    top = ["--top", bench] if has_bench else []
    words = ["--relative-to", scratch] if purpose == "synthesis" else []
    is_package = unit_of(core) == "math_pack" and not has_bench
    (scratch / "analyse.sh").write_text(sources(SAMPLES, core, purpose, "ghdl", *words, *top,
                                                *([] if is_package else ["--run"])))
    printed = run("sh", "analyse.sh", cwd=scratch, GHDL_FLAGS="--std=08")
    if has_bench and ("PASS" not in printed or "(assertion error)" in printed):
        raise Fault(f"the test bench prints {printed!r}")
    return has_bench


def verilog(core, purpose, scratch):
    """Compiles; a test bench is run, and what is for synthesis is linted."""
    bench = f"{unit_of(core)}_tb"
    has_bench = re.search(rf"/{core}/hdl/verilog/{bench}.s?v\n", sources(SAMPLES, core, purpose, "list"))
    (scratch / "core.f").write_text(sources(SAMPLES, core, purpose, "f"))
    run("iverilog", "-g2012", "-o", "core.vvp", *(["-s", bench] if has_bench else []),
        "-c", "core.f", cwd=scratch)
    if purpose == "synthesis":
        # the boxes are empty, and the Verilog parts of a mixed core have no top of their own
        form = "f" if unit_of(core) in ["tone_gen", "event_station"] else "verilator"
        (scratch / "core.vc").write_text(sources(SAMPLES, core, purpose, form))
        run("verilator", "--lint-only", "-Wall", "-Wno-style", "-Wno-MULTITOP", "-f", "core.vc",
            cwd=scratch)
    if has_bench and "PASS" not in (printed := run("vvp", "-n", "core.vvp", cwd=scratch)):
        raise Fault(f"the test bench prints {printed!r}")
    return bool(has_bench)


COMPILE = {"VHDL": ghdl, "Verilog": verilog, "SystemVerilog": verilog}


def netlists(scratch):
    """The sample netlists are what Yosys makes of their sources."""
    for folder in ["examples", "scripts"]:
        shutil.copytree(ROOT / folder, scratch / folder)
    made = sorted((scratch / "examples/repository").rglob("*.edif"))
    expect(len(made), 5, "the number of netlists")
    for path in made:
        path.unlink()
    run("bash", scratch / "scripts/make-netlists.sh", cwd=scratch)
    for path in made:
        expect(path.read_bytes() == (ROOT / path.relative_to(scratch)).read_bytes(), True, path.name)


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
    """The library and path of each source that the script analyses, told by a `ghdl` that only writes its words
    down."""
    (scratch / "bin").mkdir(exist_ok=True)
    (scratch / "bin/ghdl").write_text('#!/bin/sh\nprintf "%s\\0" "$@" ""\n')
    (scratch / "bin/ghdl").chmod(0o755)
    (scratch / "calls.sh").write_text(document)
    path = f"{scratch}/bin:{os.environ['PATH']}"
    calls = run("sh", "calls.sh", cwd=scratch, PATH=path, GHDL_FLAGS="-x -y").split("\0\0")[:-1]
    for call in calls:
        words = [word for word in call.split("\0") if not word.startswith("--std=")]
        expect(words[:3], ["-a", "-x", "-y"], "the words of a call")
        expect(len(call.encode()) < 101_000, True, "a call that a system takes")
        yield from ((words[3].removeprefix("--work="), "VHDL", path) for path in words[4:])


def make_lists(document, scratch):
    (scratch / "core.mk").write_text(document)
    (scratch / "show.mk").write_text("include core.mk\nshow:\n"
                                     "\t@$(foreach s,$(KEL_SOURCES),printf '%s\\n' '$(subst ','\\'',$s)';)\n")
    return run("make", "-f", "show.mk", cwd=scratch).splitlines()


def cmake_lists(document, scratch):
    (scratch / "core.cmake").write_text(document)
    (scratch / "show.cmake").write_text('include(core.cmake)\nforeach(s IN LISTS KEL_SOURCES)\n'
                                        'file(APPEND shown "${s}//")\nendforeach()\n')
    (scratch / "shown").write_text("")
    run("cmake", "-P", "show.cmake", cwd=scratch)
    return (scratch / "shown").read_text().split("//")[:-1]


EDAM_LANGUAGES = {"vhdlSource": "VHDL", "verilogSource": "Verilog", "systemVerilogSource": "SystemVerilog"}


def forms(repository, core, purpose, scratch, expected=None):
    """All forms name the same sources, in the same order, with the same libraries. Those for one language end with 1
    where there is none of it, and so does one that can't hold a path."""
    data = {form: json.loads(sources(repository, core, purpose, form)) for form in ["json", "edam"]}
    wanted = expected or records(sources(repository, core, purpose, "json"))
    directories = data["json"]["include_directories"]
    vhdl = [record for record in wanted if record[1] == "VHDL"]
    verilog_files = [record[2] for record in wanted if record[1].endswith("Verilog")]
    paths = [path for _, _, path in wanted]
    files = lambda text: [re.sub(r"\\(.)", r"\1", line) for line in text.splitlines()
                          if not line.startswith(("// ", "--top-module"))]
    shown = {
        "list": (str.splitlines, [re.sub(r"[\x00-\x1f\x7f]", lambda c: f"\\x{ord(c[0]):02x}", path) for path in paths]),
        "tcl": (lambda text: tcl_lists(text, scratch), (wanted, directories)),
        "ghdl": (lambda text: list(ghdl_calls(text, scratch)), vhdl),
        "vhdl_ls": (lambda text: list(vhdl_ls_records(text)), vhdl),
        "cmake": (lambda text: cmake_lists(text, scratch), paths),
        "make": (lambda text: make_lists(text, scratch), [] if " " in "".join(paths) else paths),
        "f": (files, verilog_files and [f"+incdir+{path}" for path in directories] + verilog_files)}
    shown["verilator"] = shown["f"]
    expect(sorted([*shown, "json", "edam"]), sorted(FORMATS), "the formats")
    for form, (read, there) in shown.items() if wanted else []:
        if "\n" in str(repository) and form in ["f", "verilator"]:
            there = []
        if there:
            expect(read(sources(repository, core, purpose, form)), there, form)
        else:
            expect(refusal(repository, core, purpose, form), (1, b""), form)
    expect(records(json.dumps(data["json"])), wanted, "json")
    files = data["edam"]["files"]
    expect([(file["logical_name"], EDAM_LANGUAGES[file["file_type"].split("-")[0]], file["name"])
            for file in files if "logical_name" in file], wanted, "edam")
    headers = [file for file in files if "include_path" in file]
    expect(list(dict.fromkeys(file["include_path"] for file in headers)), directories,
           "the include directories of edam")
    if missing := [file["name"] for file in headers if not pathlib.Path(file["name"]).is_file()]:
        raise Fault(f"edam names files that are not there: {missing}")
    for form, name in [("json", "sources"), ("edam", "edam")]:
        strictly_valid(data[form], name)


def refusal(repository, core, purpose, form):
    done = subprocess.run([KEL, "-L", repository, "sources", core, "--for", purpose, "--format", form],
                          capture_output=True, timeout=60)
    return done.returncode, done.stdout


def valid(document, schema):
    """The validator, which takes the document."""
    validator = jsonschema.validators.validator_for(schema)(schema)
    validator.check_schema(schema)
    if fault := jsonschema.exceptions.best_match(validator.iter_errors(document)):
        raise Fault(f"{list(fault.path)}: {fault.message}")
    return validator


def strictly_valid(document, name):
    """Valid, and no longer so without a member, with one more or with another type of file."""
    validator = valid(document, json.loads((ROOT / f"docs/{name}.schema.json").read_text()))
    part_at = next(name for name in ["files", "sources", "findings"] if name in document)
    parts = document[part_at]
    for at in [None, *range(len(parts))]:
        whole = document if at is None else parts[at]
        changes = [{key: whole[key] for key in whole if key != name} for name in whole if name not in OPTIONAL]
        changes += [{**whole, "unknown": "x"}, {**whole, "file_type": "VHDL"}]
        for changed in changes:
            if validator.is_valid(changed if at is None else {**document, part_at: [*parts[:at], changed, *parts[at + 1:]]}):
                raise Fault(f"the schema allows {changed}")


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
    (home / "hdl/in c'lude/again").symlink_to(".")
    (home / "data").mkdir()
    (home / "data/odd_v2_1_0.qvr").write_text("OPTION HDL = BOTH\nOPTION STYLE = HDL\n")
    (home / "data/odd_v2_1_0.ldx").write_text("".join(order))
    for purpose in PURPOSES:
        forms(repository, core, purpose, scratch, wanted)
    if "\n" not in folder:
        (scratch / "odd.f").write_text(sources(repository, core, "synthesis", "f"))
        run("verilator", "--lint-only", "-f", "odd.f", cwd=scratch)


def long_order(scratch):
    """More sources than one call takes."""
    data = scratch / "ipmods/long_v1_00_a/data"
    data.mkdir(parents=True)
    names = [f"{i:0100}.vhd" for i in range(1500)]
    (data / "long_v2_1_0.qvr").write_text("OPTION HDL = VHDL\n")
    (data / "long_v2_1_0.ldx").write_text("".join(f"lib long {name}\n" for name in names))
    script = sources(scratch, "long_v1_00_a", "synthesis", "ghdl", "--relative-to", data.parent / "hdl/vhdl")
    expect([path for _, _, path in ghdl_calls(script, scratch)], names, "the sources")
    expect(script.count("ghdl -a"), 2, "the calls")


def terminal(scratch):
    """A terminal gets no control character of any file from any verb or format."""
    data = scratch / "ipmods/a_v1_00_a/data"
    data.mkdir(parents=True)
    (data / "a_v2_1_0.qvr").write_text("OPTION STYLE = MIX\nOPTION DESC = \x1b[31m\nPORT p\x1b = \x1b\n")
    (data / "a_v2_1_0.ldx").write_text("lib a x\x1b[2J.vhd\nlib a y\x1b[2J.v Verilog\n")
    (data / "a_v2_1_0.tew").write_text("FILES\nn\x1b.edif\n")
    sourcing = ["sources", "a", "--for", "synthesis", "--format"]
    for words in [["list"], ["show", "a"], ["show", "a", "--json"], ["check"], ["netlists", "a"], ["which", "\x1b"],
                  *[[*sourcing, form] for form in FORMATS]]:
        screen, end = pty.openpty()
        subprocess.run([KEL, "--color", "never", "-L", scratch, *words], stdout=end, stderr=end, timeout=60)
        os.close(end)
        shown = os.read(screen, 65536)
        os.close(screen)
        if not shown or b"\x1b" in shown:
            raise Fault(f"{words} shows {shown}")


def npm_installs(scratch):
    """False if npm isn't there or reaches nothing."""
    try:
        run("npm", "install", "--ignore-scripts", "--no-audit", "--no-fund", "--no-save", "--silent",
            "--fetch-retries=0", *SARIF_PACKAGES, cwd=scratch)
        return True
    except (Fault, OSError, subprocess.TimeoutExpired):
        print("  npm reaches no registry: SARIF is not checked", flush=True)
        return False


def findings(scratch):
    """The document of a check, and its SARIF: by the schema that others wrote, and their reader."""
    faulty = scratch / "rep o%"
    data = faulty / "ipmods/ü_v1_00_a/data"
    data.mkdir(parents=True)
    (data / "ü_v2_1_0.qvr").write_text("PORT p = 'ü', DIR = I VEC = [1:0]\nPORT p = q, DIR = O\n")
    fetched = npm_installs(scratch)
    for repository, count in [(SAMPLES, 0), (faulty, 3)]:
        document, log = [json.loads(subprocess.run(
            [KEL, "-L", repository, "check", "--format", form, "--relative-to", repository],
            capture_output=True, timeout=60).stdout) for form in ["json", "sarif"]]
        expect(len(document["findings"]), count, "the number of findings")
        strictly_valid(document, "check")
        shown = [(result["ruleId"], urllib.parse.unquote(
            result["locations"][0]["physicalLocation"]["artifactLocation"]["uri"]))
                 for result in log["runs"][0]["results"]]
        expect(shown, [(finding["code"], finding["file"]) for finding in document["findings"]], "SARIF")
        if fetched:
            others_read(log, count, scratch)


def others_read(log, count, scratch):
    modules = scratch / "node_modules"
    valid(log, json.loads((modules / SARIF_SCHEMA).read_text()))
    (scratch / "log.sarif").write_text(json.dumps(log))
    run("node", modules / "sarif-junit/bin/sarif-junit.js", "-i", "log.sarif", "-o", "log.xml",
        cwd=scratch)
    cases = xml.etree.ElementTree.parse(scratch / "log.xml").getroot().findall(".//testcase")
    expect(len(cases), count, "the number of findings that a reader finds")


def check(name, function, *words):
    """What the function gives, or False if it fails."""
    start, result = time.monotonic(), False
    with tempfile.TemporaryDirectory() as scratch:
        try:
            result = function(*words, pathlib.Path(scratch).resolve())
            verdict = "ok"
        except Exception as fault:  # whatever it is, the other checks still run
            verdict = f"FAILED\n  {type(fault).__name__}: {fault}"
            failed.append(name)
    print(f"{name}: {verdict} ({time.monotonic() - start:.1f} s)", flush=True)
    return result


def main():
    keys = [line.split("\t")[0] for line in run(KEL, "-L", SAMPLES, "list", "--all").splitlines()]
    ran = {"VHDL": [], "Verilog": [], "SystemVerilog": []}
    for key in keys:
        for purpose in PURPOSES:
            check(f"forms, {key}, {purpose}", forms, SAMPLES, key, purpose)
            languages = {record[1] for record in records(sources(SAMPLES, key, purpose, "json"))}
            for language in languages:
                ran[language].append(check(f"{language}, {key}, {purpose}", COMPILE[language], key, purpose))
    check("netlists", netlists)
    check("odd paths", odd_paths, "o'd \"d\" $x [y] {z} #\\t")
    check("odd paths with a line break", odd_paths, "new\nline")
    check("a long order", long_order)
    check("findings", findings)
    check("terminal", terminal)
    benches = [sum(results) for results in ran.values()]
    print(f"{len(keys)} samples, {benches} test benches ran")
    sys.exit(1 if failed or len(keys) < 13 or benches[0] < 8 or benches[1] < 3 else 0)


if __name__ == "__main__":
    main()
