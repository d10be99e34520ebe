#include "sources/scenario/Vehicle.h"

#include <algorithm>
#include <cmath>

#include "sources/scenario/RadioMap.h"

namespace vespscope::sources::scenario {
namespace {

constexpr double begin = 240;         // metres along the road at which the drive begins
constexpr double firstLight = 2200;   // metres without traffic lights at the beginning, through the first hollow
constexpr double acceleration = 1.7;  // m/s^2
constexpr double deceleration = 2.2;  // m/s^2
constexpr double speedStep = 600;     // metres of road over which the speed of the traffic changes
constexpr double seconds = 0.01;      // one frame

}  // namespace

Vehicle::Vehicle(std::uint64_t seed)
    : seed_(hashOf(seed, 10)), random_(hashOf(seed, 11)), along_(begin), toLight_(firstLight) {}

void Vehicle::chooseNextLight() {
  toLight_ = random_.uniform(250, 900);
  lightIsRed_ = random_.chance(0.45) && RadioMap::inTown(std::fmod(along_ + toLight_, roadLength));
}

void Vehicle::tick(Time now) {
  if (red_.running()) {
    if (!red_.expired(now)) return;
    chooseNextLight();
  }
  const double mean = RadioMap::inTown(along_) ? 13.5 : 16;
  const double flow = smoothNoise(seed_, along_, speedStep, static_cast<std::int64_t>(roadLength / speedStep));
  double wanted = std::clamp(mean + (toLight_ > 1500 ? 0.3 : 2.0) * flow, 7.0, 22.0);
  if (lightIsRed_) wanted = std::min(wanted, std::sqrt(2 * deceleration * std::max(0.0, toLight_ - 1)));
  speed_ += std::clamp(wanted - speed_, -1.5 * deceleration * seconds, acceleration * seconds);
  if (lightIsRed_ && toLight_ < 2) speed_ = 0;
  along_ += speed_ * seconds;
  if (along_ >= roadLength) along_ -= roadLength;
  toLight_ -= speed_ * seconds;
  if (speed_ == 0 && lightIsRed_) {
    red_.start(now, Time(random_.between(6000, 32000)));
  } else if (toLight_ <= 0) {
    chooseNextLight();
  }
}

}  // namespace vespscope::sources::scenario
