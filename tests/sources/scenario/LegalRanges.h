// The values that 3GPP allows in each field of the simulated drive.
#pragma once

#include <cstdint>
#include <map>
#include <string>

namespace vespscope::test {

struct LegalRange {
  std::int64_t low;
  std::int64_t high;
  [[nodiscard]] bool holds(std::int64_t number) const { return low <= number && number <= high; }
};

// Keyed by message class and the keys of the field, "KCellularLteTxPower.tx_power_info.subframe_index". For bytes the
// range is that of their number.
[[nodiscard]] const std::map<std::string, LegalRange>& legalRanges();

}  // namespace vespscope::test
