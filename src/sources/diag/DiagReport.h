// How the bytes of a modem log were handled: what was read and what was skipped, as counts.
#pragma once

#include <compare>
#include <cstdint>
#include <map>
#include <optional>
#include <string>

#include "sources/diag/FrameReader.h"

namespace vespscope::sources::diag {

// A kind of record; the version is set for codes that are understood and have version-dependent layouts.
struct RecordKind {
  std::uint16_t code = 0;
  std::optional<std::uint8_t> version;
  // The part of the record, such as a subpacket of B193; for 412F, the message's channel.
  std::optional<std::uint8_t> part;
  auto operator<=>(const RecordKind&) const = default;
};

// "B193", "B193 v40", "B193 subpacket 26 v5".
[[nodiscard]] std::string nameOf(const RecordKind& kind);
// Whether a record of this kind that is left out has a layout that is not known; else it is understood, but says
// nothing that a metric has.
[[nodiscard]] bool isOfUnknownLayout(const RecordKind& kind);

using RecordCounts = std::map<RecordKind, std::uint64_t>;

struct DiagReport {
  FrameCounters frames;
  std::uint64_t otherFrames = 0;      // frames that are not log records
  std::uint64_t malformedFrames = 0;  // log records with wrong lengths or an impossible time
  std::uint64_t otherRadios = 0;      // records of more radios than a phone has
  RecordCounts read;                  // understood
  RecordCounts skipped;               // of an unknown code or version
  RecordCounts broken;                // of a known one, but too short or out of range
  RecordCounts partsSkipped;          // unknown parts of records that were read

  // One line for a user: "1808 frames, 1347 records read, 461 skipped (B060: 9, B063: 50, …)".
  [[nodiscard]] std::string text() const;
  // A table for a user: every frame and every kind of record, how they were handled, and totals. Ends in a newline.
  [[nodiscard]] std::string table() const;
};

}  // namespace vespscope::sources::diag
