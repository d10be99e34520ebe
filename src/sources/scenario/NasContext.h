// The phone's registrations: EPS, GPRS and circuit-switched mobility management and the packet bearers.
#pragma once

#include <cstdint>
#include <vector>

#include "sources/scenario/Context.h"
#include "sources/scenario/NasReports.h"

namespace vespscope::sources::scenario {

class NasContext {
 public:
  NasContext(NasReports& reports, std::uint64_t seed);

  // Called with every new serving cell; in an area where the phone is not registered it requests a registration.
  void camped(Context& context, const Cell& cell);
  [[nodiscard]] bool wantsSignalling() const { return procedure_ != Procedure::none; }
  // Called while there is a connection: the requested procedure runs.
  void connectionReady(Context& context);
  // Ends procedures that are due.
  void tick(Context& context);

 private:
  enum class Procedure : std::uint8_t { none, attach, trackingAreaUpdate, routingAreaUpdate };

  void complete(Context& context);
  void report() const;
  void newIdentities(Random& random, Technology technology);

  NasReports& reports_;
  Random random_;
  Registration registration_;
  Procedure procedure_ = Procedure::none;
  Technology technology_ = Technology::lte;
  Timer answer_;   // of the network
  Timer bearers_;  // delay before the bearers follow the registration
  bool attached_ = false;
  std::uint32_t currentTac_ = 0;
  Technology bearersFor_ = Technology::lte;
};

}  // namespace vespscope::sources::scenario
