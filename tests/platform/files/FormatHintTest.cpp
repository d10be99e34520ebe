// The type of a file that was given as a recording but is of another kind.
#include <cstdlib>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "platform/files/FormatHint.h"
#include "support/TemporaryFolder.h"
#include "values/Value.h"

namespace vespscope::test {
namespace {

using namespace std::string_view_literals;
using files::formatHint;
using testing::HasSubstr;

std::string_view hintOf(std::string_view head) {
  const Bytes bytes(head.begin(), head.end());
  return formatHint(bytes);
}

TEST(FormatHint, NamesTheFormatByItsFirstBytes) {
  const std::vector<std::pair<std::string_view, std::string_view>> table = {
      {"\x4D\x3C\xB2\xA1\x02\x00\x04\x00"sv, "replay:FILE"},
      {"\x0A\x0D\x0D\x0A\x00"sv, "replay:FILE"},
      {"PK\x03\x04\x14"sv, "ZIP archive: unpack it first"},
      {"BZh91AY"sv, "bzip2"},
      {"\x28\xB5\x2F\xFD\x04"sv, "zstd"},
      {"SQLite format 3\0\x10"sv, "SQLite"},
      {"Dear diary,\n"sv, "it is text"},
  };
  for (const auto& [head, hint] : table) EXPECT_THAT(std::string(hintOf(head)), HasSubstr(std::string(hint)));
}

TEST(FormatHint, NamesATarArchiveByAMarkFurtherOn) {
  std::string archive(512, '\0');
  archive.replace(0, 5, "a.log");
  archive.replace(257, 5, "ustar");
  EXPECT_EQ(hintOf(archive), "it is a tar archive: unpack it first");
}

TEST(FormatHint, LooksAtAFileUnpacked) {
  const TemporaryFolder folder;
  const std::string path = folder.write("letter", "Dear diary,\n");
  EXPECT_EQ(files::formatHintOf(path), "it is text");
  ASSERT_EQ(std::system(("gzip " + path).c_str()), 0);
  EXPECT_EQ(files::formatHintOf(path + ".gz"), "it is text");
  EXPECT_EQ(files::formatHintOf(folder / "none"), "");
}

TEST(FormatHint, IsEmptyForBytesThatItDoesNotRecognise) {
  EXPECT_EQ(hintOf(""), "");
  EXPECT_EQ(hintOf("\x01\x02"), "");
  EXPECT_EQ(hintOf("PK"), "it is text");  // shorter than the magic number
}

}  // namespace
}  // namespace vespscope::test
