// The optional information elements behind the mandatory part of a message (3GPP TS 24.007 11.2.4).
#pragma once

#include <array>
#include <optional>

#include "sources/nas/Octets.h"

namespace vespscope::sources::nas {

// An element of format TV: its length cannot be told from its identifier.
struct FixedElement {
  std::uint8_t identifier;
  std::uint8_t length;  // of the value, in octets
};

class Elements {
 public:
  // Finds the elements in `bytes`; `fixed` are those of format TV that the protocol's messages use.
  Elements(Span bytes, std::span<const FixedElement> fixed);

  // The value of the first element with this identifier.
  [[nodiscard]] std::optional<Span> find(std::uint8_t identifier) const;

 private:
  // Values begin at an offset of at least one, behind the identifier: 0 stands for an absent element.
  struct Place {
    std::uint16_t offset = 0;
    std::uint16_t length = 0;
  };
  Span bytes_;
  std::array<Place, 256> places_{};
};

}  // namespace vespscope::sources::nas
