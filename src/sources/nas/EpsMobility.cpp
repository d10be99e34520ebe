#include "sources/nas/EpsMobility.h"

#include "sources/nas/Elements.h"
#include "sources/nas/Timers.h"

namespace vespscope::sources::nas {
namespace {

using Kind = EpsMobilityKind;
using Message = EpsMobilityMessage;

constexpr std::array<FixedElement, 9> fixedElements = {{
    {0x13, 5},  // location area identification
    {0x17, 1},  // T3402
    {0x19, 3},  // old P-TMSI signature
    {0x52, 5},  // last visited tracking area
    {0x53, 1},  // EMM cause
    {0x55, 4},  // nonce
    {0x59, 1},  // T3423
    {0x5A, 1},  // T3412
    {0x5C, 2},  // DRX parameter
}};

std::optional<Kind> kindOf(std::uint8_t type) {
  switch (type) {
    case 0x41:
      return Kind::attachRequest;
    case 0x42:
      return Kind::attachAccept;
    case 0x43:
      return Kind::attachComplete;
    case 0x44:
      return Kind::attachReject;
    case 0x45:
      return Kind::detachRequest;
    case 0x46:
      return Kind::detachAccept;
    case 0x48:
      return Kind::updateRequest;
    case 0x49:
      return Kind::updateAccept;
    case 0x4A:
      return Kind::updateComplete;
    case 0x4B:
      return Kind::updateReject;
    case 0x4C:
      return Kind::serviceRequest;
    case 0x4E:
      return Kind::serviceReject;
    default:
      return std::nullopt;
  }
}

void readUsageSetting(const Elements& elements, Message& message) {
  const auto setting = elements.find(0x5D);
  if (setting && !setting->empty()) message.dataCentric = ((*setting)[0] & 4U) != 0;
}

bool readAttachRequest(Octets octets, Message& message) {
  const auto type = octets.octet();
  if (!type || !octets.lengthValue() || !octets.lengthValue()) return false;
  const auto session = octets.longLengthValue();
  if (!session) return false;
  message.type = static_cast<std::uint8_t>(*type & 7U);
  message.session = *session;
  readUsageSetting(Elements(octets.rest(), fixedElements), message);
  return true;
}

bool readUpdateRequest(Octets octets, Message& message) {
  const auto type = octets.octet();
  if (!type || !octets.lengthValue()) return false;
  message.type = static_cast<std::uint8_t>(*type & 7U);
  readUsageSetting(Elements(octets.rest(), fixedElements), message);
  return true;
}

// The common elements of attach accept and tracking area update accept.
void readAcceptElements(const Elements& elements, Message& message) {
  if (const auto list = elements.find(0x54)) message.trackingAreas = trackingAreasOf(*list);
  if (const auto identity = elements.find(0x50)) message.guti = gutiOf(*identity);
  if (const auto area = elements.find(0x13)) message.locationArea = locationAreaOf(*area);
  if (const auto identity = elements.find(0x23)) message.tmsi = temporaryIdentityOf(*identity);
  if (const auto list = elements.find(0x4A)) message.equivalentPlmns = plmnListOf(*list);
  if (const auto cause = elements.find(0x53)) message.cause = (*cause)[0];
  if (const auto timer = elements.find(0x5A)) message.updateTimerSeconds = timerSeconds((*timer)[0]);
  // The extended value replaces the other one (5.3.5).
  if (const auto timer = elements.find(0x5E); timer && !timer->empty()) {
    message.updateTimerSeconds = timer3Seconds((*timer)[0]);
  }
  if (const auto features = elements.find(0x64); features && !features->empty()) {
    message.imsVoice = ((*features)[0] & 1U) != 0;
    message.emergencyBearers = ((*features)[0] & 2U) != 0;
  }
}

bool readAttachAccept(Octets octets, Message& message) {
  const auto result = octets.octet();
  const auto timer = octets.octet();
  const auto areas = octets.lengthValue();
  const auto session = octets.longLengthValue();
  if (!result || !timer || !areas || !session) return false;
  message.type = static_cast<std::uint8_t>(*result & 7U);
  message.updateTimerSeconds = timerSeconds(*timer);
  readAcceptElements(Elements(octets.rest(), fixedElements), message);
  message.trackingAreas = trackingAreasOf(*areas);
  message.session = *session;
  return true;
}

bool readUpdateAccept(Octets octets, Message& message) {
  const auto result = octets.octet();
  if (!result) return false;
  message.type = static_cast<std::uint8_t>(*result & 7U);
  readAcceptElements(Elements(octets.rest(), fixedElements), message);
  return true;
}

bool read(Octets octets, Message& message) {
  switch (message.kind) {
    case Kind::attachRequest:
      return readAttachRequest(octets, message);
    case Kind::attachAccept:
      return readAttachAccept(octets, message);
    case Kind::updateRequest:
      return readUpdateRequest(octets, message);
    case Kind::updateAccept:
      return readUpdateAccept(octets, message);
    case Kind::attachReject:
    case Kind::updateReject:
    case Kind::serviceReject:
      message.cause = octets.octet();
      return message.cause.has_value();
    case Kind::attachComplete:
      if (const auto session = octets.longLengthValue()) message.session = *session;
      return true;
    case Kind::detachRequest: {
      const auto type = octets.octet();
      if (!type) return false;
      message.type = static_cast<std::uint8_t>(*type & 7U);
      message.switchOff = (*type & 8U) != 0;
      return true;
    }
    case Kind::updateComplete:
    case Kind::serviceRequest:
    case Kind::detachAccept:
      return true;
  }
  return false;
}

}  // namespace

std::optional<EpsMobilityMessage> epsMobilityMessageOf(Span bytes) {
  constexpr std::uint8_t plain = 0x07;
  constexpr std::uint8_t shortServiceRequest = 0xC;
  constexpr std::size_t shortServiceRequestLength = 4;
  Octets octets(bytes);
  const auto head = octets.octet();
  if (!head || (*head & 0xFU) != plain) return std::nullopt;
  if (*head >> 4U == shortServiceRequest) {
    if (bytes.size() < shortServiceRequestLength) return std::nullopt;
    EpsMobilityMessage message;
    message.kind = Kind::serviceRequest;
    return message;
  }
  const auto type = octets.octet();
  if (*head != plain || !type) return std::nullopt;
  const auto kind = kindOf(*type);
  if (!kind) return std::nullopt;
  EpsMobilityMessage message;
  message.kind = *kind;
  if (!read(octets, message)) return std::nullopt;
  return message;
}

}  // namespace vespscope::sources::nas
