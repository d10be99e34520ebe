#include "sources/diag/ByteView.h"
#include "sources/diag/LteRecords.h"
#include "sources/diag/MeasurementScales.h"
#include "sources/diag/Subpackets.h"

namespace vespscope::sources::diag {
namespace {

// The subpacket with the serving cell, and where its versions keep the words that moved.
constexpr std::uint8_t servingCellSubpacket = 25;
struct Layout {
  std::uint8_t version;
  std::size_t levels;        // RSRP over both antennas, then the words with the RSRQs
  std::size_t rsrqCombined;  // this word and shift
  unsigned rsrqShift;
  std::size_t antennaRssi;
  std::size_t combinedRssi;  // the SNRs follow 24 bytes behind
};
constexpr std::array<Layout, 2> layouts = {{{19, 32, 40, 20, 44, 48}, {22, 36, 48, 10, 52, 60}}};
constexpr std::size_t snrDistance = 24;

const Layout* layoutOf(std::uint8_t version) {
  for (const Layout& layout : layouts) {
    if (layout.version == version) return &layout;
  }
  return nullptr;
}

Decoded<ServingMeasurement> cellOf(const ByteView& body, const Layout& layout) {
  if (!body.holds(layout.combinedRssi + snrDistance, 4)) return RecordFault::tooShort;
  ServingMeasurement cell;
  const std::uint32_t name = body.u16(8);
  cell.cell = {body.u32(0), static_cast<std::uint16_t>(bits(name, 0, 9))};
  cell.cellIndex = static_cast<std::uint8_t>(bits(name, 9, 3));
  cell.serving = bits(name, 12, 1) != 0;
  const std::uint32_t frame = body.u16(12);
  cell.systemFrame = static_cast<std::uint16_t>(bits(frame, 0, 10));
  cell.subframe = static_cast<std::uint8_t>(bits(frame, 10, 4));
  const std::uint32_t rssi = body.u32(layout.antennaRssi);
  const std::uint32_t snr = body.u32(layout.combinedRssi + snrDistance);
  cell.antennas[0] = {rsrpOf(bits(body.u32(24), 10, 12)), rsrqOf(bits(body.u32(layout.levels + 4), 12, 10)),
                      rssiOf(bits(rssi, 10, 11))};
  cell.antennas[1] = {rsrpOf(bits(body.u32(28), 12, 12)), rsrqOf(bits(body.u32(layout.levels + 8), 0, 10)),
                      rssiOf(bits(rssi, 21, 11))};
  cell.snr = {snrOf(bits(snr, 0, 9)), snrOf(bits(snr, 9, 9))};
  cell.combined = {rsrpOf(bits(body.u32(layout.levels), 12, 12)),
                   rsrqOf(bits(body.u32(layout.rsrqCombined), layout.rsrqShift, 10)),
                   rssiOf(bits(body.u32(layout.combinedRssi), 0, 11))};
  if (cell.cell.pci > highestPci) return RecordFault::outOfRange;
  return cell;
}

}  // namespace

Decoded<ServingMeasurementRecord> servingMeasurementOf(std::span<const std::uint8_t> payload) {
  ServingMeasurementRecord record;
  const auto fault = forEachSubpacket(payload, [&record](const Subpacket& subpacket) -> std::optional<RecordFault> {
    const Layout* layout = layoutOf(subpacket.version);
    if (subpacket.kind != servingCellSubpacket || layout == nullptr) {
      record.unread.push_back({subpacket.kind, subpacket.version});
      return std::nullopt;
    }
    if (!subpacket.body.holds(4, 2)) return RecordFault::tooShort;
    const unsigned cells = subpacket.body.u16(4);
    if (cells == 0) return std::nullopt;
    const auto cell = cellOf(subpacket.body, *layout);
    if (const auto* broken = std::get_if<RecordFault>(&cell)) return *broken;
    record.cells.push_back(std::get<ServingMeasurement>(cell));
    if (cells > 1) record.unread.push_back({subpacket.kind, subpacket.version});
    return std::nullopt;
  });
  if (fault) return *fault;
  return record;
}

Decoded<NeighbourMeasurementRecord> neighbourMeasurementOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t head = 28;
  constexpr std::size_t neighbourLength = 12;
  constexpr std::size_t detectedLength = 16;
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  if (bytes.u8(0) != 4) return RecordFault::unknownVersion;
  if (!bytes.holds(0, head)) return RecordFault::tooShort;
  NeighbourMeasurementRecord record;
  record.serving = {bytes.u32(8), bytes.u16(12)};
  record.servingRsrp = rsrpOf(bytes.u16(16));
  record.servingRsrq = rsrqOf(bytes.u16(20));
  const std::size_t neighbours = bytes.u8(24);
  record.detectedCells = bytes.u8(25);
  if (!bytes.holds(head, neighbours * neighbourLength + record.detectedCells * detectedLength)) {
    return RecordFault::tooShort;
  }
  if (record.serving.pci > highestPci) return RecordFault::outOfRange;
  for (std::size_t i = 0; i < neighbours; ++i) {
    const std::size_t offset = head + i * neighbourLength;
    record.neighbours.push_back({bytes.u16(offset), rsrpOf(bytes.u16(offset + 2)), rsrqOf(bytes.u16(offset + 6))});
    if (record.neighbours.back().pci > highestPci) return RecordFault::outOfRange;
  }
  return record;
}

}  // namespace vespscope::sources::diag
