// The optional information elements after the mandatory part of a message (3GPP TS 24.007 11.2.4).
#pragma once

#include <array>
#include <optional>

#include "sources/nas/Octets.h"

namespace vespscope::sources::nas {

// An element of format TV, whose identifier does not imply its length.
struct FixedElement {
  std::uint8_t identifier;
  std::uint8_t length;  // of the value, in octets
};

class Elements {
 public:
  // Finds the elements in `bytes`; `fixed` lists those of format TV in the protocol's messages.
  Elements(Span bytes, std::span<const FixedElement> fixed);

  // The value of the first element with this identifier.
  [[nodiscard]] std::optional<Span> find(std::uint8_t identifier) const;

 private:
  // Values begin at an offset of at least one, after the identifier: 0 means that the element is absent.
  struct Place {
    std::uint16_t offset = 0;
    std::uint16_t length = 0;
  };
  Span bytes_;
  std::array<Place, 256> places_{};
};

}  // namespace vespscope::sources::nas
