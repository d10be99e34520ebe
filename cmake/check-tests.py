#!/usr/bin/env python3
"""Checks that tests are found by name.

In tests/, a file NAMETest.cpp opens with a sentence. NAME, and each of its suites, begins with a class, struct, enumeration,
function or file of src/ (of any layer), or with a program whose process is under test. Every namespace of tests/ is
vespscope::test or lies in it, except that of tests/mutation/Switch.h, which is written into the mutated tree. Tests that
docs/reliability.md and SECURITY.md name must exist under their full names.

usage: check-tests.py [ROOT]
"""
import os
import re
import sys

# The subjects of process tests: the programs and their installed artefacts, as users see them.
PROGRAMS = ("Vespscope", "Rhoxd", "Vespctl", "Wireshark", "Package", "Manual", "Completion")
SUITE = re.compile(r"^(?:TEST|TEST_F|TEST_P|TYPED_TEST)\(\s*(\w+)\s*,\s*(\w+)\s*\)", re.MULTILINE)
DECLARED = re.compile(r"\b(?:class|struct|enum class|enum|using|concept)\s+([A-Z]\w+)|^[\w:<>,&*\[\] ]*?\b([a-z]\w+)\(", re.MULTILINE)
NAMESPACE = re.compile(r"^(?:inline )?namespace (\w[\w:]*) \{", re.MULTILINE)
OWN_NAMESPACE = (os.path.join("tests", "mutation", "Switch.h"),)
NAMED_TEST = re.compile(r"`([A-Z]\w+)\.([A-Z]\w+)(…?)`")


def names_of_sources(root):
    """Returns every name that a suite may begin with."""
    names = set(PROGRAMS)
    for folder, _, files in os.walk(os.path.join(root, "src")):
        for file in files:
            if file.endswith((".h", ".cpp", ".qml")):
                names.add(os.path.splitext(file)[0])
                if file.endswith(".h"):
                    with open(os.path.join(folder, file), encoding="utf-8") as text:
                        for one, other in DECLARED.findall(text.read()):
                            names.add(one or other[0].upper() + other[1:])
    for folder, _, files in os.walk(os.path.join(root, "tests", "support")):
        names.update(os.path.splitext(file)[0] for file in files if file.endswith(".h"))
    return {name for name in names if len(name) > 2}


def test_files(root):
    for folder, _, files in os.walk(os.path.join(root, "tests")):
        for file in sorted(files):
            if file.endswith("Test.cpp"):
                yield os.path.relpath(os.path.join(folder, file), root)


def problems_of_namespaces(root):
    for folder, _, files in os.walk(os.path.join(root, "tests")):
        for file in sorted(files):
            path = os.path.relpath(os.path.join(folder, file), root)
            if not file.endswith((".h", ".cpp")) or path in OWN_NAMESPACE:
                continue
            with open(os.path.join(root, path), encoding="utf-8") as source:
                text = source.read()
            for match in NAMESPACE.finditer(text):
                if not (match.group(1) + "::").startswith("vespscope::test::"):
                    line = text.count("\n", 0, match.start()) + 1
                    yield f"{path}:{line}: namespace {match.group(1)} is not in vespscope::test"


def begins_with_a_name(text, names):
    return any(text[:end] in names and (end == len(text) or text[end].isupper() or text[end].isdigit())
               for end in range(3, len(text) + 1))


def problems_of_file(path, text, names):
    stem = os.path.basename(path).removesuffix("Test.cpp")
    if not text.startswith("// "):
        yield f"{path}:1: does not open with a sentence"
    if not begins_with_a_name(stem, names):
        yield f"{path}: {stem} begins with no name of src/"
    for match in SUITE.finditer(text):
        if not begins_with_a_name(match.group(1), names):
            line = text.count("\n", 0, match.start()) + 1
            yield f"{path}:{line}: suite {match.group(1)} begins with no name of src/"


def problems_of_document(path, text, tests):
    for match in NAMED_TEST.finditer(text):
        line = text.count("\n", 0, match.start()) + 1
        name = f"{match.group(1)}.{match.group(2)}"
        if match.group(3):
            yield f"{path}:{line}: names {name} only in part"
        elif name not in tests:
            yield f"{path}:{line}: names {name}, which is no test"


def main(arguments):
    root = arguments[0] if arguments else "."
    names = names_of_sources(root)
    problems, tests = [], set()
    for path in test_files(root):
        with open(os.path.join(root, path), encoding="utf-8") as file:
            text = file.read()
        tests.update(f"{suite}.{name}" for suite, name in SUITE.findall(text))
        problems += problems_of_file(path, text, names)
    problems += problems_of_namespaces(root)
    for folder, _, files in os.walk(os.path.join(root, "tests")):
        for file in files:  # tests in Python and test programs of their own
            if file.endswith("Test.py"):
                with open(os.path.join(folder, file), encoding="utf-8") as text:
                    source = text.read()
                for suite in re.findall(r"^class (\w+)\(unittest", source, re.MULTILINE):
                    tests.update(f"{suite}.{name}" for name in re.findall(r"def test_(\w+)", source))
    for path in ("docs/reliability.md", "SECURITY.md"):
        whole = os.path.join(root, path)
        if os.path.exists(whole):
            with open(whole, encoding="utf-8") as file:
                problems += problems_of_document(path, file.read(), tests)
    if problems:
        print("\n".join(problems))
    return 1 if problems else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
