#include "sources/scenario/Propagation.h"

#include <algorithm>
#include <cmath>

#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

constexpr double range = 2400;            // metres beyond which a mast is not received
constexpr double antennaGain = 15;        // dBi, less the cable loss
constexpr double carLoss = 5;             // dB through the car's body
constexpr double shadowDeviation = 6.5;   // dB
constexpr double shadowStep = 50;         // metres of road over which shadowing changes, TR 36.814 table B.1.2.1-4
constexpr double layerDeviation = 1.5;    // dB by which layers on one mast differ in shadowing
constexpr double measurementError = 0.7;  // dB left of fast fading after filtering

constexpr double lteNoise = -125.2;  // dBm in a resource element of 15 kHz with a noise figure of 7 dB
constexpr double gsmNoise = -112;    // dBm in 200 kHz with a noise figure of 9 dB

constexpr std::int64_t shadowSteps = static_cast<std::int64_t>(roadLength / shadowStep);

// Patterns of a sector antenna with beams 70 degrees wide and 10 degrees high, TR 36.814 table A.2.1.1-2, tilted down
// by 8 degrees on a mast 28 m above the car.
double horizontalLoss(double cosine) {
  const double ratio = arcCosine(cosine) / 70;
  return std::min(12 * ratio * ratio, 25.0);
}
double verticalLoss(double distance) {
  constexpr double height = 25;
  const double ratio = (arcCosine(distance / std::sqrt(distance * distance + height * height)) - 7) / 10;
  return std::min(12 * ratio * ratio, 15.0);
}

struct Direction {
  double along, lateral;
};
// Main directions of the three sectors, 120 degrees apart.
constexpr std::array<Direction, sectorsPerSite> sectorDirections = {{
    {0.8660254037844386, 0.5},
    {-0.8660254037844386, 0.5},
    {0, -1},
}};

}  // namespace

Propagation::Propagation(const RadioMap& map, std::uint64_t seed) : map_(map), seed_(hashOf(seed, 4)) {}

void Propagation::moveTo(const Place& place) {
  along_ = place.along;
  paths_.clear();
  const double common = smoothNoise(seed_, along_, shadowStep, shadowSteps);
  for (std::size_t site = 0; site < map_.siteCount(); ++site) {
    const Place& mast = map_.site(site);
    const double along = alongFrom(mast.along, place.along);
    if (std::fabs(along) > range) continue;
    const double lateral = place.lateral - mast.lateral;
    const double distance = std::max(40.0, std::sqrt(along * along + lateral * lateral));
    // Half of the shadowing is caused near the car and common to all masts, TR 36.942 4.5.2.
    const double own = smoothNoise(hashOf(seed_, site + 1), along_, shadowStep, shadowSteps);
    const double shadow = shadowDeviation * 0.7071067811865476 * (common + own);
    Path path{static_cast<std::uint16_t>(site), 0, {}};
    // Macro cell model of TR 36.942 4.5.2 with antennas 15 m above the roofs, without its frequency term.
    path.loss = 58.8 + 3.76 * decibels(distance / 1000) + shadow;
    const double vertical = verticalLoss(distance);
    for (std::size_t sector = 0; sector < sectorsPerSite; ++sector) {
      const Direction& main = sectorDirections[sector];
      const double horizontal = horizontalLoss((along * main.along + lateral * main.lateral) / distance);
      path.antenna[sector] = antennaGain - std::min(horizontal + vertical, 25.0);
    }
    paths_.push_back(path);
  }
}

double Propagation::fixedPower(LayerIndex layer) const {
  const Layer& carrier = layers[layer];
  return carrier.pilotPower - 2.1 * decibels(carrier.megahertz) - carLoss - RadioMap::hillLoss(layer, along_);
}

double Propagation::siteLoss(const Path& path, LayerIndex layer) const {
  const std::uint64_t key = 0x10000U + path.site * 8U + layer;
  return path.loss + layerDeviation * smoothNoise(hashOf(seed_, key), along_, shadowStep, shadowSteps);
}

// The share of its resources that a cell uses, 0.08..0.9; it changes within half a minute.
double Propagation::loadOf(const Cell& cell, Time now) const {
  const std::uint64_t key = 0x20000U + (cell.site * 4U + cell.sector) * 8U + cell.layer;
  const double seconds = static_cast<double>(now.count()) / 1000;
  constexpr std::int64_t wholeDay = 2880;
  return std::clamp(0.3 + 0.15 * smoothNoise(hashOf(seed_, key), seconds, 30, wholeDay), 0.08, 0.9);
}

std::vector<LteLevel> Propagation::lte(LayerIndex layer, Time now, Random& random) const {
  struct Heard {
    double pilot, occupied;  // mW in a resource element: reference signal, mean over all elements
  };
  std::vector<LteLevel> levels;
  std::vector<Heard> heard;
  const double noise = ratioOf(lteNoise);
  const double fixed = fixedPower(layer);
  double total = noise;
  for (const Path& path : paths_) {
    if (!map_.hosts(path.site, layer)) continue;
    const double site = fixed - siteLoss(path, layer);
    for (std::uint8_t sector = 0; sector < sectorsPerSite; ++sector) {
      LteLevel level;
      level.cell = {layer, sector, path.site};
      level.rsrp = site + path.antenna[sector] + measurementError * random.normal();
      const double pilot = ratioOf(level.rsrp);
      // A sixth of the elements of a symbol with reference signals is always sent, the others in proportion to the
      // load.
      const double occupied = pilot * (1.0 / 6 + 5.0 / 6 * loadOf(level.cell, now));
      total += occupied;
      levels.push_back(level);
      heard.push_back({pilot, occupied});
    }
  }
  const double blocks = layers[layer].resourceBlocks;
  const double rssi = decibels(total * 12 * blocks);
  for (std::size_t i = 0; i < levels.size(); ++i) {
    levels[i].rssi = rssi;
    levels[i].rsrq = decibels(blocks) + levels[i].rsrp - rssi;
    levels[i].sinr = std::clamp(decibels(heard[i].pilot / (total - heard[i].occupied)), -20.0, 30.0);
  }
  std::sort(levels.begin(), levels.end(), [](const LteLevel& a, const LteLevel& b) { return a.rsrp > b.rsrp; });
  return levels;
}

std::vector<UmtsLevel> Propagation::umts(LayerIndex layer, Time now, Random& random) const {
  std::vector<UmtsLevel> levels;
  const double fixed = fixedPower(layer);
  double total = ratioOf(umtsNoise);
  for (const Path& path : paths_) {
    if (!map_.hosts(path.site, layer)) continue;
    const double site = fixed - siteLoss(path, layer);
    for (std::uint8_t sector = 0; sector < sectorsPerSite; ++sector) {
      UmtsLevel level;
      level.cell = {layer, sector, path.site};
      level.rscp = site + path.antenna[sector] + measurementError * random.normal();
      // The CPICH and the other common channels use a fifth of the mast's 43 dBm, the rest depends on the load.
      total += 10 * ratioOf(level.rscp) * (0.2 + 0.8 * loadOf(level.cell, now));
      levels.push_back(level);
    }
  }
  const double rssi = decibels(total);
  for (UmtsLevel& level : levels) {
    level.rssi = rssi;
    level.ecno = level.rscp - rssi;
  }
  std::sort(levels.begin(), levels.end(), [](const UmtsLevel& a, const UmtsLevel& b) { return a.rscp > b.rscp; });
  return levels;
}

std::vector<GsmLevel> Propagation::gsm(Random& random) const {
  std::vector<GsmLevel> levels;
  const double fixed = fixedPower(gsm900);
  for (const Path& path : paths_) {
    if (!map_.hosts(path.site, gsm900)) continue;
    const double site = fixed - siteLoss(path, gsm900);
    for (std::uint8_t sector = 0; sector < sectorsPerSite; ++sector) {
      GsmLevel level;
      level.cell = {gsm900, sector, path.site};
      level.rxlev = site + path.antenna[sector] + measurementError * random.normal();
      levels.push_back(level);
    }
  }
  const double noise = ratioOf(gsmNoise);
  for (GsmLevel& level : levels) {
    double interference = noise;
    for (const GsmLevel& other : levels) {
      if (other.cell != level.cell && map_.arfcn(other.cell) == map_.arfcn(level.cell)) {
        interference += ratioOf(other.rxlev);
      }
    }
    level.carrierToInterference = level.rxlev - decibels(interference);
  }
  std::sort(levels.begin(), levels.end(), [](const GsmLevel& a, const GsmLevel& b) { return a.rxlev > b.rxlev; });
  return levels;
}

}  // namespace vespscope::sources::scenario
