// The messages that open, keep and secure a connection, and those that carry others.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "rrc/Message.h"

namespace vespscope::rrc::lte {

struct ConnectionRequest {
  std::string_view cause;          // "emergency", "mt-Access", "mo-Signalling", "mo-Data", …
  bool temporaryIdentity = false;  // the phone is registered and states its S-TMSI, which is not read here
};

struct ConnectionReject {
  std::uint8_t waitTime = 0;  // s, 1..16
};

struct ConnectionSetupComplete {
  std::uint8_t selectedNetwork = 0;  // 1..6: the position in the list of system information block 1
  std::vector<std::uint8_t> nas;     // the first message for the non-access stratum
};

struct ReestablishmentRequest {
  std::uint16_t cRnti = 0;         // in the cell where the connection failed
  std::uint16_t physicalCell = 0;  // of that cell, 0..503
  std::string_view cause;          // "reconfigurationFailure", "handoverFailure", "otherFailure"
};

struct SecurityMode {
  std::string_view ciphering;  // "eea0" (none) .. "eea3-v1130"
  std::string_view integrity;  // "eia0-v920" (none) .. "eia3-v1130"
};

// MobilityFromEUTRACommand: the phone leaves LTE.
struct MobilityFromLte {
  bool csFallback = false;
  std::string_view purpose;     // "handover", "cellChangeOrder", "e-CSFB-r9"
  std::string_view technology;  // of a handover: "utra", "geran", "nr", …; of a cell change order: "geran"
};

// The head of a paging message; identities are not read.
struct Paging {
  std::uint8_t records = 0;  // 0..16
  bool systemInformationChange = false;
  bool earthquakeWarning = false;  // ETWS
  bool mobileAlert = false;        // CMAS
};

// Nothing when the message is another.
[[nodiscard]] std::optional<ConnectionRequest> connectionRequestOf(const Message& message);
[[nodiscard]] std::optional<ConnectionReject> connectionRejectOf(const Message& message);
[[nodiscard]] std::optional<ConnectionSetupComplete> connectionSetupCompleteOf(const Message& message);
[[nodiscard]] std::optional<ReestablishmentRequest> reestablishmentRequestOf(const Message& message);
[[nodiscard]] std::optional<SecurityMode> securityModeOf(const Message& message);
[[nodiscard]] std::optional<MobilityFromLte> mobilityFromLteOf(const Message& message);
[[nodiscard]] std::optional<Paging> pagingOf(const Message& message);
// The message for the non-access stratum in an information transfer, up or down.
[[nodiscard]] std::optional<std::vector<std::uint8_t>> transferredNasOf(const Message& message);

}  // namespace vespscope::rrc::lte
