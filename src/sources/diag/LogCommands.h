// The commands that turn a modem's log on and off, and the answers to them.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "values/Value.h"

namespace vespscope::sources::diag {

// The highest four bits of a code are the number of its equipment.
inline constexpr std::size_t equipmentCount = 16;
using CodeCounts = std::array<std::uint32_t, equipmentCount>;  // the number of codes of each equipment

// A complete frame of `content`: with its checksum, escapes and end.
[[nodiscard]] Bytes frameWith(Bytes content);

// The frames of the commands.
[[nodiscard]] Bytes askForCodeCounts();
// Turns on logging of `codes`, which are all of `equipment`, and turns off all its others. `count` is the equipment's
// number of codes.
[[nodiscard]] Bytes turnOn(std::uint8_t equipment, std::uint32_t count, std::span<const std::uint16_t> codes);
[[nodiscard]] Bytes turnAllOff();

// The log codes whose records are mapped.
[[nodiscard]] std::span<const std::uint16_t> mappedCodes();

// A modem's answer to a command.
struct LogAnswer {
  enum class Kind { codeCounts, turnedOn, turnedOff, refused };
  Kind kind = Kind::refused;
  CodeCounts counts{};         // of codeCounts
  std::uint8_t equipment = 0;  // of turnedOn
};
// Reads an answer; empty for any other frame.
[[nodiscard]] std::optional<LogAnswer> logAnswerOf(std::span<const std::uint8_t> frame);

}  // namespace vespscope::sources::diag
