// Random numbers that are the same on every machine, unlike those of the standard distributions.
#pragma once

#include <cstdint>

namespace vespscope::sources::scenario {

// A sequence of random numbers (SplitMix64).
class Random {
 public:
  explicit Random(std::uint64_t seed) : state_(seed) {}

  std::uint64_t next();
  double uniform();  // 0 <= x < 1
  double uniform(double low, double high) { return low + (high - low) * uniform(); }
  std::int64_t between(std::int64_t low, std::int64_t high);  // both ends included
  bool chance(double probability) { return uniform() < probability; }
  double normal();  // mean 0, variance 1, never beyond 3.5
  double exponential(double mean);

 private:
  std::uint64_t state_;
};

// One fixed random number for each pair of arguments.
[[nodiscard]] std::uint64_t hashOf(std::uint64_t seed, std::uint64_t key);
[[nodiscard]] double uniformOf(std::uint64_t bits);  // 0 <= x < 1
[[nodiscard]] double normalOf(std::uint64_t bits);   // mean 0, variance 1, never beyond 3.5

// A curve of mean 0 and variance 1 that takes a new value every `step` and repeats after `count` steps.
[[nodiscard]] double smoothNoise(std::uint64_t seed, double position, double step, std::int64_t count);

}  // namespace vespscope::sources::scenario
