#include "sources/nas/Mobility.h"

#include <array>
#include <span>

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
  message.type = static_cast<std::uint8_t>(*result >> 4U & 7U);  // after the force to standby
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

bool readCause(Octets octets, Message& message) {
  message.cause = octets.octet();
  return message.cause.has_value();
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

template <std::uint8_t mask>
bool readType(Octets octets, Message& message) {
  const auto octet = octets.octet();
  if (octet) message.type = static_cast<std::uint8_t>(*octet & mask);
  return octet.has_value();
}

bool readAttachRequest(Octets octets, Message& message) {
  return octets.lengthValue() && readType<7>(octets, message);  // after the network capability
}

bool readDetach(Octets octets, Message& message) {
  // The meaning of the other types depends on the direction (10.5.5.5).
  return readType<7>(octets, message) && message.type == 1;
}

bool readNothing(Octets /*octets*/, Message& /*message*/) { return true; }

// A message of one domain: its number, its kind, and the function that reads it after its header; that returns false
// when the message is truncated.
struct Row {
  std::uint8_t type;
  Kind kind;
  bool (*read)(Octets octets, Message& message);
};

// 3GPP TS 24.008 table 10.4.
constexpr std::array<Row, 12> packetRows = {{
    {0x01, Kind::attachRequest, readAttachRequest},
    {0x02, Kind::attachAccept, readPacketAttachAccept},
    {0x04, Kind::attachReject, readCause},
    {0x05, Kind::detach, readDetach},
    {0x08, Kind::updateRequest, readType<7>},
    {0x09, Kind::updateAccept, readPacketUpdateAccept},
    {0x0B, Kind::updateReject, readCause},
    {0x0C, Kind::serviceRequest, readNothing},
    {0x0D, Kind::serviceAccept, readNothing},
    {0x0E, Kind::serviceReject, readCause},
    {0x10, Kind::newIdentity, readPacketReallocation},
    {0x14, Kind::authenticationReject, readNothing},
}};

// 3GPP TS 24.008 table 10.2.
constexpr std::array<Row, 8> circuitRows = {{
    {0x01, Kind::detach, readNothing},
    {0x02, Kind::updateAccept, readLocationAccept},
    {0x04, Kind::updateReject, readCause},
    {0x08, Kind::updateRequest, readType<3>},
    {0x11, Kind::authenticationReject, readNothing},
    {0x1A, Kind::newIdentity, readCircuitReallocation},
    {0x22, Kind::serviceReject, readCause},
    {0x24, Kind::serviceRequest, readNothing},
}};

std::optional<Message> messageOf(std::span<const Row> rows, Domain domain, std::uint8_t type, Octets octets) {
  for (const Row& row : rows) {
    if (row.type != type) continue;
    Message message;
    message.domain = domain;
    message.kind = row.kind;
    if (!row.read(octets, message)) return std::nullopt;
    return message;
  }
  return std::nullopt;
}

}  // namespace

std::optional<MobilityMessage> mobilityMessageOf(Span bytes) {
  constexpr std::uint8_t circuitDiscriminator = 5;
  constexpr std::uint8_t packetDiscriminator = 8;
  // The phone puts a sequence number into the two highest bits of its messages of the circuit domain (3GPP TS 24.007
  // 11.2.3.2.1).
  constexpr std::uint8_t withoutNumber = 0x3F;
  Octets octets(bytes);
  const auto head = octets.octet();
  const auto type = octets.octet();
  if (!head || !type) return std::nullopt;
  if (*head == packetDiscriminator) return messageOf(packetRows, Domain::packet, *type, octets);
  if (*head != circuitDiscriminator) return std::nullopt;
  return messageOf(circuitRows, Domain::circuit, *type & withoutNumber, octets);
}

}  // namespace vespscope::sources::nas
