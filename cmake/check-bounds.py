#!/usr/bin/env python3
"""Makes SECURITY.md's table of bounds from cmake/bounds.toml and the constants that it names, and checks it.

The code declares each value; a row names the constants ("path:identifier"), what they bound, the unit, what happens beyond, and
the tests at the bound: one that is still taken, one that is not. The check fails when the table differs, a constant is
gone, or a test is.

usage: check-bounds.py [--write] [ROOT]
"""
import os
import re
import sys
import tomllib

BEGIN = "<!-- bounds: written by cmake/check-bounds.py --write -->"
END = "<!-- bounds: end -->"
SUITE = re.compile(r"^(?:TEST|TEST_F|TEST_P)\(\s*(\w+)\s*,\s*(\w+)\s*\)", re.MULTILINE)
# What may stand in a constant's value besides numbers and operators.
NOISE = re.compile(r"std::size_t|std::uint64_t|std::chrono::(?:milliseconds|seconds)|(?<=\d)(?:ULL|UL|U|ms|s)\b|(?<=\d)'(?=\d)|[{}]")
UNITS = {"bytes": ((1 << 20, "MiB"), (1 << 10, "KiB"), (1, "bytes")), "ms": ((1000, "s"), (1, "ms"))}


def read(root, path):
    with open(os.path.join(root, path), encoding="utf-8") as file:
        return file.read()


def value_of(root, name):
    """Returns the number that the constant has in the source."""
    path, identifier = name.split(":")
    # A member of a structure of bounds counts, a variable of another name does not.
    found = re.findall(rf"^[^/\n]*(?<!\w\.)\b{identifier}\s*(?:=\s*([^;,\n]+)|(\{{[\d' ()+*<]+\}}))[;,]",
                       read(root, os.path.join("src", path)), re.MULTILINE)
    if len(found) != 1:
        raise LookupError(f"src/{path}: {len(found)} declarations of {identifier}")
    expression = NOISE.sub("", next(part for part in found[0] if part)).strip()
    if not re.fullmatch(r"[\d\s()+*<-]+", expression):
        raise LookupError(f"src/{path}: {identifier} is {expression}, which is no number")
    return eval(expression)  # digits and operators only


def words_of(value, unit):
    for size, name in UNITS.get(unit, ((1, unit),)):
        if value % size == 0:
            return f"{value // size:,} {name}"
    return None


def table_of(root, rows):
    lines = ["| what | bound | beyond | tests at the bound |", "|---|---|---|---|"]
    for row in rows:
        bounds = "; ".join(words_of(value_of(root, name), unit) for name, unit in row["bounds"])
        tests = ", ".join(f"`{test}`" for test in row["tests"])
        lines.append(f"| {row['what']} | {bounds} | {row['beyond']} | {tests} |")
    return "\n".join(lines)


def test_names(root):
    names = set()
    for folder, _, files in os.walk(os.path.join(root, "tests")):
        for file in files:
            if file.endswith("Test.cpp"):
                names.update(f"{suite}.{name}" for suite, name in SUITE.findall(read(folder, file)))
    return names


def main(arguments):
    write = "--write" in arguments
    root = next((argument for argument in arguments if argument != "--write"), ".")
    with open(os.path.join(root, "cmake", "bounds.toml"), "rb") as file:
        rows = tomllib.load(file)["bound"]
    known = test_names(root)
    problems = [f"cmake/bounds.toml: {row['what']}: {test} is no test" for row in rows for test in row["tests"] if test not in known]
    problems += [f"cmake/bounds.toml: {row['what']}: no test" for row in rows if not row["tests"]]
    try:
        table = table_of(root, rows)
    except LookupError as problem:
        print("\n".join(problems + [str(problem)]))
        return 1
    text = read(root, "SECURITY.md")
    before, rest = text.split(BEGIN, 1)
    after = rest.split(END, 1)[1]
    made = f"{before}{BEGIN}\n{table}\n{END}{after}"
    if write:
        with open(os.path.join(root, "SECURITY.md"), "w", encoding="utf-8") as file:
            file.write(made)
    elif made != text:
        problems.append("SECURITY.md: the table of bounds differs from the code: run cmake/check-bounds.py --write")
    if problems:
        print("\n".join(problems))
    return 1 if problems else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
