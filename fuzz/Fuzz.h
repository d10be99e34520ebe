// The fuzz targets' common parts: their entry points, a reader of their inputs, and the stop on a finding.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <span>
#include <string>
#include <string_view>

// Runs the target on one input; the name is libFuzzer's, and 0 means "done".
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace vespscope::fuzz {

// Reports a finding and stops, unless the condition holds.
inline void require(bool holds, std::string_view what) {
  if (holds) return;
  std::fprintf(stderr, "fuzz: %.*s\n", static_cast<int>(what.size()), what.data());
  std::abort();
}

// Reads an input from its beginning; after its end it returns zeros.
class Input {
 public:
  Input(const std::uint8_t* data, std::size_t size) : rest_(data, size) {}

  [[nodiscard]] bool empty() const { return rest_.empty(); }
  std::uint8_t byte() {
    const auto piece = bytes(1);
    return piece.empty() ? std::uint8_t{0} : piece[0];
  }
  std::uint16_t word() {
    const std::uint8_t low = byte();
    return static_cast<std::uint16_t>(low | byte() << 8);
  }
  std::span<const std::uint8_t> bytes(std::size_t count) {
    const auto piece = rest_.first(std::min(count, rest_.size()));
    rest_ = rest_.subspan(piece.size());
    return piece;
  }
  // A piece preceded by its length: one byte, or 255 and two bytes.
  std::span<const std::uint8_t> piece() {
    const std::uint8_t length = byte();
    return bytes(length == 255 ? word() : length);
  }
  std::span<const std::uint8_t> rest() { return bytes(rest_.size()); }

 private:
  std::span<const std::uint8_t> rest_;
};

}  // namespace vespscope::fuzz
