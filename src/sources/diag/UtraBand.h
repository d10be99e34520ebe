// The UTRA operating band of a downlink carrier (3GPP TS 25.101 table 5.1).
#pragma once

#include <cstdint>
#include <optional>

namespace vespscope::sources::diag {

// The band's number, 1 for I; empty where no band or more than one has the carrier, and for the additional channels.
[[nodiscard]] std::optional<std::uint32_t> utraBandOfDownlink(std::uint32_t uarfcn);

}  // namespace vespscope::sources::diag
