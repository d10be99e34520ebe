// Converts the GSM state of the phone into metric events.
#pragma once

#include <cstdint>
#include <vector>

#include "sources/scenario/Outbox.h"
#include "sources/scenario/Propagation.h"

namespace vespscope::sources::scenario {

struct GsmCallLevel {
  Cell cell;
  double rxlev = -110;        // dBm, over the SUB set of frames, TS 45.008 8.4
  std::uint32_t rxqual = 0;   // 0..7, TS 45.008 8.2.4
  std::uint32_t antenna = 0;  // 0, 1
  std::vector<int> transmit;  // dBm, 5..33 in steps of 2, TS 45.005 4.1.1
};

class GsmReports {
 public:
  GsmReports(Outbox& outbox, const RadioMap& map) : outbox_(outbox), map_(map) {}

  void servingCell(const Cell& cell, bool dedicated);
  void idleConfiguration(const Cell& cell);
  void gprsConfiguration(const Cell& cell);
  void idleLevel(const GsmLevel& serving, std::uint32_t antenna);
  void callLevel(const GsmCallLevel& level);
  void neighbours(const std::vector<GsmLevel>& gsm, const std::vector<UmtsLevel>& umts,
                  const std::vector<LteLevel>& lte);

 private:
  Outbox& outbox_;
  const RadioMap& map_;
};

}  // namespace vespscope::sources::scenario
