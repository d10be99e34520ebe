// Random numbers that are the same with every compiler and library.
#pragma once

#include <cstdint>
#include <random>

namespace vespscope::bench {

class Random {
 public:
  explicit Random(std::uint32_t seed) : engine_(seed) {}

  // A number from 0 to `count` - 1.
  [[nodiscard]] std::uint64_t below(std::uint64_t count) { return engine_() % count; }
  // True in this share of cases.
  [[nodiscard]] bool chance(double share) {
    return static_cast<double>(engine_() >> 11) < share * static_cast<double>(std::uint64_t{1} << 53);
  }

 private:
  std::mt19937_64 engine_;  // the standard fixes its numbers, but not what distributions make of them
};

}  // namespace vespscope::bench
