#!/usr/bin/env python3
"""The check of the layers finds violations in every layer of the tree and in every form of declaration."""
import os
import shutil
import sys
import unittest

from planted_tree import ROOT, PlantedTree

sys.path.insert(0, os.path.join(ROOT, "cmake"))
from layers import closure, read_layers  # noqa: E402


class LayerCheck(PlantedTree):
    CHECK = "check-layers.py"

    def small_tree(self, **lines):
        """Declares one layer per argument, folder = CMake line, and writes the map."""
        self.write("ARCHITECTURE.md", "<!-- layers: written by cmake/check-layers.py --map -->\n<!-- layers: end -->\n")
        for folder, line in lines.items():
            self.write(f"src/{folder}/CMakeLists.txt", line + "\n")
            self.write(f"src/{folder}/{folder.capitalize()}.h", "#pragma once\n")

    def test_FindsAPlantedViolationInEveryLayerOfTheTree(self):
        layers = read_layers(ROOT)
        uses = {layer.name: layer.uses for layer in layers.values()}
        shutil.copy(os.path.join(ROOT, "ARCHITECTURE.md"), self.tree)
        for layer in layers.values():
            self.write(os.path.join(layer.folder, "CMakeLists.txt"),
                       f"vespscope_layer({layer.name}" + (f" USES {' '.join(layer.uses)}" if layer.uses else "") + ")\n")
            self.write(os.path.join(layer.folder, "Planted.h"), "#pragma once\n")
        self.assertEqual(self.check(), (0, ""))
        planted = 0
        for layer in layers.values():
            allowed = closure(layer.name, uses)
            foreign = next((other for other in layers.values() if other.name not in allowed), None)
            if foreign is None:
                continue  # a layer that uses every other one has nothing to violate
            path = os.path.join(layer.folder, "Planted.cpp")
            self.write(path, f'#include "{foreign.folder.removeprefix("src/")}/Planted.h"\n')
            status, text = self.check()
            self.assertEqual(status, 1, layer.name)
            self.assertIn(f"{path}:1: layer {layer.name} does not use {foreign.name}", text)
            os.remove(os.path.join(self.tree, path))
            planted += 1
        self.assertGreaterEqual(planted, len(layers) - 1)
        self.assertEqual(self.check(), (0, ""))

    def test_TheTreeItselfIsClean(self):
        self.assertEqual(self.check(tree=ROOT), (0, ""))

    def test_ReadsALayerThatIsHot(self):
        self.small_tree(low="vespscope_layer(low HOT)", high="vespscope_layer(high HOT USES low)")
        self.check("--map")
        self.write("src/low/Low.cpp", '#include "high/High.h"\n')
        self.assertEqual(self.check(), (1, "src/low/Low.cpp:1: layer low does not use high (high/High.h)\n"))

    def test_RefusesALayerLineThatItDoesNotUnderstand(self):
        for line in ("vespscope_layer(low WARM USES high)", "vespscope_layer(low USES)", "vespscope_layer(low",
                     "vespscope_layer(low HOT USES ${layers})"):
            self.small_tree(low=line)
            status, text = self.check()
            self.assertEqual(status, 1, line)
            self.assertIn("src/low/CMakeLists.txt:1: cannot read this layer", text)

    def test_RefusesALayerThatIsDeclaredTwiceOrNowhere(self):
        self.small_tree(low="vespscope_layer(low)", high="vespscope_layer(low)")
        self.assertIn("layer low is declared in", self.check()[1])
        self.small_tree(low="vespscope_layer(low)", high="vespscope_layer(high USES lower)")
        self.assertIn("uses lower, which is declared nowhere", self.check()[1])

    def test_RefusesACircle(self):
        self.small_tree(low="vespscope_layer(low)")
        self.check("--map")
        self.write("src/low/CMakeLists.txt", "vespscope_layer(low USES low)\n")
        self.assertIn("low: this layer uses itself in a circle", self.check()[1])

    def test_RefusesAMapThatDiffersFromTheLayers(self):
        self.small_tree(low="vespscope_layer(low)", high="vespscope_layer(high USES low)")
        status, text = self.check()
        self.assertEqual(status, 1)
        self.assertIn("ARCHITECTURE.md: the map differs from the layers", text)
        self.assertEqual(self.check("--map"), (0, ""))
        self.assertEqual(self.check(), (0, ""))
        with open(os.path.join(self.tree, "ARCHITECTURE.md"), encoding="utf-8") as file:
            self.assertIn("1  high  -> low\n0  low\n", file.read())

    def test_KeepsCHeadersBehindTheirWrappers(self):
        self.small_tree(low="vespscope_layer(low)")
        self.check("--map")
        self.write("src/low/Low.cpp", "#include <systemd/sd-bus.h>\n")
        self.assertIn("src/low/Low.cpp:1: systemd/sd-bus.h stands behind a wrapper", self.check()[1])


if __name__ == "__main__":
    unittest.main()
