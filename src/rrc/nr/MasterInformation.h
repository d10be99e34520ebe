// The master information block of an NR cell.
#pragma once

#include <cstdint>
#include <optional>

#include "rrc/Message.h"

namespace vespscope::rrc::nr {

struct MasterInformation {
  std::uint8_t frameNumber = 0;         // the upper 6 of its 10 bits
  bool wideSpacing = false;             // of subcarriers: 30 kHz below 6 GHz, 120 kHz above; else 15 and 60 kHz
  std::uint8_t subcarrierOffset = 0;    // of the synchronisation block, 0..15
  std::uint8_t controlResourceSet = 0;  // 0..15
  std::uint8_t searchSpace = 0;         // 0..15
  bool barred = false;
  bool intraFrequencyReselection = false;  // allowed when the cell is barred
};

// Nothing when the message is another.
[[nodiscard]] std::optional<MasterInformation> masterInformationOf(const Message& message);

}  // namespace vespscope::rrc::nr
