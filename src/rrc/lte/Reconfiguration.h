// What the network sets up in a connected phone: discontinuous reception, measurements, a handover, secondary cells and
// a secondary cell group of NR.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "rrc/lte/MeasurementConfiguration.h"

namespace vespscope::rrc::lte {

// DRX-Config; times in subframes, which last 1 ms.
struct DiscontinuousReception {
  struct ShortCycle {
    std::uint16_t length = 0;
    std::uint8_t repetitions = 0;  // 1..16, before the long cycle
    bool operator==(const ShortCycle&) const = default;
  };
  std::uint16_t onDuration = 0;
  std::uint16_t inactivity = 0;
  std::uint16_t retransmission = 0;
  std::uint16_t longCycle = 0;
  std::uint16_t startOffset = 0;
  std::optional<ShortCycle> shortCycle;
  bool operator==(const DiscontinuousReception&) const = default;
};

// MobilityControlInfo: a handover within LTE.
struct MobilityControl {
  std::uint16_t physicalCell = 0;                // of the target, 0..503
  std::optional<std::uint32_t> downlinkCarrier;  // EARFCN; absent: the same
  std::optional<std::uint32_t> uplinkCarrier;
  std::optional<std::uint8_t> downlinkBandwidth;  // in resource blocks; absent: the same
  std::optional<std::uint8_t> uplinkBandwidth;    // in resource blocks; absent: as the downlink
  std::uint16_t t304 = 0;                         // ms
  std::uint16_t cRnti = 0;                        // the phone's identity in the target
};

struct SecondaryCell {
  std::uint8_t index = 0;                        // 1..31
  std::optional<std::uint16_t> physicalCell;     // absent: the cell is there, and is changed
  std::optional<std::uint32_t> downlinkCarrier;  // EARFCN
  std::optional<std::uint8_t> bandwidth;         // downlink, in resource blocks
  std::optional<std::uint32_t> uplinkCarrier;
  std::optional<std::uint8_t> uplinkBandwidth;  // in resource blocks
  bool uplink = false;                          // an uplink is configured
};

struct Reconfiguration {
  // What happens to discontinuous reception.
  enum class Drx : std::uint8_t { unchanged, released, set };
  Drx drx = Drx::unchanged;
  std::optional<DiscontinuousReception> drxSetting;  // when set
  std::optional<MeasurementConfiguration> measurements;
  std::optional<MobilityControl> mobility;
  std::vector<std::uint8_t> releasedCells;  // indexes
  std::vector<SecondaryCell> addedCells;    // or changed
  // The secondary cell group of NR.
  bool nrReleased = false;
  View nrConfiguration;  // RRCReconfiguration of NR, of the message that has been read; absent: none, or unreadable
  bool fullConfiguration = false;
  std::vector<std::vector<std::uint8_t>> nas;  // messages for the non-access stratum
};

// Nothing when the message is another. `connectionSetupOf` and `reestablishmentOf` give the part of it that they hold.
[[nodiscard]] std::optional<Reconfiguration> reconfigurationOf(const Message& message);
[[nodiscard]] std::optional<Reconfiguration> connectionSetupOf(const Message& message);
[[nodiscard]] std::optional<Reconfiguration> reestablishmentOf(const Message& message);

}  // namespace vespscope::rrc::lte
