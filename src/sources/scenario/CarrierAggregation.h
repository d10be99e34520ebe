// Adds, activates, deactivates and removes secondary carriers of an LTE connection, depending on its traffic.
#pragma once

#include <vector>

#include "sources/scenario/Context.h"
#include "sources/scenario/LteReports.h"

namespace vespscope::sources::scenario {

class CarrierAggregation {
 public:
  explicit CarrierAggregation(LteReports& reports) : reports_(reports) {}

  // Runs one round of measurements of a connection on `primary`, whose antennas differ by `imbalance` dB.
  void measure(Context& context, const Cell& primary, double imbalance);
  // Removes all secondary carriers: before a handover and at the release of the connection.
  void drop(const Cell& primary);

  [[nodiscard]] const std::vector<Secondary>& secondaries() const { return secondaries_; }
  [[nodiscard]] std::uint32_t activated() const;

 private:
  bool removeUnfit(Time now);
  bool add(Context& context, const Cell& primary, double imbalance);
  bool activate(const Context& context);

  LteReports& reports_;
  std::vector<Secondary> secondaries_;
  std::vector<Secondary> removed_;  // in this round
  Lasting data_;                    // there is data to send
  Time latestData_{0};
  Time latestBurst_{0};
  int round_ = 0;
};

}  // namespace vespscope::sources::scenario
