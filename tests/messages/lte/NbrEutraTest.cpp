// NbrEutra compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/NbrEutra.h"

namespace vespscope::test {
namespace {

TEST(NbrEutra, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 ff ff ff ff 0f 10 18 18 ff 09 20 fe ff ff ff 0f 28 7e 30 07 38 ac 02 40 96 0a 48 ad a0 01 50 94 2d 58 "
      "00 60 01 68 80 80 04";
  const auto read = readFrom<NbrEutra>(encoded);
  EXPECT_EQ(textOf(*read),
            "[earfcn: 4294967295, Q_rxlev_min: 12, Q_qual_min: -640, Q_offset: 2147483647, Pmax: 63, dl_bw: 7, "
            "Thres_X_highP: 300, Thres_X_lowP: 1302, Thres_X_highQ: 20525, Thres_X_lowQ: 5780, priority: 0, "
            "frame_type: TDD, band: 65536]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  NbrEutra written;
  EXPECT_NUMBER(earfcn, Earfcn, 4294967295U);
  EXPECT_NUMBER(qRxlevMin, QRxlevMin, 12);
  EXPECT_NUMBER(qQualMin, QQualMin, -640);
  EXPECT_NUMBER(qOffset, QOffset, 2147483647);
  EXPECT_NUMBER(pmax, Pmax, 63);
  EXPECT_NUMBER(dlBw, DlBw, 7U);
  EXPECT_NUMBER(thresXHighP, ThresXHighP, 300U);
  EXPECT_NUMBER(thresXLowP, ThresXLowP, 1302U);
  EXPECT_NUMBER(thresXHighQ, ThresXHighQ, 20525U);
  EXPECT_NUMBER(thresXLowQ, ThresXLowQ, 5780U);
  EXPECT_NUMBER(priority, Priority, 0U);
  EXPECT_NUMBER(frameType, FrameType, 1);
  EXPECT_NUMBER(band, Band, 65536U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
