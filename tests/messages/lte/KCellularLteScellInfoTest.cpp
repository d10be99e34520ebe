// KCellularLteScellInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteScellInfo.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteScellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 ac 02 18 96 0a 20 ad a0 01 28 94 2d 30 00 38 80 80 04 40 7f 48 80 01 50 80 80 01 "
      "58 b9 01 60 ff ff ff ff 0f 70 07 78 ac 02";
  const auto read = readFrom<KCellularLteScellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, phy_cell_id: 300, dl_freq: 1302, ul_freq: 20525, dl_bw: 5780, ul_bw: 0, "
            "cell_id: 65536, freq_band_ind: 127, tracking_area_code: 128, num_mnc_digits: 16384, sel_plmn_mcc: "
            "185, sel_plmn_mnc: 4294967295, tdd_sf_assignment: 7, tdd_ssf_patterns: 300]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteScellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(phyCellId, PhyCellId, 300U);
  EXPECT_NUMBER(dlFreq, DlFreq, 1302U);
  EXPECT_NUMBER(ulFreq, UlFreq, 20525U);
  EXPECT_NUMBER(dlBw, DlBw, 5780U);
  EXPECT_NUMBER(ulBw, UlBw, 0U);
  EXPECT_NUMBER(cellId, CellId, 65536U);
  EXPECT_NUMBER(freqBandInd, FreqBandInd, 127U);
  EXPECT_NUMBER(trackingAreaCode, TrackingAreaCode, 128U);
  EXPECT_NUMBER(numMncDigits, NumMncDigits, 16384U);
  EXPECT_NUMBER(selPlmnMcc, SelPlmnMcc, 185U);
  EXPECT_NUMBER(selPlmnMnc, SelPlmnMnc, 4294967295U);
  EXPECT_NUMBER(tddSfAssignment, TddSfAssignment, 7U);
  EXPECT_NUMBER(tddSsfPatterns, TddSsfPatterns, 300U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
