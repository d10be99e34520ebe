#include "registry/KBBMetricUtility.h"

#include <bit>
#include <numeric>

#include "platform/log/Log.h"

namespace vespscope {

bool KBBMetricUtility::isValidMetricIdTag(std::int64_t tag, std::string_view /*messageClass*/) {
  if (tag < 0 || tag > 0xFFFF || !isMetricTag(static_cast<std::uint16_t>(tag))) return false;
  log::system("valid metricId tag");
  return true;
}

std::size_t KBBMetricUtility::count() {
  return std::accumulate(
      metricTagBits.begin(), metricTagBits.end(), std::size_t{0},
      [](std::size_t sum, std::uint64_t bits) { return sum + static_cast<std::size_t>(std::popcount(bits)); });
}

}  // namespace vespscope
