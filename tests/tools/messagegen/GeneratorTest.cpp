// The generator of the message headers: its output equals the files in the tree, and it rejects invalid schemas.
#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>

#include <gtest/gtest.h>

#include "messagegen/Generator.h"
#include "messagegen/Model.h"
#include "messagegen/Schema.h"

namespace vespscope::test {
namespace {

using namespace messagegen;

namespace filesystem = std::filesystem;

std::string contentOf(const filesystem::path& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), {}};
}

class Folder {
 public:
  Folder() {
    std::string pattern = (filesystem::temp_directory_path() / "messagegen.XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) ADD_FAILURE() << pattern;
    path = pattern;
  }
  Folder(const Folder&) = delete;
  Folder& operator=(const Folder&) = delete;
  ~Folder() { filesystem::remove_all(path); }
  filesystem::path path;
};

const filesystem::path messages = VESPSCOPE_SOURCE_DIR "/src/messages";

TEST(Generator, MakesWhatIsCheckedInByteForByte) {
  const auto files = generateFrom(messages / "schema");
  ASSERT_TRUE(files) << files.reason();
  const Folder folder;
  ASSERT_TRUE(generation::writeFiles(*files, folder.path));
  for (const auto& [name, content] : *files) {
    EXPECT_EQ(contentOf(folder.path / name), contentOf(messages / name)) << name << ": run ./dev messages";
  }
}

TEST(Generator, MakesEveryHeaderInTheFoldersOfTheTechnologies) {
  const auto files = generateFrom(messages / "schema");
  ASSERT_TRUE(files) << files.reason();
  std::set<std::string> present;
  for (const char* technology : {"common", "lte", "umts", "gsm", "mobility"}) {
    for (const auto& entry : filesystem::directory_iterator(messages / technology)) {
      present.insert(filesystem::relative(entry.path(), messages).string());
    }
  }
  std::set<std::string> made;
  for (const auto& [name, content] : *files) {
    if (name != "MessageClasses.cpp") made.insert(name);
  }
  EXPECT_EQ(present, made) << "a header without a declaration, or the other way round";
}

TEST(Generator, WritesOnlyWhatChanged) {
  const Folder folder;
  EXPECT_EQ(generation::writeFiles({{"a/One.h", "one"}, {"Two.cpp", "two"}}, folder.path).value(), 2U);
  EXPECT_EQ(generation::writeFiles({{"a/One.h", "one"}, {"Two.cpp", "2"}}, folder.path).value(), 1U);
  EXPECT_EQ(contentOf(folder.path / "Two.cpp"), "2");
}

TEST(Generator, SaysWhatItCannotReadOrWrite) {
  EXPECT_FALSE(generateFrom("/nonexistent"));
  const Folder folder;
  EXPECT_EQ(generateFrom(folder.path).reason(), folder.path.string() + ": no schema files");
  std::ofstream(folder.path / "file") << "in the way";
  EXPECT_FALSE(generation::writeFiles({{"file/One.h", "one"}}, folder.path));
}

TEST(GeneratorNames, OfAccessorsFollowOneRule) {
  EXPECT_EQ(propertyName("timestamp"), "timestamp");
  EXPECT_EQ(propertyName("prev_state_dur_ms"), "prevStateDurMs");
  EXPECT_EQ(propertyName("QRxLevMin"), "qRxLevMin");
  EXPECT_EQ(propertyName("Thresh_serving_lowP"), "threshServingLowP");
  EXPECT_EQ(propertyName("S_non_intra_search_P"), "sNonIntraSearchP");
  EXPECT_EQ(propertyName("si_7_8_broadcast"), "si78Broadcast");
  EXPECT_EQ(propertyName("idle_rxlev_dBm"), "idleRxlevDBm");
  EXPECT_EQ(propertyName("Pmax"), "pmax");
  EXPECT_EQ(capitalized("qRxLevMin"), "QRxLevMin");
}

Result<SchemaFile> parse(const std::string& body) {
  return parseSchema("test", "syntax = \"proto2\";\npackage test;\n" + body);
}

// The reason why a schema with `body` is rejected, by the parser or by the model; its first line is line 3.
std::string refusal(const std::string& body) {
  auto file = parse(body);
  if (!file) return file.reason();
  const std::vector<SchemaFile> files = {*file};
  const auto models = buildModel(files);
  return models ? "accepted" : models.reason();
}

TEST(GeneratorModel, NamesItemsAndGivesBitsByTheAlphabetWithTimestampsFirst) {
  const auto file = parse(
      "message M {\n  optional uint32 b = 1;\n  optional bool a_b = 2;\n  optional uint64 timestamp = 3;\n"
      "  repeated M2 inst_values = 5;\n  repeated M2 rx_info = 4;\n  repeated sint32 power = 9 [packed = true];\n}\n"
      "message M2 { optional bytes content = 1; }\n");
  ASSERT_TRUE(file) << file.reason();
  const std::vector<SchemaFile> files = {*file};
  const auto models = buildModel(files);
  ASSERT_TRUE(models) << models.reason();
  const std::vector<FieldModel>& fields = models->front().messages.front().fields;
  ASSERT_EQ(fields.size(), 6U);
  EXPECT_EQ(fields[0].bit, 2U);
  EXPECT_EQ(fields[1].bit, 1U);
  EXPECT_EQ(fields[2].bit, 0U);
  EXPECT_EQ(fields[3].property, "rxInfos");
  EXPECT_EQ(fields[3].item, "rxInfo");
  EXPECT_EQ(fields[4].property, "instValues");
  EXPECT_EQ(fields[4].item, "instValues");
  EXPECT_EQ(fields[5].property, "powers");
  EXPECT_EQ(fields[5].shape, Shape::numberList);
}

TEST(GeneratorModel, ThePresenceWordHasABitForEveryNumber) {
  for (const auto& [count, width] : {std::pair{8, 8U}, {9, 16U}, {17, 32U}, {33, 64U}, {64, 64U}}) {
    std::string body = "message M {\n";
    for (int number = 1; number <= count; ++number) {
      body += "optional uint32 f" + std::to_string(number) + " = " + std::to_string(number) + ";\n";
    }
    const auto file = parse(body + "}\n");
    const std::vector<SchemaFile> files = {*file};
    EXPECT_EQ(buildModel(files)->front().messages.front().presenceWidth, width) << count;
    if (count < 64) continue;
    EXPECT_EQ(refusal(body + "optional bool one_more = 65; }"), "test.proto:3: M has more than 64 numbers");
  }
}

TEST(GeneratorSchema, KeepsTheSentenceAboveADeclaration) {
  const auto file =
      parse("// Not this one.\n\n// Two\n// lines.\nmessage M { // nor this\n  // Inner.\n  enum E { A = 1; }\n}\n");
  ASSERT_TRUE(file) << file.reason();
  EXPECT_EQ(file->messages[0].comment, "Two lines.");
  EXPECT_EQ(file->messages[0].enumerations[0].comment, "Inner.");
}

TEST(GeneratorSchema, FaultsNameFileAndLine) {
  EXPECT_EQ(parseSchema("lte", "syntax = \"proto3\";").reason(), "lte.proto:1: only proto2 is understood");
  EXPECT_EQ(refusal("message M {\n  required uint32 a = 1;\n}"),
            "test.proto:4: expected optional or repeated before 'required'");
  EXPECT_EQ(refusal("message M {\n  optional uint32 a = 1\n}"), "test.proto:5: expected ';' before '}'");
  EXPECT_EQ(refusal("message M {"), "test.proto:3: expected optional or repeated before 'end of file'");
  EXPECT_EQ(refusal("service S {}"), "test.proto:3: expected a declaration before 'service'");
  EXPECT_EQ(refusal("message M { optional uint32 a = 99999999999; }"),
            "test.proto:3: '99999999999' is no number of this kind");
  EXPECT_EQ(refusal("enum E { }"), "test.proto:3: an enumeration without values");
  EXPECT_EQ(refusal("enum E { A = 0; B = 0; }"), "test.proto:3: B is declared twice");
  EXPECT_EQ(refusal("import \"x.proto"), "test.proto:3: a text without its end");
  EXPECT_EQ(refusal("message M { optional uint32 a = 1 [default = 3]; }"),
            "test.proto:3: expected packed before 'default'");
  EXPECT_EQ(refusal("message (M)"), "test.proto:3: unexpected character '('");
}

TEST(GeneratorModel, RefusesWhatMessagesDoNotHave) {
  const auto field = [](const std::string& declaration) { return refusal("message M { " + declaration + " }"); };
  EXPECT_EQ(field("optional uint32 a = 0;"), "test.proto:3: M.a has an impossible number");
  EXPECT_EQ(field("optional uint32 a = 65536;"), "test.proto:3: M.a has an impossible number");
  EXPECT_EQ(field("optional uint32 a = 1; optional bool b = 1;"), "test.proto:3: M.b has a number that is taken");
  EXPECT_EQ(field("optional uint32 a_b = 1; optional bool aB = 2;"), "test.proto:3: M.aB has a name that is taken");
  EXPECT_EQ(field("optional double a = 1;"), "test.proto:3: M.a has the unknown type double");
  EXPECT_EQ(field("repeated uint32 a = 1;"), "test.proto:3: M.a must be packed exactly when it is repeated");
  EXPECT_EQ(field("optional uint32 a = 1 [packed = true];"),
            "test.proto:3: M.a must be packed exactly when it is repeated");
  EXPECT_EQ(field("repeated bool a = 1 [packed = true];"),
            "test.proto:3: M.a is a list of flags, which messages do not have");
  EXPECT_EQ(field("repeated bytes a = 1;"), "test.proto:3: M.a is a list of bytes, which messages do not have");
  EXPECT_EQ(field("optional bytes a = 1 [packed = true];"), "test.proto:3: M.a cannot be packed");
  EXPECT_EQ(field("enum E { A = 0; } repeated E a = 1;"),
            "test.proto:3: M.a is a list of enumeration values, which messages do not have");
  EXPECT_EQ(field("optional M a = 1;"), "test.proto:3: M.a makes the message contain itself");
  EXPECT_EQ(refusal("message A { optional B b = 1; }\nmessage B { repeated A a = 1; }"),
            "test.proto:4: B.a makes the message contain itself");
  EXPECT_EQ(refusal("message A { }\nenum A { X = 0; }"), "test.proto: A is declared twice");
}

}  // namespace
}  // namespace vespscope::test
