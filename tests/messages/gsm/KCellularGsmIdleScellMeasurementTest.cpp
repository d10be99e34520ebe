// KCellularGsmIdleScellMeasurement compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"

namespace vespscope::test {
namespace {

TEST(KCellularGsmIdleScellMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 80 01 18 80 80 01 20 b9 01 28 bd 01";
  const auto read = readFrom<KCellularGsmIdleScellMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, scell_arfcn: 128, simplified_l1_state: 16384, current_antenna: 185, "
            "idle_rxlev_dBm: -95]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmIdleScellMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(scellArfcn, ScellArfcn, 128U);
  EXPECT_NUMBER(simplifiedL1State, SimplifiedL1State, 16384U);
  EXPECT_NUMBER(currentAntenna, CurrentAntenna, 185U);
  EXPECT_NUMBER(idleRxlevDBm, IdleRxlevDBm, -95);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
