// The number of a location area or a tracking area within its network (3GPP TS 23.003 4.1 and 19.4.2.3).
#pragma once

#include <compare>
#include <cstdint>
#include <optional>

namespace vespscope::radio {

class AreaCode {
 public:
  // Empty beyond 16 bits, and for the two numbers that mean "no valid area": 0 and FFFE (hexadecimal). FFFF is no
  // area either: modems write it for a code that they do not know.
  [[nodiscard]] static std::optional<AreaCode> fromNumber(std::uint32_t number) {
    constexpr std::uint32_t noValidArea = 0xFFFE;
    if (number == 0 || number >= noValidArea) return std::nullopt;
    return AreaCode(static_cast<std::uint16_t>(number));
  }

  [[nodiscard]] std::uint16_t number() const { return number_; }
  auto operator<=>(const AreaCode&) const = default;

 private:
  explicit AreaCode(std::uint16_t number) : number_(number) {}

  std::uint16_t number_;
};

}  // namespace vespscope::radio
