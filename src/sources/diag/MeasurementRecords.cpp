#include <algorithm>

#include "sources/diag/ByteView.h"
#include "sources/diag/LteRecords.h"
#include "sources/diag/MeasurementScales.h"
#include "sources/diag/Subpackets.h"

namespace vespscope::sources::diag {
namespace {

// The subpacket of the serving cell. A field is a part of one of the 32-bit words of a cell, which are counted from the
// cell's beginning.
constexpr std::uint8_t servingCellSubpacket = 25;
struct Field {
  std::size_t offset = 0;
  unsigned shift = 0;
};
struct AntennaLayout {
  Field rsrp;                // 12 bits, like all RSRPs
  Field rsrq;                // 10 bits
  Field rssi;                // 11 bits
  std::optional<Field> snr;  // 9 bits
};
struct Layout {
  std::uint8_t version;
  std::size_t cells;   // offset of the first cell
  bool hasCount;       // the number of cells follows the EARFCN; otherwise there is one
  bool hasMask;        // a mask of the valid antennas, one bit each, follows the number of cells
  std::size_t stride;  // from cell to cell; 0 if only one cell was ever seen
  std::size_t length;  // of the fields of a cell
  Field rsrp;          // over all antennas
  std::uint32_t rsrpBase;
  Field rsrq;
  Field rssi;
  std::span<const AntennaLayout> antennas;
};

constexpr AntennaLayout antennas19[] = {{{16, 10}, {28, 12}, {36, 10}, Field{64, 0}},
                                        {{20, 12}, {32, 0}, {36, 21}, Field{64, 9}}};
constexpr AntennaLayout antennas22[] = {{{16, 10}, {32, 12}, {44, 10}, Field{76, 0}},
                                        {{20, 12}, {36, 0}, {44, 21}, Field{76, 9}}};
constexpr AntennaLayout antennas36[] = {{{16, 10}, {36, 0}, {48, 0}, Field{80, 0}},
                                        {{20, 12}, {36, 20}, {48, 11}, Field{80, 9}},
                                        {{24, 12}, {40, 10}, {52, 0}, Field{84, 0}},
                                        {{28, 0}, {40, 20}, {52, 11}, Field{84, 9}}};
// One more word after the RSRP of the third antenna; the position of the SNR is unknown.
constexpr AntennaLayout antennas48[] = {{{16, 10}, {40, 0}, {52, 0}, std::nullopt},
                                        {{20, 12}, {40, 20}, {52, 11}, std::nullopt},
                                        {{24, 12}, {44, 10}, {56, 0}, std::nullopt},
                                        {{32, 0}, {44, 20}, {56, 11}, std::nullopt}};
constexpr std::array<Layout, 5> layouts = {{
    {18, 4, false, false, 0, 68, {24, 12}, 0, {32, 20}, {40, 0}, antennas19},
    {19, 8, true, false, 0, 68, {24, 12}, 0, {32, 20}, {40, 0}, antennas19},
    {22, 8, true, false, 0, 80, {28, 12}, 0, {40, 10}, {52, 0}, antennas22},
    {36, 8, true, true, 128, 88, {28, 12}, 640, {44, 0}, {56, 0}, antennas36},
    {48, 12, true, true, 0, 64, {32, 12}, 640, {48, 0}, {60, 0}, antennas48},
}};

const Layout* layoutOf(std::uint8_t version) {
  const auto* found = std::find_if(layouts.begin(), layouts.end(),
                                   [version](const Layout& layout) { return layout.version == version; });
  return found == layouts.end() ? nullptr : found;
}

std::uint32_t read(const ByteView& cell, const Field& field, unsigned width) {
  return bits(cell.u32(field.offset), field.shift, width);
}

ServingMeasurement cellOf(const ByteView& body, const ByteView& cell, const Layout& layout, std::uint32_t mask) {
  ServingMeasurement measurement;
  const std::uint32_t name = cell.u16(0);
  measurement.cell = {body.u32(0), static_cast<std::uint16_t>(bits(name, 0, 9))};
  measurement.cellIndex = static_cast<std::uint8_t>(bits(name, 9, 3));
  measurement.serving = bits(name, 12, 1) != 0;
  const std::uint32_t frame = cell.u16(4);
  measurement.systemFrame = static_cast<std::uint16_t>(bits(frame, 0, 10));
  measurement.subframe = static_cast<std::uint8_t>(bits(frame, 10, 4));
  for (std::size_t index = 0; index < layout.antennas.size(); ++index) {
    if ((mask >> index & 1U) == 0) continue;
    const AntennaLayout& antenna = layout.antennas[index];
    AntennaLevels levels{rsrpOf(read(cell, antenna.rsrp, 12)), rsrqOf(read(cell, antenna.rsrq, 10)),
                         rssiOf(read(cell, antenna.rssi, 11)), std::nullopt};
    if (antenna.snr) levels.snr = snrOf(read(cell, *antenna.snr, 9));
    measurement.antennas[index] = levels;
  }
  measurement.combined = {rsrpOf(read(cell, layout.rsrp, 12) + layout.rsrpBase), rsrqOf(read(cell, layout.rsrq, 10)),
                          rssiOf(read(cell, layout.rssi, 11)), std::nullopt};
  return measurement;
}

std::optional<RecordFault> readCells(const Subpacket& subpacket, const Layout& layout,
                                     ServingMeasurementRecord& record) {
  constexpr std::uint32_t allAntennas = 0xF;
  const ByteView& body = subpacket.body;
  if (!body.holds(4, layout.hasMask ? 4 : 2)) return RecordFault::tooShort;
  const unsigned cells = layout.hasCount ? body.u16(4) : 1U;
  const std::uint32_t mask = layout.hasMask ? body.u16(6) : allAntennas;
  const unsigned readable = layout.stride == 0 ? std::min(cells, 1U) : cells;
  for (unsigned index = 0; index < readable; ++index) {
    const std::size_t offset = layout.cells + index * layout.stride;
    if (!body.holds(offset, layout.length)) return RecordFault::tooShort;
    const ByteView cell(body.part(offset, layout.length));
    record.cells.push_back(cellOf(body, cell, layout, mask));
    if (record.cells.back().cell.pci > highestPci) return RecordFault::outOfRange;
  }
  if (cells > readable) record.unread.push_back({subpacket.kind, subpacket.version});
  return std::nullopt;
}

}  // namespace

Decoded<ServingMeasurementRecord> servingMeasurementOf(std::span<const std::uint8_t> payload) {
  ServingMeasurementRecord record;
  const auto fault = forEachSubpacket(payload, [&record](const Subpacket& subpacket) -> std::optional<RecordFault> {
    const Layout* layout = layoutOf(subpacket.version);
    if (subpacket.kind == servingCellSubpacket && layout != nullptr) return readCells(subpacket, *layout, record);
    record.unread.push_back({subpacket.kind, subpacket.version});
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
