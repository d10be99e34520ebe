#include "sources/nas/Identities.h"

namespace vespscope::sources::nas {
namespace {

constexpr std::size_t plmnLength = Plmn::octetCount;

// One of the lists that make up a list of tracking areas: the number of areas, and their coding.
struct PartialList {
  enum class Kind { samePlmn, consecutive, ownPlmns, reserved };
  Kind kind;
  std::size_t count;
};
constexpr PartialList partialListOf(std::uint8_t head) {
  return {static_cast<PartialList::Kind>(head >> 5U & 3U), (head & 0x1FU) + 1U};
}

bool readPartialList(Octets& octets, std::vector<TrackingArea>& areas) {
  constexpr std::size_t codeLength = 2;
  const PartialList list = partialListOf(*octets.octet());
  if (list.kind == PartialList::Kind::reserved) return false;
  std::optional<Plmn> plmn;
  for (std::size_t i = 0; i < list.count; ++i) {
    if (i == 0 || list.kind == PartialList::Kind::ownPlmns) {
      const auto bytes = octets.value(plmnLength);
      plmn = bytes ? Plmn::fromOctets(*bytes) : std::nullopt;
      if (!plmn) return false;
    } else if (list.kind == PartialList::Kind::consecutive) {
      areas.push_back({*plmn, static_cast<std::uint16_t>(areas.back().tac + 1)});
      continue;
    }
    const auto code = octets.value(codeLength);
    if (!code) return false;
    areas.push_back({*plmn, number16(*code)});
  }
  return true;
}

}  // namespace

std::optional<LocationArea> locationAreaOf(Span bytes) {
  if (bytes.size() < plmnLength + 2) return std::nullopt;
  const auto plmn = Plmn::fromOctets(bytes);
  if (!plmn) return std::nullopt;
  return LocationArea{*plmn, number16(bytes.subspan(plmnLength))};
}

std::optional<RoutingArea> routingAreaOf(Span bytes) {
  if (bytes.size() < plmnLength + 3) return std::nullopt;
  const auto location = locationAreaOf(bytes);
  if (!location) return std::nullopt;
  return RoutingArea{*location, bytes[plmnLength + 2]};
}

std::vector<TrackingArea> trackingAreasOf(Span list) {
  Octets octets(list);
  std::vector<TrackingArea> areas;
  while (octets.left() > 0) {
    if (!readPartialList(octets, areas)) return {};
  }
  return areas;
}

std::optional<Guti> gutiOf(Span identity) {
  constexpr std::size_t length = 11;
  constexpr std::uint8_t gutiType = 6;
  if (identity.size() < length || (identity[0] & 7U) != gutiType) return std::nullopt;
  const auto plmn = Plmn::fromOctets(identity.subspan(1));
  if (!plmn) return std::nullopt;
  return Guti{*plmn, number16(identity.subspan(4)), identity[6], number32(identity.subspan(7))};
}

std::optional<std::uint32_t> temporaryIdentityOf(Span identity) {
  constexpr std::size_t length = 5;
  constexpr std::uint8_t temporaryType = 4;
  if (identity.size() < length || (identity[0] & 7U) != temporaryType) return std::nullopt;
  return number32(identity.subspan(1));
}

std::vector<Plmn> plmnListOf(Span list) {
  std::vector<Plmn> plmns;
  for (; list.size() >= plmnLength; list = list.subspan(plmnLength)) {
    const auto plmn = Plmn::fromOctets(list);
    if (!plmn) return {};
    plmns.push_back(*plmn);
  }
  return plmns;
}

}  // namespace vespscope::sources::nas
