// A modem's log written by the tests: ten minutes in two LTE cells, with the levels of both antennas.
#pragma once

#include <chrono>

#include "support/LogWriter.h"
#include "values/Value.h"

namespace vespscope::test {

inline constexpr int writtenLogCells = 2;           // B0C2 records
inline constexpr int writtenLogMeasurements = 600;  // B193 records, one per second

[[nodiscard]] inline Bytes writtenLog() {
  constexpr std::chrono::seconds begin{1'700'000'000};
  LogWriter log;
  for (int second = 0; second < writtenLogMeasurements; ++second) {
    const bool first = second < writtenLogMeasurements / 2;
    const WrittenCell cell{.pci = static_cast<std::uint16_t>(first ? 185 : 186), .earfcn = 5780};
    const std::chrono::nanoseconds time = begin + std::chrono::seconds(second);
    if (second % (writtenLogMeasurements / writtenLogCells) == 0) {
      WrittenServingCell serving;
      serving.cell = cell;
      serving.uplinkEarfcn = 23'780;
      serving.downlinkBlocks = 50;
      serving.uplinkBlocks = 50;
      serving.cellIdentity = first ? 0x1000A : 0x1000B;
      serving.trackingAreaCode = 7145;
      serving.band = 17;
      serving.mcc = 1;
      serving.mncDigits = 2;
      serving.mnc = 1;
      log.record(0xB0C2, time, servingCellPayload(3, serving));
    }
    const double fading = second % 7;
    const WrittenLevels levels{.rsrp = -95 - fading, .rsrq = -11, .rssi = -67 - fading, .snr = 12};
    log.record(0xB193, time + std::chrono::milliseconds(40), measurementPayload(19, cell, {levels, levels}));
  }
  return log.bytes();
}

inline constexpr int twoSimsRecords = 200;  // of each SIM card
inline constexpr std::uint32_t twoSimsFirstCell = 0x1000A;
inline constexpr std::uint32_t twoSimsSecondCell = 0x2000B;

// The log of a phone with two SIM cards, each in its own cell: their records alternate, a second apart. Card 2 has the
// first record.
[[nodiscard]] inline Bytes writtenLogOfTwoSims() {
  constexpr std::chrono::seconds begin{1'700'000'000};
  LogWriter log;
  for (int second = 0; second < 2 * twoSimsRecords; ++second) {
    const std::uint32_t sim = second % 2 == 0 ? 2 : 1;
    WrittenServingCell serving;
    serving.cell = {.pci = static_cast<std::uint16_t>(sim == 1 ? 185 : 370), .earfcn = sim == 1 ? 5780U : 1300U};
    serving.uplinkEarfcn = sim == 1 ? 23'780 : 19'300;
    serving.downlinkBlocks = serving.uplinkBlocks = sim == 1 ? 50 : 100;
    serving.cellIdentity = sim == 1 ? twoSimsFirstCell : twoSimsSecondCell;
    serving.trackingAreaCode = sim == 1 ? 7145 : 4711;
    serving.band = sim == 1 ? 17 : 3;
    serving.mcc = 1;
    serving.mncDigits = 2;
    serving.mnc = static_cast<std::uint16_t>(sim);
    log.record(0xB0C2, begin + std::chrono::seconds(second), servingCellPayload(3, serving), sim);
  }
  return log.bytes();
}

}  // namespace vespscope::test
