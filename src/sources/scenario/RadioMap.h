// The area of the simulated drive: a ring road, masts in a hexagonal grid next to it, and their cells.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "radio/Plmn.h"

namespace vespscope::sources::scenario {

enum class Technology : std::uint8_t { lte, umts, gsm };

// A carrier frequency of the operator.
struct Layer {
  Technology technology;
  std::uint32_t downlink;        // EARFCN (3GPP TS 36.101 5.7.3) or UARFCN (TS 25.101 5.4); a GSM cell has its own
  std::uint32_t uplink;          // the same, of the paired uplink
  std::uint32_t band;            // number of the operating band, as in TS 36.101 5.5 and TS 25.101 5.2
  double megahertz;              // centre of the downlink
  double pilotPower;             // dBm: one resource element (LTE), the primary CPICH (UMTS), the BCCH (GSM)
  std::uint32_t resourceBlocks;  // LTE: transmission bandwidth, TS 36.101 5.6
  std::uint32_t bandwidthMhz;    // LTE
  std::uint32_t bandwidthCode;   // LTE: 0..5 for 1.4, 3, 5, 10, 15, 20 MHz
  std::uint32_t priority;        // cell reselection priority, 0..7
};

using LayerIndex = std::uint8_t;
inline constexpr LayerIndex lte1800 = 0;
inline constexpr LayerIndex lte2600 = 1;
inline constexpr LayerIndex lte800 = 2;
inline constexpr LayerIndex umts2100 = 3;
inline constexpr LayerIndex umts900 = 4;
inline constexpr LayerIndex gsm900 = 5;

inline constexpr std::array<Layer, 6> layers = {{
    {Technology::lte, 1300, 19300, 3, 1815.0, 15, 100, 20, 5, 6},
    {Technology::lte, 2850, 20850, 7, 2630.0, 15, 100, 20, 5, 5},
    {Technology::lte, 6300, 24300, 20, 806.0, 15, 50, 10, 3, 4},
    {Technology::umts, 10713, 9763, 1, 2142.6, 33, 0, 0, 0, 3},
    {Technology::umts, 3013, 2788, 8, 942.6, 33, 0, 0, 0, 2},
    {Technology::gsm, 0, 0, 0, 947.0, 43, 0, 0, 0, 1},
}};
inline constexpr std::array<LayerIndex, 3> lteLayers = {lte1800, lte2600, lte800};
inline constexpr std::array<LayerIndex, 2> umtsLayers = {umts2100, umts900};

inline constexpr std::uint32_t mobileCountryCode = 1;  // 001 and 01: the test network of TS 36.508 4.4.2
inline constexpr std::uint32_t mobileNetworkCode = 1;
inline constexpr std::uint32_t networkCodeDigits = 2;
[[nodiscard]] radio::Plmn operatorPlmn();

inline constexpr double roadLength = 24000;  // metres around the ring

// A point given by the distance along the road from its zero mark, 0..roadLength, and by the distance to the left of
// its axis (metres).
struct Place {
  double along = 0;
  double lateral = 0;
};

// The shorter way along the ring from one point to another, -roadLength/2..roadLength/2 (metres).
[[nodiscard]] double alongFrom(double from, double to);

// A stretch in a cutting between hills, in which LTE fades and, farther inside, UMTS too (metres along).
struct Hollow {
  double lteFrom, lteTo;
  double umtsFrom, umtsTo;
  double ramp;  // over which the loss rises from zero to its maximum
};

inline constexpr std::size_t sectorsPerSite = 3;

struct Cell {
  LayerIndex layer = 0;
  std::uint8_t sector = 0;  // 0..2
  std::uint16_t site = 0;
  friend bool operator==(const Cell&, const Cell&) = default;
};

class RadioMap {
 public:
  explicit RadioMap(std::uint64_t seed);

  // The position of the road's axis at a distance `along` it: the road meanders.
  [[nodiscard]] Place roadAt(double along) const;
  // The loss that hills cause at that distance (dB).
  [[nodiscard]] static double hillLoss(LayerIndex layer, double along);
  // Whether that point is in a town, which has traffic lights.
  [[nodiscard]] static bool inTown(double along);

  [[nodiscard]] std::size_t siteCount() const { return sites_.size(); }
  [[nodiscard]] const Place& site(std::size_t index) const { return sites_[index].place; }
  [[nodiscard]] bool hosts(std::size_t site, LayerIndex layer) const {
    return ((sites_[site].layerMask >> layer) & 1U) != 0;
  }

  [[nodiscard]] std::uint32_t physicalCellId(const Cell& cell) const;  // 0..503, TS 36.211 6.11
  [[nodiscard]] std::uint32_t eutranCellId(const Cell& cell) const;    // 28 bits: eNB 20, cell 8, TS 36.413 9.2.1.38
  [[nodiscard]] std::uint32_t trackingAreaCode(const Cell& cell) const;
  [[nodiscard]] std::uint32_t scramblingCode(const Cell& cell) const;    // 0..511, TS 25.331 10.3.6.60
  [[nodiscard]] std::uint32_t utranCellId(const Cell& cell) const;       // 28 bits: RNC 12, cell 16
  [[nodiscard]] std::uint32_t arfcn(const Cell& cell) const;             // 1..124, TS 45.005 2
  [[nodiscard]] std::uint32_t bsic(const Cell& cell) const;              // 0..63, TS 23.003 4.3.2
  [[nodiscard]] std::uint32_t geranCellId(const Cell& cell) const;       // 16 bits
  [[nodiscard]] std::uint32_t locationAreaCode(const Cell& cell) const;  // for LTE, of the combined attach
  [[nodiscard]] std::uint32_t routingAreaCode(const Cell& cell) const;

 private:
  struct Site {
    Place place;
    std::uint32_t layerMask = 0;
  };

  [[nodiscard]] std::uint32_t regionOf(const Cell& cell) const;

  std::uint64_t seed_;
  std::uint32_t numberOffset_;  // start of this operator's numbering
  std::vector<Site> sites_;
};

}  // namespace vespscope::sources::scenario
