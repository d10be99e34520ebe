// Measured levels as the metric messages carry them. Empty for a level that a phone cannot have measured: modems
// write zeros for an antenna that did not measure.
#pragma once

#include <cmath>
#include <cstdint>
#include <optional>

namespace vespscope::sources::diag {

// The extended reporting range, 3GPP TS 36.133 9.1.4.
[[nodiscard]] inline bool isRsrp(double dBm) { return dBm >= -156 && dBm <= -44; }
// The extended reporting range, 3GPP TS 36.133 9.1.7.
[[nodiscard]] inline bool isRsrq(double dB) { return dB >= -34 && dB <= 2.5; }

[[nodiscard]] inline std::int32_t rounded(double number) { return static_cast<std::int32_t>(std::lround(number)); }

// SINR in half-dB steps.
[[nodiscard]] inline std::int32_t sinrSteps(double dB) { return rounded(dB * 2); }
// RSRP and RSRQ as reporting codes: dBm + 140, and half-dB steps from -19.5 dB.
[[nodiscard]] inline std::int32_t rsrpCode(double dBm) { return rounded(dBm) + 140; }
[[nodiscard]] inline std::int32_t rsrqCode(double dB) { return rounded((dB + 19.5) * 2); }
// Hundredths of dBm or dB.
[[nodiscard]] inline std::int32_t hundredths(double number) { return rounded(number * 100); }

}  // namespace vespscope::sources::diag
