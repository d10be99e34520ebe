// Times of day, ages and positions as short text.
#pragma once

#include <chrono>
#include <string>

namespace vespscope::application {

// "12:34:56", and "2016-01-17 03:42:14", in the device's time zone.
[[nodiscard]] std::string timeOfDay(std::chrono::system_clock::time_point time);
[[nodiscard]] std::string dateAndTime(std::chrono::system_clock::time_point time);

// "3 s", "4 min", "5 h", "6 d"; a negative age (the clock was set back) is shown as 0 s.
[[nodiscard]] std::string ageText(std::chrono::nanoseconds age);
// "now" below one second, then "3 s ago", "4 min ago".
[[nodiscard]] std::string agoText(std::chrono::nanoseconds age);

// A position in a recording: "01:37", and "1:01:37" from one hour; a negative position is shown as 00:00.
[[nodiscard]] std::string positionText(std::chrono::nanoseconds position);

}  // namespace vespscope::application
