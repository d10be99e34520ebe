// KCellularWcdmaSelReselCellInfo compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/EutraFreqInfo.h"
#include "messages/umts/GsmFreqInfo.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"
#include "messages/umts/UtraFreqInfo.h"

namespace vespscope::test {
namespace {

TEST(KCellularWcdmaSelReselCellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 94 2d 18 00 20 01 2a 04 04 14 ac 02 30 80 80 04 38 7f 40 80 01 48 ff ff ff ff 0f "
      "50 01 58 bd 01 60 18 68 ff 09 a8 01 80 80 01 b2 01 09 08 b9 01 10 ff ff ff ff 0f b2 01 02 10 07 ba 01 06 "
      "08 ac 02 10 96 0a ba 01 04 10 ad a0 01 c2 01 05 08 94 2d 10 00 c2 01 04 10 80 80 04";
  const auto read = readFrom<KCellularWcdmaSelReselCellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, hsdpa_capable: 5780, edch_capable: 0, duplex_mode: TDD, multi_band_info: "
            "[4, 20, 300], ims_emergency_support: 65536, cell_barred: 127, fach_meas_occ_info_present: 128, "
            "s_rxlev: -2147483648, s_qual: -1, s_intrasearch: -95, s_intersearch: 12, s_search_rat: -640, "
            "s_cell_prio: 16384, eutra_prio_info: [[earfcn: 185, prio: 4294967295], [prio: 7]], utra_prio_info: "
            "[[uarfcn: 300, prio: 1302], [prio: 20525]], gsm_prio_info: [[arfcn: 5780, prio: 0], [prio: 65536]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaSelReselCellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(hsdpaCapable, HsdpaCapable, 5780U);
  EXPECT_NUMBER(edchCapable, EdchCapable, 0U);
  EXPECT_NUMBER(duplexMode, DuplexMode, 1);
  EXPECT_NUMBERS(multiBandInfos, MultiBandInfos, multiBandInfo, MultiBandInfo, <std::uint32_t>{4, 20, 300});
  EXPECT_NUMBER(imsEmergencySupport, ImsEmergencySupport, 65536U);
  EXPECT_NUMBER(cellBarred, CellBarred, 127U);
  EXPECT_NUMBER(fachMeasOccInfoPresent, FachMeasOccInfoPresent, 128U);
  EXPECT_NUMBER(sRxlev, SRxlev, std::numeric_limits<std::int32_t>::min());
  EXPECT_NUMBER(sQual, SQual, -1);
  EXPECT_NUMBER(sIntrasearch, SIntrasearch, -95);
  EXPECT_NUMBER(sIntersearch, SIntersearch, 12);
  EXPECT_NUMBER(sSearchRat, SSearchRat, -640);
  EXPECT_NUMBER(sCellPrio, SCellPrio, 16384U);
  EXPECT_MESSAGES(eutraPrioInfos, EutraPrioInfos, eutraPrioInfo, EutraPrioInfo,
                  readAll<EutraFreqInfo>({"08 b9 01 10 ff ff ff ff 0f", "10 07"}));
  EXPECT_MESSAGES(utraPrioInfos, UtraPrioInfos, utraPrioInfo, UtraPrioInfo,
                  readAll<UtraFreqInfo>({"08 ac 02 10 96 0a", "10 ad a0 01"}));
  EXPECT_MESSAGES(gsmPrioInfos, GsmPrioInfos, gsmPrioInfo, GsmPrioInfo,
                  readAll<GsmFreqInfo>({"08 94 2d 10 00", "10 80 80 04"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
