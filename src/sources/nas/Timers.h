// Timer values of NAS messages in seconds.
#pragma once

#include <cstdint>
#include <optional>

namespace vespscope::sources::nas {

// GPRS timer (3GPP TS 24.008 10.5.7.3); empty when it is deactivated.
[[nodiscard]] constexpr std::optional<std::uint32_t> timerSeconds(std::uint8_t octet) {
  const std::uint32_t count = octet & 0x1FU;
  switch (octet >> 5U) {
    case 0:
      return count * 2;
    case 2:
      return count * 360;
    case 7:
      return std::nullopt;
    default:
      return count * 60;
  }
}

// GPRS timer 3 (3GPP TS 24.008 10.5.7.4a); empty when it is deactivated.
[[nodiscard]] constexpr std::optional<std::uint32_t> timer3Seconds(std::uint8_t octet) {
  const std::uint32_t count = octet & 0x1FU;
  switch (octet >> 5U) {
    case 1:
      return count * 3600;
    case 2:
      return count * 36'000;
    case 3:
      return count * 2;
    case 4:
      return count * 30;
    case 5:
      return count * 60;
    case 6:
      return count * 1'152'000;  // 320 hours
    case 7:
      return std::nullopt;
    default:
      return count * 600;
  }
}

}  // namespace vespscope::sources::nas
