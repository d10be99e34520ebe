// The contents of GSM's system information messages on the broadcast channel (3GPP TS 44.018 9.1.35, 9.1.36, 9.1.43a)
// as raw codes.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <variant>

#include "sources/diag/Decoded.h"
#include "sources/nas/Identities.h"

namespace vespscope::sources::diag {

inline constexpr std::uint16_t gsmMessageCode = 0x512F;

// 512F: one radio resource message.
struct GsmMessageRecord {
  std::uint8_t channel = 0;  // the highest bit means downlink
  std::uint8_t type = 0;
  std::span<const std::uint8_t> message;  // layer 3; a view of the record
};
[[nodiscard]] Decoded<GsmMessageRecord> gsmMessageOf(std::span<const std::uint8_t> payload);

// RACH control parameters, 10.5.2.29.
struct GsmAccess {
  std::uint8_t maximumRetransmissions = 0;  // code: 1, 2, 4, 7
  bool barred = false;
  bool reestablishmentAllowed = false;
  bool emergencyAllowed = false;
  std::uint16_t barredClasses = 0;  // one bit per access class; bit 10 is none
  bool operator==(const GsmAccess&) const = default;
};

// Cell selection parameters, 10.5.2.4.
struct GsmSelection {
  std::uint8_t hysteresis = 0;    // 2 dB steps
  std::uint8_t maximumPower = 0;  // MS-TXPWR-MAX-CCH
  std::uint8_t minimumLevel = 0;  // RXLEV-ACCESS-MIN
  bool operator==(const GsmSelection&) const = default;
};

// Optional selection parameters of the rest octets, 10.5.2.34.
struct GsmReselection {
  bool lowPriority = false;          // CBQ
  std::uint8_t offset = 0;           // CELL_RESELECT_OFFSET, 2 dB steps
  std::uint8_t temporaryOffset = 0;  // 10 dB steps
  std::uint8_t penaltyTime = 0;
  bool operator==(const GsmReselection&) const = default;
};

// System information type 3.
struct GsmCellDescription {
  std::uint16_t cellIdentity = 0;
  std::optional<nas::LocationArea> area;  // empty when the network's digits are invalid
  bool attachAllowed = false;             // 10.5.2.11, also for the next two
  std::uint8_t pagingMultiframes = 0;     // BS-PA-MFRMS: code + 2
  std::uint8_t locationTimer = 0;         // T3212 in tenths of an hour
  std::uint8_t uplinkDtx = 0;             // 10.5.2.3, also for the next
  std::uint8_t radioLinkTimeout = 0;      // code: 4 * (code + 1)
  GsmSelection selection;
  GsmAccess access;
  std::optional<GsmReselection> reselection;
  bool secondTerBroadcast = false;  // system information 2ter
  bool earlyClassmarkSending = false;
  bool packetService = false;  // the GPRS indicator is present
  bool operator==(const GsmCellDescription&) const = default;
};

// System information type 4.
struct GsmCellReminder {
  std::optional<nas::LocationArea> area;
  GsmSelection selection;
  GsmAccess access;
  bool cellBroadcast = false;  // the message describes a channel for it
};

// System information type 13 of a cell without a packet broadcast channel.
struct GsmPacketDescription {
  std::uint8_t routingAreaCode = 0;
  bool splitPaging = false;          // SPGC_CCCH_SUP
  std::uint8_t accessThreshold = 0;  // PRIORITY_ACCESS_THR
  std::uint8_t networkControlOrder = 0;
  std::uint8_t networkMode = 0;                 // code: operation mode I, II, III
  std::optional<bool> extendedUplinkBlockFlow;  // NW_EXT_UTBF, if the cell options include it
};

using GsmSystemInformation = std::variant<GsmCellDescription, GsmCellReminder, GsmPacketDescription>;

// Reads a layer 3 message, with or without the preceding pseudo length. Empty for other messages, and for one truncated
// in its mandatory part.
[[nodiscard]] std::optional<GsmSystemInformation> gsmSystemInformationOf(std::span<const std::uint8_t> message);

}  // namespace vespscope::sources::diag
