// The supported log records of mobility and session management, as plain structures.
#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "sources/diag/Decoded.h"
#include "sources/nas/Identities.h"

namespace vespscope::sources::diag {

inline constexpr std::uint16_t emmStateCode = 0xB0EE;
inline constexpr std::uint16_t bearerStateCode = 0xB0E5;
inline constexpr std::uint16_t esmMessageInCode = 0xB0E2;
inline constexpr std::uint16_t esmMessageOutCode = 0xB0E3;
inline constexpr std::uint16_t securedEsmInCode = 0xB0E0;
inline constexpr std::uint16_t securedEsmOutCode = 0xB0E1;
inline constexpr std::uint16_t securedEmmInCode = 0xB0EA;
inline constexpr std::uint16_t securedEmmOutCode = 0xB0EB;
inline constexpr std::uint16_t emmMessageInCode = 0xB0EC;
inline constexpr std::uint16_t emmMessageOutCode = 0xB0ED;
inline constexpr std::uint16_t gmmStateCode = 0x7130;
inline constexpr std::uint16_t mmStateCode = 0x7131;
inline constexpr std::uint16_t gmmRegistrationCode = 0x7135;
inline constexpr std::uint16_t gprsMessageCode = 0x713A;

// B0EE: EPS mobility management.
struct EmmStateRecord {
  std::uint8_t state = 0;
  std::uint16_t substate = 0;
  std::optional<nas::Guti> guti;  // empty when its network's digits are invalid
};
[[nodiscard]] Decoded<EmmStateRecord> emmStateOf(std::span<const std::uint8_t> payload);

// B0E5: one EPS bearer.
struct BearerStateRecord {
  std::uint8_t bearer = 0;  // EPS bearer identity
  std::uint8_t state = 0;
  std::uint8_t qualityClass = 0;  // QCI, 3GPP TS 23.203 6.1.7
};
[[nodiscard]] Decoded<BearerStateRecord> bearerStateOf(std::span<const std::uint8_t> payload);

// A message of the non-access stratum: plain, except that those of B0E0, B0E1, B0EA and B0EB have a security header.
struct NasMessageRecord {
  std::span<const std::uint8_t> message;  // a view of the record
};
// B0E0 to B0E3 and B0EA to B0ED.
[[nodiscard]] Decoded<NasMessageRecord> epsMessageOf(std::span<const std::uint8_t> payload);
// 713A.
[[nodiscard]] Decoded<NasMessageRecord> gprsMessageOf(std::span<const std::uint8_t> payload);

// 7130 of the packet domain, 7131 of the circuit domain.
struct MobilityStateRecord {
  std::uint8_t state = 0;
  std::uint8_t substate = 0;
  std::uint8_t updateStatus = 0;
};
[[nodiscard]] Decoded<MobilityStateRecord> mobilityStateOf(std::span<const std::uint8_t> payload);

// 7135: the registration in the packet domain.
struct GmmRegistrationRecord {
  std::uint8_t mode = 0;
  std::uint8_t service = 0;
  std::optional<nas::RoutingArea> area;  // empty when its network's digits are invalid
};
[[nodiscard]] Decoded<GmmRegistrationRecord> gmmRegistrationOf(std::span<const std::uint8_t> payload);

}  // namespace vespscope::sources::diag
