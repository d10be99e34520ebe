#include "sources/diag/UnreadSamples.h"

#include <algorithm>
#include <optional>
#include <utility>
#include <vector>

#include "sources/diag/ByteView.h"
#include "sources/diag/LogCommands.h"

namespace vespscope::sources::diag {
namespace {

// LTE and NR: the record begins with its version.
bool beginsWithVersion(std::uint16_t code) { return code >= 0xB000; }
bool isLteMeasurement(std::uint16_t code) { return code >= 0xB100 && code <= 0xB1FF; }

void copy(const ByteView& from, Bytes& to, std::size_t offset, std::size_t count) {
  const auto part = from.part(offset, count);
  std::copy(part.begin(), part.end(), to.begin() + static_cast<std::ptrdiff_t>(offset));
}

// Version, number of subpackets, two bytes more; then the subpackets, each with its identifier, version and size.
bool keepSubpackets(const ByteView& payload, Bytes& kept) {
  constexpr std::size_t recordHead = 4;
  constexpr std::size_t subpacketHead = 4;
  if (!payload.holds(0, recordHead) || payload.u8(1) == 0) return false;
  std::vector<std::size_t> heads;
  std::size_t offset = recordHead;
  for (unsigned left = payload.u8(1); left > 0; --left) {
    if (!payload.holds(offset, subpacketHead)) return false;
    const std::size_t size = payload.u16(offset + 2);
    if (size < subpacketHead || !payload.holds(offset, size)) return false;
    heads.push_back(offset);
    offset += size;
  }
  if (offset != payload.size()) return false;
  copy(payload, kept, 1, 1);
  for (const std::size_t head : heads) copy(payload, kept, head, subpacketHead);
  return true;
}

void keepLength(const ByteView& payload, Bytes& kept) {
  constexpr std::size_t width = 2;
  constexpr std::size_t shortest = 4;  // a smaller number is too often something else
  for (std::size_t offset = 1; payload.holds(offset, width + shortest); ++offset) {
    if (payload.u16(offset) != payload.size() - offset - width) continue;
    copy(payload, kept, offset, width);
    return;
  }
}

void append16(Bytes& bytes, std::size_t number) {
  bytes.push_back(static_cast<std::uint8_t>(number));
  bytes.push_back(static_cast<std::uint8_t>(number >> 8U));
}

Bytes logOf(const LogRecord& record) {
  constexpr std::uint8_t logRecord = 0x10;
  constexpr std::size_t head = 12;  // length, code, time
  const Bytes payload = redactedPayload(record);
  Bytes content = {logRecord, 0};
  append16(content, head + payload.size());
  append16(content, head + payload.size());
  append16(content, record.code);
  content.resize(content.size() + 8);
  content.insert(content.end(), payload.begin(), payload.end());
  return frameWith(std::move(content));
}

}  // namespace

Bytes redactedPayload(const LogRecord& record) {
  const ByteView payload(record.payload);
  Bytes kept(payload.size());
  if (!beginsWithVersion(record.code) || kept.empty()) return kept;
  copy(payload, kept, 0, 1);
  if (isLteMeasurement(record.code) && keepSubpackets(payload, kept)) return kept;
  keepLength(payload, kept);
  return kept;
}

void UnreadSamples::take(const LogRecord& record, const DiagReport& report) {
  const std::size_t kinds = report.skipped.size() + report.partsSkipped.size() + report.broken.size();
  if (kinds != kindsInReport_) {
    kindsInReport_ = kinds;
    takeNewKinds(record, report);
  }
  if (!unknownCodes_.contains(record.code)) return;
  Kind kind{{record.code, std::nullopt, std::nullopt}, false};
  if (beginsWithVersion(record.code) && !record.payload.empty()) kind.record.version = record.payload[0];
  add(kind, record);
}

// The kinds of this record's code that the report did not have before.
void UnreadSamples::takeNewKinds(const LogRecord& record, const DiagReport& report) {
  const RecordKind first{record.code, std::nullopt, std::nullopt};
  const auto takeFrom = [&](const RecordCounts& counts, bool broken) {
    for (auto each = counts.lower_bound(first); each != counts.end() && each->first.code == record.code; ++each) {
      const RecordKind& kind = each->first;
      if (!broken && kind == first) {
        unknownCodes_.insert(record.code);
      } else if (isOfUnknownLayout(kind)) {
        add({kind, broken}, record);
      }
    }
  };
  takeFrom(report.skipped, false);
  takeFrom(report.partsSkipped, false);
  takeFrom(report.broken, true);
}

void UnreadSamples::add(const Kind& kind, const LogRecord& record) {
  if (samples_.contains(kind)) return;
  if (samples_.size() == maximum) {
    ++leftOut_;
    return;
  }
  samples_.emplace(kind, logOf(record));
}

std::string fileNameOf(const UnreadSamples::Kind& kind) {
  std::string name = nameOf(kind.record);
  std::replace(name.begin(), name.end(), ' ', '-');
  return kind.broken ? name + "-refused" : name;
}

}  // namespace vespscope::sources::diag
