// Converts the LTE state of the phone into metric events.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "sources/scenario/Outbox.h"
#include "sources/scenario/Propagation.h"

namespace vespscope::sources::scenario {

// The metric's RRC states.
enum class LteRrc : std::uint8_t { none, idle, attempting, connected, ending, outbound, inbound };

// The metric's causes that occur in the drive.
enum class LteCause : std::uint8_t {
  mobileTerminatedAccess = 2,
  mobileOriginatedSignalling = 3,
  mobileOriginatedData = 4,
  reestablishmentHandoverFailure = 7,
  releaseNoReestablishment = 11,  // T311 expired
  releaseOther = 15,
  releaseMobilityFromLte = 20,
  mobilityToLte = 21,
  noResponse = 22,
  reestablishmentRadioLinkFailure = 27,  // T310 expired
  noService = 254,
  notApplicable = 255,
};

struct LteRrcChange {
  LteRrc state;
  LteRrc previous;
  Time previousFor;
  LteCause cause;
};

// C-DRX of TS 36.331 6.3.2 MAC-MainConfig; the subframe counts there are milliseconds.
struct LteDrx {
  std::uint32_t onDuration = 0;
  std::uint32_t inactivity = 0;
  std::uint32_t retransmission = 0;
  std::uint32_t longCycle = 0;
  std::uint32_t shortCycle = 0;
  std::uint32_t shortCycles = 0;
  std::uint32_t transmissionMode = 1;  // 1..10, TS 36.213 7.1
};

// One serving carrier as measured by its two receive antennas; the cell's own value is the better one.
struct LteServing {
  LteLevel level;
  double imbalance = 0;  // dB by which antenna 0 receives more than antenna 1
};

enum class SecondaryState : std::uint8_t { removed, configured, activated };

struct Secondary {
  std::uint32_t index = 0;
  SecondaryState state = SecondaryState::removed;
  LteServing serving;
};

struct LteTransmit {
  int pucch;     // dBm, -40..23, TS 36.101 6.2.2 and 6.3.2
  int pusch;     // dBm
  int subframe;  // 0..9
};

struct LteNeighbours {
  std::vector<LteLevel> lte;
  std::vector<UmtsLevel> umts;
  std::vector<GsmLevel> gsm;
};

// The reselection parameters that a cell of a layer broadcasts, as raw codes of TS 36.331 6.3.1.
struct LteSelection {
  int rxLevelMinimum = 0;         // Q-RxLevMin, -70..-22, in steps of 2 dB
  std::uint32_t hysteresis = 0;   // q-Hyst, 0..15: dB = code up to 6
  std::uint32_t intraSearch = 0;  // s-IntraSearchP and the three below, 0..31, in steps of 2 dB
  std::uint32_t nonIntraSearch = 0;
  std::uint32_t servingLow = 0;
  std::uint32_t high = 0;  // threshX-High
  std::uint32_t low = 0;   // threshX-Low
};
[[nodiscard]] const LteSelection& selectionOf(LayerIndex layer);

// The number of measurements in an average of levels.
inline constexpr std::size_t levelWindow = 16;

class LteReports {
 public:
  LteReports(Outbox& outbox, const RadioMap& map) : outbox_(outbox), map_(map) {}

  void rrc(const LteRrcChange& change);
  void drx(const LteDrx& drx, bool configured, LteRrc state, std::uint32_t servingCells);
  void servingCell(const Cell& cell);
  void selection(const Cell& cell);
  void servingLevel(const LteServing& serving, bool connected);
  // Reports the levels of all serving cells, primary first; `window` are the primary's latest ones, levelWindow at
  // most.
  void levels(const std::vector<LteServing>& serving, const std::vector<LteServing>& window, Time period,
              const std::string& callId);
  void transmitPower(const std::vector<LteTransmit>& powers);
  void carriers(const Cell& primary, const std::vector<Secondary>& secondaries);
  void aggregation(const std::vector<Secondary>& secondaries);
  void lteNeighbours(const std::vector<LteLevel>& neighbours);
  void otherNeighbours(const std::vector<UmtsLevel>& umts, const std::vector<GsmLevel>& gsm);

 private:
  Outbox& outbox_;
  const RadioMap& map_;
};

}  // namespace vespscope::sources::scenario
