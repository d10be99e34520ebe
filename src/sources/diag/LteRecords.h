// The supported log records of LTE's radio, as plain structures in physical units.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "radio/Plmn.h"
#include "sources/diag/Decoded.h"

namespace vespscope::sources::diag {

inline constexpr std::uint16_t servingCellCode = 0xB0C2;
inline constexpr std::uint16_t rrcMessageCode = 0xB0C0;
inline constexpr std::uint16_t servingMeasurementCode = 0xB193;
inline constexpr std::uint16_t neighbourMeasurementCode = 0xB179;
inline constexpr std::uint16_t idleNeighboursCode = 0xB192;
inline constexpr std::uint16_t connectedNeighboursCode = 0xB195;

// A cell's name in measurements: carrier and physical identity.
struct CellName {
  std::uint32_t earfcn = 0;
  std::uint16_t pci = 0;  // 0..503
  bool operator==(const CellName&) const = default;
};
inline constexpr std::uint16_t highestPci = 503;

// B0C2: the cell that the phone camps on or is connected to.
struct ServingCellRecord {
  CellName cell;
  std::uint32_t uplinkEarfcn = 0;
  std::uint8_t downlinkBlocks = 0;  // bandwidth in resource blocks
  std::uint8_t uplinkBlocks = 0;
  std::uint32_t cellIdentity = 0;  // 28 bits, 3GPP TS 36.331 CellIdentity
  std::uint16_t trackingAreaCode = 0;
  std::uint32_t band = 0;
  std::optional<radio::Plmn> plmn;  // empty when its digits are invalid
  bool operator==(const ServingCellRecord&) const = default;
};
[[nodiscard]] Decoded<ServingCellRecord> servingCellOf(std::span<const std::uint8_t> payload);

// B193: power and quality of one serving cell.
struct AntennaLevels {
  double rsrp = 0;            // dBm, 1/16 dB steps from -180, also for the next two
  double rsrq = 0;            // dB, from -30
  double rssi = 0;            // dBm, from -110
  std::optional<double> snr;  // dB, 0.1 dB steps from -20; of one antenna, if its position is known
  bool operator==(const AntennaLevels&) const = default;
};
inline constexpr std::size_t maximumAntennas = 4;
struct ServingMeasurement {
  CellName cell;
  std::uint8_t cellIndex = 0;  // 0 the primary, 1.. the secondaries
  bool serving = false;
  std::uint16_t systemFrame = 0;
  std::uint8_t subframe = 0;
  // Empty for an antenna that the modem does not have or did not use.
  std::array<std::optional<AntennaLevels>, maximumAntennas> antennas;
  // The combined levels: RSRP and RSSI of the strongest antenna, and the best RSRQ of all.
  AntennaLevels combined;
};
// A skipped part of a record.
struct UnreadSubpacket {
  std::uint8_t subpacket = 0;
  std::uint8_t version = 0;
  bool operator==(const UnreadSubpacket&) const = default;
};
struct ServingMeasurementRecord {
  std::vector<ServingMeasurement> cells;
  // The record's other parts: other subpackets, and cells after the first of a subpacket.
  std::vector<UnreadSubpacket> unread;
};
[[nodiscard]] Decoded<ServingMeasurementRecord> servingMeasurementOf(std::span<const std::uint8_t> payload);

// B179: a measurement of one carrier in connected mode.
struct NeighbourMeasurement {
  std::uint16_t pci = 0;
  double rsrp = 0;  // dBm
  double rsrq = 0;  // dB
};
struct NeighbourMeasurementRecord {
  CellName serving;
  double servingRsrp = 0;  // dBm
  double servingRsrq = 0;  // dB
  std::vector<NeighbourMeasurement> neighbours;
  std::uint8_t detectedCells = 0;  // detected but not measured
};
[[nodiscard]] Decoded<NeighbourMeasurementRecord> neighbourMeasurementOf(std::span<const std::uint8_t> payload);

// B192 in idle, B195 in connected mode: the neighbours of one or more carriers, each sample as measured.
struct NeighbourCarrier {
  std::uint32_t earfcn = 0;
  std::vector<NeighbourMeasurement> neighbours;
};
struct NeighbourCarriersRecord {
  std::vector<NeighbourCarrier> carriers;
  std::vector<UnreadSubpacket> unread;
};
[[nodiscard]] Decoded<NeighbourCarriersRecord> idleNeighboursOf(std::span<const std::uint8_t> payload);
[[nodiscard]] Decoded<NeighbourCarriersRecord> connectedNeighboursOf(std::span<const std::uint8_t> payload);

// B0C0: one RRC message.
enum class RrcChannel {
  broadcast,          // master information block
  systemInformation,  // system information blocks, on DL-SCH
  multicast,
  paging,
  downlinkCcch,
  downlinkDcch,
  uplinkCcch,
  uplinkDcch,
  other,
};
// Whether messages of the channel are to or from this phone, and so belong to its serving cell.
[[nodiscard]] constexpr bool isDedicated(RrcChannel channel) {
  return channel >= RrcChannel::downlinkCcch && channel != RrcChannel::other;
}

struct RrcMessageRecord {
  CellName cell;
  RrcChannel channel = RrcChannel::other;
  bool narrowband = false;  // NB-IoT, whose messages have a different coding
  std::uint8_t radioBearer = 0;
  std::span<const std::uint8_t> message;  // unaligned PER; a view of the record
};
[[nodiscard]] Decoded<RrcMessageRecord> rrcMessageOf(std::span<const std::uint8_t> payload);

}  // namespace vespscope::sources::diag
