#include "radio/Plmn.h"

#include <algorithm>

namespace vespscope::radio {
namespace {

constexpr unsigned noDigit = 0xF;

constexpr unsigned low(std::uint8_t octet) { return octet & 0xFU; }
constexpr unsigned high(std::uint8_t octet) { return octet >> 4U; }
constexpr bool isDigit(unsigned value) { return value <= 9; }

}  // namespace

// MCC digits 2 and 1, MNC digit 3 and MCC digit 3, MNC digits 2 and 1: the first of each pair in the high half.
std::optional<Plmn> Plmn::fromOctets(std::span<const std::uint8_t> octets) {
  if (octets.size() < octetCount) return std::nullopt;
  const bool digits = isDigit(low(octets[0])) && isDigit(high(octets[0])) && isDigit(low(octets[1])) &&
                      isDigit(low(octets[2])) && isDigit(high(octets[2]));
  if (!digits || (!isDigit(high(octets[1])) && high(octets[1]) != noDigit)) return std::nullopt;
  return Plmn({octets[0], octets[1], octets[2]});
}

std::optional<Plmn> Plmn::fromDigitOctets(std::span<const std::uint8_t> digits) {
  constexpr std::size_t count = 6;
  if (digits.size() < count || !std::all_of(digits.begin(), digits.begin() + 5, isDigit)) return std::nullopt;
  const auto pair = [](unsigned first, unsigned second) { return static_cast<std::uint8_t>(first << 4U | second); };
  const unsigned third = isDigit(digits[5]) ? digits[5] : noDigit;
  return Plmn({pair(digits[1], digits[0]), pair(third, digits[2]), pair(digits[4], digits[3])});
}

std::optional<Plmn> Plmn::fromText(std::string_view digits) {
  if (digits.size() != 5 && digits.size() != 6) return std::nullopt;
  std::array<std::uint8_t, 6> values{0, 0, 0, 0, 0, noDigit};
  for (std::size_t index = 0; index < digits.size(); ++index) {
    if (digits[index] < '0' || digits[index] > '9') return std::nullopt;
    values[index] = static_cast<std::uint8_t>(digits[index] - '0');
  }
  return fromDigitOctets(values);
}

std::optional<Plmn> Plmn::fromNumbers(std::uint32_t mcc, std::uint32_t mnc, std::uint32_t mncDigits) {
  if (mncDigits != 2 && mncDigits != 3) return std::nullopt;
  if (mcc > 999 || mnc > (mncDigits == 2 ? 99U : 999U)) return std::nullopt;
  const auto digit = [](std::uint32_t number, std::uint32_t unit) {
    return static_cast<std::uint8_t>(number / unit % 10);
  };
  const std::uint32_t first = mncDigits == 2 ? 10 : 100;
  const std::uint8_t third = mncDigits == 2 ? std::uint8_t{noDigit} : digit(mnc, 1);
  const std::array<std::uint8_t, 6> values = {digit(mcc, 100),   digit(mcc, 10),         digit(mcc, 1),
                                              digit(mnc, first), digit(mnc, first / 10), third};
  return fromDigitOctets(values);
}

std::uint16_t Plmn::mcc() const {
  return static_cast<std::uint16_t>(low(octets_[0]) * 100 + high(octets_[0]) * 10 + low(octets_[1]));
}

std::uint16_t Plmn::mnc() const {
  const unsigned two = low(octets_[2]) * 10 + high(octets_[2]);
  return static_cast<std::uint16_t>(mncDigits() == 2 ? two : two * 10 + high(octets_[1]));
}

std::uint8_t Plmn::mncDigits() const { return high(octets_[1]) == noDigit ? 2 : 3; }

std::string Plmn::text() const {
  const auto padded = [](unsigned number, std::size_t width) {
    std::string digits = std::to_string(number);
    return digits.insert(0, width - digits.size(), '0');
  };
  return padded(mcc(), 3) + '-' + padded(mnc(), mncDigits());
}

}  // namespace vespscope::radio
