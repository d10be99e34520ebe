// KCellularMmCommonInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/KCellularLocationAreaId.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/Plmn.h"

namespace vespscope::test {
namespace {

TEST(KCellularMmCommonInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 12 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 1a 06 0a 04 08 29 26 10 1a 05 "
      "0a 03 13 00 14 22 07 0a 03 62 f2 10 10 00 22 04 10 80 80 04 2a 04 0a 00 10 7f 2a 03 10 80 01 32 16 0a 10 "
      "fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 10 80 80 01 32 03 10 b9 01 3a 0c 0a 04 08 29 26 10 10 ff "
      "ff ff ff 0f 3a 02 10 07";
  const auto read = readFrom<KCellularMmCommonInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, imsi: <fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01>, eplmn_list: "
            "[[encoded_plmn: <08 29 26 10>], [encoded_plmn: <13 00 14>]], roaming_flai_list: [[encoded_plmn: <62 "
            "f2 10>, lac: 0], [lac: 65536]], reg_prov_flai_list: [[encoded_plmn: <>, lac: 127], [lac: 128]], "
            "roaming_ftai_list: [[encoded_plmn: <fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01>, tac: 16384], "
            "[tac: 185]], reg_prov_ftai_list: [[encoded_plmn: <08 29 26 10>, tac: 4294967295], [tac: 7]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularMmCommonInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_CONTENT(imsi, Imsi, hex("fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01"));
  EXPECT_MESSAGES(eplmnLists, EplmnLists, eplmnList, EplmnList, readAll<Plmn>({"0a 04 08 29 26 10", "0a 03 13 00 14"}));
  EXPECT_MESSAGES(roamingFlaiLists, RoamingFlaiLists, roamingFlaiList, RoamingFlaiList,
                  readAll<KCellularLocationAreaId>({"0a 03 62 f2 10 10 00", "10 80 80 04"}));
  EXPECT_MESSAGES(regProvFlaiLists, RegProvFlaiLists, regProvFlaiList, RegProvFlaiList,
                  readAll<KCellularLocationAreaId>({"0a 00 10 7f", "10 80 01"}));
  EXPECT_MESSAGES(roamingFtaiLists, RoamingFtaiLists, roamingFtaiList, RoamingFtaiList,
                  readAll<KCellularTrackingAreaId>(
                      {"0a 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 10 80 80 01", "10 b9 01"}));
  EXPECT_MESSAGES(regProvFtaiLists, RegProvFtaiLists, regProvFtaiList, RegProvFtaiList,
                  readAll<KCellularTrackingAreaId>({"0a 04 08 29 26 10 10 ff ff ff ff 0f", "10 07"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
