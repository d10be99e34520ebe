#include "sources/nas/EpsSession.h"

#include "sources/nas/Elements.h"

namespace vespscope::sources::nas {
namespace {

using Kind = EpsSessionKind;

constexpr std::array<FixedElement, 2> fixedElements = {{
    {0x32, 1},  // negotiated LLC service access point
    {0x58, 1},  // ESM cause
}};
constexpr std::uint8_t configurationElement = 0x27;
constexpr std::uint8_t extendedConfigurationElement = 0x7B;

std::optional<Kind> kindOf(std::uint8_t type) {
  switch (type) {
    case 0xC1:
      return Kind::activateDefault;
    case 0xC2:
    case 0xC6:
      return Kind::accepted;
    case 0xC3:
    case 0xC7:
      return Kind::rejected;
    case 0xC5:
      return Kind::activateDedicated;
    case 0xC9:
      return Kind::modify;
    case 0xCD:
      return Kind::deactivate;
    case 0xCE:
      return Kind::deactivated;
    default:
      return std::nullopt;
  }
}

void readServers(Octets octets, EpsSessionMessage& message) {
  const Elements elements(octets.rest(), fixedElements);
  const auto options = elements.find(configurationElement);
  const auto extended = elements.find(extendedConfigurationElement);
  if (options) message.nameServers = nameServersOf(*options);
  if (extended) message.nameServers = nameServersOf(*extended);
}

bool readQuality(Octets& octets, EpsSessionMessage& message) {
  const auto quality = octets.lengthValue();
  if (!quality || quality->empty()) return false;
  message.qualityClass = (*quality)[0];
  return true;
}

bool readActivateDefault(Octets octets, EpsSessionMessage& message) {
  if (!readQuality(octets, message)) return false;
  const auto name = octets.lengthValue();
  const auto address = octets.lengthValue();
  if (!name || !address) return false;
  message.accessPoint = accessPointNameOf(*name);
  message.address = pdnAddressOf(*address);
  readServers(octets, message);
  return true;
}

bool readActivateDedicated(Octets octets, EpsSessionMessage& message) {
  const auto linked = octets.octet();
  if (!linked || !readQuality(octets, message)) return false;
  message.linked = static_cast<std::uint8_t>(*linked & 0xFU);
  return octets.lengthValue().has_value();  // the traffic flow template
}

}  // namespace

std::optional<EpsSessionMessage> epsSessionMessageOf(Span bytes) {
  constexpr std::uint8_t discriminator = 2;
  constexpr std::uint8_t firstBearer = 5;
  Octets octets(bytes);
  const auto head = octets.octet();
  const auto transaction = octets.octet();
  const auto type = octets.octet();
  if (!head || !transaction || !type || (*head & 0xFU) != discriminator) return std::nullopt;
  const auto kind = kindOf(*type);
  EpsSessionMessage message;
  message.bearer = *head >> 4U;
  if (!kind || message.bearer < firstBearer) return std::nullopt;
  message.kind = *kind;
  if (message.kind == Kind::activateDefault && !readActivateDefault(octets, message)) return std::nullopt;
  if (message.kind == Kind::activateDedicated && !readActivateDedicated(octets, message)) return std::nullopt;
  if (message.kind == Kind::modify) readServers(octets, message);
  return message;
}

}  // namespace vespscope::sources::nas
