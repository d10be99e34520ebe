// Events carry their message, stamped in whole milliseconds.
#include <chrono>

#include <gtest/gtest.h>

#include "messages/lte/KCellularLteRrcState.h"
#include "sources/report/StampedEvent.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using sources::stampedEvent;

TEST(StampedEvent, CutsItsTimeToMilliseconds) {
  KCellularLteRrcState message;
  const MetricEvent event = stampedEvent(0x3C4E04, message, 1'700'000'000s + 1'999'999ns, 1);
  EXPECT_EQ(message.timestamp(), 1'700'000'000'001U);
  EXPECT_EQ(event.metricID, 0x3C4E04);
  EXPECT_EQ(event.profileID, 1);
  EXPECT_EQ(event.time, 1'700'000'000s + 1'999'999ns);
  EXPECT_EQ(event.payload, message.encoded());
}

}  // namespace
}  // namespace vespscope::test
