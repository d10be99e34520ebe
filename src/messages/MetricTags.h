// What every reader does before it looks at its own fields: ask the registry of metric tags.
#pragma once

#include <cstdint>
#include <string_view>

#include "messages/WireReader.h"
#include "registry/KBBMetricUtility.h"

namespace vespscope {

// Consumes and logs the varint of a field whose number the registry knows.
bool takeKnownMetricTag(WireReader& reader, std::uint16_t fieldNumber, std::string_view messageClass);

// When `fieldNumber` is a metric tag, consumes one varint, whatever the wire type says, logs it as an unknown tag and
// returns true. A length-delimited value with such a number is therefore read on as if its content were keys.
[[nodiscard]] inline bool takeMetricTag(WireReader& reader, std::uint16_t fieldNumber, std::string_view messageClass) {
  return isMetricTag(fieldNumber) && takeKnownMetricTag(reader, fieldNumber, messageClass);
}

}  // namespace vespscope
