#include "sources/nas/Mobility.h"

#include "sources/nas/Elements.h"
#include "sources/nas/Timers.h"

namespace vespscope::sources::nas {
namespace {

using Kind = MobilityKind;
using Message = MobilityMessage;

constexpr std::size_t locationAreaLength = 5;
constexpr std::size_t routingAreaLength = 6;

constexpr std::array<FixedElement, 3> packetFixedElements = {{
    {0x17, 1},  // READY timer
    {0x19, 3},  // P-TMSI signature
    {0x25, 1},  // GMM cause
}};

void readIdentity(const std::optional<Span>& identity, std::optional<std::uint32_t>& into) {
  if (identity) into = temporaryIdentityOf(*identity);
}

bool readArea(Octets& octets, Message& message) {
  const auto area = octets.value(locationAreaLength);
  if (!area) return false;
  message.locationArea = locationAreaOf(*area);
  return true;
}

bool readRoutingArea(Octets& octets, Message& message) {
  const auto bytes = octets.value(routingAreaLength);
  if (!bytes) return false;
  if (const auto area = routingAreaOf(*bytes)) {
    message.locationArea = area->location;
    message.routingAreaCode = area->rac;
  }
  return true;
}

void readPacketElements(Octets octets, Message& message) {
  const Elements elements(octets.rest(), packetFixedElements);
  readIdentity(elements.find(0x18), message.temporaryIdentity);
  readIdentity(elements.find(0x23), message.tmsi);
  if (const auto cause = elements.find(0x25)) message.cause = (*cause)[0];
  if (const auto list = elements.find(0x4A)) message.equivalentPlmns = plmnListOf(*list);
}

bool readPacketAttachAccept(Octets octets, Message& message) {
  const auto result = octets.octet();
  const auto timer = octets.octet();
  if (!result || !timer || !octets.octet() || !readRoutingArea(octets, message)) return false;
  message.type = static_cast<std::uint8_t>(*result & 7U);
  message.updateTimerSeconds = timerSeconds(*timer);
  readPacketElements(octets, message);
  return true;
}

bool readPacketUpdateAccept(Octets octets, Message& message) {
  const auto result = octets.octet();
  const auto timer = octets.octet();
  if (!result || !timer || !readRoutingArea(octets, message)) return false;
  message.type = static_cast<std::uint8_t>(*result >> 4U & 7U);  // behind the force to standby
  message.updateTimerSeconds = timerSeconds(*timer);
  readPacketElements(octets, message);
  return true;
}

bool readPacketReallocation(Octets octets, Message& message) {
  const auto identity = octets.lengthValue();
  if (!identity) return false;
  message.temporaryIdentity = temporaryIdentityOf(*identity);
  return readRoutingArea(octets, message);
}

bool readTypeOctet(Octets octets, std::optional<std::uint8_t>& type, std::uint8_t mask) {
  const auto octet = octets.octet();
  if (octet) type = static_cast<std::uint8_t>(*octet & mask);
  return octet.has_value();
}

bool readCause(Octets octets, Message& message) {
  message.cause = octets.octet();
  return message.cause.has_value();
}

bool readPacket(std::uint8_t type, Octets octets, Message& message) {
  switch (type) {
    case 0x01:
      message.kind = Kind::attachRequest;
      // Behind the network capability.
      return octets.lengthValue() && readTypeOctet(octets, message.type, 7);
    case 0x02:
      message.kind = Kind::attachAccept;
      return readPacketAttachAccept(octets, message);
    case 0x04:
      message.kind = Kind::attachReject;
      return readCause(octets, message);
    case 0x05:
      message.kind = Kind::detach;
      // The other types mean one thing from the phone and another from the network (10.5.5.5).
      return readTypeOctet(octets, message.type, 7) && message.type == 1;
    case 0x08:
      message.kind = Kind::updateRequest;
      return readTypeOctet(octets, message.type, 7);
    case 0x09:
      message.kind = Kind::updateAccept;
      return readPacketUpdateAccept(octets, message);
    case 0x0B:
      message.kind = Kind::updateReject;
      return readCause(octets, message);
    case 0x0C:
      message.kind = Kind::serviceRequest;
      return true;
    case 0x0E:
      message.kind = Kind::serviceReject;
      return readCause(octets, message);
    case 0x10:
      message.kind = Kind::newIdentity;
      return readPacketReallocation(octets, message);
    case 0x14:
      message.kind = Kind::authenticationReject;
      return true;
    default:
      return false;
  }
}

bool readLocationAccept(Octets octets, Message& message) {
  if (!readArea(octets, message)) return false;
  const Elements elements(octets.rest(), {});
  readIdentity(elements.find(0x17), message.temporaryIdentity);
  if (const auto list = elements.find(0x4A)) message.equivalentPlmns = plmnListOf(*list);
  return true;
}

bool readCircuitReallocation(Octets octets, Message& message) {
  if (!readArea(octets, message)) return false;
  const auto identity = octets.lengthValue();
  if (!identity) return false;
  message.temporaryIdentity = temporaryIdentityOf(*identity);
  return true;
}

bool readCircuit(std::uint8_t type, Octets octets, Message& message) {
  switch (type) {
    case 0x01:
      message.kind = Kind::detach;
      return true;
    case 0x02:
      message.kind = Kind::updateAccept;
      return readLocationAccept(octets, message);
    case 0x04:
      message.kind = Kind::updateReject;
      return readCause(octets, message);
    case 0x08:
      message.kind = Kind::updateRequest;
      return readTypeOctet(octets, message.type, 3);
    case 0x11:
      message.kind = Kind::authenticationReject;
      return true;
    case 0x1A:
      message.kind = Kind::newIdentity;
      return readCircuitReallocation(octets, message);
    case 0x22:
      message.kind = Kind::serviceReject;
      return readCause(octets, message);
    case 0x24:
      message.kind = Kind::serviceRequest;
      return true;
    default:
      return false;
  }
}

}  // namespace

std::optional<MobilityMessage> mobilityMessageOf(Span bytes) {
  constexpr std::uint8_t circuitDiscriminator = 5;
  constexpr std::uint8_t packetDiscriminator = 8;
  // The phone numbers its messages of the circuit domain in the two highest bits (3GPP TS 24.007 11.2.3.2.1).
  constexpr std::uint8_t withoutNumber = 0x3F;
  Octets octets(bytes);
  const auto head = octets.octet();
  const auto type = octets.octet();
  if (!head || !type) return std::nullopt;
  MobilityMessage message;
  if (*head == packetDiscriminator) {
    message.domain = Domain::packet;
    if (!readPacket(*type, octets, message)) return std::nullopt;
    return message;
  }
  if (*head != circuitDiscriminator || !readCircuit(*type & withoutNumber, octets, message)) return std::nullopt;
  return message;
}

}  // namespace vespscope::sources::nas
