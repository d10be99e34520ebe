"""A tree of a test's own, in which one of the checks in cmake/ runs."""
import os
import shutil
import subprocess
import sys
import tempfile
import unittest

ROOT = os.path.dirname(os.path.dirname(os.path.dirname(os.path.abspath(__file__))))


class PlantedTree(unittest.TestCase):
    """A test case with an empty tree; a subclass names its script of cmake/ as CHECK."""
    CHECK = ""

    def setUp(self):
        self.tree = tempfile.mkdtemp()
        self.addCleanup(shutil.rmtree, self.tree)

    def write(self, path, text):
        whole = os.path.join(self.tree, path)
        os.makedirs(os.path.dirname(whole), exist_ok=True)
        with open(whole, "w", encoding="utf-8") as file:
            file.write(text)

    def check(self, *arguments, tree=None):
        """Returns the check's exit status and what it printed, for the planted tree unless another is given."""
        done = subprocess.run([sys.executable, os.path.join(ROOT, "cmake", self.CHECK), *arguments, tree or self.tree],
                              capture_output=True, text=True, check=False)
        return done.returncode, done.stdout + done.stderr
