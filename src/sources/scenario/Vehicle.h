// The car that carries the phone along the ring road, with traffic lights in town.
#pragma once

#include "sources/scenario/Clock.h"
#include "sources/scenario/Random.h"

namespace vespscope::sources::scenario {

class Vehicle {
 public:
  explicit Vehicle(std::uint64_t seed);

  // Advances by one frame.
  void tick(Time now);

  [[nodiscard]] double along() const { return along_; }  // metres from the road's zero mark
  [[nodiscard]] double speed() const { return speed_; }  // metres per second

 private:
  void chooseNextLight();

  std::uint64_t seed_;
  Random random_;
  double along_;
  double speed_ = 0;
  double toLight_ = 0;  // metres to the next traffic light
  bool lightIsRed_ = false;
  Timer red_;  // while the car waits at it
};

}  // namespace vespscope::sources::scenario
