#include "messages/MetricTags.h"

#include <algorithm>
#include <array>
#include <charconv>

#include "platform/log/Log.h"

namespace vespscope {

bool takeKnownMetricTag(WireReader& reader, std::uint16_t fieldNumber, std::string_view messageClass) {
  if (!KBBMetricUtility::isValidMetricIdTag(fieldNumber, messageClass)) return false;
  const auto value = static_cast<std::uint32_t>(reader.readVarint());
  std::array<char, 64> line;
  constexpr std::string_view words = "Unknown tag: ";
  char* place = std::copy(words.begin(), words.end(), line.data());
  place = std::to_chars(place, line.data() + line.size(), fieldNumber, 16).ptr;
  *place++ = ':';
  place = std::to_chars(place, line.data() + line.size(), value).ptr;
  log::system({line.data(), place});
  return true;
}

}  // namespace vespscope
