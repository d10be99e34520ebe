#include "sources/nas/Session.h"

#include "sources/nas/Elements.h"

namespace vespscope::sources::nas {
namespace {

using Kind = SessionKind;

constexpr std::array<FixedElement, 1> fixedElements = {{{0x39, 1}}};  // SM cause
constexpr std::uint8_t accessPointElement = 0x28;
constexpr std::uint8_t addressElement = 0x2B;
constexpr std::uint8_t configurationElement = 0x27;

bool readActivateRequest(Octets octets, SessionMessage& message) {
  const auto accessPointId = octets.octet();
  if (!accessPointId || !octets.octet() || !octets.lengthValue() || !octets.lengthValue()) return false;
  message.accessPointId = static_cast<std::uint8_t>(*accessPointId & 0xFU);
  if (const auto name = Elements(octets.rest(), fixedElements).find(accessPointElement)) {
    message.accessPoint = accessPointNameOf(*name);
  }
  return true;
}

bool readActivateAccept(Octets octets, SessionMessage& message) {
  if (!octets.octet() || !octets.lengthValue() || !octets.octet()) return false;
  const Elements elements(octets.rest(), fixedElements);
  if (const auto address = elements.find(addressElement)) message.address = pdpAddressOf(*address);
  if (const auto options = elements.find(configurationElement)) message.nameServers = nameServersOf(*options);
  return true;
}

}  // namespace

std::optional<SessionMessage> sessionMessageOf(Span bytes) {
  constexpr std::uint8_t discriminator = 0xA;
  constexpr std::uint8_t extended = 7;
  Octets octets(bytes);
  const auto head = octets.octet();
  if (!head || (*head & 0xFU) != discriminator) return std::nullopt;
  SessionMessage message;
  message.transaction = *head >> 4U & 7U;
  if (message.transaction == extended) {
    const auto number = octets.octet();
    if (!number) return std::nullopt;
    message.transaction = *number & 0x7FU;
  }
  const auto type = octets.octet();
  if (!type) return std::nullopt;
  bool whole = true;
  switch (*type) {
    case 0x41:
      message.kind = Kind::activateRequest;
      whole = readActivateRequest(octets, message);
      break;
    case 0x42:
      message.kind = Kind::activateAccept;
      whole = readActivateAccept(octets, message);
      break;
    case 0x43:
      message.kind = Kind::activateReject;
      break;
    case 0x46:
      message.kind = Kind::deactivateRequest;
      break;
    case 0x47:
      message.kind = Kind::deactivateAccept;
      break;
    default:
      return std::nullopt;
  }
  if (!whole) return std::nullopt;
  return message;
}

}  // namespace vespscope::sources::nas
