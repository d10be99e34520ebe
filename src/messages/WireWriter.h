// Writes the Protocol Buffers wire format into a byte buffer that grows.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>
#include <utility>

#include "values/Value.h"

namespace vespscope {

class WireWriter {
 public:
  // In place of a field number: the value alone, as inside a packed field.
  static constexpr std::uint32_t noField = 0xFFFFFFFF;

  void writeUint64(std::uint64_t value, std::uint32_t fieldNumber) { writeVarint(value, fieldNumber); }
  void writeUint32(std::uint32_t value, std::uint32_t fieldNumber) { writeVarint(value, fieldNumber); }
  // Negative numbers take ten bytes, as Protocol Buffers has them.
  void writeInt32(std::int32_t value, std::uint32_t fieldNumber) {
    writeVarint(static_cast<std::uint64_t>(std::int64_t{value}), fieldNumber);
  }
  // ZigZag: 0, -1, 1, -2 become 0, 1, 2, 3.
  void writeSint32(std::int32_t value, std::uint32_t fieldNumber) {
    const auto bits = static_cast<std::uint32_t>(value);
    writeVarint((bits << 1) ^ static_cast<std::uint32_t>(value >> 31), fieldNumber);
  }
  void writeBool(bool value, std::uint32_t fieldNumber) { writeVarint(value ? 1 : 0, fieldNumber); }
  void writeBytes(std::span<const std::uint8_t> value, std::uint32_t fieldNumber);
  void writeString(std::string_view value, std::uint32_t fieldNumber);

  // An embedded message, length-delimited.
  template <class Message>
  void writeMessage(const Message& message, std::uint32_t fieldNumber) {
    const Mark mark = placeMark(fieldNumber);
    message.writeTo(*this);
    recallMark(mark);
  }

  // Begins a length-delimited value whose length is known only when it has been written.
  struct Mark {
    std::size_t start;
  };
  Mark placeMark(std::uint32_t fieldNumber);
  // Back-fills the length of what has been written since the mark.
  void recallMark(Mark mark);

  [[nodiscard]] const Bytes& bytes() const noexcept { return buffer_; }
  [[nodiscard]] Bytes takeBytes() noexcept { return std::exchange(buffer_, {}); }

 private:
  void writeVarint(std::uint64_t value, std::uint32_t fieldNumber);
  void appendVarint(std::uint64_t value);
  void appendLengthKey(std::uint32_t fieldNumber);

  Bytes buffer_;
};

}  // namespace vespscope
