#!/usr/bin/env python3
"""Checks the house rules that no compiler knows: who may include whom, how long a source is, and how much
of the code is tests.

Each rule has a sample in tests/data/house, or here, that must fail; one that passes is a failure of the
check itself.

The share of tests: lines of code (neither blank nor comment) under tests/, divided by those under tests/ and
the product's folders. It is printed, with the share of comments in sources (*.cpp of the product).
"""

import pathlib
import re
import subprocess
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent
SAMPLES = ROOT / "tests/data/house"
LONGEST_SOURCE = 600
PRODUCT = ["s", "include", "platform", "tools"]
LARGEST_SHARE_OF_TESTS = 0.33
CODE = ["*.cpp", "*.h", "*.py", "*.sh", "*.bash", "*.fish", "_kel"]
COMMENT = re.compile(r"\s*(//|#(?!\s*(include|define|undef|if|ifdef|ifndef|else|elif|endif|pragma|error)\b))")

# The modules of the whole design. One may include itself and modules of a lower rank. The first pattern that fits a file's
# path counts.
RANKS = [
    (0, r"platform/.*"),
    (1, r"include/Tarvo_Export\.h"),
    (2, r"include/Tarvo_KelDiagnostic\.h"),
    (2, r"s/Tarvo_(Word|Existence|LineFault|RangeText)\..*"),
    (3, r"s/Tarvo_DiagnosticCodes\.h"),
    (4, r"s/Tarvo_Diagnosis\..*"),
    (5, r"s/Tarvo_(Report|PropertyList|NameTable|TokenReader)\..*"),
    (6, r"(include|s)/Tarvo_(Kel_Key|KelLibrary_Utils|FileScanner)\..*"),
    (7, r"(include|s)/Tarvo_(KelRecords|TellFault)\..*"),
    (13, r"s/Tarvo_KnownProperties\.cpp"),  # its rows point at constants of the readers
    (8, r"s/Tarvo_(Guard|QVRStatement|LDXEntry|TEWLine|KnownProperties)\..*"),
    (9, r"(include|s)/Tarvo_OptionScanner\..*"),
    (10, r"(include|s)/Tarvo_Kel_Index\..*"),
    (11, r"(include|s)/Tarvo_(QVRParser|AnalyseOrder|FileKey|TellUnknown)\..*"),
    (12, r"s/Tarvo_((AnalyseOrderReader|LDXParser_Hdl)\.h|OrderPart\..*)"),
    (13, r"s/Tarvo_(OrderAnalysis|SourceMaker)\..*"),
    (14, r"(include|s)/Tarvo_(LDXParser(_Hdl|_Answers)?|TEWParser)\..*"),
    (15, r"(include|s)/Tarvo_(KelIP|VersionWalk)\..*"),
    (16, r"(include|s)/Tarvo_KelLibrary\..*"),
    (17, r"s/Tarvo_(DescriptionChecker|OrderChecker)\..*"),
    (18, r"s/Tarvo_TableChecker\..*"),
    (19, r"(include|s)/Tarvo_KelChecker\..*"),
    (20, r"s/Tarvo_Version\.cpp"),
    (21, r"(tools|tests|bench|examples)/.*"),
    (22, r"fuzz/.*"),
]
# What one of these may not include, whatever its rank.
FORBIDDEN = [
    (r"(platform/)?include/.*", r"boost/.*", "exported headers include no Boost header"),
    (r"(?!bench/).*", r"regex(\.h)?|boost/regex.*", "expressions are the platform's Port_Regexp"),
    (r"(s|include)/.*", r"(unistd|fcntl|sys/.*|dirent)(\.h)?", "only platform/ makes system calls"),
]
# A header of these folders is private, and only these may include it.
PRIVATE = [(r"s/.*", r"s/.*|tests/unit/.*|fuzz/.*"), (r"platform/s/.*", r"platform/s/.*"),
           (r"tools/.*", r"tools/.*"), (r"tests/.*", r"(tests|fuzz)/.*"), (r"bench/.*", r"bench/.*")]
INCLUDE = re.compile(r'^\s*#\s*include\s*[<"]([^>"]+)[>"]')


def rank_of(path):
    """The rank and the module of a file, or None for one that the table does not know."""
    for rank, pattern in RANKS:
        if re.fullmatch(pattern, path):
            stem = re.sub("_(Hdl|Answers)$", "", pathlib.Path(path).stem)  # second sources
            module = path.split("/")[0] if rank in (0, 21, 22) else stem
            return rank, module
    return None


def resolve(name, headers):
    """The project's header that an include names, or None for one from elsewhere."""
    return headers.get(pathlib.PurePosixPath(name).name)


def breaches(path, lines, headers):
    """What is wrong with a file, as texts with file and line."""
    own = rank_of(path)
    if own is None:
        yield f"{path}: no rank is known for this file; add it to RANKS"
        return
    if len(lines) > LONGEST_SOURCE:
        yield f"{path}: {len(lines)} lines, more than {LONGEST_SOURCE}"
    for number, line in enumerate(lines, 1):
        match = INCLUDE.match(line)
        if not match:
            continue
        name = match.group(1)
        for where, what, reason in FORBIDDEN:
            if re.fullmatch(where, path) and re.fullmatch(what, name):
                yield f"{path}:{number}: includes {name}: {reason}"
        header = resolve(name, headers)
        other = header and rank_of(header)
        for folder, users in PRIVATE:
            if header and re.fullmatch(folder, header) and not re.fullmatch(users, path):
                yield f"{path}:{number}: includes {name}, which is private to its folder"
        if other and other[0] >= own[0] and other[1] != own[1]:
            yield f"{path}:{number}: rank {own[0]} includes {name} of rank {other[0]}"


def project_files(*patterns):
    listed = subprocess.run(
        ["git", "ls-files", "-z", "--cached", "--others", "--exclude-standard", *patterns],
        cwd=ROOT, check=True, capture_output=True, text=True).stdout.split("\0")
    return [path for path in listed if path and not path.startswith("tests/data/") and (ROOT / path).exists()]


def count_lines(path):
    """How many lines of a file are code, and how many are comments."""
    lines = [line for line in (ROOT / path).read_text().splitlines() if line.strip()]
    comments = sum(bool(COMMENT.match(line)) for line in lines)
    return len(lines) - comments, comments


def share(part, whole):
    return part / max(part + whole, 1)


def faults_of_share(tests, product):
    if share(tests, product) > LARGEST_SHARE_OF_TESTS:
        yield f"tests: {share(tests, product):.1%} of the code, more than {LARGEST_SHARE_OF_TESTS:.0%}"


def size_faults():
    """Prints the shares, and gives what is wrong with them."""
    code, comments, lines = {"tests": 0, "product": 0}, 0, 0
    for path in project_files(*CODE):
        folder = path.split("/")[0]
        if folder not in ["tests", *PRODUCT]:
            continue
        own, own_comments = count_lines(path)
        code["tests" if folder == "tests" else "product"] += own
        if folder in PRODUCT and path.endswith(".cpp"):
            lines, comments = lines + own, comments + own_comments
    print(f"{code['product']} lines of product, {code['tests']} of tests: tests are "
          f"{share(code['tests'], code['product']):.1%}, comments {share(comments, lines):.1%} of sources")
    return faults_of_share(code["tests"], code["product"])


def sample_failures(headers):
    """Each sample names in its first line the path to take it for, and must breach a rule."""
    if not any(breaches("s/Tarvo_Kel_Key.cpp", [""] * (LONGEST_SOURCE + 1), headers)):
        yield "a source that is too long passes"
    if not any(faults_of_share(1, 2)):
        yield "too many tests pass"
    for sample in sorted(SAMPLES.glob("*.sample")):
        lines = sample.read_text().splitlines()
        if not any(breaches(lines[0].removeprefix("// as "), lines, headers)):
            yield f"{sample.name}: a sample that must fail passes"


def main():
    sources = project_files("*.h", "*.cpp")
    headers = {pathlib.Path(path).name: path for path in sources if path.endswith(".h")}
    found = [*sample_failures(headers), *size_faults()]
    for path in sources:
        found += breaches(path, (ROOT / path).read_text().splitlines(), headers)
    for text in found:
        print(text)
    print(f"{len(sources)} sources, {len(found)} breaches of the house rules")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
