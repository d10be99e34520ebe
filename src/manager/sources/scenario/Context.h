// What every part of the phone needs to know at a moment of the drive.
#pragma once

#include "manager/sources/scenario/Clock.h"
#include "manager/sources/scenario/Propagation.h"
#include "manager/sources/scenario/RadioMap.h"
#include "manager/sources/scenario/Random.h"
#include "manager/sources/scenario/Traffic.h"

namespace vespscope::manager::scenario {

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

}  // namespace vespscope::manager::scenario
