// The commands that turn a modem's log on and off, and their answers.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "values/Value.h"

namespace vespscope::sources::diag {

// The codes of an equipment have its number in their highest four bits.
inline constexpr std::size_t equipmentCount = 16;
using CodeCounts = std::array<std::uint32_t, equipmentCount>;  // how many codes each equipment has

// A whole frame of `content`: with its checksum, escaped, ended.
[[nodiscard]] Bytes frameWith(Bytes content);

// The frames of the commands.
[[nodiscard]] Bytes askForCodeCounts();
// Turns on the log of `codes`, which are all of `equipment`, and off all its others. `count` is how many it has.
[[nodiscard]] Bytes turnOn(std::uint8_t equipment, std::uint32_t count, std::span<const std::uint16_t> codes);
[[nodiscard]] Bytes turnAllOff();

// The log codes whose records are mapped.
[[nodiscard]] std::span<const std::uint16_t> mappedCodes();

// What a frame from the modem says to a command.
struct LogAnswer {
  enum class Kind { codeCounts, turnedOn, turnedOff, refused };
  Kind kind = Kind::refused;
  CodeCounts counts{};         // of codeCounts
  std::uint8_t equipment = 0;  // of turnedOn
};
// Empty for a frame that answers none of them.
[[nodiscard]] std::optional<LogAnswer> logAnswerOf(std::span<const std::uint8_t> frame);

}  // namespace vespscope::sources::diag
