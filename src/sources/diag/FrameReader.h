// Splits a modem's byte stream into frames: 0x7E at the end, 0x7D as escape, preceded by CRC-16/X.25.
#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "values/Value.h"

namespace vespscope::sources::diag {

// CRC-16/X.25 (ITU-T X.25 2.2.7): 0x906E for the text "123456789".
[[nodiscard]] std::uint16_t crc16X25(std::span<const std::uint8_t> bytes);

struct FrameCounters {
  std::uint64_t good = 0;
  std::uint64_t badChecksum = 0;
  std::uint64_t aborted = 0;    // an escape directly before the end of the frame
  std::uint64_t oversized = 0;  // longer than `maximumFrameLength`
  std::uint64_t truncated = 0;  // incomplete at the end of the input

  bool operator==(const FrameCounters&) const = default;
};

// An invalid frame is dropped and counted; reading continues after the next 0x7E.
class FrameReader {
 public:
  // A log record's length field is at most 65535; its own head, the wrapper of a second SIM and the checksum are added.
  static constexpr std::size_t maximumFrameLength = 65'535 + 4 + 8 + 2;

  // Provides the next piece of the stream, which must stay valid until `next` has returned nothing.
  void feed(std::span<const std::uint8_t> piece) { piece_ = piece; }
  // The next frame without its checksum, valid until the next call; empty when the piece is consumed.
  [[nodiscard]] std::optional<std::span<const std::uint8_t>> next();
  // Reports the end of the stream.
  void finish();

  [[nodiscard]] const FrameCounters& counters() const { return counters_; }

 private:
  void take(std::uint8_t byte);
  [[nodiscard]] bool frameIsGood();
  void beginFrame();

  std::span<const std::uint8_t> piece_;
  Bytes frame_;
  Bytes finished_;
  bool escaped_ = false;
  bool overflowed_ = false;
  FrameCounters counters_;
};

}  // namespace vespscope::sources::diag
