#!/usr/bin/env python3
"""The check of printing finds every way of writing to a standard output outside platform/console and platform/log."""
import os
import shutil
import subprocess
import sys
import tempfile
import unittest

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))
CHECK = os.path.join(ROOT, "cmake", "check-printing.py")


class PrintingCheck(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.tree = tempfile.mkdtemp()
        cls.addClassCleanup(shutil.rmtree, cls.tree)
        shutil.copytree(os.path.join(ROOT, "src"), os.path.join(cls.tree, "src"))

    def check(self, tree):
        done = subprocess.run([sys.executable, CHECK, tree], capture_output=True, text=True, check=False)
        return done.returncode, done.stdout + done.stderr

    def plant(self, text):
        with open(os.path.join(self.tree, "src", "shell", "Planted.cpp"), "w", encoding="utf-8") as file:
            file.write(text)

    def test_FindsNothingInTheTree(self):
        self.assertEqual(self.check(ROOT), (0, ""))

    def test_FindsEachWayOfPrinting(self):
        for line in ('std::cerr << name;', 'std::cout << name;', 'std::fprintf(stderr, "%s", name);', 'std::puts(name);',
                     'printf("%s", name);', 'perror(name);', 'std::fputs(name, stdout);',
                     '::write(STDERR_FILENO, name, 4);', 'const int out = STDOUT_FILENO;'):
            with self.subTest(line):
                self.plant("// Planted.\n" + line + "\n")
                status, text = self.check(self.tree)
                self.assertEqual(status, 1)
                self.assertRegex(text, r"\Asrc/shell/Planted\.cpp:2: [\w:]+: print through platform/console\n\Z")

    def test_PassesOverCommentsAndOtherFunctions(self):
        self.plant("// Not on stderr.\n/* nor\n std::cout */\nlog::print(line);\nstd::snprintf(text, 4, name);\n")
        self.assertEqual(self.check(self.tree), (0, ""))


if __name__ == "__main__":
    unittest.main()
