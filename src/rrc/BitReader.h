// Reads bits of an unaligned PER encoding (ITU-T X.691), the highest bit of each byte first.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>

namespace vespscope::rrc {

class BitReader {
 public:
  explicit BitReader(std::span<const std::uint8_t> bytes) : bytes_(bytes), limit_(bytes.size() * 8) {}

  [[nodiscard]] std::size_t position() const { return position_; }
  // No bit is read from here on.
  [[nodiscard]] std::size_t limit() const { return limit_; }
  [[nodiscard]] std::size_t left() const { return limit_ - position_; }
  void setLimit(std::size_t limit) { limit_ = limit; }
  void setPosition(std::size_t position) { position_ = position; }

  // The bits at `position`, at most 57, which are before the end.
  [[nodiscard]] std::uint64_t peek(std::size_t position, unsigned count) const {
    if (count == 0) return 0;
    const std::size_t first = position / 8;
    std::uint64_t word = 0;
    if (first + 8 <= bytes_.size()) {
      std::memcpy(&word, bytes_.data() + first, 8);
      if constexpr (std::endian::native == std::endian::little) word = __builtin_bswap64(word);
    } else {
      for (std::size_t index = first; index < bytes_.size(); ++index) {
        word |= std::uint64_t{bytes_[index]} << (56 - 8 * (index - first));
      }
    }
    return word << (position % 8) >> (64 - count);
  }

  // At most 57 bits; false, and nothing is read, when fewer are left.
  [[nodiscard]] bool read(unsigned count, std::uint64_t& value) {
    if (count > left()) return false;
    value = peek(position_, count);
    position_ += count;
    return true;
  }
  [[nodiscard]] bool skip(std::size_t count) {
    if (count > left()) return false;
    position_ += count;
    return true;
  }

 private:
  std::span<const std::uint8_t> bytes_;
  std::size_t position_ = 0;
  std::size_t limit_;
};

}  // namespace vespscope::rrc
