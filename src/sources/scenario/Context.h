// What every part of the phone needs to know at a moment of the drive.
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

  // Measurements are made where the car is: to be called before them, once in a frame at most.
  void lookAround() {
    if (lookedAt == now) return;
    lookedAt = now;
    propagation.moveTo(place);
  }
  Place place{};
  Time lookedAt{-1};
};

// A modem's wish to go on in another technology.
struct Departure {
  Technology to;
  bool connected;  // with the connection kept, by handover
};

}  // namespace vespscope::sources::scenario
