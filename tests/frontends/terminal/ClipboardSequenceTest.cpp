// A text for the clipboard is sent in base64 inside its control sequence.
#include <gtest/gtest.h>

#include "frontends/terminal/ClipboardSequence.h"

namespace vespscope::test {
namespace {

using terminal::clipboardSequence;

// The examples of RFC 4648, section 10.
TEST(ClipboardSequence, EncodesTextsOfEveryLengthAsPublished) {
  EXPECT_EQ(clipboardSequence(""), "\x1b]52;c;\x07");
  EXPECT_EQ(clipboardSequence("f"), "\x1b]52;c;Zg==\x07");
  EXPECT_EQ(clipboardSequence("fo"), "\x1b]52;c;Zm8=\x07");
  EXPECT_EQ(clipboardSequence("foo"), "\x1b]52;c;Zm9v\x07");
  EXPECT_EQ(clipboardSequence("foob"), "\x1b]52;c;Zm9vYg==\x07");
  EXPECT_EQ(clipboardSequence("fooba"), "\x1b]52;c;Zm9vYmE=\x07");
  EXPECT_EQ(clipboardSequence("foobar"), "\x1b]52;c;Zm9vYmFy\x07");
}

TEST(ClipboardSequence, HidesEveryByteThatActsOnATerminal) {
  EXPECT_EQ(clipboardSequence("\x1b]0;title\x07").find('\x1b', 1), std::string::npos);
  EXPECT_EQ(clipboardSequence("\xff\xfe"), "\x1b]52;c;//4=\x07");
}

}  // namespace
}  // namespace vespscope::test
