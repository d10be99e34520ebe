// What an NR reconfiguration sets up, by itself or inside one of LTE: the cells of a group.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "rrc/Message.h"

namespace vespscope::rrc::nr {

// What a cell is added with; what is absent stays as it is.
struct CellConfiguration {
  std::optional<std::uint16_t> physicalCell;          // 0..1007
  std::optional<std::uint32_t> synchronisationBlock;  // its NR-ARFCN
  std::optional<std::uint32_t> pointA;                // NR-ARFCN of the lowest resource block
  std::vector<std::uint16_t> bands;
  std::optional<std::uint16_t> bandwidth;       // in resource blocks of the first subcarrier spacing
  std::optional<std::uint16_t> carrierSpacing;  // of that bandwidth, in kHz
  std::optional<std::uint16_t> spacing;         // of the subcarriers of the synchronisation block, in kHz
};

struct SecondaryCell {
  std::uint8_t index = 0;  // 1..31
  CellConfiguration cell;
};

struct CellGroup {
  std::uint8_t id = 0;                    // 0: master, 1..3: secondary
  std::optional<CellConfiguration> main;  // the group's special cell, when the phone synchronises with it
  std::optional<std::uint16_t> cRnti;     // then
  std::vector<SecondaryCell> added;       // or changed
  std::vector<std::uint8_t> released;     // indexes
};

struct Reconfiguration {
  std::optional<CellGroup> master;
  std::optional<CellGroup> secondary;
};

// `message` is an RRCReconfiguration, by itself or of a channel; `body` is one inside another message. Nothing when it
// is something else.
[[nodiscard]] std::optional<Reconfiguration> reconfigurationOf(const Message& message);
[[nodiscard]] std::optional<Reconfiguration> reconfigurationOf(const View& body);

}  // namespace vespscope::rrc::nr
