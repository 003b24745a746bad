#!/usr/bin/env python3
"""Runs the examples of the documents and compares what they print with what the documents show.

Usage: check-docs.py [--calls | --update] [BUILD_DIRECTORY]
  --calls   runs calls of the command alone, which is quick
  --update  writes into the manual page what the command's help says, and into tests/transcripts what is
            printed, for you to read the difference

In a `console` block a line behind "$ " is run with the built `kel` on the path, and the lines below
it are what it must print, standard error last; a line of three dots stands for any lines. A line that ends
in a backslash goes on in the next. In tests/transcripts an exit status other than 0 stands below, as [1]. In a manual page the blocks are those between .EX and .EE. Each `cpp` block is
compiled and run as README.md says, and prints what the `text` block behind it shows. Data files, whose
first line is a comment with their path, make a repository, in which the document's lines are then run.
The table of literals in docs/formats.md has what to write, and what is handed on then.
docs/diagnostics.md has a section for each code of `kel help diagnostics`: its data files, in a repository
of their own behind its `sh` blocks, are checked, and the lines with the code are those of its `text` block.
The manual page has what `kel help` says, and a schema what the command may write.
The project's directory is written /home/me/kel. And the headers' pages come without a warning.
"""

import json
import os
import pathlib
import re
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent
DOCUMENTS = ["README.md", "docs/guide.md", "docs/formats.md", "docs/adopting.md", "docs/kel.1"]
TRANSCRIPTS = sorted(str(path.relative_to(ROOT)) for path in ROOT.glob("tests/transcripts/*.md"))
SHOWN_ROOT = "/home/me/kel"
# A command and what it prints, in a `console` block.
CALL = r"^\$ ((?:.*\\\n)*.*)\n((?:(?!\$ ).*\n)*)"


def blocks(text, language):
    return re.findall(rf"^```{language}\n(.*?)^```$", text, re.MULTILINE | re.DOTALL)


# What the escapes of a manual page's examples stand for.
ESCAPES = {"-": "-", "e": "\\", "&": "", "(aq": "'", "(dq": '"', "(ha": "^", "(ti": "~", "(ga": "`"}


def manual_blocks(text):
    """The examples of a manual page as they are read, without its requests."""
    for block in re.findall(r"^\.EX\n(.*?)^\.EE$", text, re.MULTILINE | re.DOTALL):
        lines = re.sub(r"^[.'].*\n", "", block, flags=re.MULTILINE)
        yield re.sub(r"\\(\(..|.)", lambda escape: ESCAPES[escape.group(1)], lines)


def run(command, environment, directory=ROOT, tells_status=False):
    done = subprocess.run(["bash", "-c", command], cwd=directory, env=environment,
                          capture_output=True, text=True)
    status = f"[{done.returncode}]\n" if tells_status and done.returncode else ""
    printed = done.stdout + done.stderr + status
    return printed.replace(str(directory), SHOWN_ROOT).replace(str(ROOT), SHOWN_ROOT)


def matches(expected, printed):
    begin, dots, end = expected.rpartition("...\n")
    return printed.startswith(begin) and printed.endswith(end) if dots else printed == expected


def console_faults(name, text, environment, directory):
    found = list(blocks(text, "console") if name.endswith(".md") else manual_blocks(text))
    for block in found:
        for command, expected in re.findall(CALL, block, re.MULTILINE):
            printed = run(command, environment, directory, name in TRANSCRIPTS)
            if not matches(expected, printed):
                yield f"{name}: $ {command}\nprints\n{printed}"


def calls_of(readme):
    """The ways in which the README builds a program: with the build tree, and with an installation."""
    by_hand, installed = [block for block in blocks(readme, "sh") if "program.cpp" in block]
    return by_hand, installed


def program_faults(name, text, call, build):
    """Each program is built by the call, and prints what the next block of text shows."""
    pairs = re.findall(r"^```cpp\n(.*?)^```$.*?^```text\n(.*?)^```$", text, re.MULTILINE | re.DOTALL)
    if len(pairs) != len(blocks(text, "cpp")):
        yield f"{name}: a program without what it prints"
    for program, shown in pairs:
        with tempfile.TemporaryDirectory() as scratch:
            source, binary = pathlib.Path(scratch, "program.cpp"), pathlib.Path(scratch, "program")
            source.write_text(program)
            words = {"build/demo": build, "build/consumer": f"{scratch}/consumer",
                     "program.cpp": str(source), "-o program": f"-o {binary}"}
            made = call
            for word, place in words.items():
                made = made.replace(word, place)
            printed = run(f"{{ {made} }} >{scratch}/log || cat {scratch}/log\n{binary}",
                          dict(os.environ, HOME=scratch))
            if "consumer" in call:
                consumer = run(f"{scratch}/consumer/program", os.environ)
                printed = printed if printed == consumer else f"{printed} and {consumer}"
        if not matches(shown, printed):
            yield f"{name}: a program prints\n{printed}"


def write_files(text, directory):
    """Writes each data file that a document shows: its first line is a comment with its path."""
    for extension in ("qvr", "ldx", "tew"):
        for block in blocks(text, extension):
            path = directory / block.split("\n")[0].removeprefix("# ")
            path.parent.mkdir(parents=True, exist_ok=True)
            path.write_text(block)


def with_calls(text, environment):
    """A transcript with what its calls print now."""
    def played(call):
        printed = run(call[1], environment, directory, True)
        return f"$ {call[1]}\n{call[2] if matches(call[2], printed) else printed}"
    with tempfile.TemporaryDirectory() as scratch:
        write_files(text, pathlib.Path(scratch))
        directory = scratch if any(pathlib.Path(scratch).iterdir()) else ROOT
        for block in blocks(text, "console"):
            text = text.replace(block, re.sub(CALL, played, block, flags=re.MULTILINE))
    return text


def document_faults(name, environment):
    text = (ROOT / name).read_text()
    with tempfile.TemporaryDirectory() as scratch:
        write_files(text, pathlib.Path(scratch))
        shows_files = any(pathlib.Path(scratch).iterdir())
        if shows_files and name in DOCUMENTS:
            # All is well but for the files that a document doesn't hold.
            findings = run("kel -L . check", environment, scratch).splitlines()[:-1]
            bad = [finding for finding in findings if not re.search(r"\[missing-(source|netlist|data-file|include-directory)\]", finding)]
            if bad or not findings:
                yield f"{name}: its files are not good:\n{bad}"
        yield from console_faults(name, text, environment, scratch if shows_files else ROOT)


def code_faults(environment):
    """Each code of the command has its section, and is reported where its example says."""
    name = "docs/diagnostics.md"
    sections = re.split(r"^## (.*)\n", (ROOT / name).read_text(), flags=re.MULTILINE)[1:]
    codes = re.findall(r"^(\S+) \(", run("kel help diagnostics", environment), re.MULTILINE)
    if codes != sections[::2]:
        yield f"{name}: its sections are {sections[::2]}, and the codes {codes}"
    for code, text in zip(sections[::2], sections[1::2]):
        if not blocks(text, "text") and re.search(r"no\s+example", text):
            continue
        with tempfile.TemporaryDirectory() as scratch:
            (pathlib.Path(scratch) / "ipmods").mkdir()
            printed = "".join(run(commands, environment, scratch) for commands in blocks(text, "sh"))
            write_files(text, pathlib.Path(scratch))
            found = run("kel -L . check --relative-to .", environment, scratch).splitlines()
            printed += "".join(f"{line}\n" for line in found if f"[{code}]: " in line)
        if [printed] != blocks(text, "text"):
            yield f"{name}: the example of {code} gives\n{printed}"


def literal_faults(environment):
    """Each row of the table of literals, written as a parameter, hands on what it says."""
    name = "docs/formats.md"
    rows = re.findall(r"^\| [^|]+ \| `(.+)` \|(?: `(.+)`)? \|$", (ROOT / name).read_text(), re.MULTILINE)
    with tempfile.TemporaryDirectory() as scratch:
        data = pathlib.Path(scratch, "ipmods/a_v1_00_a/data")
        data.mkdir(parents=True)
        # The property behind each shows that it is not cut.
        lines = [f"PARAMETER P{number} = {row[0]}, DESC = end\n" for number, row in enumerate(rows)]
        (data / "a_v2_1_0.qvr").write_text("".join(lines))
        printed = run("kel -L . show a --json", environment, scratch)
    found = [one["properties"] for one in json.loads(printed)["parameters"]]
    shown = [(one["VALUE"], one.get("DESC")) for one in found]
    for (written, expected), read in zip(rows, shown, strict=True):
        if read != (expected, "end"):
            yield f"{name}: {written} hands on {read}"
    if len(rows) < 10:
        yield f"{name}: its table of literals is not found"


def roff(text):
    return text.replace("\\", "\\e").replace("-", "\\-").replace("'", "\\(aq")


class Word:
    """A word as `kel help` shows it, and the lines behind it."""

    def __init__(self, label, lines):
        words = re.sub(r"( \.\.\.)?( REQUIRED)?$", "", label).split(" ", 1)
        self.is_option = label.startswith("-")
        self.is_required, self.is_repeated = label.endswith(" REQUIRED"), " ..." in label
        value, self.choices, self.default = re.fullmatch(
            r"([A-Z=]*)(?::\{(.*)\})?(?:=(.*))?", words[1]).groups() if len(words) > 1 else ("", None, None)
        names = [(r"\fB%s\fP" if self.is_option else r"\fI%s\fP") % roff(name) for name in words[0].split(",")]
        self.names = ", ".join(names) + (rf" \fI{value}\fP" if value else "")
        self.help, *self.lines = lines

    def synopsis(self):
        shown = self.names.replace(r"\fB", "").replace(r"\fP ", " ") if self.is_option else self.names
        return (shown if self.is_required else rf"\fR[\fP{shown}\fR]\fP") + (r"\fR...\fP" * self.is_repeated)

    def entry(self):
        choices = [f"One of {', '.join(self.choices.split(','))}."] if self.choices else []
        default = [f"Without it, {self.default}."] if self.default else []
        lines = [".TP", self.names, f"{roff(self.help)}.", *choices, *default]
        for name, meaning in (line.split(": ", 1) for line in self.lines):
            lines += [".RS", ".TP", rf"\fB{roff(name)}\fP", f"{roff(meaning)}.", ".RE"]
        return lines


def words_of(text):
    """The arguments and options that the help of a verb, or of the command, shows."""
    shown = "".join(re.findall(r"^(?:Positionals|Options):\n((?:  .*\n)+)", text, re.MULTILINE))
    for label, lines in re.findall(r"^  (\S.*?)(?:  +|\n +)(\S.*\n(?: {10}.*\n)*)", shown, re.MULTILINE):
        yield Word(label, [line.strip() for line in lines.splitlines()])


def manual_part(verb, environment):
    """The lines of the manual page that follow from the help of a verb, or of the command."""
    text = run(f"kel help {verb}", environment)
    words = [word for word in words_of(text) if not verb or "help" not in word.names]
    known = [r"\fIKEY\fP", r"\fIGLOB\fP"]  # which the page's description explains
    lines = [line for word in words if word.names not in known for line in word.entry()]
    if verb:
        synopsis = " ".join([verb, *(word.synopsis() for word in words)])
        lines = [f".SS {synopsis}", f"{roff(text.splitlines()[0])}.", *lines]
    return "".join(f"{line}\n" for line in lines)


def with_help(page, environment):
    """The manual page with what the command's help says of each verb and option."""
    verbs = [line.split("\t")[0] for line in run("kel __complete ''", environment).splitlines()]
    for verb in [*verbs, ""]:
        begin = f'.\\" From `{f"kel help {verb}".strip()}`:\n'
        if begin not in page:
            page = page.replace(".SH GLOBAL OPTIONS\n", f'{begin}.\\" End.\n.SH GLOBAL OPTIONS\n')
        before, rest = page.split(begin)
        page = before + begin + manual_part(verb, environment) + rest[rest.index('.\\" End.\n'):]
    return page


def help_faults(environment):
    """What is written down about the command, and follows from its rows."""
    page = (ROOT / "docs/kel.1").read_text()
    if page != with_help(page, environment):
        yield "docs/kel.1: differs from the command's help; scripts/check-docs.py --update writes it"
    for schema in sorted((ROOT / "docs").glob("*.schema.json")):
        document = json.loads(schema.read_text())
        verb, form = re.match(r"kel (\w+) --format (\w+)", document["title"]).groups()
        if f"--format={form}" not in run(f"kel __complete {verb} --format={form}", environment).split():
            yield f"{schema.name}: kel {verb} has no format {form}"
        purposes = document["properties"].get("purpose", {"enum": []})["enum"]
        if purposes and purposes != run("kel __complete sources --for ''", environment).split():
            yield f"{schema.name}: these are not the purposes of kel sources: {purposes}"


def page_faults(environment):
    """The pages of the headers, without a warning."""
    printed = run("mkdir -p build && doxygen docs/Doxyfile", environment)
    if "warning" in printed or "error" in printed:
        yield f"docs/Doxyfile: {printed}"


def program_and_page_faults(build, environment):
    """The programs of the documents, and the pages of the headers."""
    readme = (ROOT / "README.md").read_text()
    for name in DOCUMENTS:
        for call in calls_of(readme)[:2 if name == "README.md" else 1]:
            yield from program_faults(name, (ROOT / name).read_text(), call, build)
    if blocks(readme, "cpp") != [(ROOT / "examples/consumer/program.cpp").read_text()]:
        yield "examples/consumer/program.cpp is not the program of README.md"
    yield from page_faults(environment)


def main():
    words = [word for word in sys.argv[1:] if not word.startswith("--")]
    build = words[0] if words else "build/gcc-release"
    environment = dict(os.environ, PATH=f"{ROOT / build / 'bin'}:{os.environ['PATH']}")
    if "--update" in sys.argv:
        page = ROOT / "docs/kel.1"
        page.write_text(with_help(page.read_text(), environment))
        for name in TRANSCRIPTS:
            (ROOT / name).write_text(with_calls((ROOT / name).read_text(), environment))
        return 0
    faults = [fault for name in DOCUMENTS + TRANSCRIPTS for fault in document_faults(name, environment)]
    faults += [*code_faults(environment), *literal_faults(environment), *help_faults(environment)]
    if "--calls" not in sys.argv:
        faults += program_and_page_faults(build, environment)
    print("\n".join(faults) or "The documents' examples print what they show")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
