// The LTE part of the phone: cell selection, idle and connected mobility, measurements.
#pragma once

#include <deque>
#include <optional>
#include <string>
#include <vector>

#include "sources/scenario/CarrierAggregation.h"
#include "sources/scenario/Context.h"
#include "sources/scenario/LteReports.h"
#include "sources/scenario/NasContext.h"

namespace vespscope::sources::scenario {

class LteModem {
 public:
  LteModem(LteReports& reports, NasContext& nas) : reports_(reports), nas_(nas), aggregation_(reports) {}

  // Enters LTE: at power-on and by reselection with `connected` false, by handover with it true.
  void enter(Context& context, bool connected);
  // Advances by one frame.
  std::optional<Departure> tick(Context& context);

 private:
  // The results of one round of measurements.
  struct Findings {
    std::vector<LteLevel> own;    // neighbours on the serving layer
    std::vector<LteLevel> other;  // cells of other LTE layers
    std::vector<UmtsLevel> umts;
    std::vector<GsmLevel> gsm;
  };

  void change(Context& context, LteRrc state, LteCause cause);
  void takeCell(Context& context, const Cell& cell);
  void becomeConnected(Context& context, LteCause cause);
  void release(Context& context, LteCause cause);
  std::optional<Departure> leave(Context& context, LteCause cause, bool connected);

  void tickIdle(Context& context);
  void tickAttempt(Context& context);
  std::optional<Departure> tickConnected(Context& context);

  Findings measure(Context& context);
  void report(Context& context, const Findings& findings);
  void reportNeighbours(const Findings& findings);
  void reportTransmitPower(Context& context);
  void considerReselection(Context& context, const Findings& findings);
  void considerHandover(Context& context, const Findings& findings);
  void executeHandover(Context& context);
  void considerLinkFailure(Context& context);
  [[nodiscard]] bool lostTo(const Findings& findings) const;
  void updateDrx(Context& context);
  [[nodiscard]] bool connected() const { return state_ == LteRrc::connected; }

  LteReports& reports_;
  NasContext& nas_;
  CarrierAggregation aggregation_;

  LteRrc state_ = LteRrc::none;
  Time stateSince_{0};
  LteCause attemptCause_ = LteCause::notApplicable;
  Timer stateEnds_;
  Timer measurement_;
  Timer drxUpdate_;
  int round_ = 0;

  Cell cell_;
  LteServing serving_;
  std::deque<LteServing> window_;
  Time latestActivity_{0};
  bool voice_ = false;
  std::string callId_;

  std::optional<Cell> candidate_;
  Lasting candidateBetter_;
  std::optional<Cell> handoverTarget_;
  Timer handover_;
  Lasting lost_;
  Lasting outOfSync_;
  bool handoverToUmts_ = false;  // a loss of coverage ends by handover this time
  bool leaving_ = false;         // released towards UMTS
};

}  // namespace vespscope::sources::scenario
