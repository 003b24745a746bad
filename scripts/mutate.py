#!/usr/bin/env python3
"""Changes the product at random places, one place at a time, and notes which tests find each change.

usage: mutate.py draw COUNT FILE [--seed N] [--jobs N] [--first] [--commit C]
                                      draws changes, tries them and writes FILE
       mutate.py again OLD FILE       tries the changes of OLD on the present tree; same options
       mutate.py compare OLD FILE     fails if one that was found is found no more
       mutate.py show FILE            what no test finds, and what each test finds alone

With --first the first test that finds a change is enough, which takes half the time.

A change is one operator, condition, constant, statement or text of a source of the library, the platform
layer or the command. One that does not compile is not counted. Each worker has a copy of the committed
tree in build/mutate, so the work tree is left alone. A draw goes on with a FILE that is there already. A
change is told by its line and the line above it, and so is found again after others have moved it. `again`
says which are gone, and tries only what was found.
"""

import argparse
import collections
import concurrent.futures
import contextlib
import json
import os
import pathlib
import queue
import random
import re
import signal
import subprocess
import sys
import threading

ROOT = pathlib.Path(__file__).resolve().parent.parent
COPIES = ROOT / "build/mutate"
# Not headers: with each change of one, nearly all would be built anew.
SOURCES = ["s/*.cpp", "platform/s/*.cpp", "tools/kel/*.cpp"]
PROGRAMS = ["kel_unit_tests", "kel_api_tests"]
# Seconds for all tests of a program, which take less than five: a change may make a loop endless.
LIMIT = 60

LITERAL = r'"(?:[^"\\]|\\.)*"'
# What is changed, and into what; the first group of a pattern is what goes.
CHANGES = [
    ("operator", r"(?<=\s)(==|!=|<=|>=|&&|\|\||[-+<>])(?=\s)",
     {"==": "!=", "!=": "==", "<=": "<", ">=": ">", "<": "<=", ">": ">=", "&&": "||", "||": "&&",
      "+": "-", "-": "+"}.get),
    ("operator", r"(\+\+|--)", {"++": "--", "--": "++"}.get),
    ("condition", r"\b(?:if|while) \((?=[^;]*\) [^;]*;$|[^;]*\) \{$)()", lambda _: "!"),
    ("condition", r"\b(true|false)\b", {"true": "false", "false": "true"}.get),
    ("condition", r"(!)(?=[A-Za-z_(])(?!=)", lambda _: ""),
    ("constant", r"(?<![\w.\"'])(\d+)(?=[;,)\]}\s])", lambda number: str(int(number) + 1)),
    ("statement", r"^\s+((?!return\b|const\b|using\b|struct\b|case\b|break\b|static\b|friend\b|~)"
                  r"(?:if \([^;]*\) (?:return[^;]*|continue|throw[^;]*);"
                  r"|[\w.>:\[\]-]+(?:\([^;]*\)| \+?= [^;]*);))$", lambda _: ";"),
    ("text", rf"({LITERAL})", lambda text: text[:-1] + "~\"" if len(text) > 2 else "\"~\""),
]


def code_of(line):
    """The line without its comment; nothing for a line of the preprocessor."""
    if line.lstrip().startswith(("#", "//")):
        return ""
    comment = re.match(rf"(?:[^\"'/]|{LITERAL}|'(?:[^'\\]|\\.)*'|/(?!/))*//", line)
    return line[:comment.end() - 2].rstrip() if comment else line


def candidates(root):
    """Every change that could be drawn."""
    for pattern in SOURCES:
        for path in sorted(root.glob(pattern)):
            lines = path.read_text().split("\n")
            for number, line in enumerate(lines):
                code = code_of(line)
                literals = [match.span() for match in re.finditer(LITERAL, code)]
                for kind, expression, change in CHANGES:
                    for match in re.finditer(expression, code):
                        start, end = match.span(1)
                        in_text = any(a < start < b for a, b in literals)
                        if in_text or "static_assert" in code:
                            continue
                        yield {"kind": kind, "path": str(path.relative_to(root)), "above": lines[number - 1],
                               "line": line, "start": start, "end": end, "by": change(match.group(1))}


def place(change, root):
    """The path and the line's number where the change is to be made now, or None if it is gone."""
    own = root / change["path"]
    paths = ([own] if own.exists() else []) + [path for pattern in SOURCES for path in sorted(root.glob(pattern))]
    for needs_above in (True, False):
        for path in paths:
            lines = path.read_text().split("\n")
            found = [number for number, line in enumerate(lines) if line.strip() == change["line"].strip()
                     and (not needs_above or lines[number - 1].strip() == change["above"].strip())]
            if found and (needs_above or len(found) == 1):
                return path, found[0]
    return None


class Worker:
    """A copy of the tree with a build of its own, in which one change after the other is tried."""

    def __init__(self, number, commit, first):
        self.first = first
        self.root = COPIES / str(number)
        self.build = self.root / "build/tests"
        if not self.root.exists():
            subprocess.run(["git", "clone", "-q", ROOT, self.root], check=True)
        self.call("git", "fetch", "-q", "origin", check=True)
        self.call("git", "checkout", "-q", "--force", commit, check=True)
        self.call("cmake", "-S", ".", "-B", self.build, "-GNinja", "-DCMAKE_BUILD_TYPE=",
                  "-DCMAKE_CXX_FLAGS=-O0", "-DCMAKE_LINK_DEPENDS_NO_SHARED=ON",
                  "-DKEL_BUILD_TESTS=ON", "-DKEL_PRECOMPILE=ON", check=True)
        if not self.make():
            sys.exit(f"{self.root} does not build")
        if self.finders():
            sys.exit(f"tests fail without a change: {self.finders()}")

    def call(self, *words, check=False, seconds=None, **more):
        """The exit status and the output; a call that takes too long is ended with all that it started."""
        running = subprocess.Popen([str(word) for word in words], cwd=self.root, text=True, errors="replace",
                                   stdout=subprocess.PIPE, stderr=subprocess.STDOUT, start_new_session=True, **more)
        try:
            output = running.communicate(timeout=seconds)[0]
        except subprocess.TimeoutExpired:
            os.killpg(running.pid, signal.SIGKILL)
            return None, running.communicate()[0]
        if check and running.returncode != 0:
            sys.exit(output)
        return running.returncode, output

    def make(self):
        return self.call("cmake", "--build", self.build, "-j1", "--target", "kel", *PROGRAMS)[0] == 0

    def failures_of(self, program):
        """The failing tests of a program. One that takes the program down is named, and left out of a next run."""
        failing = []
        for _ in range(4):
            without = "-" + ":".join(failing) if failing else "*"
            status, output = self.call(self.build / "bin" / program, f"--gtest_filter={without}",
                                       *["--gtest_fail_fast"] * self.first, seconds=LIMIT)
            failing += re.findall(r"^\[  FAILED  \] (\S+) \(", output, re.MULTILINE)
            begun = re.findall(r"^\[ RUN      \] (\S+)", output, re.MULTILINE)
            if self.first and failing or status in (0, 1) or not begun or begun[-1] in failing:
                return failing + (["start"] if not begun else [])
            failing.append(begun[-1])
        return failing

    def scripts(self, *which):
        """The further tests that ctest knows and that fail; see tests/CMakeLists.txt."""
        output = self.call("ctest", "--test-dir", self.build, *which, "-j1", seconds=LIMIT)[1]
        return re.findall(r"^\s+\d+ - (\S+) \(", output, re.MULTILINE)

    def finders(self):
        """The tests that fail, of all but those that take long."""
        found = []
        for program in PROGRAMS:
            if not (self.first and found):
                found += self.failures_of(program)
        if not (self.first and found):
            found += self.scripts("-L", "quick")
        return sorted(found)

    def attempt(self, change):
        """The tests that find the change, or None if it can't be made or does not compile."""
        where = place(change, self.root)
        if where is None:
            return None
        path, number = where
        lines = path.read_text().split("\n")
        shift = len(lines[number]) - len(lines[number].lstrip()) - len(change["line"]) + len(change["line"].lstrip())
        start, end = change["start"] + shift, change["end"] + shift
        lines[number] = lines[number][:start] + change["by"] + lines[number][end:]
        if change["kind"] == "condition" and change["by"] == "!":
            close = closing(lines[number], start)
            lines[number] = lines[number][:start] + "!(" + lines[number][start + 1:close] + ")" + lines[number][close:]
        with self.saved(path):
            path.write_text("\n".join(lines))
            return self.finders() if self.make() else None

    @contextlib.contextmanager
    def saved(self, path):
        """Puts a source and its object back, so that it is not compiled again for the next change."""
        text, times = path.read_text(), (path.stat().st_atime_ns, path.stat().st_mtime_ns)
        objects = {file: file.read_bytes() for file in self.build.rglob(f"{path.name}.o")}
        try:
            yield
        finally:
            path.write_text(text)
            os.utime(path, ns=times)
            for file, content in objects.items():
                file.write_bytes(content)


def closing(line, start):
    """Where the parenthesis closes that opened before `start`."""
    depth = 1
    for at in range(start, len(line)):
        depth += {"(": 1, ")": -1}.get(line[at], 0)
        if depth == 0:
            return at
    return len(line)


def make_workers(arguments):
    commit = subprocess.run(["git", "rev-parse", arguments.commit], cwd=ROOT, check=True, capture_output=True,
                            text=True).stdout.strip()
    with concurrent.futures.ThreadPoolExecutor() as pool:
        return list(pool.map(lambda number: Worker(number, commit, arguments.first), range(arguments.jobs)))


def try_all(workers, changes, count, file, results):
    """Tries changes until `count` of them compiled, and writes each result as soon as it is there, behind the
    results of a run before."""
    waiting, lock = queue.SimpleQueue(), threading.Lock()
    tried = {key(result) for result in results}
    for change in changes:
        if key(change) not in tried:
            waiting.put(change)

    def work(worker):
        while len(results) < count and not waiting.empty():
            change = waiting.get()
            found = worker.attempt(change)
            with lock:
                if found is not None and len(results) < count:
                    results.append({**change, "found_by": found})
                    file.write_text(json.dumps(results, indent=1, ensure_ascii=False))
                    print(f"{len(results)}/{count} {change['path']}: {change['kind']}: "
                          f"{' '.join(found[:3]) or 'NOT FOUND'}", flush=True)

    threads = [threading.Thread(target=work, args=(worker,)) for worker in workers]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    return results


def key(change):
    return tuple(change[name] for name in ("path", "above", "line", "start", "by"))


def told(change):
    line = change["line"]
    return f"{change['path']}: {line[:change['start']]}[{line[change['start']:change['end']]} -> {change['by']}]" \
           f"{line[change['end']:]}"


def compare(old, new):
    found = {key(change): change["found_by"] for change in new}
    known = [change for change in old if change["found_by"]]
    gone = [change for change in known if key(change) not in found]
    lost = [change for change in known if not found.get(key(change), ["gone"])]
    for change in gone:
        print(f"gone: {told(change)}")
    for change in lost:
        print(f"not found any more: {told(change)}\n    was found by {', '.join(change['found_by'])}")
    print(f"{len(known)} of {len(old)} changes were found; {len(gone)} of them are gone, and {len(lost)} are "
          f"found no more")
    return 1 if lost else 0


def show(changes):
    alone, all_of = collections.Counter(), collections.Counter()
    for change in changes:
        if not change["found_by"]:
            print(f"not found: {told(change)}")
        for test in change["found_by"]:
            all_of[test] += 1
            alone[test] += len(change["found_by"]) == 1
    print(f"{sum(bool(change['found_by']) for change in changes)} of {len(changes)} changes are found")
    for test, number in sorted(all_of.items()):
        print(f"{test} finds {number}, {alone[test]} of them alone")


def main():
    parser = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    parser.add_argument("verb", choices=["draw", "again", "compare", "show"])
    parser.add_argument("words", nargs="+")
    parser.add_argument("--seed", type=int, default=1)
    parser.add_argument("--jobs", type=int, default=2)
    parser.add_argument("--first", action="store_true")
    parser.add_argument("--commit", default="HEAD")
    arguments = parser.parse_args()
    files = arguments.words
    if arguments.verb == "draw":
        workers = make_workers(arguments)
        changes = list(candidates(workers[0].root))
        print(f"{len(changes)} places")
        random.Random(arguments.seed).shuffle(changes)
        count, file = int(files[0]), pathlib.Path(files[1])
        before = json.loads(file.read_text()) if file.exists() else []
        return 0 if len(try_all(workers, changes, count, file, before)) == count else 1
    old = json.loads(pathlib.Path(files[0]).read_text())
    if arguments.verb == "show":
        return show(old)
    if arguments.verb == "again":
        found = [change for change in old if change["found_by"]]
        return compare(old, try_all(make_workers(arguments), found, len(found), pathlib.Path(files[1]), []))
    return compare(old, json.loads(pathlib.Path(files[1]).read_text()))


if __name__ == "__main__":
    sys.exit(main())
