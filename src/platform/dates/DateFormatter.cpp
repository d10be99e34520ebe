#include "platform/dates/DateFormatter.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <ctime>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include <time.h>

#include "platform/log/Log.h"
#include "values/Text.h"

namespace vespscope::dates {
namespace {

// A text being built: in a fixed buffer, which nearly always suffices, then in a string.
class Line {
 public:
  void operator+=(char character) {
    if (size_ == start_.size()) continueInString();
    start_[size_++] = character;
  }
  void operator+=(std::string_view text) {
    for (const char character : text) *this += character;
  }
  [[nodiscard]] std::string take() {
    if (rest_.empty()) return {start_.data(), size_};
    continueInString();
    return std::move(rest_);
  }

 private:
  void continueInString() {
    rest_.append(start_.data(), size_);
    size_ = 0;
  }

  std::array<char, 48> start_;
  std::size_t size_ = 0;
  std::string rest_;
};

void appendPadded(Line& out, std::int64_t number, std::size_t width) {
  if (width == 2 && number >= 0 && number < 100) {  // nearly always true
    out += static_cast<char>('0' + number / 10);
    out += static_cast<char>('0' + number % 10);
    return;
  }
  std::array<char, 24> digits;
  const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), std::abs(number)).ptr;
  const auto length = static_cast<std::size_t>(end - digits.data());
  if (number < 0) out += '-';
  for (std::size_t place = length; place < width; ++place) out += '0';
  out += std::string_view(digits.data(), length);
}

// Appends `width` digits of a fraction of a second (0 to less than 1), truncated.
void appendFraction(Line& out, double fraction, std::size_t width) {
  for (std::size_t digit = 0; digit < width; ++digit) {
    fraction *= 10;
    const int whole = std::min(static_cast<int>(fraction), 9);
    out += static_cast<char>('0' + whole);
    fraction -= whole;
  }
}

void appendField(Line& out, char letter, std::size_t width, const std::tm& moment, double fraction) {
  switch (letter) {
    case 'y': {
      const std::int64_t year = std::int64_t{moment.tm_year} + 1900;
      return width == 2 ? appendPadded(out, std::abs(year) % 100, 2) : appendPadded(out, year, width);
    }
    case 'M':
      return appendPadded(out, moment.tm_mon + 1, width);
    case 'd':
      return appendPadded(out, moment.tm_mday, width);
    case 'H':
      return appendPadded(out, moment.tm_hour, width);
    case 'm':
      return appendPadded(out, moment.tm_min, width);
    case 's':
      return appendPadded(out, moment.tm_sec, width);
    case 'S':
      return appendFraction(out, fraction, width);
    case 'z':
      out += std::string_view(moment.tm_zone);
      return;
    default:
      log::fatal(std::string("a date pattern has the unknown letter ") + letter);
  }
}

// Copies the quoted text that starts at `position`, where two quotes mean one; returns the position after it.
std::size_t appendQuoted(Line& out, std::string_view pattern, std::size_t position) {
  if (pattern.substr(position, 2) == "''") {
    out += '\'';
    return position + 2;
  }
  for (++position; position < pattern.size(); ++position) {
    if (pattern[position] == '\'') {
      if (pattern.substr(position, 2) != "''") return position + 1;
      ++position;
    }
    out += pattern[position];
  }
  return position;
}

// Local times of instants. A library call for each would cost more than the rest of a timestamp, and instants come
// close together, so each quarter of an hour with a constant zone offset is looked up once.
class LocalTimes {
 public:
  // Empty for an instant outside the calendar's range.
  [[nodiscard]] std::optional<std::tm> of(std::time_t instant) {
    followZone();
    const std::time_t begin = instant - ((instant % quarter) + quarter) % quarter;
    Known& known = known_[static_cast<std::size_t>(begin / quarter & 1)];
    if (known.begin != begin) known = {begin, firstOf(begin)};
    if (known.first) return within(*known.first, instant - begin);
    std::tm moment{};
    if (::localtime_r(&instant, &moment) == nullptr) return std::nullopt;
    return moment;
  }

 private:
  static constexpr std::time_t quarter = 900;  // s

  struct Known {
    std::optional<std::time_t> begin;
    std::optional<std::tm> first;
  };

  // The local time at the beginning of a quarter, from which minutes and seconds are counted; empty when the zone does
  // not divide hours like that or changes its offset or name within the quarter.
  static std::optional<std::tm> firstOf(std::time_t begin) {
    std::tm first{};
    std::tm last{};
    const std::time_t end = begin + quarter - 1;
    if (::localtime_r(&begin, &first) == nullptr || ::localtime_r(&end, &last) == nullptr) return std::nullopt;
    const bool even = first.tm_sec == 0 && last.tm_sec == 59 && last.tm_min == first.tm_min + 14;
    const bool same = first.tm_hour == last.tm_hour && first.tm_gmtoff == last.tm_gmtoff &&
                      std::string_view(first.tm_zone) == last.tm_zone;
    return even && same ? std::optional(first) : std::nullopt;
  }
  static std::tm within(std::tm moment, std::time_t seconds) {
    moment.tm_min += static_cast<int>(seconds / 60);
    moment.tm_sec = static_cast<int>(seconds % 60);
    return moment;
  }

  // Looks up the device's zone again, which localtime_r alone need not do. Without TZ the library reads the file system
  // for that, which is expensive, so it is done only after a pause.
  void followZone() {
    constexpr std::int64_t pause = 100'000'000;  // ns
    if (const char* zone = std::getenv("TZ")) {
      next_ = 0;
      if (zone_ == zone) return;
      zone_ = zone;
    } else {
      timespec now{};
      ::clock_gettime(CLOCK_MONOTONIC_COARSE, &now);
      const std::int64_t instant = std::int64_t{now.tv_sec} * 1'000'000'000 + now.tv_nsec;
      if (instant < next_) return;
      next_ = instant + pause;
      zone_.reset();
    }
    ::tzset();
    known_ = {};
  }

  std::optional<std::string> zone_;  // TZ at the last look-up
  std::int64_t next_ = 0;            // when to look again if TZ is not set
  // The last two quarters, for events that arrive slightly out of order.
  std::array<Known, 2> known_;
};

bool isLetter(char character) {
  return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z');
}

}  // namespace

std::string DateFormatter::stringFromSeconds(double seconds) const {
  constexpr double limit = 9.0e18;  // the range of 64-bit seconds
  thread_local LocalTimes localTimes;
  const double whole = std::floor(seconds);
  std::optional<std::tm> moment;
  if (std::abs(seconds) < limit) moment = localTimes.of(static_cast<std::time_t>(whole));  // false for a NaN as well
  if (!moment) {
    std::string number;
    appendNumber(number, seconds);
    return number;
  }
  Line out;
  const std::string_view pattern = pattern_;
  std::size_t position = 0;
  while (position < pattern.size()) {
    const char character = pattern[position];
    if (character == '\'') {
      position = appendQuoted(out, pattern, position);
    } else if (isLetter(character)) {
      const std::size_t end = std::min(pattern.find_first_not_of(character, position), pattern.size());
      appendField(out, character, end - position, *moment, seconds - whole);
      position = end;
    } else {
      out += character;
      ++position;
    }
  }
  return out.take();
}

}  // namespace vespscope::dates
