// Times of day and ages as short text.
#pragma once

#include <chrono>
#include <string>

namespace vespscope::terminal {

// "12:34:56" in the device's time zone.
[[nodiscard]] std::string timeOfDay(std::chrono::system_clock::time_point time);

// "3 s", "4 min", "5 h", "6 d"; an age below zero (the clock was set back) counts as 0 s.
[[nodiscard]] std::string ageText(std::chrono::system_clock::duration age);

}  // namespace vespscope::terminal
