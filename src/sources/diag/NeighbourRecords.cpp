#include "sources/diag/ByteView.h"
#include "sources/diag/LteRecords.h"
#include "sources/diag/MeasurementScales.h"
#include "sources/diag/Subpackets.h"

namespace vespscope::sources::diag {
namespace {

constexpr std::uint8_t idleSubpacket = 27;
constexpr std::uint8_t connectedSubpacket = 31;
constexpr std::uint8_t subpacketVersion = 4;

Decoded<NeighbourCarrier> carrierOf(const ByteView& body) {
  constexpr std::size_t head = 8;
  constexpr std::size_t cellLength = 52;
  if (!body.holds(0, head)) return RecordFault::tooShort;
  NeighbourCarrier carrier;
  carrier.earfcn = body.u32(0);
  const std::size_t cells = bits(body.u32(4), 0, 6);
  if (!body.holds(head, cells * cellLength)) return RecordFault::tooShort;
  carrier.neighbours.reserve(cells);
  for (std::size_t i = 0; i < cells; ++i) {
    const std::size_t cell = head + i * cellLength;
    const auto pci = static_cast<std::uint16_t>(bits(body.u16(cell), 0, 10));
    if (pci > highestPci) return RecordFault::outOfRange;
    carrier.neighbours.push_back(
        {pci, rsrpOf(bits(body.u16(cell + 12), 0, 12)), rsrqOf(bits(body.u32(cell + 20), 10, 10))});
  }
  return carrier;
}

Decoded<NeighbourCarriersRecord> carriersOf(std::span<const std::uint8_t> payload, std::uint8_t kind) {
  NeighbourCarriersRecord record;
  const auto fault = forEachSubpacket(payload, [&](const Subpacket& subpacket) -> std::optional<RecordFault> {
    if (subpacket.kind != kind || subpacket.version != subpacketVersion) {
      record.unread.push_back({subpacket.kind, subpacket.version});
      return std::nullopt;
    }
    auto carrier = carrierOf(subpacket.body);
    if (const auto* broken = std::get_if<RecordFault>(&carrier)) return *broken;
    record.carriers.push_back(std::move(std::get<NeighbourCarrier>(carrier)));
    return std::nullopt;
  });
  if (fault) return *fault;
  return record;
}

}  // namespace

Decoded<NeighbourCarriersRecord> idleNeighboursOf(std::span<const std::uint8_t> payload) {
  return carriersOf(payload, idleSubpacket);
}

Decoded<NeighbourCarriersRecord> connectedNeighboursOf(std::span<const std::uint8_t> payload) {
  return carriersOf(payload, connectedSubpacket);
}

}  // namespace vespscope::sources::diag
