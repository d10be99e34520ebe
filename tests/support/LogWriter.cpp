#include "support/LogWriter.h"

#include <cmath>

namespace vespscope::test {
namespace {

// Numbers are written lowest byte first.
void put(Bytes& bytes, std::uint64_t number, unsigned width) {
  for (unsigned byte = 0; byte < width; ++byte) bytes.push_back(static_cast<std::uint8_t>(number >> (8 * byte) & 0xFF));
}

void append(Bytes& bytes, const Bytes& more) { bytes.insert(bytes.end(), more.begin(), more.end()); }

// CRC-16/X.25 bit by bit: polynomial 0x1021 reflected, initial value all ones, complemented.
std::uint16_t checksumOf(const Bytes& content) {
  unsigned crc = 0xFFFF;
  for (const std::uint8_t byte : content) {
    crc ^= byte;
    for (int bit = 0; bit < 8; ++bit) crc = (crc & 1U) != 0 ? crc >> 1U ^ 0x8408U : crc >> 1U;
  }
  return static_cast<std::uint16_t>(~crc);
}

std::uint32_t steps(double level, double zero) { return static_cast<std::uint32_t>(std::lround((level - zero) * 16)); }

// Sets bits of the 32-bit word at `offset`.
void set(Bytes& bytes, std::size_t offset, unsigned shift, unsigned width, std::uint32_t value) {
  std::uint32_t word = 0;
  for (unsigned byte = 4; byte > 0; --byte) word = word << 8U | bytes.at(offset + byte - 1);
  const std::uint32_t mask = ((1U << width) - 1) << shift;
  word = (word & ~mask) | (value << shift & mask);
  for (unsigned byte = 0; byte < 4; ++byte) bytes.at(offset + byte) = static_cast<std::uint8_t>(word >> (8 * byte));
}

Bytes subpacket(std::uint8_t kind, std::uint8_t version, const Bytes& body) {
  Bytes payload = {1, 1, 0, 0, kind, version};
  put(payload, body.size() + 4, 2);
  append(payload, body);
  return payload;
}

// A network of five or six digits in three octets (3GPP TS 24.008 10.5.1.3).
void putPlmn(Bytes& bytes, const std::string& plmn) {
  const auto digit = [&plmn](std::size_t index) { return static_cast<unsigned>(plmn.at(index) - '0'); };
  put(bytes, digit(1) << 4U | digit(0), 1);
  put(bytes, (plmn.size() == 6 ? digit(5) : 0xFU) << 4U | digit(2), 1);
  put(bytes, digit(4) << 4U | digit(3), 1);
}

struct Place {
  std::size_t offset;
  unsigned shift;
};
struct Places {
  Place rsrp, rsrq, rssi, snr;
};

// The positions of the fields of an antenna in a version, relative to its cell, and of the combined fields.
struct Layout {
  std::size_t head;  // before the cell
  std::vector<Places> antennas;
  Place rsrp, rsrq, rssi;
  std::uint32_t rsrpBase;
  std::size_t length;
};

Layout layoutOf(std::uint8_t version) {
  const std::vector<Places> two = {{{16, 10}, {28, 12}, {36, 10}, {64, 0}}, {{20, 12}, {32, 0}, {36, 21}, {64, 9}}};
  const std::vector<Places> moved = {{{16, 10}, {32, 12}, {44, 10}, {76, 0}}, {{20, 12}, {36, 0}, {44, 21}, {76, 9}}};
  const std::vector<Places> four = {{{16, 10}, {36, 0}, {48, 0}, {80, 0}},
                                    {{20, 12}, {36, 20}, {48, 11}, {80, 9}},
                                    {{24, 12}, {40, 10}, {52, 0}, {84, 0}},
                                    {{28, 0}, {40, 20}, {52, 11}, {84, 9}}};
  const std::vector<Places> fourMoved = {{{16, 10}, {40, 0}, {52, 0}, {80, 0}},
                                         {{20, 12}, {40, 20}, {52, 11}, {80, 9}},
                                         {{24, 12}, {44, 10}, {56, 0}, {84, 0}},
                                         {{32, 0}, {44, 20}, {56, 11}, {84, 9}}};
  switch (version) {
    case 18:
      return {4, two, {24, 12}, {32, 20}, {40, 0}, 0, 68};
    case 19:
      return {8, two, {24, 12}, {32, 20}, {40, 0}, 0, 68};
    case 22:
      return {8, moved, {28, 12}, {40, 10}, {52, 0}, 0, 80};
    case 36:
      return {8, four, {28, 12}, {44, 0}, {56, 0}, 640, 128};
    default:
      return {12, fourMoved, {32, 12}, {48, 0}, {60, 0}, 640, 88};
  }
}

}  // namespace

void LogWriter::record(std::uint16_t code, std::chrono::nanoseconds time, const Bytes& payload, std::uint32_t radio) {
  constexpr std::chrono::nanoseconds epoch = std::chrono::seconds(315'964'800);  // 1980-01-06
  const auto ticks = static_cast<std::uint64_t>((time - epoch) / std::chrono::microseconds(1250));
  Bytes content;
  if (radio != 0) {
    content = {0x98, 0x01, 0x00, 0x00};
    put(content, radio, 4);
  }
  append(content, {0x10, 0x00});
  put(content, payload.size() + 12, 2);
  put(content, payload.size() + 12, 2);
  put(content, code, 2);
  put(content, ticks << 16U, 8);
  append(content, payload);
  frame(content, false);
}

void LogWriter::damagedFrame() { frame({0x10, 0x00, 0x0C, 0x00, 0x0C, 0x00, 0x93, 0xB1}, true); }

void LogWriter::otherFrame() { frame({0x1C, 0x01, 0x7E, 0x7D}, false); }

void LogWriter::frame(const Bytes& content, bool damaged) {
  Bytes whole = content;
  put(whole, static_cast<std::uint16_t>(checksumOf(content) ^ (damaged ? 1U : 0U)), 2);
  for (const std::uint8_t byte : whole) {
    if (byte == 0x7E || byte == 0x7D) {
      append(bytes_, {0x7D, static_cast<std::uint8_t>(byte ^ 0x20U)});
    } else {
      bytes_.push_back(byte);
    }
  }
  bytes_.push_back(0x7E);
}

Bytes servingCellPayload(std::uint8_t version, const WrittenServingCell& cell) {
  const unsigned width = version == 2 ? 2 : 4;
  Bytes payload = {version};
  put(payload, cell.cell.pci, 2);
  put(payload, cell.cell.earfcn, width);
  put(payload, cell.uplinkEarfcn, width);
  put(payload, cell.downlinkBlocks, 1);
  put(payload, cell.uplinkBlocks, 1);
  put(payload, cell.cellIdentity, 4);
  put(payload, cell.trackingAreaCode, 2);
  put(payload, cell.band, 4);
  put(payload, cell.mcc, 2);
  put(payload, cell.mncDigits, 1);
  put(payload, cell.mnc, 2);
  put(payload, 0, 1);
  return payload;
}

Bytes measurementPayload(std::uint8_t version, const WrittenCell& cell, const std::vector<WrittenLevels>& antennas) {
  const Layout layout = layoutOf(version);
  Bytes fields(layout.length, 0xA5);
  set(fields, 0, 0, 13, cell.pci | static_cast<std::uint32_t>(cell.index) << 9U | 1U << 12U);
  set(fields, 4, 0, 14, 517 | 4U << 10U);
  WrittenLevels best = antennas.at(0);
  for (std::size_t index = 0; index < antennas.size(); ++index) {
    const WrittenLevels& levels = antennas[index];
    const Places& places = layout.antennas.at(index);
    set(fields, places.rsrp.offset, places.rsrp.shift, 12, steps(levels.rsrp, -180));
    set(fields, places.rsrq.offset, places.rsrq.shift, 10, steps(levels.rsrq, -30));
    set(fields, places.rssi.offset, places.rssi.shift, 11, steps(levels.rssi, -110));
    set(fields, places.snr.offset, places.snr.shift, 9,
        static_cast<std::uint32_t>(std::lround((levels.snr + 20) * 10)));
    best.rsrp = std::max(best.rsrp, levels.rsrp);
    best.rsrq = std::max(best.rsrq, levels.rsrq);
    best.rssi = std::max(best.rssi, levels.rssi);
  }
  set(fields, layout.rsrp.offset, layout.rsrp.shift, 12, steps(best.rsrp, -180) - layout.rsrpBase);
  set(fields, layout.rsrq.offset, layout.rsrq.shift, 10, steps(best.rsrq, -30));
  set(fields, layout.rssi.offset, layout.rssi.shift, 11, steps(best.rssi, -110));
  Bytes body;
  put(body, cell.earfcn, 4);
  if (layout.head > 4) put(body, 1, 2);
  if (layout.head > 4) put(body, (1U << antennas.size()) - 1, 2);
  body.resize(layout.head, 0xA5);
  append(body, fields);
  return subpacket(25, version, body);
}

Bytes neighboursPayload(std::uint16_t code, const WrittenCell& serving, std::uint32_t earfcn,
                        const std::vector<WrittenNeighbour>& neighbours) {
  Bytes body;
  if (code == 0xB179) {
    body = {4, 0, 0, 0, 0, 0, 0, 0};
    put(body, earfcn, 4);
    put(body, serving.pci, 2);
    body.resize(24, 0);
    put(body, neighbours.size(), 1);
    body.resize(28, 0);
    for (const WrittenNeighbour& neighbour : neighbours) {
      put(body, neighbour.pci, 2);
      for (int twice = 0; twice < 2; ++twice) put(body, steps(neighbour.rsrp, -180), 2);
      for (int twice = 0; twice < 2; ++twice) put(body, steps(neighbour.rsrq, -30), 2);
      put(body, 0, 2);
    }
    return body;
  }
  put(body, earfcn, 4);
  put(body, neighbours.size(), 4);
  for (const WrittenNeighbour& neighbour : neighbours) {
    Bytes cell(52, 0);
    set(cell, 0, 0, 10, neighbour.pci);
    set(cell, 12, 0, 12, steps(neighbour.rsrp, -180));
    set(cell, 20, 10, 10, steps(neighbour.rsrq, -30));
    append(body, cell);
  }
  return subpacket(code == 0xB192 ? 27 : 31, 4, body);
}

Bytes rrcPayload(std::uint8_t version, unsigned channel, const WrittenCell& cell, const Bytes& message) {
  unsigned first = 5;
  if (version == 9 || version == 12) first = 12;
  if ((version >= 14 && version <= 16) || version == 20 || version == 24 || version == 25) first = 6;
  if (version == 19 || version >= 26) first = 8;
  Bytes payload = {version, 14, 9};
  if (version >= 25) put(payload, 0, 2);
  put(payload, 1, 1);
  put(payload, cell.pci, 2);
  put(payload, cell.earfcn, version < 8 ? 2 : 4);
  put(payload, 0x1234, 2);
  put(payload, first + channel, 1);
  if (version > 4) put(payload, 0, 4);
  put(payload, message.size(), 2);
  if (version == 30) put(payload, 0, 3);
  append(payload, message);
  return payload;
}

Bytes wcdmaCellPayload(const WrittenWcdmaCell& cell) {
  Bytes payload;
  put(payload, cell.uarfcn - 950, 4);
  put(payload, cell.uarfcn, 4);
  put(payload, cell.cellIdentity, 4);
  put(payload, 0, 4);
  put(payload, static_cast<std::uint64_t>(cell.scramblingCode) << 4U, 2);
  for (std::size_t index = 0; index < 6; ++index) {
    put(payload, index < cell.plmn.size() ? static_cast<std::uint64_t>(cell.plmn[index] - '0') : 0xFF, 1);
  }
  put(payload, cell.locationAreaCode, 4);
  put(payload, 0, 4);
  return payload;
}

Bytes wcdmaRrcPayload(std::uint8_t channel, const Bytes& message) {
  Bytes payload = {channel, 2};
  put(payload, message.size(), 2);
  append(payload, message);
  return payload;
}

Bytes wcdmaBroadcastPayload(std::uint16_t uarfcn, std::uint16_t scramblingCode, const Bytes& message) {
  Bytes place;
  put(place, uarfcn, 2);
  put(place, scramblingCode, 2);
  append(place, message);
  return wcdmaRrcPayload(0x84, place);
}

Bytes epsMessagePayload(const Bytes& message) {
  Bytes payload = {1, 9, 5, 0};
  append(payload, message);
  return payload;
}

Bytes emmStatePayload(std::uint8_t state, std::uint16_t substate, const WrittenGuti& guti) {
  Bytes payload = {2, state};
  put(payload, substate, 2);
  putPlmn(payload, guti.plmn);
  put(payload, 0x0601, 2);
  putPlmn(payload, guti.plmn);
  put(payload, guti.group, 2);
  put(payload, guti.code, 1);
  put(payload, guti.temporaryIdentity, 4);
  return payload;
}

Bytes bearerStatePayload(std::uint8_t bearer, std::uint8_t state, std::uint8_t qualityClass) {
  Bytes payload = {1, 0, bearer, state, 0, 0, 0, 0, 8, bearer, 5, qualityClass};
  put(payload, 0xFFFFFFFF, 4);
  put(payload, 0, 4);
  return payload;
}

Bytes gprsMessagePayload(const Bytes& message) {
  Bytes payload = {1};
  put(payload, message.size(), 4);
  append(payload, message);
  return payload;
}

Bytes mobilityStatePayload(std::uint8_t state, std::uint8_t substate, std::uint8_t updateStatus) {
  return {state, substate, updateStatus};
}

Bytes gmmRegistrationPayload(const std::string& plmn, std::uint16_t locationAreaCode, std::uint8_t routingAreaCode) {
  Bytes payload = {0, 1};
  putPlmn(payload, plmn);
  // The one number that comes with its highest byte first.
  put(payload, locationAreaCode >> 8U, 1);
  put(payload, locationAreaCode & 0xFFU, 1);
  put(payload, routingAreaCode, 1);
  append(payload, {0xAA, 0xBB});
  return payload;
}

Bytes gsmMessagePayload(const Bytes& message) {
  Bytes payload = {0x81, message.size() > 2 ? message[2] : std::uint8_t{0}};
  put(payload, message.size(), 1);
  append(payload, message);
  return payload;
}

Bytes nrRrcPayload(std::uint8_t content, std::uint16_t pci, std::uint32_t nrArfcn, const Bytes& message) {
  Bytes payload;
  put(payload, 8, 4);
  append(payload, {15, 3, 1});
  put(payload, pci, 2);
  put(payload, nrArfcn, 4);
  put(payload, 517, 4);
  put(payload, content, 1);
  put(payload, 0, 4);
  put(payload, message.size(), 2);
  append(payload, message);
  return payload;
}

}  // namespace vespscope::test
