// What system information says about access and about the choice of cells while idle: blocks 2, 3, 5, 6 and 7.
//
// Thresholds "in 2 dB" are codes 0..31; priorities are 0..7, and 7 is the highest (3GPP TS 36.304 5.2.4).
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "rrc/lte/Carriers.h"

namespace vespscope::rrc::lte {

// AC-BarringConfig.
struct AccessBarring {
  std::uint8_t factor = 0;          // the percentage of attempts that pass: 0..95
  std::uint16_t time = 0;           // mean, in s: 4..512
  std::uint8_t specialClasses = 0;  // 5 bits: access classes 11..15, the highest bit is 11
};

// Block 2.
struct AccessInformation {
  bool emergencyBarred = false;
  std::optional<AccessBarring> signalling;
  std::optional<AccessBarring> data;
  std::optional<AccessBarring> csFallback;
  std::optional<std::uint16_t> uplinkCarrier;   // EARFCN; absent: as the band's default duplex distance has it
  std::optional<std::uint8_t> uplinkBandwidth;  // in resource blocks; absent: as the downlink
};

// Block 3.
struct ServingReselection {
  std::uint8_t hysteresis = 0;                    // dB
  std::optional<std::uint8_t> sNonIntraSearch;    // in 2 dB
  std::uint8_t threshServingLow = 0;              // in 2 dB
  std::optional<std::uint8_t> threshServingLowQ;  // dB
  std::uint8_t priority = 0;
  std::int8_t qRxLevMin = 0;                      // -70..-22, in 2 dBm
  std::optional<std::int8_t> qQualMin;            // dB
  std::optional<std::int8_t> maximumPower;        // dBm
  std::optional<std::uint8_t> sIntraSearch;       // in 2 dB
  std::optional<std::uint8_t> sIntraSearchP;      // in 2 dB, of release 9 on, in place of sIntraSearch
  std::optional<std::uint8_t> sIntraSearchQ;      // dB
  std::optional<std::uint8_t> sNonIntraSearchP;   // in 2 dB, of release 9 on, in place of sNonIntraSearch
  std::optional<std::uint8_t> sNonIntraSearchQ;   // dB
  std::optional<std::uint8_t> measuredBandwidth;  // in resource blocks
  bool antennaPort1 = false;                      // all neighbours have at least two antenna ports
  std::uint8_t neighbourConfiguration = 0;        // 2 bits
  std::uint8_t reselectionTime = 0;               // s
};

// Block 5: an LTE frequency with its neighbours.
struct LteNeighbourFrequency {
  struct Cell {
    std::uint16_t physicalCell = 0;  // 0..503
    std::int8_t offset = 0;          // dB
  };
  std::uint32_t carrier = 0;                 // EARFCN
  std::int8_t qRxLevMin = 0;                 // -70..-22, in 2 dBm
  std::optional<std::int8_t> qQualMin;       // dB
  std::optional<std::int8_t> maximumPower;   // dBm
  std::uint8_t reselectionTime = 0;          // s
  std::uint8_t threshXHigh = 0;              // in 2 dB
  std::uint8_t threshXLow = 0;               // in 2 dB
  std::optional<std::uint8_t> threshXHighQ;  // dB
  std::optional<std::uint8_t> threshXLowQ;   // dB
  std::uint8_t measuredBandwidth = 0;        // in resource blocks
  bool antennaPort1 = false;
  std::optional<std::uint8_t> priority;
  std::uint8_t neighbourConfiguration = 0;  // 2 bits
  std::int8_t offset = 0;                   // dB
  std::vector<Cell> cells;
  std::vector<CellRange> excludedCells;
};

// Block 6: a UMTS frequency.
struct UmtsNeighbourFrequency {
  bool tdd = false;
  std::uint16_t carrier = 0;  // UARFCN
  std::optional<std::uint8_t> priority;
  std::uint8_t threshXHigh = 0;         // in 2 dB
  std::uint8_t threshXLow = 0;          // in 2 dB
  std::int8_t qRxLevMin = 0;            // -60..-13: dBm = 2 * value + 1
  std::int8_t maximumPower = 0;         // dBm
  std::optional<std::int8_t> qQualMin;  // dB; FDD only
};

// Block 7: a group of GSM frequencies.
struct GsmNeighbourFrequencies {
  GsmCarriers carriers;
  std::optional<std::uint8_t> priority;
  std::uint8_t permittedColourCodes = 0;     // 8 bits: network colour codes 0..7, the highest bit is 0
  std::uint8_t qRxLevMin = 0;                // 0..45: dBm = 2 * value - 115
  std::optional<std::uint8_t> maximumPower;  // dBm
  std::uint8_t threshXHigh = 0;              // in 2 dB
  std::uint8_t threshXLow = 0;               // in 2 dB
};

// The blocks of one system information message.
struct SystemInformation {
  std::optional<AccessInformation> access;
  std::optional<ServingReselection> serving;
  std::optional<std::vector<LteNeighbourFrequency>> lte;
  std::optional<std::vector<UmtsNeighbourFrequency>> umts;
  std::optional<std::uint8_t> umtsReselectionTime;  // s
  std::optional<std::vector<GsmNeighbourFrequencies>> gsm;
  std::optional<std::uint8_t> gsmReselectionTime;  // s
};

// Nothing when the message is another.
[[nodiscard]] std::optional<SystemInformation> systemInformationOf(const Message& message);

}  // namespace vespscope::rrc::lte
