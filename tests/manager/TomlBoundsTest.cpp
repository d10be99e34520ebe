// The bounds of a TOML text: each one just kept and just exceeded, and no text that hides its depth from them.
#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <toml++/toml.h>

#include "manager/TomlBounds.h"

namespace vespscope::test {
namespace {

using manager::TomlBounds;
using manager::violationOf;

std::string repeated(const std::string& text, std::size_t count) {
  std::string all;
  for (std::size_t number = 0; number < count; ++number) all += text;
  return all;
}

// A key with this many parts.
std::string keyOf(std::size_t parts) { return "a" + repeated(".a", parts - 1); }

TEST(TomlBounds, HoldForTheWholeTextsSize) {
  EXPECT_EQ(violationOf(std::string(65'536, '#')), std::nullopt);
  EXPECT_EQ(violationOf(std::string(65'537, '#')), "the configuration is longer than 65536 bytes");
}

TEST(TomlBounds, HoldForTheKeysPartsWhereverAKeyCanBe) {
  const std::vector<std::pair<std::string, std::string>> places = {{"", " = 1"},
                                                                   {"[", "]"},
                                                                   {"[[", "]]"},
                                                                   {"x = {", " = 1}"},
                                                                   {"x = { y = 1, ", " = 1}"},
                                                                   {"\t ", "= 1"},
                                                                   {"[x]\n", " = 1"},
                                                                   {"x = [[{", " = 1}]]"},
                                                                   {"x = [\n{", " = 1}]"},
                                                                   {"# .....\n", " = 1"},
                                                                   {"[", "] # ."},
                                                                   {"x = 1.5\n", "=1"},
                                                                   {"\"q.q\".", "=1"},
                                                                   {"x = '.........'\n", "=1"}};
  for (const auto& [before, after] : places) {
    const std::size_t quoted = before.starts_with('"') ? 1 : 0;
    EXPECT_EQ(violationOf(before + keyOf(8 - quoted) + after), std::nullopt) << before;
    const auto violation = violationOf(before + keyOf(9 - quoted) + after);
    ASSERT_TRUE(violation.has_value()) << before;
    EXPECT_TRUE(violation->ends_with(": a key has more than 8 parts")) << *violation;
  }
  EXPECT_EQ(violationOf("\n\n" + repeated("a . ", 9) + "a = 1"), "line 3: a key has more than 8 parts");
  EXPECT_EQ(violationOf(repeated("\"\".", 9) + "a = 1"), "line 1: a key has more than 8 parts");
}

TEST(TomlBounds, HoldForTheLengthOfAKey) {
  for (const auto& [before, after] : std::vector<std::pair<std::string, std::string>>{
           {"", "=1"}, {"[", "]"}, {"[[", "]]"}, {"x = {", "=1}"}, {"x = { y = 1,", "=1}"}, {"x = [ # a\n{", "=1}]"}}) {
    EXPECT_EQ(violationOf(before + std::string(256, 'k') + after), std::nullopt) << before;
    const auto violation = violationOf(before + std::string(257, 'k') + after);
    ASSERT_TRUE(violation.has_value()) << before;
    EXPECT_TRUE(violation->ends_with(": a key is longer than 256 bytes")) << *violation;
  }
  EXPECT_EQ(violationOf("x = \"" + std::string(10'000, 'v') + "\"\n"), std::nullopt);  // a value may be longer
}

TEST(TomlBounds, HoldForTheNestingOfValues) {
  for (const std::string bracket : {"[", "{a=", "[{a="}) {
    const std::size_t depth = static_cast<std::size_t>(
        std::count_if(bracket.begin(), bracket.end(), [](char letter) { return letter == '[' || letter == '{'; }));
    EXPECT_EQ(violationOf("x = " + repeated(bracket, 8 / depth)), std::nullopt) << bracket;
    EXPECT_EQ(violationOf("x = " + repeated(bracket, 8 / depth) + bracket),
              "line 1: values are nested more than 8 deep");
  }
  EXPECT_EQ(violationOf("x = " + repeated("[]\ny = ", 100) + "1"), std::nullopt);  // allowed next to each other
}

TEST(TomlBounds, AreNotHiddenBehindStringsAndComments) {
  const std::string deep = keyOf(9) + " = 1\n";
  for (const std::string harmless : {"x = \"#\"\n", "x = '\\'\n", "x = \"\\\"\"\n", "x = \"\\\\\"\n",
                                     "x = \"\"\"\n\"\" \\\"\"\"\"\n", "x = ''''''\n", "x = ''''''''\n", "x = \"\"\n",
                                     "# \"\n", "# '''\n", "x = '''\n#\n'''\n", "x = \"\"\"\"\"\"\"\"\n"}) {
    EXPECT_EQ(violationOf(harmless), std::nullopt) << harmless;
    EXPECT_NE(violationOf(harmless + deep), std::nullopt) << harmless;
  }
}

TEST(TomlBounds, AllowNothingThatMakesTheEndOfAStringUncertain) {
  EXPECT_EQ(violationOf("x = \"abc\ny = 1\n"), "line 1: a string has no end");
  EXPECT_EQ(violationOf("\nx = '''abc\n\ny = 1\n"), "line 2: a string has no end");
  EXPECT_EQ(violationOf("x = \"abc\\"), "line 1: a string has no end");
  for (const std::string before : {"", "# ", "x = \"", "x = '''\n"}) {
    for (const char letter : {'\0', '\x0B', '\x0C', '\x1B', '\x7F', '\r'}) {
      const auto violation = violationOf(before + letter + "\"'''\n");
      ASSERT_TRUE(violation.has_value());
      EXPECT_TRUE(violation->ends_with(": a control character")) << *violation;
    }
    EXPECT_EQ(violationOf("\t# \tx\r\n"), std::nullopt);
  }
}

std::size_t depthOf(const toml::node& node) {
  std::size_t deepest = 0;
  if (const auto* table = node.as_table()) {
    for (const auto& [key, value] : *table) deepest = std::max(deepest, 1 + depthOf(value));
  } else if (const auto* array = node.as_array()) {
    for (const auto& value : *array) deepest = std::max(deepest, 1 + depthOf(value));
  }
  return deepest;
}

// Texts combined from the characters that affect depth; many of them are valid TOML.
TEST(TomlBounds, BoundTheTreeThatTheLibraryMakes) {
  constexpr TomlBounds tight{.size = 4096, .keyLength = 64, .keyParts = 2, .nesting = 1};
  const std::vector<std::string> pieces = {
      "a",   "b",     ".",      "=",      "1",    "[",     "]",      "{",
      "}",   ",",     "\n",     "\n",     "\"",   "'",     "\"\"\"", "'''",
      "\\",  "#",     " ",      "\t",     "a=1",  "a.b",   "\"x\"",  "'.'",
      "\n[", "]\n",   "= 1\n",  "={a=",   "1}\n", "a=[1]", "\r\n",   "\xE2\x80\xA8",
      "1.5", "[[b]]", "\\\"\n", "a.b=1\n"};
  std::mt19937 random(20261122);
  std::size_t accepted = 0;
  std::size_t parsed = 0;
  for (int round = 0; round < 60'000; ++round) {
    std::string text;
    for (std::size_t count = random() % 24; count > 0; --count) text += pieces[random() % pieces.size()];
    if (violationOf(text, tight)) continue;
    ++accepted;
    try {
      const toml::table table = toml::parse(text);
      ++parsed;
      ASSERT_LE(depthOf(table), tight.keyParts * (tight.nesting + 2) + tight.nesting) << text;
    } catch (const toml::parse_error&) {  // rejected by the library
    }
  }
  EXPECT_GT(accepted, 1000U);
  EXPECT_GT(parsed, 300U);
}

}  // namespace
}  // namespace vespscope::test
