#!/usr/bin/env python3
"""The check of the tests' names finds files, suites and documents that violate its rules."""
import unittest

from planted_tree import ROOT, PlantedTree


class TestNamesCheck(PlantedTree):
    CHECK = "check-tests.py"

    def setUp(self):
        super().setUp()
        self.write("src/player/CMakeLists.txt", "vespscope_layer(player)\n")
        self.write("src/player/Player.h", "class Player {};\nclass PlayerList {};\nint songOf(int number);\n")
        self.write("tests/player/PlayerTest.cpp", "// Players play.\nTEST(PlayerAtTheEnd, Stops) {}\n")

    def test_TakesSuitesThatBeginWithTheirClass(self):
        self.assertEqual(self.check(), (0, ""))

    def test_TheTreeItselfIsClean(self):
        self.assertEqual(self.check(tree=ROOT), (0, ""))

    def test_TakesFilesOfFunctionsAndOfFoldersWithinALayer(self):
        self.write("tests/player/SongOfTest.cpp", "// Numbers have songs.\nTEST(SongOf, IsAbsentForZero) {}\n")
        self.write("src/player/lists/List.h", "struct Shuffled {};\n")
        self.write("tests/player/lists/ShuffledTest.cpp", "// Lists are shuffled.\nTEST(Shuffled, Differs) {}\n")
        self.assertEqual(self.check(), (0, ""))

    def test_TakesProgramsWhereToolsAreTested(self):
        self.write("src/tools/CMakeLists.txt", "")
        self.write("tests/tools/VespctlPlayTest.cpp", "// The tool plays.\nTEST(VespctlPlay, Plays) {}\n")
        self.assertEqual(self.check(), (0, ""))
        self.write("tests/player/VespctlPlayTest.cpp", "// The tool plays.\nTEST(VespctlPlay, Plays) {}\n")
        self.assertEqual(self.check(),
                         (1, "tests/player/VespctlPlayTest.cpp: VespctlPlay begins with no name of src/player\n"))

    def test_RefusesASuiteOfAnotherClass(self):
        for suite in ("APlayer", "PlayerList", "Players"):
            self.write("tests/player/PlayerTest.cpp", f"// Players play.\nTEST({suite}, Stops) {{}}\n")
            if suite == "PlayerList":  # begins with the class as well
                self.assertEqual(self.check(), (0, ""))
                continue
            self.assertEqual(self.check(), (1, f"tests/player/PlayerTest.cpp:2: suite {suite} does not begin with Player, "
                                               "the class of the file\n"))
        self.write("tests/player/PlayerTest.cpp", "// Players play.\nTEST(Player, Stops) {}\n")
        self.write("tests/player/PlayerListTest.cpp", "// Lists of players.\nTEST(Player, Stops) {}\n")
        self.assertEqual(self.check(), (1, "tests/player/PlayerListTest.cpp:2: suite Player does not begin with "
                                           "PlayerList, the class of the file\n"))

    def test_RefusesAFileWithoutAClass(self):
        self.write("tests/player/StoppingTest.cpp", "// Players stop.\nTEST(Player, Stops) {}\n")
        self.assertEqual(self.check(), (1, "tests/player/StoppingTest.cpp: Stopping begins with no name of src/player\n"))

    def test_RefusesAFolderThatDoesNotMirrorTheSource(self):
        self.write("tests/PlayerTest.cpp", "// Players play.\nTEST(Player, Stops) {}\n")
        self.write("tests/player/more/PlayerTest.cpp", "// Players play.\nTEST(Player, Stops) {}\n")
        self.assertEqual(self.check(), (1, "tests/PlayerTest.cpp: Player begins with no name of src/.\n"
                                           "tests/player/more/PlayerTest.cpp: Player begins with no name of "
                                           "src/player/more\n"))

    def test_RefusesAFileWithoutASentence(self):
        self.write("tests/player/PlayerTest.cpp", "TEST(Player, Stops) {}\n")
        self.assertEqual(self.check(), (1, "tests/player/PlayerTest.cpp:1: does not open with a sentence\n"))

    def test_RefusesAnotherNamespaceInTestsAndTheirSupport(self):
        self.write("tests/player/PlayerTest.cpp",
                   "// Players play.\nnamespace vespscope::test {\nnamespace {\nTEST(Player, Stops) {}\n}\n}\n")
        self.write("tests/player/Songs.h", "namespace vespscope::test::literal {\n}\n")
        self.assertEqual(self.check(), (0, ""))
        self.write("tests/player/Songs.h", "namespace vespscope::testing {\n}\n")
        self.write("tests/player/PlayerTest.cpp", "// Players play.\nnamespace vespscope {\nTEST(Player, Stops) {}\n}\n")
        self.assertEqual(self.check(), (1, "tests/player/PlayerTest.cpp:2: namespace vespscope is not in vespscope::test\n"
                                           "tests/player/Songs.h:1: namespace vespscope::testing is not in vespscope::test\n"))

    def test_RefusesADocumentThatNamesNoTestOrAPartOfOne(self):
        self.write("docs/reliability.md", "`PlayerAtTheEnd.Stops`\n`PlayerAtTheEnd.St…`\n`Player.Runs`\n")
        self.assertEqual(self.check(), (1, "docs/reliability.md:2: names PlayerAtTheEnd.St only in part\n"
                                           "docs/reliability.md:3: names Player.Runs, which is no test\n"))


if __name__ == "__main__":
    unittest.main()
