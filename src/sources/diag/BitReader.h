// Bits of an unaligned PER encoding or of rest octets, from the highest of each byte on. Reading past the end fails.
#pragma once

#include <cstdint>
#include <optional>
#include <span>

namespace vespscope::sources::diag {

class BitReader {
 public:
  explicit BitReader(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  // At most 32 bits.
  std::optional<unsigned> read(unsigned count) {
    if (position_ + count > bytes_.size() * 8) return std::nullopt;
    unsigned value = 0;
    for (; count > 0; --count, ++position_) value = value << 1U | (bytes_[position_ / 8] >> (7 - position_ % 8) & 1U);
    return value;
  }
  // May move past the end.
  void skip(std::size_t count) { position_ += count; }

 private:
  std::span<const std::uint8_t> bytes_;
  std::size_t position_ = 0;
};

}  // namespace vespscope::sources::diag
