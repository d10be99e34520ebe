// What a cell broadcasts about itself: the master information block and system information block 1.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "rrc/lte/Plmn.h"

namespace vespscope::rrc::lte {

struct MasterInformation {
  std::uint8_t bandwidth = 0;      // downlink, in resource blocks: 6, 15, 25, 50, 75, 100
  bool extendedPhich = false;      // PHICH duration
  std::string_view phichResource;  // "oneSixth", "half", "one", "two"
  std::uint8_t frameNumber = 0;    // the upper 8 of its 10 bits
};

// TDD-Config.
struct TddConfiguration {
  std::uint8_t subframeAssignment = 0;      // 0..6
  std::uint8_t specialSubframePattern = 0;  // 0..8
};

struct SystemInformationSchedule {
  std::uint16_t period = 0;              // in radio frames
  std::vector<std::string_view> blocks;  // "sibType3"; empty names for those of later releases; block 2 is not listed
};

struct CellInformation {
  struct Network {
    Plmn plmn;
    bool reserved = false;  // for the operator's use
  };
  std::vector<Network> networks;
  std::uint16_t trackingAreaCode = 0;
  std::uint32_t cellIdentity = 0;  // 28 bits
  bool barred = false;
  bool intraFrequencyReselection = false;    // allowed when the cell is barred
  std::optional<std::uint32_t> csgIdentity;  // 27 bits; only for a closed subscriber group
  std::int8_t qRxLevMin = 0;                 // -70..-22, in 2 dBm
  std::uint8_t qRxLevMinOffset = 0;          // 0..8, in 2 dB
  std::optional<std::int8_t> qQualMin;       // -34..-3 dB
  std::optional<std::int8_t> maximumPower;   // -30..33 dBm
  std::uint16_t band = 0;                    // 1..256
  std::vector<std::uint16_t> moreBands;      // of the same carrier
  std::vector<SystemInformationSchedule> schedule;
  std::optional<TddConfiguration> tdd;
  std::uint8_t windowLength = 0;  // of system information, in ms
  std::uint8_t valueTag = 0;      // 0..31
};

// Nothing when the message is another.
[[nodiscard]] std::optional<MasterInformation> masterInformationOf(const Message& message);
[[nodiscard]] std::optional<CellInformation> cellInformationOf(const Message& message);
// `block` is a SystemInformationBlockType1, such as a reconfiguration's.
[[nodiscard]] CellInformation cellInformationOf(const View& block);

}  // namespace vespscope::rrc::lte
