#!/usr/bin/env python3
"""Checks that tests are found by name.

A file tests/FOLDER/NAMETest.cpp opens with a sentence. NAME begins with the file's class: a class, structure, enumeration or
function that a header of the layer src/FOLDER declares, or a file of that layer. Each suite of the file begins with the same
class. Two kinds of folders hold tests that belong to no single layer: in tests/tools, a program (the tests run it) or what is
built into a package takes the place of the class; tests/instructions measures a class of any layer.

Every namespace of tests/ is vespscope::test or lies in it, except that of tests/mutation/Switch.h, which is written into the
mutated tree. Tests that docs/reliability.md and SECURITY.md name must exist under their full names.

usage: check-tests.py [ROOT]
"""
import os
import re
import sys

# What the tests in tests/tools run or read: the programs, and what is built into their packages.
PROGRAMS = ("Vespscope", "Rhoxd", "Vespctl", "Wireshark", "Package", "Manual", "Completion", "ServiceUnit")
TOOLS = os.path.join("tests", "tools")
INSTRUCTIONS = os.path.join("tests", "instructions")
SUITE = re.compile(r"^(?:TEST|TEST_F|TEST_P|TYPED_TEST)\(\s*(\w+)\s*,\s*(\w+)\s*\)", re.MULTILINE)
DECLARED = re.compile(r"\b(?:class|struct|enum class|enum|using|concept)\s+([A-Z]\w+)|^[\w:<>,&*\[\] ]*?\b([a-z]\w+)\(", re.MULTILINE)
NAMESPACE = re.compile(r"^(?:inline )?namespace (\w[\w:]*) \{", re.MULTILINE)
OWN_NAMESPACE = (os.path.join("tests", "mutation", "Switch.h"),)
NAMED_TEST = re.compile(r"`([A-Z]\w+)\.([A-Z]\w+)(…?)`")


def names_of_layers(root):
    """Returns the names that a file of tests may begin with, by the folder of the layer below src/."""
    layers = {}
    for folder, folders, files in os.walk(os.path.join(root, "src")):
        folders.sort()
        place = os.path.relpath(folder, os.path.join(root, "src"))
        while place and not os.path.exists(os.path.join(root, "src", place, "CMakeLists.txt")):
            place = os.path.dirname(place)  # a folder within a layer
        names = layers.setdefault(place, set())
        for file in files:
            if file.endswith((".h", ".cpp", ".qml", ".proto")):
                stem = os.path.splitext(file)[0]
                names.add(stem[0].upper() + stem[1:])
            if file.endswith(".h"):
                with open(os.path.join(folder, file), encoding="utf-8") as text:
                    for one, other in DECLARED.findall(text.read()):
                        names.add(one or other[0].upper() + other[1:])
    return {place: {name for name in names if len(name) > 2} for place, names in layers.items()}


def names_for(root, path, layers):
    """Returns the names that the file of tests may begin with, and where they come from as messages name it."""
    folder = os.path.dirname(path)
    if folder == INSTRUCTIONS:
        return set().union(*layers.values()), "src/"
    place = os.path.relpath(folder, "tests")
    layer = place if os.path.isdir(os.path.join(root, "src", place)) else ""
    while layer and layer not in layers:
        layer = os.path.dirname(layer)
    names = layers.get(layer, set()) if layer else set()
    return names | set(PROGRAMS if folder == TOOLS else ()), "src/" + place


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


def begins_with(text, name):
    return text.startswith(name) and (len(text) == len(name) or not text[len(name)].islower())


def class_of(text, names):
    """Returns the longest of the names that the text begins with, or None."""
    return max((name for name in names if begins_with(text, name)), key=len, default=None)


def problems_of_file(path, text, names, place):
    stem = os.path.basename(path).removesuffix("Test.cpp")
    if not text.startswith("// "):
        yield f"{path}:1: does not open with a sentence"
    name = class_of(stem, names)
    if name is None:
        yield f"{path}: {stem} begins with no name of {place}"
        return
    for match in SUITE.finditer(text):
        if not begins_with(match.group(1), name):
            line = text.count("\n", 0, match.start()) + 1
            yield f"{path}:{line}: suite {match.group(1)} does not begin with {name}, the class of the file"


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
    layers = names_of_layers(root)
    problems, tests = [], set()
    for path in test_files(root):
        with open(os.path.join(root, path), encoding="utf-8") as file:
            text = file.read()
        tests.update(f"{suite}.{name}" for suite, name in SUITE.findall(text))
        problems += problems_of_file(path, text, *names_for(root, path, layers))
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
