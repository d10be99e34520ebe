// One log record of the modem, taken from a frame.
#pragma once

#include <chrono>
#include <cstdint>
#include <span>
#include <variant>

namespace vespscope::sources::diag {

struct LogRecord {
  std::uint32_t radio = 0;  // the SIM, if the modem reports it, else 0
  std::uint16_t code = 0;
  std::chrono::nanoseconds time{0};       // since 1970-01-01 00:00 UTC
  std::span<const std::uint8_t> payload;  // a view of the frame
};

// Why a frame is not a log record.
enum class FrameFault {
  otherKind,    // another kind of message
  malformed,    // lengths inconsistent with the frame
  timeTooLate,  // the time overflows nanoseconds since 1970
};

[[nodiscard]] std::variant<LogRecord, FrameFault> logRecordOf(std::span<const std::uint8_t> frame);

}  // namespace vespscope::sources::diag
