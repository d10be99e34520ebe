// Takes a modem's byte stream apart into frames: ended by 0x7E, 0x7D escaping, CRC-16/X.25 at the end.
#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "values/Value.h"

namespace vespscope::sources::diag {

// CRC-16/X.25 (ITU-T X.25 2.2.7): 0x906E over the text "123456789".
[[nodiscard]] std::uint16_t crc16X25(std::span<const std::uint8_t> bytes);

struct FrameCounters {
  std::uint64_t good = 0;
  std::uint64_t badChecksum = 0;
  std::uint64_t aborted = 0;    // an escape directly before the end of the frame
  std::uint64_t oversized = 0;  // longer than `maximumFrameLength`
  std::uint64_t truncated = 0;  // without its end when the input ended

  bool operator==(const FrameCounters&) const = default;
};

// A frame that is wrong in any way is dropped and counted; reading goes on behind the next 0x7E.
class FrameReader {
 public:
  // A log record's length field reaches 65535; its own head, the wrapper of a second SIM and the checksum come on top.
  static constexpr std::size_t maximumFrameLength = 65'535 + 4 + 8 + 2;

  // Gives the next piece of the stream, which the caller keeps alive until `next` has returned nothing.
  void feed(std::span<const std::uint8_t> piece) { piece_ = piece; }
  // The next frame without its checksum, good until the next call; empty when the piece is used up.
  [[nodiscard]] std::optional<std::span<const std::uint8_t>> next();
  // Tells that the stream has ended.
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
