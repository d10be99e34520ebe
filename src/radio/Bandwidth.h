// The channel bandwidth of an LTE carrier (3GPP TS 36.101 table 5.6-1).
#pragma once

#include <array>
#include <compare>
#include <cstdint>
#include <optional>

namespace vespscope::radio {

class Bandwidth {
 public:
  // 6, 15, 25, 50, 75 or 100.
  [[nodiscard]] static std::optional<Bandwidth> fromResourceBlocks(std::uint32_t blocks) {
    for (std::uint32_t code = 0; code < widths.size(); ++code) {
      if (widths[code].blocks == blocks) return fromCode(code);
    }
    return std::nullopt;
  }
  // 0..5 for 1.4, 3, 5, 10, 15, 20 MHz, as RRC messages number them (3GPP TS 36.331 6.2.2, dl-Bandwidth).
  [[nodiscard]] static std::optional<Bandwidth> fromCode(std::uint32_t code) {
    if (code >= widths.size()) return std::nullopt;
    return Bandwidth(static_cast<std::uint8_t>(code));
  }

  [[nodiscard]] std::uint32_t code() const { return code_; }
  [[nodiscard]] std::uint32_t resourceBlocks() const { return widths[code_].blocks; }
  [[nodiscard]] std::uint32_t kilohertz() const { return widths[code_].kilohertz; }
  // Steps of 500 kHz; 1.4 MHz becomes the nearest one.
  [[nodiscard]] std::uint32_t halfMegahertz() const { return (kilohertz() + 250) / 500; }
  auto operator<=>(const Bandwidth&) const = default;

 private:
  struct Width {
    std::uint32_t blocks;
    std::uint32_t kilohertz;
  };
  static constexpr std::array<Width, 6> widths = {
      {{6, 1400}, {15, 3000}, {25, 5000}, {50, 10000}, {75, 15000}, {100, 20000}}};

  explicit Bandwidth(std::uint8_t code) : code_(code) {}

  std::uint8_t code_;
};

}  // namespace vespscope::radio
