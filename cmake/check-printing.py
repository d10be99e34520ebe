#!/usr/bin/env python3
"""Checks that src/ writes to the standard outputs only where texts are made printable first.

Names of files, texts of a remote manager and other outside bytes may contain escape sequences for a terminal.
Only platform/console writes to the user of a program, and platform/log writes log lines; both make every line printable.
All other code calls these. The exceptions below list what else is written to a standard output.

usage: check-printing.py [ROOT]
"""
import os
import re
import sys

PRINTS = re.compile(r"\bstd::(?:w?cout|w?cerr|w?clog|print|println|printf|vprintf|puts|putchar|perror)\b"
                    r"|\b(?:stdout|stderr)\b"
                    r"|(?<![\w:.>])(?:printf|vprintf|puts|putchar|perror|psignal|warnx?|errx?)\s*\(")
DESCRIPTORS = re.compile(r"\b(?:STDOUT_FILENO|STDERR_FILENO)\b")

BUILD_TOOL = "a program of the build, which prints names of the tree"
# file or folder -> why it prints
MAY_PRINT = {
    "src/platform/console/": "writes to the person who runs a program",
    "src/tools/vespctl/Output.cpp": "JSON, in which such characters are written by their numbers",
    "src/tools/GeneratedFiles.cpp": BUILD_TOOL,
    "src/tools/messagegen/": BUILD_TOOL,
    "src/tools/rrcgen/": BUILD_TOOL,
}
# file or folder -> what it does with the descriptors of standard output or standard error
MAY_NAME_DESCRIPTORS = {
    **MAY_PRINT,
    "src/platform/log/": "log lines, made printable",
    "src/platform/files/": "opens closed descriptors, and copies others behind them",
    "src/capture/PcapOutput.cpp": "a capture that is written to standard output",
    "src/frontends/terminal/Terminal.cpp": "the terminal's screen, made of printable cells",
    "src/rhoxlink/SshProcess.cpp": "the descriptors of the process that it starts",
    "src/sources/SourceInputs.cpp": "compares standard output with the source's files",
    "src/tools/rhoxd.cpp": "the bus protocol on standard output",
    "src/tools/vespscope.cpp": "looks whether there is a terminal",
}


def without_comments(text):
    """The code, with its line ends. A // within a text is taken for a comment, which hides nothing that prints."""
    text = re.sub(r"/\*.*?\*/", lambda match: "\n" * match.group().count("\n"), text, flags=re.S)
    return re.sub(r"//[^\n]*", "", text)


def main(arguments):
    os.chdir(arguments[0] if arguments else ".")
    problems = []
    for folder, _, files in os.walk("src"):
        for name in sorted(files):
            path = os.path.join(folder, name)
            if not name.endswith((".h", ".cpp")):
                continue
            with open(path, encoding="utf-8") as file:
                lines = without_comments(file.read()).split("\n")
            for pattern, allowed in ((PRINTS, MAY_PRINT), (DESCRIPTORS, MAY_NAME_DESCRIPTORS)):
                if path.startswith(tuple(allowed)):
                    continue
                for number, line in enumerate(lines, 1):
                    found = pattern.search(line)
                    if found:
                        problems.append(f"{path}:{number}: {found.group().rstrip('( ')}: print through platform/console")
    for path in MAY_NAME_DESCRIPTORS:
        if not os.path.exists(path):
            problems.append(f"cmake/check-printing.py: {path} does not exist")
    print("\n".join(sorted(problems)), end="\n" if problems else "")
    return 1 if problems else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
