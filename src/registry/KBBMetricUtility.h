// The registry of metric tags, asked by every message reader for every field number it meets.
#pragma once

#include <cstdint>
#include <string_view>

namespace vespscope {

class KBBMetricUtility {
 public:
  KBBMetricUtility() = delete;

  // True when `tag` is the tag of a known metric, which is also logged as "valid metricId tag". The answer does
  // not depend on `messageClass`, the name of the message class that asks. Safe from any thread.
  [[nodiscard]] static bool isValidMetricIdTag(std::int64_t tag, std::string_view messageClass);

  // The number of tags in the registry.
  [[nodiscard]] static std::size_t count();
};

}  // namespace vespscope
