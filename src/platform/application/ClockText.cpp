#include "platform/application/ClockText.h"

#include <algorithm>
#include <cstdint>

#include "platform/dates/DateFormatter.h"

namespace vespscope::application {
namespace {

std::string formatted(std::string_view pattern, std::chrono::system_clock::time_point time) {
  const auto whole = std::chrono::floor<std::chrono::seconds>(time.time_since_epoch());
  return dates::DateFormatter(pattern).stringFromSeconds(static_cast<double>(whole.count()));
}

std::int64_t secondsOf(std::chrono::nanoseconds duration) {
  return std::max<std::int64_t>(std::chrono::duration_cast<std::chrono::seconds>(duration).count(), 0);
}

std::string twoDigits(std::int64_t number) { return (number < 10 ? "0" : "") + std::to_string(number); }

}  // namespace

std::string timeOfDay(std::chrono::system_clock::time_point time) { return formatted("HH:mm:ss", time); }
std::string dateAndTime(std::chrono::system_clock::time_point time) { return formatted("yyyy-MM-dd HH:mm:ss", time); }

std::string ageText(std::chrono::nanoseconds age) {
  const std::int64_t seconds = secondsOf(age);
  if (seconds < 60) return std::to_string(seconds) + " s";
  if (seconds < 3600) return std::to_string(seconds / 60) + " min";
  if (seconds < 86400) return std::to_string(seconds / 3600) + " h";
  return std::to_string(seconds / 86400) + " d";
}

std::string agoText(std::chrono::nanoseconds age) { return secondsOf(age) == 0 ? "now" : ageText(age) + " ago"; }

std::string positionText(std::chrono::nanoseconds position) {
  const std::int64_t seconds = secondsOf(position);
  const std::string rest = twoDigits(seconds / 60 % 60) + ":" + twoDigits(seconds % 60);
  return seconds < 3600 ? rest : std::to_string(seconds / 3600) + ":" + rest;
}

}  // namespace vespscope::application
