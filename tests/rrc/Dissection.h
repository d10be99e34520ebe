// TShark's output for RRC messages, and the values that this reader finds, as lists of the same form.
#pragma once

#include <cstdint>
#include <filesystem>
#include <span>
#include <string>
#include <utility>
#include <vector>

#include "rrc/Message.h"

namespace vespscope::test {

// A value of a message, in the order of the message, before its own contents.
struct Value {
  std::string name;        // in the spelling of the definitions; "*" for an element of a list
  std::string text;        // a number, bytes in hexadecimal, or nothing
  std::string other = {};  // a string of bits as a number, as TShark prints some
  int depth = 0;
  bool opaque = false;  // a string that only TShark dissects
};

struct Dissection {
  std::vector<Value> values;
  bool complete = true;  // TShark has reached the end
};

// Writes the messages to a capture file that names TShark's dissector for each.
void writeCapture(const std::filesystem::path& path,
                  std::span<const std::pair<rrc::Pdu, std::vector<std::uint8_t>>> messages);
// Whether TShark has a dissector for it.
[[nodiscard]] bool isDissected(rrc::Pdu pdu);

// Reads TShark's PDML from a file, a message at a time.
[[nodiscard]] std::vector<Dissection> readPdml(const std::filesystem::path& path);

// The values of a message in TShark's order.
[[nodiscard]] std::vector<Value> valuesOf(const rrc::Message& message);

// The first difference in words, or nothing. Adds the number of equal values to `compared`.
[[nodiscard]] std::string difference(const std::vector<Value>& ours, const Dissection& theirs, std::size_t& compared);

}  // namespace vespscope::test
