// The UMTS part of the phone: RRC states by traffic, best cell, measurements, changes to LTE and GSM.
#pragma once

#include <optional>
#include <vector>

#include "sources/scenario/Context.h"
#include "sources/scenario/NasContext.h"
#include "sources/scenario/UmtsReports.h"

namespace vespscope::sources::scenario {

class UmtsModem {
 public:
  UmtsModem(UmtsReports& reports, NasContext& nas) : reports_(reports), nas_(nas) {}

  // Enters UMTS: by reselection or redirection, or by handover with `connected` true.
  void enter(Context& context, bool connected);
  // Advances by one frame.
  std::optional<Departure> tick(Context& context);

 private:
  struct Findings {
    std::vector<UmtsLevel> own;    // neighbours on the serving layer
    std::vector<UmtsLevel> other;  // cells of the other layer
    std::vector<GsmLevel> gsm;
    std::vector<LteLevel> lte;
  };

  void change(Context& context, UmtsRrc state);
  void takeCell(Context& context, const Cell& cell);
  void release(Context& context, UmtsRelease cause);
  std::optional<Departure> leave(Context& context, Technology to, bool connected);

  void tickIdle(Context& context);
  void tickConnected(Context& context);
  Findings measure(Context& context);
  void report(Context& context, const Findings& findings);
  void reportTransmitPower(Context& context);
  void considerCell(Context& context, const Findings& findings);
  std::optional<Departure> considerDeparture(Context& context, const Findings& findings);

  [[nodiscard]] bool dedicated() const { return state_ == UmtsRrc::cellDch; }
  [[nodiscard]] bool paging() const {
    return state_ == UmtsRrc::idle || state_ == UmtsRrc::uraPch || state_ == UmtsRrc::cellPch;
  }

  UmtsReports& reports_;
  NasContext& nas_;

  UmtsRrc state_ = UmtsRrc::inactive;
  Time stateSince_{0};
  std::optional<UmtsEstablishment> establishment_;
  std::optional<UmtsRelease> release_;
  Timer stateEnds_;
  Timer measurement_;
  Time latestActivity_{0};
  int round_ = 0;

  UmtsServing serving_;
  bool dualCarrier_ = false;
  std::optional<Cell> candidate_;
  Lasting candidateBetter_;
  Lasting lteBetter_;
  Lasting lost_;
  std::optional<Technology> redirected_;  // where the release of the connection redirects the phone
};

}  // namespace vespscope::sources::scenario
