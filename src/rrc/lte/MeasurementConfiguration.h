// Which cells a phone measures, and when it reports them.
//
// The lists change what the phone has: they add or replace by identity, and remove.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "rrc/lte/Carriers.h"

namespace vespscope::rrc::lte {

struct MeasurementObject {
  enum class Technology : std::uint8_t { lte, umts, gsm, cdma2000, wlan, nr, later };
  struct Cell {
    std::uint8_t index = 0;          // 1..32
    std::uint16_t physicalCell = 0;  // 0..503
    std::int8_t offset = 0;          // dB
  };
  std::uint8_t id = 0;  // 1..64
  Technology technology = Technology::later;
  std::optional<std::uint32_t> carrier;  // of LTE, UMTS and NR: EARFCN, UARFCN, NR-ARFCN
  std::optional<GsmCarriers> gsmCarriers;
  std::optional<std::uint8_t> bandwidth;        // of LTE, in resource blocks
  std::int8_t offset = 0;                       // dB
  std::vector<Cell> cells;                      // of LTE
  std::optional<std::uint16_t> cellToIdentify;  // of LTE: whose global identity the phone reports
};

struct ReportConfiguration {
  // A level that an event compares with: "threshold-RSRP", "threshold-RSRQ", "utra-RSCP", "b1-ThresholdGERAN",
  // "nr-RSRP-r15", …, and its code (3GPP TS 36.133 9.1).
  struct Threshold {
    std::string_view quantity;
    std::int16_t code = 0;
  };
  std::uint8_t id = 0;  // 1..32
  bool interTechnology = false;
  std::string_view trigger;  // "eventA3", "eventB1-NR-r15", "periodical", …
  std::vector<Threshold> thresholds;
  std::optional<std::int8_t> offset;           // of A3 and A6, in 0.5 dB
  std::optional<std::uint8_t> hysteresis;      // in 0.5 dB
  std::optional<std::uint16_t> timeToTrigger;  // ms
  std::string_view purpose;                    // of a periodical report: "reportStrongestCells", "reportCGI", …
  std::string_view triggerQuantity;            // of LTE: "rsrp", "rsrq"
  std::uint8_t maximumCells = 0;               // 1..8
  std::uint32_t interval = 0;                  // ms; 0 for a spare value
  std::optional<std::uint8_t> amount;          // of reports; absent: without an end
};

struct MeasurementIdentity {
  std::uint8_t id = 0;  // 1..64
  std::uint8_t object = 0;
  std::uint8_t report = 0;
};

struct MeasurementConfiguration {
  std::vector<std::uint8_t> removedObjects;
  std::vector<MeasurementObject> objects;
  std::vector<std::uint8_t> removedReports;
  std::vector<ReportConfiguration> reports;
  std::vector<std::uint8_t> removedIdentities;
  std::vector<MeasurementIdentity> identities;
  std::optional<std::uint8_t> sMeasure;  // RSRP code 0..97: neighbours are measured below it; 0: always
};

// `configuration` is a MeasConfig.
[[nodiscard]] MeasurementConfiguration measurementConfigurationOf(const View& configuration);

}  // namespace vespscope::rrc::lte
