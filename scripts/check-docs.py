#!/usr/bin/env python3
"""Runs the examples of the documents and compares what they print with what the documents show.

Usage: check-docs.py [BUILD_DIRECTORY]

In a `console` block a line behind "$ " is run with the built `kel` on the path, and the lines below
it are what it must print; a line of three dots stands for the rest. A line that ends in a backslash
goes on in the next. In a manual page the blocks are those between .EX and .EE. The `cpp` block of
README.md is compiled and run as README.md says. The project's directory is written /home/me/kel.
"""

import os
import pathlib
import re
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent
DOCUMENTS = ["README.md", "docs/kel.1"]
SHOWN_ROOT = "/home/me/kel"


def blocks(text, language):
    return re.findall(rf"^```{language}\n(.*?)^```$", text, re.MULTILINE | re.DOTALL)


# What the escapes of a manual page's examples stand for.
ESCAPES = {"-": "-", "e": "\\", "&": "", "(aq": "'", "(dq": '"', "(ha": "^", "(ti": "~", "(ga": "`"}


def manual_blocks(text):
    """The examples of a manual page as they are read, without its requests."""
    for block in re.findall(r"^\.EX\n(.*?)^\.EE$", text, re.MULTILINE | re.DOTALL):
        lines = re.sub(r"^[.'].*\n", "", block, flags=re.MULTILINE)
        yield re.sub(r"\\(\(..|.)", lambda escape: ESCAPES[escape.group(1)], lines)


def run(command, environment, directory=ROOT):
    done = subprocess.run(["bash", "-c", command], cwd=directory, env=environment,
                          capture_output=True, text=True)
    return (done.stdout + done.stderr).replace(str(ROOT), SHOWN_ROOT)


def matches(expected, printed):
    if expected.endswith("...\n"):
        return printed.startswith(expected.removesuffix("...\n"))
    return printed == expected


def console_faults(name, text, environment):
    found = list(blocks(text, "console") if name.endswith(".md") else manual_blocks(text))
    if not found:
        yield f"{name}: has no examples"
    for block in found:
        for command, expected in re.findall(r"^\$ ((?:.*\\\n)*.*)\n((?:(?!\$ ).*\n)*)", block,
                                            re.MULTILINE):
            printed = run(command, environment)
            if not matches(expected, printed):
                yield f"{name}: $ {command}\nprints\n{printed}"


def program_faults(text, build, environment):
    """The compiler's call stands in the block that names the program's file, and what the program
    prints in the one block of text."""
    (program,) = blocks(text, "cpp")
    (call,) = [block for block in blocks(text, "sh") if "program.cpp" in block]
    with tempfile.TemporaryDirectory() as scratch:
        source, binary = pathlib.Path(scratch, "program.cpp"), pathlib.Path(scratch, "program")
        source.write_text(program)
        call = call.replace("program.cpp", str(source)).replace("-o program", f"-o {binary}")
        printed = run(call.replace("build/demo", build) + f"\n{binary}", environment)
    (shown,) = blocks(text, "text")
    if printed != shown:
        yield f"README.md: the program prints\n{printed}"


def main():
    build = sys.argv[1] if len(sys.argv) > 1 else "build/gcc-release"
    environment = dict(os.environ, PATH=f"{ROOT / build / 'bin'}:{os.environ['PATH']}")
    faults = []
    for name in DOCUMENTS:
        faults += console_faults(name, (ROOT / name).read_text(), environment)
    faults += program_faults((ROOT / "README.md").read_text(), build, environment)
    print("\n".join(faults) or "The documents' examples print what they show")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
