// The generator of the reader's tables: what it makes of a small module, what it refuses, and whether the tables of the
// tree are what it makes of the definitions, where these are: in the folder that the environment variable
// VESPSCOPE_ASN1 states, else in ../shared/asn1 beside the tree.
#include <cstdlib>
#include <fstream>
#include <iterator>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "rrcgen/Syntax.h"
#include "rrcgen/Tables.h"
#include "rrcgen/Writer.h"

namespace vespscope::test {
namespace {

using namespace rrcgen;
using rrc::Kind;
using ::testing::ElementsAre;
using ::testing::HasSubstr;

constexpr const char* module = R"(
Letters DEFINITIONS AUTOMATIC TAGS ::= BEGIN
IMPORTS Stamp, maxStamps FROM Stamps;
-- A comment with { and ::=
Letter ::= SEQUENCE {
  urgent BOOLEAN,
  weight INTEGER (-5..maxWeight) OPTIONAL, -- grams
  stamps SEQUENCE (SIZE (1..maxStamps)) OF Stamp,
  colour ENUMERATED {red, green, ..., blue},
  content OCTET STRING (CONTAINING Letter) OPTIONAL,
  back Switch { Stamp } DEFAULT off:NULL,
  ...,
  [[ sender BIT STRING (SIZE (8)) OPTIONAL,
     note OCTET STRING (SIZE (1..4)) OPTIONAL ]],
  receiver NULL
}
Switch { Value } ::= CHOICE { off NULL, on Value, ... }
maxWeight INTEGER ::= 40
END
)";
constexpr const char* imported = R"(
Stamps DEFINITIONS AUTOMATIC TAGS ::= BEGIN
Stamp ::= INTEGER (0..7)
maxStamps INTEGER ::= 3
END
)";

std::vector<Module> parsed(const std::string& letters) {
  std::vector<Module> modules;
  for (const std::string& text : {letters, std::string(imported)}) {
    auto one = parseModule("test.asn", text);
    EXPECT_TRUE(one) << one.reason();
    if (one) modules.push_back(std::move(*one));
  }
  return modules;
}

std::string withoutDefault() {
  std::string text = module;
  text.replace(text.find("DEFAULT off:NULL"), 16, "OPTIONAL");
  return text;
}

const Selection selection{{{"letter", {"Letters", "Letter"}}}, {{"Letters", "note", {"Stamps", "Stamp"}}}};

Result<Tables> tables() { return buildTables(parsed(withoutDefault()), selection); }

// The field of a sequence with this name.
const rrc::Field& field(const Tables& made, const rrc::Type& type, std::string_view name) {
  for (std::size_t index = type.first; index < type.first + type.count + type.extra; ++index) {
    if (made.names[made.fields[index].name] == name) return made.fields[index];
  }
  throw std::runtime_error("no field " + std::string(name));
}

TEST(Tables, MakesTypesOfAModule) {
  const auto made = tables();
  ASSERT_TRUE(made) << made.reason();
  ASSERT_EQ(made->pdus.size(), 1U);
  const rrc::Type& letter = made->types[made->pdus[0].second];
  EXPECT_EQ(letter.kind(), Kind::sequence);
  EXPECT_EQ(letter.extensible, 1);
  EXPECT_EQ(letter.count, 6);
  EXPECT_EQ(letter.extra, 2);
  EXPECT_EQ(letter.range, 3);  // optional fields
  const rrc::Field& weight = field(*made, letter, "weight");
  EXPECT_TRUE(weight.optional());
  const rrc::Range& range = made->ranges[made->types[weight.type()].range];
  EXPECT_EQ(range.lower, -5);
  EXPECT_EQ(range.upper, 40);
  const rrc::Type& stamps = made->types[field(*made, letter, "stamps").type()];
  EXPECT_EQ(stamps.kind(), Kind::list);
  EXPECT_EQ(made->ranges[stamps.range].upper, 3);
  EXPECT_EQ(made->types[stamps.first].kind(), Kind::integer);
  const rrc::Type& colour = made->types[field(*made, letter, "colour").type()];
  EXPECT_EQ(colour.count, 2);
  EXPECT_EQ(colour.extra, 1);
  EXPECT_EQ(made->names[made->items[colour.first + 2]], "blue");
  // The content of a letter is a letter.
  EXPECT_EQ(made->types[field(*made, letter, "content").type()].first, made->pdus[0].second);
}

TEST(Tables, FillsInParametersAndGroups) {
  const auto made = tables();
  ASSERT_TRUE(made) << made.reason();
  const rrc::Type& letter = made->types[made->pdus[0].second];
  const rrc::Type& back = made->types[field(*made, letter, "back").type()];
  EXPECT_EQ(back.kind(), Kind::choice);
  EXPECT_EQ(back.extensible, 1);
  const rrc::Type& stamps = made->types[field(*made, letter, "stamps").type()];
  EXPECT_EQ(field(*made, back, "on").type(), stamps.first);
  const rrc::Type& group = made->types[field(*made, letter, "").type()];
  EXPECT_EQ(group.count, 2);
  EXPECT_EQ(group.range, 2);
  // The selection states what a note holds.
  EXPECT_EQ(made->types[field(*made, group, "note").type()].first, stamps.first);
}

TEST(Tables, SortsTheNames) {
  const auto made = tables();
  ASSERT_TRUE(made) << made.reason();
  EXPECT_THAT(made->names, ElementsAre("", "back", "blue", "colour", "content", "green", "note", "off", "on",
                                       "receiver", "red", "sender", "stamps", "urgent", "weight"));
}

TEST(Tables, WritesTheSameFilesEveryTime) {
  const auto first = tables();
  const auto second = tables();
  ASSERT_TRUE(first && second);
  const GeneratedFiles files = write(*first);
  EXPECT_EQ(files, write(*second));
  EXPECT_THAT(files.at("Ranges.inc"), HasSubstr("{-5,40},"));
  EXPECT_THAT(files.at("Pdus.inc"), HasSubstr("letter = "));
}

TEST(Tables, RefusesWhatItDoesNotUnderstandWithALine) {
  const auto syntax = parseModule("test.asn", module);
  ASSERT_FALSE(syntax);
  EXPECT_THAT(syntax.reason(), HasSubstr("test.asn:11: unexpected character ':'"));
  const auto end = parseModule("test.asn", "A DEFINITIONS AUTOMATIC TAGS ::= BEGIN\nB ::= SEQUENCE {");
  ASSERT_FALSE(end);
  EXPECT_THAT(end.reason(), HasSubstr("test.asn:2: expected"));
  std::string missing = withoutDefault();
  missing.replace(missing.find("maxWeight"), 9, "maxHeight");
  const auto names = buildTables(parsed(missing), selection);
  ASSERT_FALSE(names);
  EXPECT_EQ(names.reason(), "test.asn:7: maxHeight is not defined");
  const auto other = buildTables(parsed(withoutDefault()), {{{"post", {"Letters", "Postcard"}}}, {}});
  ASSERT_FALSE(other);
  EXPECT_THAT(other.reason(), HasSubstr("Postcard is not defined"));
}

TEST(Tables, RefusesASelectionThatIsNone) {
  EXPECT_THAT(parseSelection("list", "pdu a B C\ncontent a\n").reason(), HasSubstr("list:2: expected"));
  EXPECT_THAT(parseSelection("list", "# nothing\n").reason(), HasSubstr("no line 'pdu"));
}

TEST(Tables, MakesTheTablesOfTheTree) {
  const std::filesystem::path tree(VESPSCOPE_SOURCE_DIR);
  const char* stated = std::getenv("VESPSCOPE_ASN1");
  const std::filesystem::path definitions =
      stated != nullptr ? std::filesystem::path(stated) : tree / ".." / "shared" / "asn1";
  if (!std::filesystem::is_directory(definitions)) {
    GTEST_SKIP() << "the definitions are missing: the tables have not been compared";
  }
  const auto files = generateFrom(definitions, tree / "src" / "rrc" / "tables.list");
  ASSERT_TRUE(files) << files.reason();
  for (const auto& [name, content] : *files) {
    std::ifstream file(tree / "src" / "rrc" / "tables" / name, std::ios::binary);
    EXPECT_TRUE(content == std::string(std::istreambuf_iterator<char>(file), {})) << name << " differs";
  }
}

}  // namespace
}  // namespace vespscope::test
