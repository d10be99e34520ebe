// The signals that a phone in the car receives from every cell around it, by link budget.
#pragma once

#include <array>
#include <cstdint>
#include <vector>

#include "sources/scenario/Clock.h"
#include "sources/scenario/RadioMap.h"
#include "sources/scenario/Random.h"

namespace vespscope::sources::scenario {

// The levels of an LTE cell, defined as in 3GPP TS 36.214 5.1: rsrq = N * rsrp / rssi holds exactly.
struct LteLevel {
  Cell cell;
  double rsrp = -140;   // dBm
  double rsrq = -19.5;  // dB
  double rssi = -100;   // dBm over the carrier
  double sinr = -20;    // dB
};

// The levels of a UMTS cell, TS 25.215 5.1: ecno = rscp - rssi holds exactly.
struct UmtsLevel {
  Cell cell;
  double rscp = -120;   // dBm
  double ecno = -24.5;  // dB
  double rssi = -100;   // dBm
};

struct GsmLevel {
  Cell cell;
  double rxlev = -110;               // dBm
  double carrierToInterference = 0;  // dB
};

inline constexpr double umtsNoise = -100.2;  // dBm in 3.84 MHz with a noise figure of 8 dB

class Propagation {
 public:
  Propagation(const RadioMap& map, std::uint64_t seed);

  // Computes the paths to every mast in range of a place, where the measurements below are made.
  void moveTo(const Place& place);

  // The cells of a layer, strongest first. Each call is a measurement with its own error.
  [[nodiscard]] std::vector<LteLevel> lte(LayerIndex layer, Time now, Random& random) const;
  [[nodiscard]] std::vector<UmtsLevel> umts(LayerIndex layer, Time now, Random& random) const;
  [[nodiscard]] std::vector<GsmLevel> gsm(Random& random) const;

 private:
  // The path to a mast, without the parts that depend on the layer.
  struct Path {
    std::uint16_t site;
    double loss;                                 // dB
    std::array<double, sectorsPerSite> antenna;  // dB: gain of each sector's antenna into this direction
  };

  [[nodiscard]] double siteLoss(const Path& path, LayerIndex layer) const;
  [[nodiscard]] double fixedPower(LayerIndex layer) const;
  [[nodiscard]] double loadOf(const Cell& cell, Time now) const;

  const RadioMap& map_;
  std::uint64_t seed_;
  std::vector<Path> paths_;
  double along_ = 0;
};

}  // namespace vespscope::sources::scenario
