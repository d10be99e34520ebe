#!/usr/bin/env python3
"""Runs clang-tidy on every source of src/, in as many processes as there are cores.

Most of the time goes into the headers that every file includes, so files are checked in groups: a group is one file
that includes its members, which share no name in their anonymous namespaces. Where members still do not compile
together, those with the errors are checked in a group of their own.

Excludes the tests, because analysing the test framework's macros takes half a minute per file.

With --deep the analyzer also follows paths through the functions.

usage: run-tidy.py [--deep] BUILD_FOLDER [FILE...]
"""
import collections
import concurrent.futures
import itertools
import json
import os
import re
import shlex
import subprocess
import sys


# Excludes unix.Stream, which does not know that libpcap takes ownership of a stream, nor that a short fread ends a
# loop; and NewDeleteLeaks, because the address sanitizer finds leaks.
DEEP = ("--checks=clang-analyzer-core.*,clang-analyzer-cplusplus.*,clang-analyzer-unix.*,-clang-analyzer-unix.Stream,"
        "-clang-analyzer-cplusplus.NewDeleteLeaks")
LARGEST_GROUP = 24
INCLUDE = '#include "{}"  // NOLINT(bugprone-suspicious-include)\n'
FINDING = re.compile(r"(?:warning|error): .*\[[\w.,-]+\]$", re.MULTILINE)
NOT_TOGETHER = re.compile(r"^(.*?):\d+:\d+: error: .*\[clang-diagnostic-error", re.MULTILINE)
NOT_CODE = re.compile(r'//[^\n]*|/\*.*?\*/|"(?:\\.|[^"\\\n])*"|\'(?:\\.|[^\'\\\n])+\'', re.DOTALL)
ALIAS = re.compile(r"^\s*using (\w+) =", re.MULTILINE)
BRACE = re.compile(r"[{}]")
DECLARED = re.compile(r"(?<!::)\b(\w+)\s*[({=\[]")


def flags_of(entry):
    """The compiler's options, without its name and those of the input and the output."""
    words = list(itertools.dropwhile(lambda word: not word.startswith("-"), shlex.split(entry["command"])))
    drop = {place + offset for place, word in enumerate(words) if word in ("-o", "-c") for offset in (0, 1)}
    return tuple(word for place, word in enumerate(words) if place not in drop)


def local_names(path):
    """What a file declares for itself alone: names at the top of its anonymous namespaces, and its aliases."""
    with open(path, encoding="utf-8") as file:
        text = NOT_CODE.sub(" ", file.read())
    names = set(ALIAS.findall(text))
    for region in re.finditer(r"\bnamespace\s*\{", text):
        depth = 1
        start = place = region.end()
        while depth > 0:
            place = next(BRACE.finditer(text, place)).end()
            before = depth
            depth += 1 if text[place - 1] == "{" else -1
            if before == 1:
                names.update(DECLARED.findall(text, start, place))
            start = place
    return names


def groups_of(entries):
    """Lists of (flags, [path...]): files that are compiled alike and share no name of their own, the largest first."""
    alike = collections.defaultdict(list)
    for path, entry in sorted(entries.items()):
        alike[flags_of(entry)].append(path)
    groups = []
    for flags, paths in alike.items():
        open_groups = []
        for path in paths:
            names = local_names(path)
            for taken, members in open_groups:
                if len(members) < LARGEST_GROUP and taken.isdisjoint(names):
                    break
            else:
                taken, members = set(), []
                open_groups.append((taken, members))
            taken |= names
            members.append(path)
        groups += [(flags, members) for _, members in open_groups]
    return sorted(groups, key=lambda group: -len(group[1]))


class Tidy:
    def __init__(self, build, extra):
        self.folder = os.path.join(os.path.abspath(build), "tidy")
        self.extra = extra
        self.top = os.getcwd()
        os.makedirs(self.folder, exist_ok=True)

    def check(self, flags, paths):
        """The findings in `paths`, each as the text that clang-tidy prints for a group."""
        if len(paths) == 1:
            name = os.path.join(self.top, paths[0])
        else:
            name = os.path.join(self.folder, paths[0].replace("/", "-"))
            with open(name, "w", encoding="utf-8") as file:
                file.writelines(INCLUDE.format(os.path.join(self.top, path)) for path in paths)
        result = subprocess.run(["clang-tidy-19", "--quiet", *self.extra, name, "--", *flags],
                                capture_output=True, text=True)
        failed = {os.path.relpath(path, self.top) for path in NOT_TOGETHER.findall(result.stdout)}
        if failed and len(paths) > 1:
            apart = [path for path in paths if path in failed] or paths[len(paths) // 2:]
            if len(apart) == len(paths):
                apart = paths[len(paths) // 2:]
            return self.check(flags, apart) + self.check(flags, [path for path in paths if path not in apart])
        if result.returncode != 0 or FINDING.search(result.stdout):
            return [f"{' '.join(paths)}:\n{result.stdout}{result.stderr}"]
        return []


def main():
    arguments = sys.argv[1:]
    extra = [DEEP] if "--deep" in arguments else []
    build, *files = [each for each in arguments if each != "--deep"]
    top = os.getcwd()
    with open(os.path.join(build, "compile_commands.json"), encoding="utf-8") as file:
        known = {os.path.relpath(entry["file"], top): entry for entry in json.load(file)}
    wanted = files or [path for path in known if path.startswith("src/")]
    missing = [path for path in wanted if path not in known]
    if missing:
        sys.exit(f"run-tidy: not part of the build: {', '.join(missing)}")

    tidy = Tidy(build, extra)
    findings = []
    done = 0
    with concurrent.futures.ThreadPoolExecutor(max_workers=os.cpu_count()) as pool:
        started = {pool.submit(tidy.check, flags, paths): len(paths)
                   for flags, paths in groups_of({path: known[path] for path in wanted})}
        for future in concurrent.futures.as_completed(started):
            done += started[future]
            if sys.stderr.isatty():
                print(f"\rclang-tidy {done}/{len(wanted)}", end="", file=sys.stderr, flush=True)
            for finding in future.result():
                findings.append(finding)
                print(finding)
    if sys.stderr.isatty():
        print(file=sys.stderr)
    print(f"clang-tidy: {len(wanted)} files, {len(findings)} findings" if findings
          else f"clang-tidy: {len(wanted)} files, no findings")
    return 1 if findings else 0


sys.exit(main())
