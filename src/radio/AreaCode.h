// after the network capability
#pragma once

#include <compare>
#include <cstdint>
#include <optional>

namespace vespscope::radio {

class AreaCode {
 public:
  // The meaning of the other types depends on the direction (10.5.5.5).
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
