// The levels that a phone reports to an NR cell.
//
// Levels are codes: of NR (3GPP TS 38.133 10.1) RSRP c is from c - 157 dBm to 1 dB more, RSRQ c from (c - 88) / 2 dB,
// SINR c from (c - 47) / 2 dB; of LTE those of 3GPP TS 36.133 9.1.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "rrc/Message.h"

namespace vespscope::rrc::nr {

struct Levels {
  std::optional<std::uint8_t> rsrp;  // of NR 0..127, of LTE 0..97
  std::optional<std::uint8_t> rsrq;  // of NR 0..127, of LTE 0..34
  std::optional<std::uint8_t> sinr;  // 0..127
  bool operator==(const Levels&) const = default;
};

struct MeasuredCell {
  std::optional<std::uint16_t> physicalCell;  // of NR 0..1007, of LTE 0..503
  Levels levels;                              // of NR: of the synchronisation blocks, else of the reference signals
};

struct ServingCell {
  std::uint8_t index = 0;  // 0..31
  MeasuredCell cell;
  std::optional<MeasuredCell> neighbour;  // the best on its frequency
};

struct MeasurementReport {
  std::uint8_t measurement = 0;  // identity, 1..64
  std::vector<ServingCell> serving;
  // Of these, at most one is filled.
  std::vector<MeasuredCell> nr;
  std::vector<MeasuredCell> lte;
};

// Nothing when the message is another.
[[nodiscard]] std::optional<MeasurementReport> measurementReportOf(const Message& message);
// `body` is a MeasurementReport inside another message, such as LTE's transfer of messages for NR.
[[nodiscard]] std::optional<MeasurementReport> measurementReportOf(const View& body);

}  // namespace vespscope::rrc::nr
