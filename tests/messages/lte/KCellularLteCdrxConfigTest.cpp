// KCellularLteCdrxConfig compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteCdrxConfig.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteCdrxConfig, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 ad a0 01 18 94 2d 20 00 28 80 80 04 38 7f 50 80 01 58 80 80 01 60 07 68 b9 01 70 "
      "ff ff ff ff 0f";
  const auto read = readFrom<KCellularLteCdrxConfig>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, cell_status: 20525, on_duration_ms: 5780, drx_inactivity_ms: 0, "
            "drx_retx_timer_ms: 65536, long_drx_cycle_ms: 127, short_drx_cycle_ms: 128, drx_short_cycle_num: "
            "16384, rrc_state: (unknown: 7), cdrx_config_status: 185, transmission_mode: 4294967295]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteCdrxConfig written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(cellStatus, CellStatus, 20525U);
  EXPECT_NUMBER(onDurationMs, OnDurationMs, 5780U);
  EXPECT_NUMBER(drxInactivityMs, DrxInactivityMs, 0U);
  EXPECT_NUMBER(drxRetxTimerMs, DrxRetxTimerMs, 65536U);
  EXPECT_NUMBER(longDrxCycleMs, LongDrxCycleMs, 127U);
  EXPECT_NUMBER(shortDrxCycleMs, ShortDrxCycleMs, 128U);
  EXPECT_NUMBER(drxShortCycleNum, DrxShortCycleNum, 16384U);
  EXPECT_NUMBER(rrcState, RrcState, 7);
  EXPECT_NUMBER(cdrxConfigStatus, CdrxConfigStatus, 185U);
  EXPECT_NUMBER(transmissionMode, TransmissionMode, 4294967295U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
