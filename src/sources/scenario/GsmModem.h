// The GSM part of the phone: camping, calls, measurements, the return to UMTS.
#pragma once

#include <optional>
#include <vector>

#include "sources/scenario/Context.h"
#include "sources/scenario/GsmReports.h"
#include "sources/scenario/NasContext.h"

namespace vespscope::sources::scenario {

class GsmModem {
 public:
  GsmModem(GsmReports& reports, NasContext& nas) : reports_(reports), nas_(nas) {}

  // Enters GSM: by reselection or cell change order, or with a call by handover when `connected` is true.
  void enter(Context& context, bool connected);
  // Advances by one frame.
  std::optional<Departure> tick(Context& context);

 private:
  struct Findings {
    std::vector<GsmLevel> own;  // neighbours
    std::vector<UmtsLevel> umts;
    std::vector<LteLevel> lte;
  };

  void takeCell(Context& context, const Cell& cell);
  void setDedicated(Context& context, bool dedicated);
  Findings measure(Context& context);
  void reportCall(Context& context);
  void considerCell(Context& context, const Findings& findings);

  GsmReports& reports_;
  NasContext& nas_;

  bool dedicated_ = false;
  GsmLevel serving_;
  std::uint32_t antenna_ = 0;
  int transmit_ = 33;  // dBm
  int round_ = 0;
  Timer measurement_;
  Timer neighbours_;
  Time latestActivity_{0};
  Time stateSince_{0};
  std::optional<Cell> candidate_;
  Lasting candidateBetter_;
  Lasting umtsBetter_;
};

}  // namespace vespscope::sources::scenario
