#include "registry/KBBMetricUtility.h"

#include <algorithm>
#include <array>
#include <mutex>

#include "platform/log/Log.h"
#include "registry/MetricRows.h"

namespace vespscope {
namespace {

using Tags = std::array<std::uint16_t, metricRows.size()>;

// The tags in ascending order, built on first use.
const Tags& registry() {
  static std::once_flag once;
  static Tags tags;
  std::call_once(once, [] {
    std::transform(metricRows.begin(), metricRows.end(), tags.begin(), [](const MetricRow& row) { return row.tag; });
    std::sort(tags.begin(), tags.end());
  });
  return tags;
}

}  // namespace

bool KBBMetricUtility::isValidMetricIdTag(std::int64_t tag, std::string_view /*messageClass*/) {
  const Tags& tags = registry();
  if (!std::binary_search(tags.begin(), tags.end(), tag)) return false;
  log::system("valid metricId tag");
  return true;
}

std::size_t KBBMetricUtility::count() { return registry().size(); }

}  // namespace vespscope
