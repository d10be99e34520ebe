// The records of a log, and what its levels say of their carrier.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <variant>
#include <vector>

#include <gtest/gtest.h>

#include "sources/diag/FrameReader.h"
#include "sources/diag/LogRecord.h"
#include "sources/diag/LteRecords.h"
#include "values/Value.h"

namespace vespscope::test {

// Calls `visit` with every log record of the log.
template <class Visit>
sources::diag::FrameCounters forEachRecord(const Bytes& log, Visit visit) {
  sources::diag::FrameReader reader;
  reader.feed(log);
  while (const auto frame = reader.next()) {
    const auto parsed = sources::diag::logRecordOf(*frame);
    EXPECT_TRUE(std::holds_alternative<sources::diag::LogRecord>(parsed));
    if (const auto* record = std::get_if<sources::diag::LogRecord>(&parsed)) visit(*record);
  }
  reader.finish();
  return reader.counters();
}

// RSRQ is RSRP over RSSI, times the resource blocks of the carrier (3GPP TS 36.214 5.1.3).
inline double blocksOf(const sources::diag::AntennaLevels& levels) {
  return std::pow(10, (levels.rsrq - levels.rsrp + levels.rssi) / 10);
}

inline double quantile(std::vector<double> values, double part) {
  std::sort(values.begin(), values.end());
  return values.at(static_cast<std::size_t>(part * static_cast<double>(values.size() - 1)));
}

}  // namespace vespscope::test
