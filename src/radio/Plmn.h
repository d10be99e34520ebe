// A public land mobile network: its country code and network code (3GPP TS 23.003 2.2).
#pragma once

#include <array>
#include <compare>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "values/Value.h"

namespace vespscope::radio {

class Plmn {
 public:
  static constexpr std::size_t octetCount = 3;

  // The first three octets of `octets` in the coding of signalling (3GPP TS 24.008 10.5.1.3). Empty when they are
  // fewer, or when one of the digits is none.
  [[nodiscard]] static std::optional<Plmn> fromOctets(std::span<const std::uint8_t> octets);
  // Six octets with one digit each; a sixth that is no digit means a network code of two digits.
  [[nodiscard]] static std::optional<Plmn> fromDigitOctets(std::span<const std::uint8_t> digits);
  // "26201" or "310260": three digits of the country, then two or three of the network.
  [[nodiscard]] static std::optional<Plmn> fromText(std::string_view digits);
  // `mcc` 0..999; `mnc` 0..99 or 0..999, by its number of digits (2 or 3).
  [[nodiscard]] static std::optional<Plmn> fromNumbers(std::uint32_t mcc, std::uint32_t mnc, std::uint32_t mncDigits);

  [[nodiscard]] std::uint16_t mcc() const;
  [[nodiscard]] std::uint16_t mnc() const;
  [[nodiscard]] std::uint8_t mncDigits() const;  // 2 or 3
  // In the coding of signalling.
  [[nodiscard]] Bytes octets() const { return {octets_.begin(), octets_.end()}; }
  // "262-01".
  [[nodiscard]] std::string text() const;

  auto operator<=>(const Plmn&) const = default;

 private:
  explicit Plmn(const std::array<std::uint8_t, octetCount>& octets) : octets_(octets) {}

  std::array<std::uint8_t, octetCount> octets_;
};

}  // namespace vespscope::radio
