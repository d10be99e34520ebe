// The type of a file that was given as a modem log but is of another kind.
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/diag/FormatHint.h"
#include "values/Value.h"

namespace vespscope::test {
namespace {

using namespace std::string_view_literals;
using sources::diag::formatHint;
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

TEST(FormatHint, IsEmptyForBytesThatItDoesNotRecognise) {
  EXPECT_EQ(hintOf(""), "");
  EXPECT_EQ(hintOf("\x01\x02"), "");
  EXPECT_EQ(hintOf("PK"), "it is text");  // shorter than the magic number
}

}  // namespace
}  // namespace vespscope::test
