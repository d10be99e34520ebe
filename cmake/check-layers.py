#!/usr/bin/env python3
"""Checks that every file of src/ includes only layers that its own layer uses, and that ARCHITECTURE.md shows them.

Layers are declared by vespscope_layer(NAME USES ...) in each folder's CMakeLists.txt. A folder without such a line
belongs to the nearest folder above that has one; programs (src/tools) may use everything. Only its wrapper may include a
C header that has one.

usage: check-layers.py [--map] [ROOT]

--map writes the map of the layers into ROOT/ARCHITECTURE.md instead of checking anything.
"""
import os
import re
import sys

sys.path.insert(0, os.path.dirname(os.path.abspath(__file__)))
from layers import LayerError, circles, closure, drawn, read_layers  # noqa: E402

# header -> its only users: a folder that is the wrapper as a whole, or one file
BEHIND_A_WRAPPER = {
    "systemd/sd-bus.h": ["src/rhoxlink/bus/"],
    "pcap/pcap.h": ["src/capture/PcapFile.cpp"],
    "pcap.h": ["src/capture/PcapFile.cpp"],
    "curses.h": ["src/frontends/terminal/Terminal.cpp"],
    "ncurses.h": ["src/frontends/terminal/Terminal.cpp"],
    "ncursesw/curses.h": ["src/frontends/terminal/Terminal.cpp"],
    "toml++/toml.h": ["src/manager/Configuration.cpp"],
}

MAP_BEGIN = "<!-- layers: written by cmake/check-layers.py --map -->"
MAP_END = "<!-- layers: end -->"


def sources(root):
    for folder, _, files in os.walk(os.path.join(root, "src")):
        for name in sorted(files):
            if name.endswith((".h", ".cpp")):
                yield os.path.relpath(os.path.join(folder, name), root)


def problems_of_includes(root, layers):
    uses = {layer.name: layer.uses for layer in layers.values()}

    def owner(path):
        folder = os.path.dirname(path)
        while folder and folder not in layers:
            folder = os.path.dirname(folder)
        return layers[folder].name if folder else None

    problems = []
    for path in sources(root):
        layer = owner(path)
        allowed = closure(layer, uses) if layer else None
        with open(os.path.join(root, path), encoding="utf-8") as file:
            lines = file.read().splitlines()
        for number, content in enumerate(lines, 1):
            match = re.match(r'\s*#\s*include\s+([<"])([^>"]+)[>"]', content)
            if not match:
                continue
            name = match.group(2)
            homes = BEHIND_A_WRAPPER.get(name)
            if homes and not path.startswith(tuple(homes)):
                problems.append(f"{path}:{number}: {name} stands behind a wrapper: {', '.join(homes)}")
            if match.group(1) == '"' and allowed is not None:
                target = owner("src/" + name)
                if target is not None and target not in allowed:
                    problems.append(f"{path}:{number}: layer {layer} does not use {target} ({name})")
    return problems


def with_map(text, layers):
    """Returns the document with the map of the layers in its place."""
    begin, end = text.find(MAP_BEGIN), text.find(MAP_END)
    if begin < 0 or end < begin:
        raise LayerError(f"ARCHITECTURE.md: has no place for the map ({MAP_BEGIN} … {MAP_END})")
    block = "\n".join([MAP_BEGIN, "```", *drawn(layers), "```", ""])
    return text[:begin] + block + text[end:]


def main(arguments):
    write = "--map" in arguments
    roots = [argument for argument in arguments if argument != "--map"]
    root = roots[0] if roots else "."
    document = os.path.join(root, "ARCHITECTURE.md")
    try:
        layers = read_layers(root)
        with open(document, encoding="utf-8") as file:
            text = file.read()
        wanted = with_map(text, layers)
    except LayerError as error:
        print(error)
        return 1
    if write:
        with open(document, "w", encoding="utf-8") as file:
            file.write(wanted)
        return 0
    problems = problems_of_includes(root, layers)
    problems += [f"{name}: this layer uses itself in a circle" for name in circles(layers)]
    if wanted != text:
        problems.append("ARCHITECTURE.md: the map differs from the layers; run cmake/check-layers.py --map")
    if problems:
        print("\n".join(problems))
    return 1 if problems else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
