// The registry of metric tags, which every message reader queries for every field number.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "registry/MetricRows.h"

namespace vespscope {

// One bit per possible tag, because readers query every key.
inline constexpr auto metricTagBits = [] {
  std::array<std::uint64_t, 65536 / 64> bits{};
  for (const MetricRow& row : metricRows) bits[row.tag / 64U] |= std::uint64_t{1} << row.tag % 64U;
  return bits;
}();

// True when `tag` is the tag of a known metric; logs nothing.
constexpr bool isMetricTag(std::uint16_t tag) { return (metricTagBits[tag / 64U] >> tag % 64U & 1) != 0; }

class KBBMetricUtility {
 public:
  KBBMetricUtility() = delete;

  // True when `tag` is the tag of a known metric, which is also logged as "valid metricId tag". The result does not
  // depend on `messageClass`, the name of the calling message class. Safe from any thread.
  [[nodiscard]] static bool isValidMetricIdTag(std::int64_t tag, std::string_view messageClass);

  // The number of tags in the registry.
  [[nodiscard]] static std::size_t count();
};

}  // namespace vespscope
