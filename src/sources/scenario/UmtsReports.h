// Converts the UMTS state of the phone into metric events.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "sources/scenario/Outbox.h"
#include "sources/scenario/Propagation.h"

namespace vespscope::sources::scenario {

// The metric's RRC connection states.
enum class UmtsRrc : std::uint8_t {
  inactive = 1,
  idle = 2,
  establishing = 3,
  uraPch = 4,
  cellPch = 5,
  cellFach = 6,
  cellDch = 7,
  releasing = 8,
};

// The establishment causes of TS 25.331 10.3.3.11 that occur in the drive.
enum class UmtsEstablishment : std::uint8_t {
  originatingConversational = 0,
  originatingInteractive = 2,
  terminatingConversational = 5,
  terminatingInteractive = 7,
  registration = 12,
};

// The release causes that occur in the drive.
enum class UmtsRelease : std::uint8_t { inactive = 3, normal = 4, cellChanged = 6, establishmentFailed = 8 };

struct UmtsServing {
  UmtsLevel level;
  double imbalance = 0;  // dB by which antenna 0 receives more than antenna 1
};

struct UmtsTransmit {
  int control;   // dBm, the DPCCH only
  int total;     // dBm, -50..24: power class 3, TS 25.101 6.2.1
  int subframe;  // of HSUPA, 0..4
};

class UmtsReports {
 public:
  UmtsReports(Outbox& outbox, const RadioMap& map) : outbox_(outbox), map_(map) {}

  void rrc(UmtsRrc state, std::optional<UmtsEstablishment> establishment, std::optional<UmtsRelease> release);
  void configuration(Time drxCycle, bool dualCarrier);
  void servingCell(const Cell& cell);
  void selection(const UmtsLevel& serving);
  void servingLevel(const UmtsServing& serving, bool connected);
  void transmitPower(const std::vector<UmtsTransmit>& powers);
  void neighbours(const std::vector<UmtsLevel>& umts, const std::vector<GsmLevel>& gsm,
                  const std::vector<LteLevel>& lte);

 private:
  Outbox& outbox_;
  const RadioMap& map_;
};

}  // namespace vespscope::sources::scenario
