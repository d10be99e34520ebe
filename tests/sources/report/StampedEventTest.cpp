// Events carry their message, stamped in whole milliseconds, and the SIM card's files in their order.
#include <chrono>

#include <gtest/gtest.h>

#include "messages/WireReader.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "sources/report/SimCardFiles.h"
#include "sources/report/StampedEvent.h"
#include "values/Text.h"

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

TEST(SimCardFiles, KeepTheirOrderAndContents) {
  const auto message = sources::simCardFilesMessage({{0x2FE2, {0x98, 0x10}}, {0x6F07, {}}});
  EXPECT_EQ(toText(message.dictionaryRepresentation()),
            "[ef_list: [[ef_id: 12258, content: <98 10>], [ef_id: 28423, content: <>]]]");
}

}  // namespace
}  // namespace vespscope::test
