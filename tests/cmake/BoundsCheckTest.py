#!/usr/bin/env python3
"""The check of the bounds makes SECURITY.md's table from the code, and finds what differs from it."""
import os
import unittest

from planted_tree import ROOT, PlantedTree

ROW = '[[bound]]\nwhat = "a line"\nbounds = [["log/Line.h:longest", "bytes"]]\nbeyond = "it is cut"\ntests = ["Line.IsCut"]\n'


class BoundsCheck(PlantedTree):
    CHECK = "check-bounds.py"

    def setUp(self):
        super().setUp()
        self.write("src/log/Line.h", "constexpr std::size_t longest = std::size_t{4} << 10;  // bytes\n")
        self.write("tests/log/LineTest.cpp", "TEST(Line, IsCut) {}\n")
        self.write("cmake/bounds.toml", ROW)
        self.write("SECURITY.md", "before\n<!-- bounds: written by cmake/check-bounds.py --write -->\n<!-- bounds: end -->\nafter\n")
        self.assertEqual(self.check("--write"), (0, ""))

    def test_WritesTheTableFromTheCode(self):
        with open(os.path.join(self.tree, "SECURITY.md"), encoding="utf-8") as file:
            text = file.read()
        self.assertIn("| a line | 4 KiB | it is cut | `Line.IsCut` |\n<!-- bounds: end -->\nafter\n", text)
        self.assertEqual(self.check(), (0, ""))

    def test_TheTreeItselfIsClean(self):
        self.assertEqual(self.check(tree=ROOT), (0, ""))

    def test_RefusesATableThatDiffersFromTheCode(self):
        self.write("src/log/Line.h", "constexpr std::size_t longest = 5000;\n")
        status, text = self.check()
        self.assertEqual(status, 1)
        self.assertIn("SECURITY.md: the table of bounds differs from the code", text)

    def test_RefusesABoundThatTheCodeNoLongerDeclares(self):
        self.write("src/log/Line.h", "constexpr std::size_t largest = 4096;\n")
        self.assertEqual(self.check(), (1, "src/log/Line.h: 0 declarations of longest\n"))

    def test_RefusesABoundWithoutATest(self):
        self.write("tests/log/LineTest.cpp", "TEST(Line, IsShown) {}\n")
        self.assertEqual(self.check(), (1, "cmake/bounds.toml: a line: Line.IsCut is no test\n"))
        self.write("cmake/bounds.toml", ROW.replace('"Line.IsCut"', ""))
        self.assertIn("cmake/bounds.toml: a line: no test\n", self.check()[1])


if __name__ == "__main__":
    unittest.main()
