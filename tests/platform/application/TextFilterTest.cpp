// The filter that a user types for a list.
#include <clocale>

#include <gtest/gtest.h>

#include "platform/application/TextFilter.h"

namespace vespscope::test {
namespace {

using application::caseFolded;
using application::TextFilter;

TEST(TextFilter, PassesEveryTextWhileItIsEmpty) {
  EXPECT_TRUE(TextFilter().passes(""));
  EXPECT_TRUE(TextFilter("").passes("anything"));
}

TEST(TextFilter, PassesTextsThatContainItsOwnInAnyCase) {
  const TextFilter filter("rSrP");
  EXPECT_TRUE(filter.passes("nbr_rsrp"));
  EXPECT_TRUE(filter.passes("RSRP_LOW"));
  EXPECT_FALSE(filter.passes("rsr p"));
  EXPECT_EQ(filter.text(), "rSrP");
}

TEST(TextFilter, IgnoresTheCaseOfLettersOutsideAsciiToo) {
  ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr);
  EXPECT_TRUE(TextFilter("ä").passes("NÄCHSTE"));
  EXPECT_EQ(caseFolded("Ünïcode Я 中 \xF0\x9F\x93\xB1"), "ünïcode я 中 \xF0\x9F\x93\xB1");
}

TEST(TextFilter, TakesTextsThatAreNotUtf8) {
  EXPECT_TRUE(TextFilter("a").passes("\xFF\x80 A"));
  EXPECT_FALSE(TextFilter("\xFF").passes("a"));
}

}  // namespace
}  // namespace vespscope::test
