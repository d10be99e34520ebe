// The state of one modem at one moment as ModemManager reports it. Unreported values are empty.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "radio/Plmn.h"
#include "values/Value.h"

namespace vespscope::sources::modemmanager {

enum class Technology { none, gsm, umts, lte };

// ModemManager's MMModem3gppRegistrationState, one state for all domains of the modem.
enum class Registration : std::uint32_t {
  idle = 0,
  home = 1,
  searching = 2,
  denied = 3,
  unknown = 4,
  roaming = 5,
  homeSmsOnly = 6,
  roamingSmsOnly = 7,
  emergencyOnly = 8,
  homeCsfbNotPreferred = 9,
  roamingCsfbNotPreferred = 10,
  attachedRlos = 11,
};

struct Cell {
  Technology technology = Technology::none;
  bool serving = false;
  std::optional<radio::Plmn> network;
  std::optional<std::uint32_t> area;       // location or tracking area code
  std::optional<std::uint32_t> cellId;     // within its network
  std::optional<std::uint32_t> channel;    // ARFCN, downlink UARFCN or EARFCN
  std::optional<std::uint32_t> code;       // BSIC, primary scrambling code or physical cell identity
  std::optional<double> power;             // RSCP or RSRP (dBm)
  std::optional<double> quality;           // Ec/Io or RSRQ (dB)
  std::optional<std::uint32_t> levelCode;  // RXLEV 0..63, 3GPP TS 45.008 8.1.4
};

struct Bearer {
  std::optional<std::uint32_t> contextId;
  std::optional<std::string> accessPoint;
  std::optional<std::uint32_t> families;  // ModemManager's MMBearerIpFamily: 1 IPv4, 2 IPv6, 4 both
  Bytes ipv4;                             // 4 bytes, or empty
  Bytes ipv6;                             // 16 bytes, or empty
  std::vector<Bytes> dns;                 // in order, those of IPv4 first
};

struct SimCard {
  std::optional<std::string> iccid;         // digits
  std::optional<std::string> imsi;          // digits
  std::optional<std::string> operatorCode;  // MCC and MNC, digits
  std::optional<std::string> operatorName;  // the service provider's
  std::optional<Bytes> gid1;
  std::optional<Bytes> gid2;
};

struct ModemState {
  Technology technology = Technology::none;
  bool hsdpa = false;  // used in the serving cell
  bool hsupa = false;
  bool mayUseGsmOrUmts = false;
  bool mayUseLte = false;

  std::optional<Registration> registration;
  std::optional<bool> packetAttached;
  std::optional<std::uint32_t> epsMode;  // MMModem3gppEpsUeModeOperation, 1..4
  std::optional<radio::Plmn> network;    // registered with
  std::optional<std::uint32_t> lac;
  std::optional<std::uint32_t> tac;
  std::optional<std::uint32_t> cellId;

  struct Lte {
    std::optional<double> rsrp;  // dBm
    std::optional<double> rsrq;  // dB
    std::optional<double> snr;   // dB
  } lte;
  struct Umts {
    std::optional<double> rssi;  // dBm
    std::optional<double> rscp;  // dBm
    std::optional<double> ecio;  // dB
  } umts;
  std::optional<double> gsmRssi;  // dBm

  std::vector<Cell> cells;
  bool bearersKnown = false;    // each bearer of the modem has been read
  std::vector<Bearer> bearers;  // the connected ones
  SimCard sim;
};

}  // namespace vespscope::sources::modemmanager
