// Reads the octets of a message one after the other; past the end everything is absent.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

namespace vespscope::sources::nas {

using Span = std::span<const std::uint8_t>;

class Octets {
 public:
  explicit Octets(Span bytes) : rest_(bytes) {}

  [[nodiscard]] std::size_t left() const { return rest_.size(); }
  [[nodiscard]] Span rest() const { return rest_; }

  // Format V of one octet.
  std::optional<std::uint8_t> octet() {
    if (rest_.empty()) return std::nullopt;
    const std::uint8_t value = rest_[0];
    rest_ = rest_.subspan(1);
    return value;
  }
  // Format V.
  std::optional<Span> value(std::size_t length) {
    if (rest_.size() < length) return std::nullopt;
    const Span value = rest_.first(length);
    rest_ = rest_.subspan(length);
    return value;
  }
  // Format LV.
  std::optional<Span> lengthValue() {
    const auto length = octet();
    return length ? value(*length) : std::nullopt;
  }
  // Format LV-E, with a length of two octets.
  std::optional<Span> longLengthValue() {
    const auto high = octet();
    const auto low = octet();
    return low ? value(static_cast<std::size_t>(*high) << 8U | *low) : std::nullopt;
  }

 private:
  Span rest_;
};

// The number in the first two or four octets, highest first; the span must contain them.
[[nodiscard]] constexpr std::uint16_t number16(Span bytes) {
  return static_cast<std::uint16_t>(bytes[0] << 8U | bytes[1]);
}
[[nodiscard]] constexpr std::uint32_t number32(Span bytes) {
  return static_cast<std::uint32_t>(number16(bytes)) << 16U | number16(bytes.subspan(2));
}

}  // namespace vespscope::sources::nas
