#include "messages/MetricTags.h"

#include <cinttypes>
#include <cstdio>

#include "platform/log/Log.h"

namespace vespscope {

bool takeKnownMetricTag(WireReader& reader, std::uint16_t fieldNumber, std::string_view messageClass) {
  if (!KBBMetricUtility::isValidMetricIdTag(fieldNumber, messageClass)) return false;
  const auto value = static_cast<std::uint32_t>(reader.readVarint());
  char line[64];
  std::snprintf(line, sizeof line, "Unknown tag: %" PRIx16 ":%" PRIu32, fieldNumber, value);
  log::system(line);
  return true;
}

}  // namespace vespscope
