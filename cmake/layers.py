"""The layers of src/ as their CMakeLists.txt files declare them: vespscope_layer(NAME [HOT] [USES layer...])."""
import os
import re

DECLARATION = re.compile(r"^vespscope_layer\((?P<name>\w+)(?P<hot>\s+HOT)?(?:\s+USES(?P<uses>(?:\s+\w+)+))?\s*\)", re.MULTILINE)
ANY_CALL = re.compile(r"^[ \t]*vespscope_layer\b.*$", re.MULTILINE)


class LayerError(Exception):
    """A declaration that cannot be read, with its file and line."""


class Layer:
    def __init__(self, folder, name, uses):
        self.folder = folder  # relative to the root, such as "src/platform/log"
        self.name = name
        self.uses = uses  # names of the layers used directly


def read_layers(root):
    """Returns the layers below root/src by folder. Raises LayerError for a declaration that is not understood, a name
    declared twice, and a used layer that is declared nowhere."""
    found = {}
    for folder, _, files in os.walk(os.path.join(root, "src")):
        if "CMakeLists.txt" not in files:
            continue
        path = os.path.join(folder, "CMakeLists.txt")
        with open(path, encoding="utf-8") as file:
            text = re.sub(r"#.*", "", file.read())
        # A declaration may be inside if(); its indentation is ignored.
        flush = re.sub(r"^[ \t]+(?=vespscope_layer)", "", text, flags=re.MULTILINE)
        calls = list(ANY_CALL.finditer(flush))
        matches = {match.start(): match for match in DECLARATION.finditer(flush)}
        for call in calls:
            if call.start() not in matches:
                line = flush.count("\n", 0, call.start()) + 1
                raise LayerError(f"{os.path.relpath(path, root)}:{line}: cannot read this layer: {call.group(0).strip()}")
        if len(calls) > 1:
            raise LayerError(f"{os.path.relpath(path, root)}: declares {len(calls)} layers; a folder is one layer")
        for match in matches.values():
            relative = os.path.relpath(folder, root)
            found[relative] = Layer(relative, match.group("name"), (match.group("uses") or "").split())
    names = {}
    for layer in found.values():
        if layer.name in names:
            raise LayerError(f"{layer.folder}: layer {layer.name} is declared in {names[layer.name]} too")
        names[layer.name] = layer.folder
    for layer in found.values():
        for used in layer.uses:
            if used not in names:
                raise LayerError(f"{layer.folder}: layer {layer.name} uses {used}, which is declared nowhere")
    return found


def closure(name, uses):
    """Returns the layers that `name` reaches over `uses` (name -> names used directly), itself included."""
    reached, waiting = set(), [name]
    while waiting:
        layer = waiting.pop()
        if layer not in reached:
            reached.add(layer)
            waiting += uses.get(layer, [])
    return reached


def circles(layers):
    """Returns the names of the layers that use themselves over others."""
    uses = {layer.name: layer.uses for layer in layers.values()}
    return sorted(name for name, used in uses.items() if any(name in closure(other, uses) for other in used))


def reduced(layers):
    """Returns name -> the layers used directly that no other used layer implies."""
    uses = {layer.name: layer.uses for layer in layers.values()}
    return {
        name: sorted(used for used in set(direct)
                     if not any(other != used and used in closure(other, uses) for other in direct))
        for name, direct in uses.items()
    }


def drawn(layers):
    """Returns the map as lines of text: levels from the top, each with its layers and the arrows that they need."""
    if circles(layers):
        return ["(a circle)"]
    arrows = reduced(layers)
    height = {}

    def height_of(name):
        if name not in height:
            height[name] = 1 + max((height_of(used) for used in arrows[name]), default=-1)
        return height[name]

    folders = {layer.name: layer.folder.removeprefix("src/") for layer in layers.values()}
    for name in arrows:
        height_of(name)
    width = max(len(folder) for folder in folders.values())
    lines = []
    for storey in range(max(height.values()), -1, -1):
        for name in sorted((name for name in arrows if height[name] == storey), key=lambda name: folders[name]):
            used = ", ".join(sorted(folders[used] for used in arrows[name]))
            lines.append(f"{storey}  {folders[name]:<{width}}  {'-> ' + used if used else ''}".rstrip())
    return lines
