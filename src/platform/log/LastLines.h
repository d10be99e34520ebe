// The last log lines, bounded in number and in bytes: the oldest are dropped first, and the newest is kept whatever its
// length.
#pragma once

#include <cstddef>
#include <deque>
#include <utility>

namespace vespscope::log {

inline constexpr std::size_t lastLinesCapacity = 2000;                      // lines
inline constexpr std::size_t lastLinesByteCapacity = std::size_t{4} << 20;  // of text, in the text's own units

// `Line` has a member `text` with a size().
template <class Line>
class LastLines {
 public:
  // Adds a line at the end without dropping any.
  void add(Line line) {
    bytes_ += sizeOf(line);
    lines_.push_back(std::move(line));
  }
  // How many of the oldest lines exceed the bounds.
  [[nodiscard]] std::size_t excess() const {
    std::size_t count = 0;
    std::size_t bytes = bytes_;
    for (; count + 1 < lines_.size(); ++count) {
      if (lines_.size() - count <= lastLinesCapacity && bytes <= lastLinesByteCapacity) break;
      bytes -= sizeOf(lines_[count]);
    }
    return count;
  }
  void removeOldest(std::size_t count) {
    for (; count > 0; --count) {
      bytes_ -= sizeOf(lines_.front());
      lines_.pop_front();
    }
  }
  void push(Line line) {
    add(std::move(line));
    removeOldest(excess());
  }
  // Returns all lines and empties the list.
  [[nodiscard]] std::deque<Line> take() {
    bytes_ = 0;
    return std::exchange(lines_, {});
  }

  [[nodiscard]] bool empty() const { return lines_.empty(); }
  [[nodiscard]] std::size_t size() const { return lines_.size(); }
  [[nodiscard]] const Line& front() const { return lines_.front(); }
  [[nodiscard]] const Line& operator[](std::size_t index) const { return lines_[index]; }
  [[nodiscard]] auto begin() const { return lines_.begin(); }
  [[nodiscard]] auto end() const { return lines_.end(); }

 private:
  static std::size_t sizeOf(const Line& line) { return static_cast<std::size_t>(line.text.size()); }

  std::deque<Line> lines_;
  std::size_t bytes_ = 0;
};

}  // namespace vespscope::log
