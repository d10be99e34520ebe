// A modem's log that tests write themselves: ten minutes in two LTE cells, with the levels of both antennas.
#pragma once

#include <chrono>

#include "support/LogWriter.h"
#include "values/Value.h"

namespace vespscope::test {

inline constexpr int writtenLogCells = 2;           // B0C2 records
inline constexpr int writtenLogMeasurements = 600;  // B193 records, one each second

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

}  // namespace vespscope::test
