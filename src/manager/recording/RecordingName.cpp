#include "manager/recording/RecordingName.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace vespscope::manager {
namespace {

using namespace std::chrono;

constexpr RecordingTime earliest = sys_days(year(0) / 1 / 1);
constexpr RecordingTime latest = sys_days(year(9999) / 12 / 31) + 23h + 59min + 59s + 999ms;

// The number that `digits` write.
unsigned numberOf(std::string_view digits) {
  unsigned number = 0;
  for (const char digit : digits) number = number * 10 + static_cast<unsigned>(digit - '0');
  return number;
}

bool isDigit(char letter) { return letter >= '0' && letter <= '9'; }

}  // namespace

std::string recordingName(RecordingTime time) {
  const RecordingTime told = std::clamp(time, earliest, latest);
  const auto day = floor<days>(told);
  const year_month_day date(day);
  const hh_mm_ss clock(told - day);
  std::array<char, 64> text{};
  const int length = std::snprintf(text.data(), text.size(), "vespscope-%04d%02u%02uT%02d%02d%02d.%03dZ.pcap",
                                   static_cast<int>(date.year()), static_cast<unsigned>(date.month()),
                                   static_cast<unsigned>(date.day()), static_cast<int>(clock.hours().count()),
                                   static_cast<int>(clock.minutes().count()), static_cast<int>(clock.seconds().count()),
                                   static_cast<int>(clock.subseconds().count()));
  return {text.data(), static_cast<std::size_t>(length)};
}

std::optional<RecordingTime> recordingTime(std::string_view name) {
  constexpr std::string_view example = "vespscope-00000000T000000.000Z.pcap";
  if (name.size() != example.size()) return std::nullopt;
  for (std::size_t index = 0; index < example.size(); ++index) {
    if (example[index] == '0' ? !isDigit(name[index]) : name[index] != example[index]) return std::nullopt;
  }
  const auto number = [name](std::size_t first, std::size_t count) { return numberOf(name.substr(first, count)); };
  const year_month_day date(year(static_cast<int>(number(10, 4))), month(number(14, 2)), day(number(16, 2)));
  if (!date.ok()) return std::nullopt;
  const RecordingTime time = sys_days(date) + hours(number(19, 2)) + minutes(number(21, 2)) + seconds(number(23, 2)) +
                             milliseconds(number(26, 3));
  // Times such as hour 25 or second 61 are never written here.
  return recordingName(time) == name ? std::optional(time) : std::nullopt;
}

}  // namespace vespscope::manager
