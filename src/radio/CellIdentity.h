// The identity of a cell within its network: 28 bits in E-UTRA (3GPP TS 36.331 6.3.4, CellIdentity) and in UTRA
// (3GPP TS 25.331 10.3.2.2).
#pragma once

#include <compare>
#include <cstdint>
#include <optional>

namespace vespscope::radio {

// `groupBits` is the size of the left part, which names the node that the cell belongs to.
template <unsigned groupBits>
class CellIdentity {
 public:
  // Empty beyond 28 bits.
  [[nodiscard]] static std::optional<CellIdentity> fromNumber(std::uint32_t number) {
    if (number > highest) return std::nullopt;
    return CellIdentity(number);
  }
  // Empty when the node or the cell needs more bits than its part has.
  [[nodiscard]] static std::optional<CellIdentity> fromParts(std::uint32_t node, std::uint32_t cell) {
    if (node >> groupBits != 0 || cell >> cellBits != 0) return std::nullopt;
    return CellIdentity(node << cellBits | cell);
  }

  [[nodiscard]] std::uint32_t number() const { return number_; }
  [[nodiscard]] std::uint32_t node() const { return number_ >> cellBits; }
  [[nodiscard]] std::uint32_t cell() const { return number_ & ((1U << cellBits) - 1); }
  auto operator<=>(const CellIdentity&) const = default;

 private:
  static constexpr unsigned bits = 28;
  static constexpr unsigned cellBits = bits - groupBits;
  static constexpr std::uint32_t highest = (1U << bits) - 1;

  explicit CellIdentity(std::uint32_t number) : number_(number) {}

  std::uint32_t number_;
};

// 20 bits of the macro eNodeB, 8 of its sector (3GPP TS 36.413 9.2.1.37).
using EutraCellIdentity = CellIdentity<20>;
// 12 bits of the radio network controller, 16 of the cell (3GPP TS 25.401 6.1.5).
using UtraCellIdentity = CellIdentity<12>;

}  // namespace vespscope::radio
