#!/usr/bin/env python3
"""Checks that every file of src/ includes only layers that its own layer uses.

The one declaration of the arrows is vespscope_layer(NAME USES ...) in each folder's CMakeLists.txt. A folder without
such a line belongs to the nearest folder above that has one; programs (src/tools) may use everything. C headers that
stand behind a wrapper are included by that wrapper only.
"""
import os
import re
import subprocess
import sys

# header -> who may include it: a folder that is the wrapper as a whole, or one file
BEHIND_A_WRAPPER = {
    "systemd/sd-bus.h": ["src/rhoxlink/bus/"],
    "pcap/pcap.h": ["src/capture/PcapFile.cpp"],
    "pcap.h": ["src/capture/PcapFile.cpp"],
    "curses.h": ["src/frontends/terminal/Terminal.cpp"],
    "ncurses.h": ["src/frontends/terminal/Terminal.cpp"],
    "ncursesw/curses.h": ["src/frontends/terminal/Terminal.cpp"],
    "toml++/toml.h": ["src/manager/Configuration.cpp"],
}


def layers():
    """folder -> (layer name, names used directly)"""
    found = {}
    for folder, _, files in os.walk("src"):
        if "CMakeLists.txt" in files:
            with open(os.path.join(folder, "CMakeLists.txt"), encoding="utf-8") as file:
                match = re.search(r"vespscope_layer\((\w+)(?:\s+HOT)?(?:\s+USES\s+([^)]*))?\)", file.read())
            if match:
                found[folder] = (match.group(1), (match.group(2) or "").split())
    return found


def closure(name, uses):
    reached, waiting = set(), [name]
    while waiting:
        layer = waiting.pop()
        if layer not in reached:
            reached.add(layer)
            waiting += uses.get(layer, [])
    return reached


def main():
    folders = layers()
    uses = {name: used for name, used in folders.values()}

    def owner(path):
        folder = os.path.dirname(path)
        while folder and folder not in folders:
            folder = os.path.dirname(folder)
        return folders[folder][0] if folder else None

    problems = []
    files = subprocess.run(
        ["git", "ls-files", "-co", "--exclude-standard", "src/*.h", "src/*.cpp"],
        capture_output=True, text=True, check=True).stdout.split()
    for path in files:
        if not os.path.exists(path):
            continue
        layer = owner(path)
        allowed = closure(layer, uses) if layer else None
        with open(path, encoding="utf-8") as file:
            text = file.read()
        for line, content in enumerate(text.splitlines(), 1):
            match = re.match(r'\s*#include\s+([<"])([^>"]+)[>"]', content)
            if not match:
                continue
            name = match.group(2)
            homes = BEHIND_A_WRAPPER.get(name)
            if homes and not path.startswith(tuple(homes)):
                problems.append(f"{path}:{line}: {name} stands behind a wrapper: {', '.join(homes)}")
            if match.group(1) == '"' and allowed is not None:
                target = owner("src/" + name)
                if target is not None and target not in allowed:
                    problems.append(f"{path}:{line}: layer {layer} does not use {target} ({name})")
    for folder, (name, used) in folders.items():
        if name in set().union(*[closure(other, uses) for other in used] or [set()]):
            problems.append(f"{folder}: layer {name} uses itself in a circle")
    print("\n".join(problems))
    return 1 if problems else 0


sys.exit(main())
