// Writes instants as dates and times of day in the device's time zone.
#pragma once

#include <string>
#include <string_view>

namespace vespscope::dates {

// Formats instants with a date pattern (Unicode TR 35 letters y M d H m s S z and quoted text). An unknown letter is a
// programming error.
class DateFormatter {
 public:
  // The formatter keeps a view of the pattern, which has to outlive it.
  explicit DateFormatter(std::string_view pattern) : pattern_(pattern) {}
  // Formats `seconds` since 1970-01-01 00:00 UTC. For an instant outside the calendar's range, returns the seconds as
  // text.
  [[nodiscard]] std::string stringFromSeconds(double seconds) const;

 private:
  std::string_view pattern_;
};

}  // namespace vespscope::dates
