#include "frontends/terminal/ClockText.h"

#include <algorithm>
#include <array>
#include <ctime>

namespace vespscope::terminal {

std::string timeOfDay(std::chrono::system_clock::time_point time) {
  const std::time_t seconds = std::chrono::system_clock::to_time_t(std::chrono::floor<std::chrono::seconds>(time));
  std::tm parts{};
  ::localtime_r(&seconds, &parts);
  std::array<char, 16> text;
  const std::size_t length = std::strftime(text.data(), text.size(), "%H:%M:%S", &parts);
  return {text.data(), length};
}

std::string ageText(std::chrono::system_clock::duration age) {
  const auto seconds = std::max<std::int64_t>(std::chrono::duration_cast<std::chrono::seconds>(age).count(), 0);
  if (seconds < 60) return std::to_string(seconds) + " s";
  if (seconds < 3600) return std::to_string(seconds / 60) + " min";
  if (seconds < 86400) return std::to_string(seconds / 3600) + " h";
  return std::to_string(seconds / 86400) + " d";
}

}  // namespace vespscope::terminal
