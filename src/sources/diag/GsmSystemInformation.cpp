#include "sources/diag/GsmSystemInformation.h"

#include <algorithm>
#include <array>

#include "sources/diag/BitReader.h"
#include "sources/diag/ByteView.h"
#include "sources/nas/Octets.h"

namespace vespscope::sources::diag {
namespace {

using nas::Octets;
using nas::Span;

constexpr std::size_t areaLength = 5;

// Rest octets (10.5.2.34): each bit is L or H, where H differs from the padding pattern.
class RestOctets {
 public:
  explicit RestOctets(Span bytes)
      : length_(std::min(bytes.size(), toggled_.size())),
        plain_(bytes.first(length_)),
        marks_(Span(toggled_).first(length_)) {
    constexpr std::uint8_t padding = 0x2B;
    std::transform(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length_), toggled_.begin(),
                   [](std::uint8_t octet) { return octet ^ padding; });
  }
  RestOctets(const RestOctets&) = delete;
  RestOctets& operator=(const RestOctets&) = delete;

  // Returns false for L, and past the end.
  bool high() {
    plain_.skip(1);
    return marks_.read(1) == 1U;
  }
  std::optional<unsigned> read(unsigned count) {
    marks_.skip(count);
    return plain_.read(count);
  }
  std::uint8_t number(unsigned count) { return static_cast<std::uint8_t>(read(count).value_or(0)); }
  void skip(std::size_t count) {
    plain_.skip(count);
    marks_.skip(count);
  }

 private:
  std::array<std::uint8_t, 20> toggled_{};
  std::size_t length_;
  BitReader plain_;
  BitReader marks_;
};

bool readSelection(Octets& octets, GsmSelection& selection) {
  const auto bytes = octets.value(2);
  if (!bytes) return false;
  selection.hysteresis = (*bytes)[0] >> 5U;
  selection.maximumPower = (*bytes)[0] & 0x1FU;
  selection.minimumLevel = (*bytes)[1] & 0x3FU;
  return true;
}

bool readAccess(Octets& octets, GsmAccess& access) {
  constexpr std::uint16_t emergencyBit = 1U << 10U;
  const auto bytes = octets.value(3);
  if (!bytes) return false;
  access.maximumRetransmissions = (*bytes)[0] >> 6U;
  access.barred = ((*bytes)[0] & 2U) != 0;
  access.reestablishmentAllowed = ((*bytes)[0] & 1U) == 0;
  const std::uint16_t classes = nas::number16(bytes->subspan(1));
  access.emergencyAllowed = (classes & emergencyBit) == 0;
  access.barredClasses = static_cast<std::uint16_t>(classes & ~emergencyBit);
  return true;
}

void readRest(Span bytes, GsmCellDescription& cell) {
  RestOctets rest(bytes);
  if (rest.high()) {
    const bool lowPriority = rest.number(1) == 1;
    cell.reselection = GsmReselection{lowPriority, rest.number(6), rest.number(3), rest.number(5)};
  }
  if (rest.high()) rest.skip(2);  // power offset
  cell.secondTerBroadcast = rest.high();
  cell.earlyClassmarkSending = rest.high();
  if (rest.high()) rest.skip(3);  // position of the schedule
  cell.packetService = rest.high();
}

std::optional<GsmSystemInformation> cellDescriptionOf(Octets octets) {
  GsmCellDescription cell;
  const auto identity = octets.value(2);
  const auto area = octets.value(areaLength);
  const auto control = octets.value(3);
  const auto options = octets.octet();
  if (!identity || !area || !control || !options) return std::nullopt;
  cell.cellIdentity = nas::number16(*identity);
  cell.area = nas::locationAreaOf(*area);
  cell.attachAllowed = ((*control)[0] & 0x40U) != 0;
  cell.pagingMultiframes = (*control)[1] & 7U;
  cell.locationTimer = (*control)[2];
  cell.uplinkDtx = *options >> 4U & 3U;
  cell.radioLinkTimeout = *options & 0xFU;
  if (!readSelection(octets, cell.selection) || !readAccess(octets, cell.access)) return std::nullopt;
  readRest(octets.rest(), cell);
  return cell;
}

std::optional<GsmSystemInformation> cellReminderOf(Octets octets) {
  constexpr std::uint8_t broadcastChannel = 0x64;
  GsmCellReminder cell;
  const auto area = octets.value(areaLength);
  if (!area || !readSelection(octets, cell.selection) || !readAccess(octets, cell.access)) return std::nullopt;
  cell.area = nas::locationAreaOf(*area);
  cell.cellBroadcast = octets.octet() == broadcastChannel;
  return cell;
}

// GPRS mobile allocation, 3GPP TS 44.060 12.10a; returns false when it is truncated.
bool skipMobileAllocation(RestOctets& rest) {
  rest.skip(6);
  const auto skipList = [&rest](unsigned width) {
    while (true) {
      rest.skip(width);
      const auto more = rest.read(1);
      if (!more) return false;
      if (*more == 0) return true;
    }
  };
  if (rest.number(1) == 1 && !skipList(4)) return false;
  if (rest.number(1) == 0) {
    const auto length = rest.read(6);
    if (!length) return false;
    rest.skip(*length + 1);
    return true;
  }
  return rest.number(1) == 0 || skipList(6);
}

// GPRS cell options, 3GPP TS 44.060 12.24.
void readCellOptions(RestOctets& rest, GsmPacketDescription& cell) {
  cell.networkMode = rest.number(2);
  rest.skip(3 + 3 + 3 + 1 + 1 + 4);
  if (rest.number(1) == 1) rest.skip(3 + 3 + 3);
  if (rest.number(1) == 0) return;
  const auto length = rest.read(6);
  const auto enhanced = rest.read(1);
  if (!length || !enhanced) return;
  const unsigned ahead = 1 + (*enhanced == 1 ? 1 + 4 : 0) + 1 + 1 + 1 + 1;
  if (*length + 1 <= ahead) return;
  rest.skip(ahead - 1);
  if (const auto flag = rest.read(1)) cell.extendedUplinkBlockFlow = *flag == 1;
}

std::optional<GsmSystemInformation> packetDescriptionOf(Octets octets) {
  RestOctets rest(octets.rest());
  if (!rest.high()) return std::nullopt;
  rest.skip(3 + 4);
  if (rest.number(1) == 1) {
    rest.skip(2);
    if (!skipMobileAllocation(rest)) return std::nullopt;
  }
  if (rest.read(1) != 0U) return std::nullopt;  // a packet broadcast channel has these parameters
  const auto area = rest.read(8);
  const auto split = rest.read(1);
  const auto threshold = rest.read(3);
  const auto order = rest.read(2);
  if (!area || !split || !threshold || !order) return std::nullopt;
  GsmPacketDescription cell;
  cell.routingAreaCode = static_cast<std::uint8_t>(*area);
  cell.splitPaging = *split == 1;
  cell.accessThreshold = static_cast<std::uint8_t>(*threshold);
  cell.networkControlOrder = static_cast<std::uint8_t>(*order);
  readCellOptions(rest, cell);
  return cell;
}

}  // namespace

Decoded<GsmMessageRecord> gsmMessageOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t head = 3;
  const ByteView bytes(payload);
  if (!bytes.holds(0, head) || !bytes.holds(head, bytes.u8(2))) return RecordFault::tooShort;
  return GsmMessageRecord{bytes.u8(0), bytes.u8(1), bytes.part(head, bytes.u8(2))};
}

std::optional<GsmSystemInformation> gsmSystemInformationOf(std::span<const std::uint8_t> message) {
  constexpr std::uint8_t radioResource = 0x06;
  constexpr std::uint8_t pseudoLength = 0x01;  // in the two lowest bits, 10.5.2.19
  if (!message.empty() && (message[0] & 3U) == pseudoLength) message = message.subspan(1);
  Octets octets(message);
  if (octets.octet() != radioResource) return std::nullopt;
  switch (octets.octet().value_or(0xFF)) {
    case 0x1B:
      return cellDescriptionOf(octets);
    case 0x1C:
      return cellReminderOf(octets);
    case 0x00:
      return packetDescriptionOf(octets);
    default:
      return std::nullopt;
  }
}

}  // namespace vespscope::sources::diag
