// Little-endian numbers at given offsets of a byte string.
#pragma once

#include <cstdint>
#include <span>

#include "platform/log/Log.h"

namespace vespscope::sources::diag {

// Call `holds` first: reading past the end is a programming error.
class ByteView {
 public:
  explicit ByteView(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  [[nodiscard]] std::size_t size() const { return bytes_.size(); }
  [[nodiscard]] bool holds(std::size_t offset, std::size_t count) const {
    return offset <= bytes_.size() && count <= bytes_.size() - offset;
  }
  [[nodiscard]] std::uint8_t u8(std::size_t offset) const { return static_cast<std::uint8_t>(number(offset, 1)); }
  [[nodiscard]] std::uint16_t u16(std::size_t offset) const { return static_cast<std::uint16_t>(number(offset, 2)); }
  [[nodiscard]] std::uint32_t u32(std::size_t offset) const { return static_cast<std::uint32_t>(number(offset, 4)); }
  [[nodiscard]] std::uint64_t u64(std::size_t offset) const { return number(offset, 8); }
  [[nodiscard]] std::span<const std::uint8_t> part(std::size_t offset, std::size_t count) const {
    if (!holds(offset, count)) log::fatal("bytes past the end of a record");
    return bytes_.subspan(offset, count);
  }

 private:
  [[nodiscard]] std::uint64_t number(std::size_t offset, std::size_t width) const {
    std::uint64_t value = 0;
    const auto bytes = part(offset, width);
    for (std::size_t i = width; i > 0; --i) value = value << 8 | bytes[i - 1];
    return value;
  }

  std::span<const std::uint8_t> bytes_;
};

}  // namespace vespscope::sources::diag
