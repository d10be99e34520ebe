#include "Captures.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <span>

namespace vespscope::test {
namespace {

using rrc::Pdu;
using Bytes = std::vector<std::uint8_t>;
using Span = std::span<const std::uint8_t>;

std::uint32_t number(Span bytes, std::size_t offset, std::size_t width) {
  std::uint32_t value = 0;
  for (std::size_t index = width; index > 0; --index) value = value << 8 | bytes[offset + index - 1];
  return value;
}

// The frames of a log, without escapes and checksum.
std::vector<Bytes> framesOf(const std::filesystem::path& path) {
  std::ifstream file(path, std::ios::binary);
  const Bytes log(std::istreambuf_iterator<char>(file), {});
  std::vector<Bytes> frames;
  Bytes frame;
  for (std::size_t index = 0; index < log.size(); ++index) {
    if (log[index] == 0x7E) {
      if (frame.size() > 2) frames.emplace_back(frame.begin(), frame.end() - 2);
      frame.clear();
    } else if (log[index] == 0x7D && index + 1 < log.size()) {
      frame.push_back(log[++index] ^ 0x20);
    } else {
      frame.push_back(log[index]);
    }
  }
  return frames;
}

// LTE channels in the order of their numbers, which depend on the record's version.
std::optional<Pdu> ltePdu(unsigned version, unsigned number) {
  static constexpr std::array<Pdu, 8> channels = {Pdu::lteBcchBch, Pdu::lteBcchDlSch, Pdu::lteMcch,   Pdu::ltePcch,
                                                  Pdu::lteDlCcch,  Pdu::lteDlDcch,    Pdu::lteUlCcch, Pdu::lteUlDcch};
  static constexpr std::array<Pdu, 8> narrow = {Pdu::nbBcchBch, Pdu::nbBcchDlSch, Pdu::nbPcch, Pdu::nbDlCcch,
                                                Pdu::nbDlDcch,  Pdu::nbUlCcch,    Pdu{},       Pdu::nbUlDcch};
  struct Numbers {
    std::vector<unsigned> versions;
    std::array<unsigned, 8> channels;
    unsigned firstNarrow;
  };
  static const std::vector<Numbers> all = {
      {{2, 3, 4, 6, 7, 8, 13, 22}, {1, 2, 3, 4, 5, 6, 7, 8}, 0},
      {{9, 12}, {8, 9, 10, 11, 12, 13, 14, 15}, 0},
      {{14, 15, 16, 24, 25}, {1, 2, 4, 5, 6, 7, 8, 9}, 0},
      {{20}, {1, 2, 4, 5, 6, 7, 8, 9}, 54},
      {{19, 26}, {1, 3, 6, 7, 8, 9, 10, 11}, 45},
      {{27, 29, 30, 31}, {1, 3, 6, 7, 8, 9, 10, 11}, 0},
  };
  for (const Numbers& numbers : all) {
    if (std::find(numbers.versions.begin(), numbers.versions.end(), version) == numbers.versions.end()) continue;
    const auto found = std::find(numbers.channels.begin(), numbers.channels.end(), number);
    if (found != numbers.channels.end()) return channels.at(std::size_t(found - numbers.channels.begin()));
    const unsigned index = number - numbers.firstNarrow;
    if (numbers.firstNarrow != 0 && index < narrow.size() && narrow.at(index) != Pdu{}) return narrow.at(index);
  }
  return std::nullopt;
}

std::optional<CapturedMessage> lteMessage(Span record) {
  if (record.size() < 16) return std::nullopt;
  const unsigned version = record[0];
  std::size_t at = version >= 25 ? 8 : 6;  // after bearer and physical cell identity
  at += version < 8 ? 2 : 4;               // channel
  at += 2;                                 // frame number
  const unsigned channel = record[at++];
  if (version > 4) at += 4;  // mask of system information
  const auto pdu = ltePdu(version, channel);
  for (const std::size_t more : {std::size_t{0}, std::size_t{3}}) {
    if (pdu && at + 2 + more <= record.size() && at + 2 + more + number(record, at, 2) == record.size()) {
      const Span content = record.subspan(at + 2 + more);
      return CapturedMessage{*pdu, {content.begin(), content.end()}};
    }
  }
  return std::nullopt;
}

std::optional<CapturedMessage> nrMessage(Span record) {
  if (record.size() < 24 || number(record, 0, 4) != 8) return std::nullopt;
  const Span content = record.subspan(24);
  if (content.size() != number(record, 22, 2)) return std::nullopt;
  const auto message = [&](Pdu pdu) { return CapturedMessage{pdu, {content.begin(), content.end()}}; };
  switch (record[17]) {
    case 1:
      return message(Pdu::nrBcchBch);
    case 8:
      return message(Pdu::nrUlDcch);
    case 9:
      return message(Pdu::nrReconfiguration);
    case 10:
      return message(Pdu::nrReconfigurationComplete);
    case 26:
      return message(Pdu::nrRadioBearerConfig);
    default:
      return std::nullopt;
  }
}

}  // namespace

std::vector<std::filesystem::path> captureFiles() {
  const char* stated = std::getenv("VESPSCOPE_CAPTURES");
  const std::filesystem::path folder = stated != nullptr
                                           ? std::filesystem::path(stated)
                                           : std::filesystem::path(VESPSCOPE_SOURCE_DIR) / ".." / "shared" / "captures";
  std::vector<std::filesystem::path> files;
  std::error_code error;
  for (const auto& entry : std::filesystem::directory_iterator(folder, error)) {
    if (entry.path().extension() == ".mi2log") files.push_back(entry.path());
  }
  std::sort(files.begin(), files.end());
  return files;
}

Capture readCapture(const std::filesystem::path& path) {
  Capture capture{path.stem().string(), {}, 0};
  for (const Bytes& frame : framesOf(path)) {
    Span record(frame);
    if (record.size() >= 8 && record[0] == 0x98) record = record.subspan(8);
    if (record.size() < 16 || record[0] != 0x10) continue;
    const unsigned code = number(record, 6, 2);
    if (code != 0xB0C0 && code != 0xB821) continue;
    const auto message = code == 0xB0C0 ? lteMessage(record.subspan(16)) : nrMessage(record.subspan(16));
    if (message) {
      capture.messages.push_back(*message);
    } else {
      ++capture.unmapped;
    }
  }
  return capture;
}

}  // namespace vespscope::test
