// The E-UTRA operating band of a downlink carrier (3GPP TS 36.101 table 5.7.3-1).
#pragma once

#include <cstdint>
#include <optional>

namespace vespscope::sources::diag {

// Empty for a number outside every band's downlink range: the ranges do not overlap.
[[nodiscard]] std::optional<std::uint32_t> eutraBandOfDownlink(std::uint32_t earfcn);

}  // namespace vespscope::sources::diag
