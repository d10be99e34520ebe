// One log record of the modem, taken from a frame.
#pragma once

#include <chrono>
#include <cstdint>
#include <span>
#include <variant>

namespace vespscope::sources::diag {

struct LogRecord {
  std::uint32_t radio = 0;  // which SIM, where the modem tells it, else 0
  std::uint16_t code = 0;
  std::chrono::nanoseconds time{0};       // since 1970-01-01 00:00 UTC
  std::span<const std::uint8_t> payload;  // into the frame
};

// Why a frame holds no log record.
enum class FrameFault {
  otherKind,    // something else that the modem says
  malformed,    // lengths that contradict the frame
  timeTooLate,  // a time that nanoseconds since 1970 cannot hold
};

[[nodiscard]] std::variant<LogRecord, FrameFault> logRecordOf(std::span<const std::uint8_t> frame);

}  // namespace vespscope::sources::diag
