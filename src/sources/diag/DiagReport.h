// What became of the bytes of a modem log: what was read, and what was left out, counted and never guessed.
#pragma once

#include <compare>
#include <cstdint>
#include <map>
#include <optional>
#include <string>

#include "sources/diag/FrameReader.h"

namespace vespscope::sources::diag {

// A kind of record: the version is there for the codes that are understood, where it decides the layout.
struct RecordKind {
  std::uint16_t code = 0;
  std::optional<std::uint8_t> version;
  // Which part of the record, such as a subpacket of B193; of 412F, the channel of the message.
  std::optional<std::uint8_t> part;
  auto operator<=>(const RecordKind&) const = default;
};

using RecordCounts = std::map<RecordKind, std::uint64_t>;

struct DiagReport {
  FrameCounters frames;
  std::uint64_t otherFrames = 0;      // frames that are no log record
  std::uint64_t malformedFrames = 0;  // log records with wrong lengths or an impossible time
  std::uint64_t otherRadios = 0;      // records of more radios than a phone has
  RecordCounts read;                  // understood
  RecordCounts skipped;               // of a code or version that is not understood
  RecordCounts broken;                // of one that is, but too short or out of range
  RecordCounts partsSkipped;          // what is not understood in records that are

  // One line for a user: "1808 frames, 1347 records read, 461 skipped (B060: 9, B063: 50, …)".
  [[nodiscard]] std::string text() const;
  // A table for a user: every frame and every kind of record, what became of them, and totals. Ends in a newline.
  [[nodiscard]] std::string table() const;
};

}  // namespace vespscope::sources::diag
