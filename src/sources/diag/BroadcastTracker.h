// Keeps what LTE cells broadcast about themselves, each cell for itself, and reports the serving cell's parameters for
// the choice of cells whenever they change.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <vector>

#include "rrc/lte/CellInformation.h"
#include "rrc/lte/Reselection.h"
#include "sources/diag/EventList.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

// What a cell has broadcast; a block that was not heard is absent.
struct CellBroadcast {
  CellName cell;
  std::chrono::nanoseconds heardAt{0};
  std::optional<std::uint8_t> downlinkBlocks;  // of the master information block
  std::optional<rrc::lte::CellInformation> information;
  std::optional<rrc::lte::AccessInformation> access;
  std::optional<rrc::lte::ServingReselection> reselection;
  std::optional<std::vector<rrc::lte::LteNeighbourFrequency>> frequencies;
};

class BroadcastTracker {
 public:
  // `message` came from `cell`: a master information block or system information.
  void take(const CellName& cell, const rrc::Message& message, const EventList& out);
  // Null for a cell that was not heard lately.
  [[nodiscard]] const CellBroadcast* find(const CellName& cell) const;
  // Reports the parameters of the serving cell, if they are known and not the ones reported last.
  void report(const CellName& serving, EventList& out);

 private:
  // A phone hears more cells than this on a long way; the one heard longest ago goes.
  static constexpr std::size_t maximumCells = 32;

  CellBroadcast& entryOf(const CellName& cell);

  std::vector<CellBroadcast> cells_;
  Bytes reported_;  // without its timestamp
};

}  // namespace vespscope::sources::diag
