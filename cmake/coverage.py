#!/usr/bin/env python3
"""Prints the lines and branches of src/ that a test run has reached, by part of the tree, and fails below the bars.

Lines are those with code; branches are both outcomes of every condition in the source. A template counts once, as
reached if any of its instances was.

usage: coverage.py BUILD_FOLDER [--missed FOLDER...]

With --missed it lists the lines that were not reached in those folders of src/ instead.
"""
import collections
import glob
import json
import os
import subprocess
import sys

SUBSYSTEMS = {
    "shell": ["shell"],
    "client": ["client"],
    "messages": ["messages"],
    "metrics": ["metrics", "registry"],
    "screens": ["screens"],
}
REST = ["values", "platform", "rhoxlink", "manager", "capture", "tools"]
FRONTENDS = ["frontends"]
# Percent of lines and of branches.
BARS = {"subsystem": (95, 85), "rest": (90, 0)}


class Reached:
    """Of one file: maps each line to whether it was reached, and each (place of a condition, outcome) likewise."""

    def __init__(self):
        self.lines = {}
        self.branches = {}


def settled_lines(path):
    """Lines of the field tables, which the compiler evaluates and no program runs."""
    settled = set()
    inside = False
    with open(path, encoding="utf-8") as source:
        for number, line in enumerate(source, 1):
            inside = inside or line.startswith("  static constexpr auto fieldTable() {")
            if inside:
                settled.add(number)
            inside = inside and line != "  }\n"
    return settled


def measure(build):
    """Reached, by path below src/."""
    raw = glob.glob(os.path.join(build, "profiles", "*.profraw"))
    if not raw:
        sys.exit(f"coverage: no profiles in {build}; run the tests first")
    profile = os.path.join(build, "profiles", "all.profdata")
    subprocess.run(["llvm-profdata-19", "merge", "-o", profile, *raw], check=True)
    programs = [path for path in sorted(glob.glob(os.path.join(build, "bin", "*"))) if os.access(path, os.X_OK)]
    objects = [programs[0]] + [word for program in programs[1:] for word in ("-object", program)]

    def export(*how):
        command = ["llvm-cov-19", "export", *how, f"-instr-profile={profile}", *objects]
        return subprocess.run(command, check=True, capture_output=True, text=True).stdout

    sources = os.path.join(os.getcwd(), "src") + os.sep
    files = collections.defaultdict(Reached)

    def reached(name):
        # Programs name their sources relative to the top of the tree, which is written as /.
        path = name if name.startswith(sources) else os.path.join(os.getcwd(), name.lstrip("/"))
        return files[path[len(sources):]] if path.startswith(sources) and os.path.exists(path) else None

    current = None
    for line in export("-format=lcov").splitlines():
        kind, _, rest = line.partition(":")
        if kind == "SF":
            current = reached(rest)
        elif kind == "DA" and current is not None:
            number, count = rest.split(",")[:2]
            current.lines[int(number)] = current.lines.get(int(number), False) or int(count) > 0
    for file in json.loads(export("-format=text", "-skip-functions", "-skip-expansions"))["data"][0]["files"]:
        current = reached(file["filename"])
        if current is None:
            continue
        # Every instance of a template lists the conditions again.
        for branch in file["branches"]:
            for outcome, count in enumerate(branch[4:6]):
                key = (*branch[:4], outcome)
                current.branches[key] = current.branches.get(key, False) or count > 0
    for path, file in files.items():
        for number in settled_lines(os.path.join("src", path)):
            file.lines.pop(number, None)
    return files


def percent(reached):
    return 100 * sum(reached) / len(reached) if reached else 100.0


def row(name, files, folders, bar):
    chosen = [file for path, file in files.items() if path.split(os.sep)[0] in folders]
    lines = [value for file in chosen for value in file.lines.values()]
    branches = [value for file in chosen for value in file.branches.values()]
    figures = percent(lines), percent(branches)
    held = bar is None or (bool(lines) and figures[0] >= bar[0] and figures[1] >= bar[1])
    print(f"{name:<28}{sum(lines):>7}/{len(lines):<7}{figures[0]:6.1f} %{sum(branches):>9}/{len(branches):<7}"
          f"{figures[1]:6.1f} %{'' if held else '  below the bar'}")
    return held


def name_missed(files, folders):
    for path in sorted(files):
        if not any(path == folder or path.startswith(folder.rstrip(os.sep) + os.sep) for folder in folders):
            continue
        file = files[path]
        with open(os.path.join("src", path), encoding="utf-8") as source:
            text = source.read().splitlines()
        half = {key[0] for key, value in file.branches.items() if not value}
        for number in sorted({line for line, value in file.lines.items() if not value} | half):
            mark = "branch" if file.lines.get(number, True) else "line"
            print(f"src/{path}:{number}: {mark}: {text[number - 1].strip()}")


def main():
    files = measure(sys.argv[1])
    if sys.argv[2:3] == ["--missed"]:
        return name_missed(files, sys.argv[3:])
    print(f"{'':<28}{'lines':>18}{'branches':>25}")
    held = [row(f"subsystem {name}", files, folders, BARS["subsystem"]) for name, folders in SUBSYSTEMS.items()]
    held.append(row("the five subsystems", files, sum(SUBSYSTEMS.values(), []), BARS["subsystem"]))
    for folder in REST:
        row(folder, files, [folder], None)
    held.append(row("the rest, no frontends", files, REST, BARS["rest"]))
    row("frontends", files, FRONTENDS, None)
    known = sum(SUBSYSTEMS.values(), []) + REST + FRONTENDS
    unknown = sorted({path.split(os.sep)[0] for path in files} - set(known))
    if unknown:
        sys.exit(f"coverage: folders that no row counts: {', '.join(unknown)}")
    if not all(held):
        sys.exit("coverage: below the bars")


main()
