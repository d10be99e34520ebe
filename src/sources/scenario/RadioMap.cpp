#include "sources/scenario/RadioMap.h"

#include <algorithm>
#include <cmath>

#include "radio/CellIdentity.h"
#include "sources/scenario/Random.h"

namespace vespscope::sources::scenario {
namespace {

// The first hollow is short so that a new user sees every technology within two minutes.
constexpr std::array<Hollow, 4> hollows = {{
    {780, 1640, 1130, 1400, 80},
    {5600, 8200, 6400, 7200, 250},
    {12000, 14800, 12900, 14700, 300},
    {18600, 21200, 19400, 20300, 250},
}};

constexpr double spacing = 600;      // metres between neighbouring masts
constexpr double rowDistance = 520;  // spacing * sqrt(3) / 2
constexpr int columns = static_cast<int>(roadLength / spacing);
constexpr double mastGap = 150;        // metres around a hollow without masts of the missing technology
constexpr double deepLoss = 65;        // dB
constexpr double regionLength = 6000;  // metres of road in one tracking area

// The depth of a point relative to the hollow from `from` to `to`: 1 inside, falling to 0 over `ramp` outside.
double depth(double along, double from, double to, double ramp) {
  const double centre = (from + to) / 2;
  const double outside = std::fabs(alongFrom(centre, along)) - (to - from) / 2;
  return std::clamp(1 - outside / ramp, 0.0, 1.0);
}

bool nearHollow(double along, bool umts) {
  return std::any_of(hollows.begin(), hollows.end(), [&](const Hollow& hollow) {
    return depth(along, umts ? hollow.umtsFrom : hollow.lteFrom, umts ? hollow.umtsTo : hollow.lteTo, mastGap) > 0;
  });
}

}  // namespace

radio::Plmn operatorPlmn() {
  return *radio::Plmn::fromNumbers(mobileCountryCode, mobileNetworkCode, networkCodeDigits);
}

double alongFrom(double from, double to) {
  double way = std::fmod(to - from, roadLength);
  if (way > roadLength / 2) way -= roadLength;
  if (way < -roadLength / 2) way += roadLength;
  return way;
}

RadioMap::RadioMap(std::uint64_t seed)
    : seed_(hashOf(seed, 1)), numberOffset_(static_cast<std::uint32_t>(hashOf(seed, 2) % 168)) {
  Random random(hashOf(seed, 3));
  for (int column = 0; column < columns; ++column) {
    for (int row = -1; row <= 1; ++row) {
      Site site;
      const double shift = row == 0 ? 0 : spacing / 2;
      site.place.along = std::fmod(column * spacing + shift + random.uniform(-70, 70) + roadLength, roadLength);
      // Keeps masts off the road itself.
      const double aside = row == 0 ? random.uniform(80, 190) * (random.chance(0.5) ? 1 : -1) : random.uniform(-70, 70);
      site.place.lateral = row * rowDistance + aside;
      const bool second = (column + row) % 2 == 0;
      const bool capacity = random.chance(0.6);
      if (!nearHollow(site.place.along, false)) {
        site.layerMask |= 1U << lte1800 | 1U << lte800;
        if (capacity) site.layerMask |= 1U << lte2600;
      }
      if (!nearHollow(site.place.along, true)) {
        site.layerMask |= 1U << umts900;
        if (second) site.layerMask |= 1U << umts2100;
      }
      if (second) site.layerMask |= 1U << gsm900;
      sites_.push_back(site);
    }
  }
}

Place RadioMap::roadAt(double along) const {
  constexpr double bend = 800;
  return {along, 60 * smoothNoise(seed_, along, bend, static_cast<std::int64_t>(roadLength / bend))};
}

double RadioMap::hillLoss(LayerIndex layer, double along) {
  const Technology technology = layers[layer].technology;
  double deepest = 0;
  for (const Hollow& hollow : hollows) {
    const double inner = depth(along, hollow.umtsFrom, hollow.umtsTo, hollow.ramp);
    const double outer = depth(along, hollow.lteFrom, hollow.lteTo, hollow.ramp);
    const double loss = technology == Technology::lte    ? deepLoss * outer
                        : technology == Technology::umts ? deepLoss * inner + 6 * outer
                                                         : 12 * inner + 4 * outer;
    deepest = std::max(deepest, loss);
  }
  return deepest;
}

bool RadioMap::inTown(double along) { return hillLoss(lte1800, along) == 0; }

// Sites are numbered along the road, and the three cells of a site have consecutive numbers, so that the remainder by
// three, which selects the primary synchronization sequence, distinguishes the sectors.
std::uint32_t RadioMap::physicalCellId(const Cell& cell) const {
  return (cell.site + numberOffset_) % 168 * 3 + cell.sector;
}

std::uint32_t RadioMap::eutranCellId(const Cell& cell) const {
  const std::uint32_t eNodeB = 0x10400 + numberOffset_ * 128 + cell.site;
  return radio::EutraCellIdentity::fromParts(eNodeB, 10U * cell.layer + cell.sector + 1U)->number();
}

std::uint32_t RadioMap::regionOf(const Cell& cell) const {
  // A border is between two hollows; there is none where the drive begins.
  return static_cast<std::uint32_t>(std::fmod(sites_[cell.site].place.along + regionLength / 2, roadLength) /
                                    regionLength);
}

std::uint32_t RadioMap::trackingAreaCode(const Cell& cell) const { return 0x1A01 + regionOf(cell); }

std::uint32_t RadioMap::scramblingCode(const Cell& cell) const {
  return (3U * cell.site + cell.sector + 5 * numberOffset_) % 512;
}

std::uint32_t RadioMap::utranCellId(const Cell& cell) const {
  const std::uint32_t controller = 0x0C1 + regionOf(cell) / 2;
  const std::uint32_t number = 1000U + 20U * cell.site + 3U * (cell.layer - umts2100) + cell.sector + 1U;
  return radio::UtraCellIdentity::fromParts(controller, number)->number();
}

// Twelve BCCH carriers, every second channel, for the four sites of a cluster with three sectors each.
std::uint32_t RadioMap::arfcn(const Cell& cell) const { return 62 + 2 * (3U * (cell.site / 2 % 4) + cell.sector); }

// Network colour code 2; the base station colour code distinguishes clusters that use the same carriers.
std::uint32_t RadioMap::bsic(const Cell& cell) const { return 2U << 3U | (cell.site / 8 % 8); }

std::uint32_t RadioMap::geranCellId(const Cell& cell) const { return 20000U + 10U * cell.site + cell.sector + 1U; }

std::uint32_t RadioMap::locationAreaCode(const Cell& cell) const {
  const std::uint32_t base = layers[cell.layer].technology == Technology::gsm ? 0x2C01 : 0x2B01;
  return base + regionOf(cell) / 2;
}

std::uint32_t RadioMap::routingAreaCode(const Cell& cell) const { return 11 + regionOf(cell); }

}  // namespace vespscope::sources::scenario
