// Reads the literals of these tests.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "Literals.h"
#include "rrc/Message.h"

namespace vespscope::test {

inline std::vector<std::uint8_t> bytesOf(std::string_view hex) {
  const auto digit = [](char letter) { return static_cast<unsigned>(letter < 'a' ? letter - '0' : letter - 'a' + 10); };
  std::vector<std::uint8_t> bytes;
  for (std::size_t index = 0; index + 1 < hex.size(); index += 2) {
    bytes.push_back(static_cast<std::uint8_t>(digit(hex[index]) << 4 | digit(hex[index + 1])));
  }
  return bytes;
}

// A literal with its bytes, already read.
class ReadMessage {
 public:
  explicit ReadMessage(std::string_view name) {
    for (const Literal& literal : literals) {
      if (literal.name != name) continue;
      bytes_ = bytesOf(literal.hex);
      fault_ = message_.read(literal.pdu, bytes_);
      EXPECT_FALSE(fault_) << name << ": " << rrc::textOf(fault_->kind) << " at bit " << fault_->bit;
      return;
    }
    ADD_FAILURE() << "no literal " << name;
  }
  ReadMessage(const ReadMessage&) = delete;
  ReadMessage& operator=(const ReadMessage&) = delete;

  const rrc::Message& operator*() const { return message_; }
  const rrc::Message* operator->() const { return &message_; }

 private:
  std::vector<std::uint8_t> bytes_;
  rrc::Message message_;
  std::optional<rrc::Fault> fault_;
};

}  // namespace vespscope::test
