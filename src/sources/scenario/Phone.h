// A phone that drives through the simulated area and reports its measurements and state.
#pragma once

#include <cstdint>
#include <optional>

#include "sources/scenario/Context.h"
#include "sources/scenario/GsmModem.h"
#include "sources/scenario/LteModem.h"
#include "sources/scenario/NasContext.h"
#include "sources/scenario/UmtsModem.h"
#include "sources/scenario/Vehicle.h"

namespace vespscope::sources::scenario {

class Phone {
 public:
  Phone(std::uint64_t seed, std::chrono::nanoseconds start);
  Phone(const Phone&) = delete;
  Phone& operator=(const Phone&) = delete;
  Phone(Phone&&) = delete;
  Phone& operator=(Phone&&) = delete;
  ~Phone() = default;

  // Advances by one frame.
  void tick();
  // The next reported event.
  [[nodiscard]] std::optional<MetricEvent> take() { return outbox_.take(); }

  [[nodiscard]] Time now() const { return context_.now; }
  [[nodiscard]] const Vehicle& vehicle() const { return vehicle_; }

 private:
  // While the phone changes technology it receives nothing.
  struct Journey {
    Departure departure;
    Timer arrival;
  };

  void arrive(const Departure& departure);

  Outbox outbox_;
  Random random_;
  RadioMap map_;
  Propagation propagation_;
  Vehicle vehicle_;
  Traffic traffic_;
  Context context_;
  LteReports lteReports_;
  UmtsReports umtsReports_;
  GsmReports gsmReports_;
  NasReports nasReports_;
  NasContext nas_;
  LteModem lte_;
  UmtsModem umts_;
  GsmModem gsm_;
  Technology technology_ = Technology::lte;
  std::optional<Journey> journey_;
  Timer cardRead_;
};

}  // namespace vespscope::sources::scenario
