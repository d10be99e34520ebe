// Lists of GSM carriers and ranges of cells, as several messages hold them.
#pragma once

#include <cstdint>
#include <vector>

#include "rrc/Message.h"

namespace vespscope::rrc::lte {

// CarrierFreqsGERAN.
struct GsmCarriers {
  bool band1900 = false;                // what the channels 512..810 mean: PCS 1900, else DCS 1800
  std::vector<std::uint16_t> channels;  // ARFCN 0..1023, the starting one first
  bool operator==(const GsmCarriers&) const = default;
};

// PhysCellIdRange.
struct CellRange {
  std::uint16_t first = 0;  // 0..503
  std::uint16_t count = 1;
  bool operator==(const CellRange&) const = default;
};

[[nodiscard]] GsmCarriers gsmCarriersOf(const View& carriers);
[[nodiscard]] std::vector<CellRange> cellRangesOf(const View& list);

}  // namespace vespscope::rrc::lte
