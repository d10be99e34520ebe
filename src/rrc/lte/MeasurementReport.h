// The levels that a connected phone reports to the network.
//
// Levels are codes (3GPP TS 36.133 9.1, 25.133 9.1, 45.008 8.1.4, 38.133 10.1): LTE RSRP c is from c - 141 dBm to 1 dB
// more, LTE RSRQ c from (c - 40) / 2 dB to 0.5 dB more; UMTS RSCP c from c - 116 dBm, Ec/N0 c from (c - 49) / 2 dB; GSM
// RXLEV c from c - 111 dBm; NR RSRP c from c - 157 dBm, RSRQ c from (c - 88) / 2 dB, SINR c from (c - 47) / 2 dB.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "rrc/lte/Plmn.h"

namespace vespscope::rrc::lte {

struct Levels {
  std::optional<std::uint8_t> rsrp;  // 0..97
  std::optional<std::uint8_t> rsrq;  // 0..34
  std::optional<std::uint8_t> sinr;  // 0..127: from (c - 47) / 2 dB
  bool operator==(const Levels&) const = default;
};

struct LteNeighbour {
  std::uint16_t physicalCell = 0;  // 0..503
  Levels levels;
  // When the network has asked for it.
  std::optional<Plmn> plmn;
  std::optional<std::uint32_t> cellIdentity;
  std::optional<std::uint16_t> trackingAreaCode;
};

struct UmtsNeighbour {
  bool tdd = false;
  std::uint16_t scramblingCode = 0;  // 0..511; of TDD the cell parameter 0..127
  std::optional<std::int8_t> rscp;   // -5..91
  std::optional<std::uint8_t> ecNo;  // 0..49
};

struct GsmNeighbour {
  std::uint16_t channel = 0;  // ARFCN
  bool band1900 = false;
  std::uint8_t identityCode = 0;  // BSIC: network colour code * 8 + base station colour code
  std::uint8_t rxlev = 0;         // 0..63
};

struct NrLevels {
  std::optional<std::uint8_t> rsrp;  // 0..127
  std::optional<std::uint8_t> rsrq;  // 0..127
  std::optional<std::uint8_t> sinr;  // 0..127
};

struct NrNeighbour {
  std::uint16_t physicalCell = 0;  // 0..1007
  NrLevels levels;
};

// A serving cell beside the primary one, and the best neighbour on its frequency.
struct ServingFrequency {
  std::uint8_t index = 0;  // 0..31
  std::optional<Levels> cell;
  std::optional<LteNeighbour> neighbour;
};

struct NrServingFrequency {
  std::uint32_t carrier = 0;  // NR-ARFCN
  std::optional<NrNeighbour> cell;
  std::optional<NrNeighbour> neighbour;
};

struct MeasurementReport {
  std::uint8_t measurement = 0;  // identity, 1..64
  Levels primary;
  std::vector<ServingFrequency> serving;
  std::vector<NrServingFrequency> nrServing;
  // Of these, at most one is filled.
  std::vector<LteNeighbour> lte;
  std::vector<UmtsNeighbour> umts;
  std::vector<GsmNeighbour> gsm;
  std::vector<NrNeighbour> nr;
};

// Nothing when the message is another.
[[nodiscard]] std::optional<MeasurementReport> measurementReportOf(const Message& message);

}  // namespace vespscope::rrc::lte
