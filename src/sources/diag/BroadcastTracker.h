// Stores what each LTE cell broadcasts about itself, and reports the serving cell's parameters of cell selection
// whenever they change.
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

// The broadcast of one cell; a block that was not received is absent.
struct CellBroadcast {
  CellName cell;
  std::chrono::nanoseconds heardAt{0};
  std::optional<std::uint8_t> downlinkBlocks;  // from the master information block
  std::optional<rrc::lte::CellInformation> information;
  std::optional<rrc::lte::AccessInformation> access;
  std::optional<rrc::lte::ServingReselection> reselection;
  std::optional<std::vector<rrc::lte::LteNeighbourFrequency>> frequencies;
};

class BroadcastTracker {
 public:
  // Takes a message from `cell`: a master information block or system information.
  void take(const CellName& cell, const rrc::Message& message, const EventList& out);
  // Null for a cell that was not received lately.
  [[nodiscard]] const CellBroadcast* find(const CellName& cell) const;
  // Reports the parameters of the serving cell if they are known and differ from those reported last.
  void report(const CellName& serving, EventList& out);

 private:
  // A phone receives more cells than this on a long way; the one received longest ago is removed.
  static constexpr std::size_t maximumCells = 32;

  CellBroadcast& entryOf(const CellName& cell);

  std::vector<CellBroadcast> cells_;
  Bytes reported_;  // without its timestamp
};

}  // namespace vespscope::sources::diag
