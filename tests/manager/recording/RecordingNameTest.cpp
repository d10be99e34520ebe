// The names of recordings are times in UTC and sort as such.
#include <string>

#include <gtest/gtest.h>

#include "manager/recording/RecordingName.h"

namespace vespscope::test {
namespace {

using namespace manager;
using namespace std::chrono;

constexpr RecordingTime moment = sys_days(year(2026) / 11 / 21) + 13h + 25min + 1s + 42ms;

TEST(RecordingName, IsTheUtcTimeOfItsBeginning) {
  EXPECT_EQ(recordingName(moment), "vespscope-20261121T132501.042Z.pcap");
  EXPECT_EQ(recordingName(sys_days(year(1970) / 1 / 1)), "vespscope-19700101T000000.000Z.pcap");
}

TEST(RecordingName, SortsAsItsTime) {
  RecordingTime time = moment;
  std::string before = recordingName(time);
  for (const auto step : {milliseconds(1), milliseconds(1s), milliseconds(1min), milliseconds(1h), milliseconds(24h),
                          milliseconds(24h * 40), milliseconds(24h * 400)}) {
    time += step;
    EXPECT_LT(before, recordingName(time));
    EXPECT_EQ(recordingTime(recordingName(time)), time);
    before = recordingName(time);
  }
}

TEST(RecordingName, StaysWithinTheYearsThatItCanHold) {
  EXPECT_EQ(recordingName(RecordingTime(milliseconds::min())), "vespscope-00000101T000000.000Z.pcap");
  EXPECT_EQ(recordingName(RecordingTime(milliseconds::max())), "vespscope-99991231T235959.999Z.pcap");
}

TEST(RecordingName, IsNothingElse) {
  for (const std::string name :
       {"", "drive.pcap", "vespscope-20261121T132501.042Z.pcapng", "vespscope-20261121T132501.042Z.pcap.bak",
        "Vespscope-20261121T132501.042Z.pcap", "vespscope-20261121T132501,042Z.pcap",
        "vespscope-2026112aT132501.042Z.pcap", "vespscope-20261321T132501.042Z.pcap",
        "vespscope-20260230T132501.042Z.pcap", "vespscope-20261121T242501.042Z.pcap",
        "vespscope-20261121T136001.042Z.pcap", "vespscope-20261121T132560.042Z.pcap"}) {
    EXPECT_EQ(recordingTime(name), std::nullopt) << name;
  }
}

}  // namespace
}  // namespace vespscope::test
