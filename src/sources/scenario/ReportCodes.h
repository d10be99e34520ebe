// The raw codes of measurement reports that several technologies share.
#pragma once

#include <algorithm>
#include <cstdint>

#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {

[[nodiscard]] inline std::uint32_t code(double value, int highest) {
  return static_cast<std::uint32_t>(std::clamp(rounded(value), 0, highest));
}

// RSRP_00..97 for -140..-44 dBm and RSRQ_00..34 for -19.5..-3 dB, 3GPP TS 36.133 9.1.4 and 9.1.7.
[[nodiscard]] inline std::uint32_t rsrpCode(double dBm) { return code(dBm + 140, 97); }
[[nodiscard]] inline std::uint32_t rsrqCode(double dB) { return code((dB + 19.5) * 2, 34); }
// CPICH_RSCP_LEV_00..91 for -115..-25 dBm and CPICH_Ec/No_00..49 for -24..0 dB, TS 25.133 9.1.1.3 and 9.1.2.3.
[[nodiscard]] inline std::uint32_t rscpCode(double dBm) { return code(dBm + 116, 91); }
[[nodiscard]] inline std::uint32_t ecnoCode(double dB) { return code((dB + 24.5) * 2, 49); }
// RXLEV 0..63 for -110..-48 dBm, TS 45.008 8.1.4.
[[nodiscard]] inline std::uint32_t rxlevCode(double dBm) { return code(dBm + 110, 63); }

}  // namespace vespscope::sources::scenario
