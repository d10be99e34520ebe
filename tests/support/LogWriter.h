// Writes a modem's diagnostic log: frames with their checksums, and records of the versions that modems write. It
// shares no code with the readers.
#pragma once

#include <array>
#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "values/Value.h"

namespace vespscope::test {

class LogWriter {
 public:
  // Writes a record of the radio `radio`, 1 or 2 in a phone with two SIM cards; 0 omits that header.
  void record(std::uint16_t code, std::chrono::nanoseconds time, const Bytes& payload, std::uint32_t radio = 0);
  // Writes a frame with a wrong checksum.
  void damagedFrame();
  // Writes a frame that is not a log record.
  void otherFrame();

  [[nodiscard]] const Bytes& bytes() const { return bytes_; }

 private:
  void frame(const Bytes& content, bool damaged);

  Bytes bytes_;
};

struct WrittenCell {
  std::uint16_t pci = 0;
  std::uint32_t earfcn = 0;
  std::uint8_t index = 0;  // 0 of the primary cell, 1 and above of secondary ones
};

// B0C2 of version 2 or 3.
struct WrittenServingCell {
  WrittenCell cell;
  std::uint32_t uplinkEarfcn = 0;
  std::uint8_t downlinkBlocks = 0;
  std::uint8_t uplinkBlocks = 0;
  std::uint32_t cellIdentity = 0;
  std::uint16_t trackingAreaCode = 0;
  std::uint32_t band = 0;
  std::uint16_t mcc = 0;
  std::uint8_t mncDigits = 2;
  std::uint16_t mnc = 0;
};
[[nodiscard]] Bytes servingCellPayload(std::uint8_t version, const WrittenServingCell& cell);

// B193 with one cell in subpacket 25 of version 18, 19, 22, 36 or 48.
struct WrittenLevels {
  double rsrp = 0;
  double rsrq = 0;
  double rssi = 0;
  double snr = 0;
};
[[nodiscard]] Bytes measurementPayload(std::uint8_t version, const WrittenCell& cell,
                                       const std::vector<WrittenLevels>& antennas);

struct WrittenNeighbour {
  std::uint16_t pci = 0;
  double rsrp = 0;
  double rsrq = 0;
};
// B195 with subpacket 31, B192 with subpacket 27, or B179, by `code`.
[[nodiscard]] Bytes neighboursPayload(std::uint16_t code, const WrittenCell& serving, std::uint32_t earfcn,
                                      const std::vector<WrittenNeighbour>& neighbours);

// B0C0 of any version, on DL-CCCH (0), DL-DCCH (1), UL-CCCH (2) or UL-DCCH (3).
[[nodiscard]] Bytes rrcPayload(std::uint8_t version, unsigned channel, const WrittenCell& cell, const Bytes& message);

// 4127.
struct WrittenWcdmaCell {
  std::uint32_t uarfcn = 0;
  std::uint32_t cellIdentity = 0;
  std::uint16_t scramblingCode = 0;
  std::string plmn;  // five or six digits
  std::uint16_t locationAreaCode = 0;
};
[[nodiscard]] Bytes wcdmaCellPayload(const WrittenWcdmaCell& cell);

// 412F, a message on UL-CCCH (0), UL-DCCH (1), DL-CCCH (2) or DL-DCCH (3), or a broadcast on another channel.
[[nodiscard]] Bytes wcdmaRrcPayload(std::uint8_t channel, const Bytes& message);
// The broadcast of a UMTS cell: its UARFCN and scrambling code come before the message.
[[nodiscard]] Bytes wcdmaBroadcastPayload(std::uint16_t uarfcn, std::uint16_t scramblingCode, const Bytes& message);

// B0E0 to B0E3 and B0EA to B0ED.
[[nodiscard]] Bytes epsMessagePayload(const Bytes& message);
// B0EE. Networks are five or six digits; the identity is that of the message's GUTI.
struct WrittenGuti {
  std::string plmn;
  std::uint16_t group = 0;
  std::uint8_t code = 0;
  std::uint32_t temporaryIdentity = 0;
};
[[nodiscard]] Bytes emmStatePayload(std::uint8_t state, std::uint16_t substate, const WrittenGuti& guti);
// B0E5.
[[nodiscard]] Bytes bearerStatePayload(std::uint8_t bearer, std::uint8_t state, std::uint8_t qualityClass);

// 713A.
[[nodiscard]] Bytes gprsMessagePayload(const Bytes& message);
// 7130 and 7131.
[[nodiscard]] Bytes mobilityStatePayload(std::uint8_t state, std::uint8_t substate, std::uint8_t updateStatus);
// 7135.
[[nodiscard]] Bytes gmmRegistrationPayload(const std::string& plmn, std::uint16_t locationAreaCode,
                                           std::uint8_t routingAreaCode);

// 512F, a message on the broadcast channel.
[[nodiscard]] Bytes gsmMessagePayload(const Bytes& message);

// B821 with a content by its number.
[[nodiscard]] Bytes nrRrcPayload(std::uint8_t content, std::uint16_t pci, std::uint32_t nrArfcn, const Bytes& message);

}  // namespace vespscope::test
