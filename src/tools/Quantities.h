// Amounts as a user writes them: "64M" bytes, "90s", "15m", "1h", "7d".
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string_view>

namespace vespscope {

// Parses a positive whole number of bytes, optionally with K, M or G for 1024, 1024^2 or 1024^3 bytes; up to 2^50
// bytes.
[[nodiscard]] std::optional<std::uint64_t> parseSize(std::string_view words);

// Parses a positive whole number followed by s, m, h or d; up to 36,500 days.
[[nodiscard]] std::optional<std::chrono::seconds> parseDuration(std::string_view words);

}  // namespace vespscope
