// The scales of LTE's measured levels in log records.
#pragma once

#include <cstdint>

namespace vespscope::sources::diag {

constexpr double rsrpOf(std::uint32_t raw) { return raw / 16.0 - 180.0; }  // dBm
constexpr double rsrqOf(std::uint32_t raw) { return raw / 16.0 - 30.0; }   // dB
constexpr double rssiOf(std::uint32_t raw) { return raw / 16.0 - 110.0; }  // dBm
constexpr double snrOf(std::uint32_t raw) { return raw / 10.0 - 20.0; }    // dB

// `width` bits of `word` above the lowest `shift`.
constexpr std::uint32_t bits(std::uint32_t word, unsigned shift, unsigned width) {
  return word >> shift & ((1U << width) - 1);
}

}  // namespace vespscope::sources::diag
