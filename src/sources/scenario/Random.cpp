#include "sources/scenario/Random.h"

#include <cmath>

#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

constexpr std::uint64_t golden = 0x9E3779B97F4A7C15U;

std::uint64_t mixed(std::uint64_t bits) {
  bits = (bits ^ (bits >> 30U)) * 0xBF58476D1CE4E5B9U;
  bits = (bits ^ (bits >> 27U)) * 0x94D049BB133111EBU;
  return bits ^ (bits >> 31U);
}

}  // namespace

std::uint64_t Random::next() {
  state_ += golden;
  return mixed(state_);
}

double Random::uniform() { return uniformOf(next()); }

std::int64_t Random::between(std::int64_t low, std::int64_t high) {
  return low + static_cast<std::int64_t>(next() % static_cast<std::uint64_t>(high - low + 1));
}

double Random::normal() { return normalOf(next()); }

double Random::exponential(double mean) { return -mean * naturalLog(1 - uniform()); }

std::uint64_t hashOf(std::uint64_t seed, std::uint64_t key) { return mixed(seed + golden * (mixed(key) + 1)); }

double uniformOf(std::uint64_t bits) { return static_cast<double>(bits >> 11U) * 0x1p-53; }

// The sum of four uniform numbers of 16 bits, scaled to variance 1.
double normalOf(std::uint64_t bits) {
  const auto sum = (bits & 0xFFFFU) + ((bits >> 16U) & 0xFFFFU) + ((bits >> 32U) & 0xFFFFU) + (bits >> 48U);
  return (static_cast<double>(sum) / 65535.0 - 2) * 1.7320508075688772;
}

double smoothNoise(std::uint64_t seed, double position, double step, std::int64_t count) {
  const double scaled = position / step;
  const double floor = std::floor(scaled);
  const double weight = scaled - floor;
  const auto index = static_cast<std::int64_t>(floor);
  const auto at = [&](std::int64_t i) {
    return normalOf(hashOf(seed, static_cast<std::uint64_t>(((i % count) + count) % count)));
  };
  const double mixture = at(index) * (1 - weight) + at(index + 1) * weight;
  return mixture / std::sqrt((1 - weight) * (1 - weight) + weight * weight);
}

}  // namespace vespscope::sources::scenario
