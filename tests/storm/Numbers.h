// Events that carry their number, so that each one can be found again in a viewer's lines and in recordings.
#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace vespscope::test {

// The life of one manager, from 0 on. Its events are numbered from 0 on.
using Life = std::uint32_t;
constexpr std::uint32_t mostEvents = 1U << 18;  // of one life
constexpr Life mostLives = 1U << 14;

// Writes a capture of `count` events of the life, `rate` in a second.
void writeSource(const std::string& path, Life life, std::uint32_t count, std::uint32_t rate);

// What arrived of one life's events.
struct Arrivals {
  std::uint64_t count = 0;
  std::uint32_t first = 0;
  std::uint32_t last = 0;
  std::uint64_t missing = 0;    // between the first and the last
  std::uint64_t again = 0;      // the last one once more: a manager begins a subscription with each metric's value
  std::uint64_t misplaced = 0;  // events that came behind a later one
};

class Numbers {
 public:
  // Takes the events that a viewer's lines show; a line may arrive in pieces.
  void readLines(std::string_view text);
  // Takes the events of a capture, or of each capture in a folder; returns why it cannot be read to its end.
  [[nodiscard]] std::optional<std::string> readCapture(const std::string& path);

  [[nodiscard]] Arrivals of(Life life) const;
  [[nodiscard]] std::uint64_t count() const { return count_; }

 private:
  void take(std::uint64_t value);

  std::map<Life, Arrivals> lives_;
  std::uint64_t count_ = 0;
  std::string rest_;  // of the last line
};

}  // namespace vespscope::test
