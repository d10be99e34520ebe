// What the records of a modem log are, and which of the viewer's screens their contents reach.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace vespscope::tools {

struct RecordScreens {
  std::uint16_t code = 0;
  std::string_view name;                      // what the record holds, in the plural
  std::string_view topic;                     // the same for several codes
  std::span<const std::string_view> screens;  // their keys
};

// The records that are understood in some version, in the order of their codes.
[[nodiscard]] std::span<const RecordScreens> recordScreens();
// The row of `code`; null for a code that is not understood in any version.
[[nodiscard]] const RecordScreens* findRecordScreens(std::uint16_t code);

// "LTE", "NR", "UMTS", "GSM", "UMTS and GSM", or empty for a code of none of these.
[[nodiscard]] std::string_view technologyOf(std::uint16_t code);

}  // namespace vespscope::tools
