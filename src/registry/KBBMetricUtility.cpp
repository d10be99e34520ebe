#include "registry/KBBMetricUtility.h"

#include <bitset>

#include "platform/log/Log.h"
#include "registry/MetricRows.h"

namespace vespscope {
namespace {

// One bit per possible tag: readers ask for every key they meet.
using Tags = std::bitset<65536>;

Tags makeTags() {
  Tags tags;
  for (const MetricRow& row : metricRows) tags.set(row.tag);
  return tags;
}

// Built by the first caller while any other waits.
const Tags& registry() {
  static const Tags tags = makeTags();
  return tags;
}

}  // namespace

bool KBBMetricUtility::isValidMetricIdTag(std::int64_t tag, std::string_view /*messageClass*/) {
  const Tags& tags = registry();
  if (tag < 0 || static_cast<std::uint64_t>(tag) >= tags.size() || !tags.test(static_cast<std::size_t>(tag))) {
    return false;
  }
  log::system("valid metricId tag");
  return true;
}

std::size_t KBBMetricUtility::count() { return registry().count(); }

}  // namespace vespscope
