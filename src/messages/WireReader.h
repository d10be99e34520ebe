// Reads the Protocol Buffers wire format from a byte buffer that the caller keeps alive.
//
// Whatever lies past the end of the buffer, or of the innermost marked value, sets the error flag and reads as zero.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

namespace vespscope {

enum class WireType : std::uint8_t {
  varint = 0,
  fixed64 = 1,
  lengthDelimited = 2,
  startGroup = 3,
  endGroup = 4,
  fixed32 = 5
};

// A key: three bits of wire type below the field number, which is taken modulo 65536.
struct WireKey {
  explicit constexpr WireKey(std::uint64_t key) noexcept
      : fieldNumber(static_cast<std::uint16_t>(key >> 3)), wireType(static_cast<WireType>(key & 7)) {}
  std::uint16_t fieldNumber;
  WireType wireType;
};

class WireReader {
 public:
  explicit WireReader(std::span<const std::uint8_t> buffer) noexcept : data_(buffer.data()), length_(buffer.size()) {}

  [[nodiscard]] std::size_t position() const noexcept { return position_; }
  // Where reading ends: the end of the buffer or of the innermost marked value.
  [[nodiscard]] std::size_t length() const noexcept { return length_; }
  [[nodiscard]] bool failed() const noexcept { return failed_; }
  [[nodiscard]] bool hasMore() const noexcept { return position_ < length_ && !failed_; }

  // Groups of seven bits, lowest first. Zero past the end, and zero when the tenth byte still continues.
  std::uint64_t readVarint() noexcept {
    if (position_ < length_ && data_[position_] < 0x80) return data_[position_++];
    return readLongVarint();
  }

  // The bytes of a length-delimited value; nothing, with the error flag set, when they lie past the end.
  std::optional<std::span<const std::uint8_t>> readDelimited() noexcept;

  struct Mark {
    std::size_t valueEnd;
    std::size_t outerLength;
  };
  // Reads a length and makes the end of that value the end of reading; nothing, with the error flag set, when the
  // value reaches past the end.
  std::optional<Mark> placeMark() noexcept;
  // Goes to the end of the marked value and takes back the end of reading that was before.
  void recallMark(const Mark& mark) noexcept;

  // Skips the value of a field that nobody knows. False for a wire type that does not exist, for a group without its
  // matching end or nested more than maximumGroupDepth deep, and for a value that reaches past the end.
  [[nodiscard]] bool skip(WireKey key) noexcept;
  static constexpr std::size_t maximumGroupDepth = 100;

 private:
  std::uint64_t readLongVarint() noexcept;
  bool skipBytes(std::uint64_t count) noexcept;
  bool skipGroup(std::uint16_t fieldNumber) noexcept;
  bool skipPlain(WireType wireType) noexcept;

  const std::uint8_t* data_;
  std::size_t position_ = 0;
  std::size_t length_;
  bool failed_ = false;
};

}  // namespace vespscope
