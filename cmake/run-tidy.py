#!/usr/bin/env python3
"""Runs clang-tidy on every source of src/, in as many processes as there are cores.

Excludes the tests, because analysing the test framework's macros takes half a minute per file.

With --deep the analyzer also follows paths through the functions.

usage: run-tidy.py [--deep] BUILD_FOLDER [FILE...]
"""
import concurrent.futures
import json
import os
import subprocess
import sys


# Excludes unix.Stream, which does not know that libpcap takes ownership of a stream, nor that a short fread ends a
# loop; and NewDeleteLeaks, because the address sanitizer finds leaks.
DEEP = ("--checks=clang-analyzer-core.*,clang-analyzer-cplusplus.*,clang-analyzer-unix.*,-clang-analyzer-unix.Stream,"
        "-clang-analyzer-cplusplus.NewDeleteLeaks")


def main():
    arguments = sys.argv[1:]
    extra = [DEEP] if "--deep" in arguments else []
    build, *files = [each for each in arguments if each != "--deep"]
    top = os.getcwd()
    with open(os.path.join(build, "compile_commands.json"), encoding="utf-8") as file:
        known = {os.path.relpath(entry["file"], top) for entry in json.load(file)}
    wanted = files or sorted(path for path in known if path.startswith("src/"))
    missing = [path for path in wanted if path not in known]
    if missing:
        sys.exit(f"run-tidy: not part of the build: {', '.join(missing)}")
    failed = 0

    def check(path):
        return path, subprocess.run(["clang-tidy-19", "--quiet", *extra, "-p", build, path], capture_output=True, text=True)

    with concurrent.futures.ThreadPoolExecutor(max_workers=os.cpu_count()) as pool:
        for number, (path, result) in enumerate(pool.map(check, wanted), 1):
            if sys.stderr.isatty():
                print(f"\rclang-tidy {number}/{len(wanted)}", end="", file=sys.stderr, flush=True)
            if result.returncode != 0 or "warning:" in result.stdout:
                failed += 1
                print(f"{path}:\n{result.stdout}{result.stderr}")
    if sys.stderr.isatty():
        print(file=sys.stderr)
    print(f"clang-tidy: {len(wanted)} files, {failed} with findings")
    return 1 if failed else 0


sys.exit(main())
