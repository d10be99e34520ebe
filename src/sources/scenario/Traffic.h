// The user's activity: data sessions and voice calls.
#pragma once

#include <optional>
#include <vector>

#include "sources/scenario/Clock.h"
#include "sources/scenario/RadioMap.h"
#include "sources/scenario/Random.h"

namespace vespscope::sources::scenario {

// The reasons for a connection at this moment.
struct Demand {
  bool data = false;
  bool burst = false;  // much data at once
  bool voice = false;
  bool mobileTerminated = false;  // the network pages for the data or the call
  bool signalling = false;        // for mobility management
  [[nodiscard]] bool any() const { return data || voice || signalling; }
};

class Traffic {
 public:
  explicit Traffic(std::uint64_t seed);

  void tick(Time now);
  // Called when the phone has camped on another technology.
  void entered(Technology technology, Time now);
  [[nodiscard]] const Demand& demand() const { return demand_; }

 private:
  struct Span {
    Time from{0}, to{0};
    [[nodiscard]] bool covers(Time now) const { return from <= now && now < to; }
  };

  Random random_;
  Span data_;
  Span voice_;
  Span burst_;
  bool dataTerminated_ = false;
  bool voiceTerminated_ = false;
  bool calledInGsm_ = false;
  Demand demand_;
};

}  // namespace vespscope::sources::scenario
