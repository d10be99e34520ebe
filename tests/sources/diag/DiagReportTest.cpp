// The report of a log adds up to its frames and records.
#include <gtest/gtest.h>

#include "sources/diag/DiagReport.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(DiagReport, TheTableListsEveryFrameAndEveryKindOfRecordAndAddsUp) {
  DiagReport report;
  report.frames = {.good = 21, .badChecksum = 2, .aborted = 1, .oversized = 3, .truncated = 1};
  report.otherFrames = 1;
  report.malformedFrames = 2;
  report.otherRadios = 3;
  report.read[{0xB0C2, 3, std::nullopt}] = 4;
  report.read[{0x4127, std::nullopt, std::nullopt}] = 1;
  report.skipped[{0xB0C2, 7, std::nullopt}] = 2;
  report.skipped[{0xB060, std::nullopt, std::nullopt}] = 5;
  report.skipped[{0x412F, std::nullopt, 254}] = 1;
  report.broken[{0xB0C2, 3, std::nullopt}] = 2;
  report.partsSkipped[{0xB195, 3, 30}] = 4;
  EXPECT_EQ(report.table(),
            "frames\n"
            "  good                             21\n"
            "  bad checksum                      2  dropped\n"
            "  aborted                           1  dropped: an escape before the end\n"
            "  too long                          3  dropped\n"
            "  cut at the end                    1  dropped\n"
            "  all                              28\n"
            "good frames\n"
            "  log records                      18\n"
            "  of another kind                   1  not mapped: no log record\n"
            "  malformed                         2  not mapped: wrong lengths, or an impossible time\n"
            "  all                              21\n"
            "log records\n"
            "  4127                              1  mapped\n"
            "  412F channel 254                  1  not mapped: no message of the phone's own connection\n"
            "  B060                              5  not mapped: the layout of this code is not known\n"
            "  B0C2 v3                           4  mapped\n"
            "  B0C2 v3                           2  broken: too short, or numbers out of range\n"
            "  B0C2 v7                           2  not mapped: the layout of this version is not known\n"
            "  of other radios                   3  not mapped: more radios than a phone has\n"
            "  all                              18  5 mapped, 11 not mapped, 2 broken\n"
            "parts of mapped records\n"
            "  B195 subpacket 30 v3              4  not mapped: the layout of this subpacket is not known\n");
}

}  // namespace
}  // namespace vespscope::test
