// KCellularLteSelReselCellInfo compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/NbrEutra.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteSelReselCellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 12 04 04 14 ac 02 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 "
      "50 b9 01 58 01 60 bd 01 68 ff ff ff ff 0f 70 07 78 ac 02 80 01 96 0a 88 01 ad a0 01 90 01 94 2d 98 01 00 "
      "a0 01 80 80 04 aa 01 09 08 7f 38 80 01 68 80 80 01 aa 01 03 68 b9 01";
  const auto read = readFrom<KCellularLteSelReselCellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, multi_band_info: [4, 20, 300], ims_emergency_support: 20525, "
            "ac_barring_for_emergency: 5780, mo_signalling_ac_barring_factor: 0, mo_signalling_ac_barring_time: "
            "65536, mo_signalling_ac_barring_for_special_ac: 127, mo_data_ac_barring_factor: 128, "
            "mo_data_ac_barring_time: 16384, mo_data_ac_barring_for_special_ac: 185, QRxLevMin: -1, QQualMin: "
            "-95, Q_hyst: 4294967295, S_non_intra_search_P: 7, S_non_intra_search_Q: 300, S_intra_search_P: "
            "1302, S_intra_search_Q: 20525, Thresh_serving_lowP: 5780, priority_operating_freq: 65536, "
            "nbr_eutra: [[earfcn: 127, Thres_X_highP: 128, band: 16384], [band: 185]]]");
  // All except field 19, whose number is a metric tag: it is written but never read.
  EXPECT_EQ(
      read->encoded(),
      hex("08 81 d0 95 ff bc 31 12 04 04 14 ac 02 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 "
          "50 b9 01 58 01 60 bd 01 68 ff ff ff ff 0f 70 07 78 ac 02 80 01 96 0a 88 01 ad a0 01 90 01 94 2d a0 01 80 "
          "80 04 aa 01 09 08 7f 38 80 01 68 80 80 01 aa 01 03 68 b9 01"));

  KCellularLteSelReselCellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBERS(multiBandInfos, MultiBandInfos, multiBandInfo, MultiBandInfo, <std::uint32_t>{4, 20, 300});
  EXPECT_NUMBER(imsEmergencySupport, ImsEmergencySupport, 20525U);
  EXPECT_NUMBER(acBarringForEmergency, AcBarringForEmergency, 5780U);
  EXPECT_NUMBER(moSignallingAcBarringFactor, MoSignallingAcBarringFactor, 0U);
  EXPECT_NUMBER(moSignallingAcBarringTime, MoSignallingAcBarringTime, 65536U);
  EXPECT_NUMBER(moSignallingAcBarringForSpecialAc, MoSignallingAcBarringForSpecialAc, 127U);
  EXPECT_NUMBER(moDataAcBarringFactor, MoDataAcBarringFactor, 128U);
  EXPECT_NUMBER(moDataAcBarringTime, MoDataAcBarringTime, 16384U);
  EXPECT_NUMBER(moDataAcBarringForSpecialAc, MoDataAcBarringForSpecialAc, 185U);
  EXPECT_NUMBER(qRxLevMin, QRxLevMin, -1);
  EXPECT_NUMBER(qQualMin, QQualMin, -95);
  EXPECT_NUMBER(qHyst, QHyst, 4294967295U);
  EXPECT_NUMBER(sNonIntraSearchP, SNonIntraSearchP, 7U);
  EXPECT_NUMBER(sNonIntraSearchQ, SNonIntraSearchQ, 300U);
  EXPECT_NUMBER(sIntraSearchP, SIntraSearchP, 1302U);
  EXPECT_NUMBER(sIntraSearchQ, SIntraSearchQ, 20525U);
  EXPECT_NUMBER(threshServingLowP, ThreshServingLowP, 5780U);
  EXPECT_FALSE(read->hasThreshServingLowQ());
  written.setThreshServingLowQ(0U);
  EXPECT_TRUE(written.hasThreshServingLowQ());
  EXPECT_EQ(written.threshServingLowQ(), 0U);
  EXPECT_NUMBER(priorityOperatingFreq, PriorityOperatingFreq, 65536U);
  EXPECT_MESSAGES(nbrEutras, NbrEutras, nbrEutra, NbrEutra,
                  readAll<NbrEutra>({"08 7f 38 80 01 68 80 80 01", "68 b9 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
