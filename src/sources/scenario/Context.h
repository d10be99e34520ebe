// The state that every part of the phone shares at a moment of the drive.
#pragma once

#include "sources/scenario/Clock.h"
#include "sources/scenario/Propagation.h"
#include "sources/scenario/RadioMap.h"
#include "sources/scenario/Random.h"
#include "sources/scenario/Traffic.h"

namespace vespscope::sources::scenario {

struct Context {
  Time now{0};
  const RadioMap& map;
  Propagation& propagation;
  Random& random;
  Demand demand{};

  // Moves the measurements to the car's place: call it before them, at most once per frame.
  void lookAround() {
    if (lookedAt == now) return;
    lookedAt = now;
    propagation.moveTo(place);
  }
  Place place{};
  Time lookedAt{-1};
};

// A modem's request to continue in another technology.
struct Departure {
  Technology to;
  bool connected;  // by handover, which keeps the connection
};

}  // namespace vespscope::sources::scenario
