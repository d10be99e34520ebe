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

  // Told of every new serving cell; an area where the phone is not registered makes it want a registration.
  void camped(Context& context, const Cell& cell);
  [[nodiscard]] bool wantsSignalling() const { return procedure_ != Procedure::none; }
  // Told while a connection is there: the procedure that is wanted runs.
  void connectionReady(Context& context);
  // Ends procedures whose time has come.
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
  Timer bearers_;  // until the bearers follow the registration
  bool attached_ = false;
  std::uint32_t currentTac_ = 0;
  Technology bearersFor_ = Technology::lte;
};

}  // namespace vespscope::sources::scenario
