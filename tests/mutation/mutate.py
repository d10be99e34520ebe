#!/usr/bin/env python3
"""Changes one operator, constant or condition of the decoder at a time and checks whether the tests detect it.

All mutants are compiled into one copy of the tree, each behind a switch that is thrown while a program runs: one build
serves them all. Mutants that do not compile are left out. A mutant is caught when a test program fails, crashes or
hangs with it.

usage: mutate.py [COUNT [SEED]]    COUNT mutants chosen by SEED (1); all without
"""
import concurrent.futures
import os
import random
import re
import subprocess
import sys
import time

from find_mutants import find_mutants

TOP = os.getcwd()
WORK = os.path.join(TOP, "build", "mutation")
TREE = os.path.join(WORK, "tree")
BUILD = os.path.join(WORK, "out")
# The reader with all operations of messages, the registry check, and the decoder with its conversions.
FOLDERS = ["src/messages", "src/registry", "src/metrics"]
PROGRAMS = ["test_registry", "test_metrics", "test_messages", "replay_decoder", "replay_messages"]
BAR = 95  # percent caught


def hand_written():
    for folder in FOLDERS:
        for name in sorted(os.listdir(folder)):
            if name.endswith((".h", ".cpp")):
                yield os.path.join(folder, name)


def source_of(path):
    with open(path, "rb") as file:
        return file.read()


def write_if_new(path, content):
    if os.path.exists(path):
        with open(path, "rb") as file:
            if file.read() == content:
                return
    os.makedirs(os.path.dirname(path), exist_ok=True)
    with open(path, "wb") as file:
        file.write(content)


def key_of(mutant, sources):
    """A mutant's name in equal.txt: file, change, the line of the source without its indentation, and the place in it."""
    source = sources[mutant.path]
    start = source.rfind(b"\n", 0, mutant.begin) + 1
    line = source[start:].split(b"\n", 1)[0].decode()
    return mutant.path, mutant.words, line.strip(), str(mutant.begin - start - len(line) + len(line.lstrip()))


def equal_mutants():
    with open(os.path.join(TOP, "tests", "mutation", "equal.txt"), encoding="utf-8") as file:
        return {tuple(line.rstrip("\n").split("\t")) for line in file if line.strip() and not line.startswith("#")}


def copy_tree(skip):
    listed = subprocess.run(["git", "ls-files", "-co", "--exclude-standard"], check=True, capture_output=True, text=True)
    for path in listed.stdout.splitlines():
        if path in skip or not os.path.isfile(path):
            continue
        with open(path, "rb") as file:
            write_if_new(os.path.join(TREE, path), file.read())


def render(source, begin, end, mutants):
    """The text between two places with every mutant in it behind its switch; line numbers do not change."""
    out = []
    at = begin
    index = 0
    while index < len(mutants):
        number, first = mutants[index]
        same = [(n, m) for n, m in mutants if (m.begin, m.end) == (first.begin, first.end)]
        inner = [(n, m) for n, m in mutants if first.begin <= m.begin and m.end <= first.end and (n, m) not in same]
        out.append(source[at : first.begin].decode())
        switched = "".join(f"mutation::on({n}) ? ({' '.join(m.text.split())}) : " for n, m in same)
        kept = render(source, first.begin, first.end, inner)
        # Both outcomes of the switch have the same type.
        out.append(f"({switched}{'bool' if same[0][1].turned else ''}({kept}))")
        at = first.end
        index += len(same) + len(inner)
    out.append(source[at:end].decode())
    return "".join(out)


def instrument(sources, mutants):
    for path, source in sources.items():
        chosen = [(number, mutant) for number, mutant in mutants if mutant.path == path]
        chosen.sort(key=lambda each: (each[1].begin, -each[1].end))
        write_if_new(os.path.join(TREE, path), render(source, 0, len(source), chosen).encode())


def build():
    """Empty when the build succeeded, else the compiler's output."""
    done = subprocess.run(["cmake", "--build", BUILD, "--target", *PROGRAMS, "--", "-k", "0"], capture_output=True, text=True)
    return "" if done.returncode == 0 else done.stdout + done.stderr


def build_what_compiles(sources, mutants):
    while True:
        instrument(sources, mutants)
        said = build()
        if not said:
            return mutants
        wrong = set()
        for path, line, column in re.findall(r"(src/[\w/]+\.(?:h|cpp)):(\d+):(\d+): (?:fatal )?error:", said):
            with open(os.path.join(TREE, path), "rb") as file:
                before = file.read().splitlines()[int(line) - 1][: int(column)].decode(errors="ignore")
            switches = re.findall(r"mutation::on\((\d+)\)", before)
            if switches:
                wrong.add(int(switches[-1]))
        if not wrong:
            sys.exit("mutate: the copy does not build:\n" + said[-4000:])
        print(f"mutate: {len(wrong)} do not compile", flush=True)
        mutants = [(number, mutant) for number, mutant in mutants if number not in wrong]


def run(command, number, limit):
    environment = dict(os.environ, MUTANT=str(number), TZ="UTC")
    process = subprocess.Popen(
        command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL, env=environment, cwd=BUILD, start_new_session=True
    )
    try:
        return process.wait(limit) == 0
    except subprocess.TimeoutExpired:
        return False
    finally:
        # Also ends its child processes, such as a death test that hangs.
        try:
            os.killpg(process.pid, 9)
        except ProcessLookupError:
            pass
        process.wait()


def commands():
    """The test runs: a program's tests in one process, except those that need separate processes."""
    found = []
    for program in PROGRAMS:
        path = os.path.join(BUILD, "bin", program)
        if program.startswith("replay_"):
            found.append([path, os.path.join(TOP, "fuzz", "corpus", program[len("replay_") :])])
            continue
        whole = [path, "--gtest_brief=1"]
        said = subprocess.run(whole, capture_output=True, text=True, cwd=BUILD).stdout
        alone = sorted(set(re.findall(r"^\[  FAILED  \] ([^ ,]+)", said, re.M)))
        fast = [path, "--gtest_brief=1", "--gtest_fail_fast"]
        found.append(fast + (["--gtest_filter=-" + ":".join(alone)] if alone else []))
        found += [fast + ["--gtest_filter=" + test] for test in alone]
    limits = []
    for command in found:
        begin = time.monotonic()
        if not run(command, 0, 600):
            sys.exit(f"mutate: fails without a mutant: {' '.join(command)}")
        limits.append(10 * (time.monotonic() - begin) + 10)
    return list(zip(found, limits))


def main():
    sources = {path: source_of(path) for path in hand_written()}
    found = []
    for path, source in sources.items():
        full = os.path.join(TREE, path)
        write_if_new(full, source)
    copy_tree(skip=set(sources))
    for path, source in sources.items():
        arguments = ["-std=c++20", "-xc++", "-I" + os.path.join(TREE, "src")]
        full = os.path.join(TREE, path)
        write_if_new(full, source)
        found += [mutant.at(path) for mutant in find_mutants(full, source, arguments)]
    mutants = list(enumerate(found, 1))
    if len(sys.argv) > 1:
        chosen = random.Random(int(sys.argv[2]) if len(sys.argv) > 2 else 1).sample(mutants, min(int(sys.argv[1]), len(mutants)))
        mutants = sorted(chosen)
    print(f"mutate: {len(mutants)} of {len(found)} places and ways to change", flush=True)
    same = equal_mutants()
    if unknown := same - {key_of(mutant, sources) for mutant in found}:
        sys.exit("mutate: no such mutant in equal.txt: " + "; ".join(map(" | ".join, sorted(unknown))))
    count = len(mutants)
    mutants = [(number, mutant) for number, mutant in mutants if key_of(mutant, sources) not in same]
    print(f"mutate: {count - len(mutants)} of them change nothing that could be noticed (equal.txt)", flush=True)
    configure = [
        "cmake", "-S", TREE, "-B", BUILD, "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Debug", "-DCMAKE_CXX_COMPILER=clang++-19",
        f"-DCMAKE_CXX_FLAGS=-include {TOP}/tests/mutation/Switch.h -w -Wno-c++11-narrowing",
        "-DCMAKE_CXX_FLAGS_DEBUG=-O0", "-DVESPSCOPE_PRECOMPILED=ON", "-DVESPSCOPE_QUICK=OFF", "-DVESPSCOPE_TESTS=ON",
    ]  # fmt: skip
    subprocess.run(configure, check=True, stdout=subprocess.DEVNULL)
    mutants = build_what_compiles(sources, mutants)
    tests = commands()
    caught = 0

    def catcher(entry):
        number, _ = entry
        return next((os.path.basename(test[0]) for test, limit in tests if not run(test, number, limit)), None)

    with (
        open(os.path.join(WORK, "mutants.txt"), "w", encoding="utf-8") as listed,
        concurrent.futures.ThreadPoolExecutor(max_workers=os.cpu_count()) as pool,
    ):
        for count, ((number, mutant), by) in enumerate(zip(mutants, pool.map(catcher, mutants)), 1):
            line = f"{mutant.path}:{mutant.line}: {mutant.words}"
            print(f"{number} {by or 'SURVIVES'} {line}", file=listed, flush=True)
            if by:
                caught += 1
            else:
                print(f"survives: {line}", flush=True)
            if count % 50 == 0:
                print(f"mutate: {caught} of the first {count} caught", flush=True)
    share = 100 * caught / len(mutants)
    print(f"mutate: {caught} of {len(mutants)} mutants caught, {share:.1f} %; all in {os.path.relpath(listed.name, TOP)}")
    if share < BAR:
        sys.exit(f"mutate: fewer than {BAR} % are caught")


main()
