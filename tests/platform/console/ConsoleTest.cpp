// The programs' output to their users.
#include <string>

#include <gtest/gtest.h>

#include "platform/console/Console.h"

namespace vespscope::test {
namespace {

std::string errorsOf(void (*write)()) {
  testing::internal::CaptureStderr();
  write();
  return testing::internal::GetCapturedStderr();
}

TEST(Console, WritesAnErrorAsOnePrintableLine) {
  EXPECT_EQ(errorsOf([] { console::error("vespctl: \x1b[2Jevil\n\x07.pcap: \xff"); }), "vespctl: ␛[2Jevil␊␇.pcap: �\n");
}

TEST(Console, TakesNewlinesOfATextAsTheyAre) {
  EXPECT_EQ(errorsOf([] { console::errorText("one\n\ntwo\x1b]0;title\x07\nthree"); }), "one\n\ntwo␛]0;title␇\nthree\n");
  testing::internal::CaptureStdout();
  console::outputText(
      "Usage:\n  \x9b"
      "1m\n");
  EXPECT_EQ(testing::internal::GetCapturedStdout(), "Usage:\n  �1m\n");
}

TEST(Console, ShowsProgressOverTheLineBefore) {
  EXPECT_EQ(errorsOf([] { console::showProgress("7 events \x1b[31m"); }), "\r7 events ␛[31m\x1b[K");
  EXPECT_EQ(errorsOf([] { console::showProgress(""); }), "\r\x1b[K");
}

TEST(Console, CutsProgressToTheTerminalsWidth) {
  EXPECT_EQ(errorsOf([] { console::showProgress(std::string(200, 'a')); }), "\r" + std::string(79, 'a') + "\x1b[K");
  // No incomplete character remains.
  EXPECT_EQ(errorsOf([] { console::showProgress(std::string(78, 'a') + "\xe2\x82\xac"); }),
            "\r" + std::string(78, 'a') + "\x1b[K");
}

}  // namespace
}  // namespace vespscope::test
