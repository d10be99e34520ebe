#include "sources/nas/Elements.h"

#include <algorithm>
#include <limits>

namespace vespscope::sources::nas {

Elements::Elements(Span bytes, std::span<const FixedElement> fixed)
    : bytes_(bytes.first(std::min<std::size_t>(bytes.size(), std::numeric_limits<std::uint16_t>::max()))) {
  Octets octets(bytes_);
  while (const auto identifier = octets.octet()) {
    // Half an octet of value in the identifier's own octet: not used here.
    if ((*identifier & 0x80U) != 0) continue;
    const auto* known = std::find_if(fixed.data(), fixed.data() + fixed.size(),
                                     [&](const FixedElement& each) { return each.identifier == *identifier; });
    const bool isFixed = known != fixed.data() + fixed.size();
    // Identifiers 0x78 to 0x7F have the format TLV-E.
    const bool isLong = (*identifier & 0x78U) == 0x78U;
    const auto value = isFixed ? octets.value(known->length) : isLong ? octets.longLengthValue() : octets.lengthValue();
    if (!value) return;
    Place& place = places_[*identifier];
    if (place.offset == 0) {
      place = {static_cast<std::uint16_t>(value->data() - bytes_.data()), static_cast<std::uint16_t>(value->size())};
    }
  }
}

std::optional<Span> Elements::find(std::uint8_t identifier) const {
  const Place& place = places_[identifier];
  if (place.offset == 0) return std::nullopt;
  return bytes_.subspan(place.offset, place.length);
}

}  // namespace vespscope::sources::nas
