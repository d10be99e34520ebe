#include "sources/diag/LogCommands.h"

#include <algorithm>
#include <array>

#include "sources/diag/ByteView.h"
#include "sources/diag/FrameReader.h"
#include "sources/diag/GsmSystemInformation.h"
#include "sources/diag/LteRecords.h"
#include "sources/diag/NasRecords.h"
#include "sources/diag/NrRecords.h"
#include "sources/diag/WcdmaRecords.h"

namespace vespscope::sources::diag {
namespace {

constexpr std::uint8_t configureLog = 0x73;
// Operations of that command.
constexpr std::uint32_t disable = 0;
constexpr std::uint32_t retrieveCounts = 1;
constexpr std::uint32_t setMask = 3;

// A modem answers a command that it does not know, or with wrong content or length, with one of these.
constexpr std::uint8_t badCommand = 0x13;
constexpr std::uint8_t badParameters = 0x14;
constexpr std::uint8_t badLength = 0x15;

// Those of every record that is read.
constexpr std::array<std::uint16_t, 24> codes = {
    wcdmaCellCode,       wcdmaRrcCode,           gsmMessageCode,          gmmStateCode,    mmStateCode,
    gmmRegistrationCode, gprsMessageCode,        rrcMessageCode,          servingCellCode, securedEsmInCode,
    securedEsmOutCode,   esmMessageInCode,       esmMessageOutCode,       bearerStateCode, securedEmmInCode,
    securedEmmOutCode,   emmMessageInCode,       emmMessageOutCode,       emmStateCode,    neighbourMeasurementCode,
    idleNeighboursCode,  servingMeasurementCode, connectedNeighboursCode, nrRrcMessageCode};
static_assert(std::is_sorted(codes.begin(), codes.end()));

void append32(Bytes& bytes, std::uint32_t number) {
  for (unsigned shift = 0; shift < 32; shift += 8) bytes.push_back(static_cast<std::uint8_t>(number >> shift));
}

Bytes commandWith(std::uint32_t operation) {
  Bytes command = {configureLog, 0, 0, 0};
  append32(command, operation);
  return command;
}

}  // namespace

Bytes frameWith(Bytes content) {
  constexpr std::uint8_t end = 0x7E;
  constexpr std::uint8_t escape = 0x7D;
  constexpr std::uint8_t escapeMask = 0x20;
  const std::uint16_t crc = crc16X25(content);
  content.push_back(static_cast<std::uint8_t>(crc));
  content.push_back(static_cast<std::uint8_t>(crc >> 8U));
  Bytes frame;
  frame.reserve(content.size() + 8);
  for (const std::uint8_t byte : content) {
    const bool special = byte == end || byte == escape;
    if (special) frame.push_back(escape);
    frame.push_back(special ? static_cast<std::uint8_t>(byte ^ escapeMask) : byte);
  }
  frame.push_back(end);
  return frame;
}

Bytes askForCodeCounts() { return frameWith(commandWith(retrieveCounts)); }

Bytes turnOn(std::uint8_t equipment, std::uint32_t count, std::span<const std::uint16_t> wanted) {
  Bytes mask((count + 7) / 8);
  for (const std::uint16_t code : wanted) {
    const std::uint32_t item = code & 0xFFFU;
    if (item < count) mask[item / 8] |= static_cast<std::uint8_t>(1U << item % 8U);
  }
  Bytes command = commandWith(setMask);
  append32(command, equipment);
  append32(command, count);
  command.insert(command.end(), mask.begin(), mask.end());
  return frameWith(std::move(command));
}

Bytes turnAllOff() { return frameWith(commandWith(disable)); }

std::span<const std::uint16_t> mappedCodes() { return codes; }

std::optional<LogAnswer> logAnswerOf(std::span<const std::uint8_t> frame) {
  constexpr std::size_t head = 12;  // command, operation, status
  LogAnswer answer;
  const ByteView bytes(frame);
  if (!bytes.holds(0, 1)) return std::nullopt;
  const std::uint8_t kind = bytes.u8(0);
  // The command itself follows it.
  const bool isRefusal = kind == badCommand || kind == badParameters || kind == badLength;
  if (isRefusal && bytes.holds(1, 1) && bytes.u8(1) == configureLog) return answer;
  if (kind != configureLog || !bytes.holds(0, head)) return std::nullopt;
  if (bytes.u32(8) != 0) return answer;
  switch (bytes.u32(4)) {
    case disable:
      answer.kind = LogAnswer::Kind::turnedOff;
      return answer;
    case retrieveCounts:
      if (!bytes.holds(head, 4 * equipmentCount)) return std::nullopt;
      answer.kind = LogAnswer::Kind::codeCounts;
      for (std::size_t i = 0; i < equipmentCount; ++i) answer.counts[i] = bytes.u32(head + 4 * i);
      return answer;
    case setMask:
      if (!bytes.holds(head, 4)) return std::nullopt;
      answer.kind = LogAnswer::Kind::turnedOn;
      answer.equipment = static_cast<std::uint8_t>(bytes.u32(head));
      return answer;
    default:
      return std::nullopt;
  }
}

}  // namespace vespscope::sources::diag
