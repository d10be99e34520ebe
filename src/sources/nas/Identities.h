// Networks, areas and temporary identities as coded in NAS messages.
#pragma once

#include <optional>
#include <vector>

#include "radio/Plmn.h"
#include "sources/nas/Octets.h"

namespace vespscope::sources::nas {

using radio::Plmn;

struct LocationArea {
  Plmn plmn;
  std::uint16_t lac = 0;
  bool operator==(const LocationArea&) const = default;
};
[[nodiscard]] std::optional<LocationArea> locationAreaOf(Span bytes);

struct RoutingArea {
  LocationArea location;
  std::uint8_t rac = 0;
  bool operator==(const RoutingArea&) const = default;
};
[[nodiscard]] std::optional<RoutingArea> routingAreaOf(Span bytes);

struct TrackingArea {
  Plmn plmn;
  std::uint16_t tac = 0;
  bool operator==(const TrackingArea&) const = default;
};
// All areas of a list (3GPP TS 24.301 9.9.3.33), in order; empty when the list is damaged.
[[nodiscard]] std::vector<TrackingArea> trackingAreasOf(Span list);

struct Guti {
  Plmn plmn;
  std::uint16_t mmeGroup = 0;
  std::uint8_t mmeCode = 0;
  std::uint32_t mTmsi = 0;
  bool operator==(const Guti&) const = default;
};
// The GUTI of an EPS mobile identity (3GPP TS 24.301 9.9.3.12); empty for other types.
[[nodiscard]] std::optional<Guti> gutiOf(Span identity);

// The TMSI or P-TMSI of a mobile identity (3GPP TS 24.008 10.5.1.4); empty for other types.
[[nodiscard]] std::optional<std::uint32_t> temporaryIdentityOf(Span identity);

// The networks of a list (3GPP TS 24.008 10.5.1.13).
[[nodiscard]] std::vector<Plmn> plmnListOf(Span list);

}  // namespace vespscope::sources::nas
