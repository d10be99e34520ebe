#include "sources/diag/LogRecord.h"

#include <limits>

#include "sources/diag/ByteView.h"

namespace vespscope::sources::diag {
namespace {

using std::chrono::nanoseconds;

// A frame of a modem with two SIMs: this head (the first byte is the kind), the radio's number, then the plain frame.
constexpr std::uint8_t wrapperKind = 0x98;
constexpr std::uint32_t wrapperHead = 0x0000'0198;
constexpr std::size_t wrapperLength = 8;

constexpr std::uint8_t recordKind = 0x10;
constexpr std::size_t outerHead = 4;   // kind, records pending, length
constexpr std::size_t innerHead = 12;  // length, code, timestamp

// 1980-01-06 00:00 UTC, the origin of the modem's time. Leap seconds are ignored.
constexpr nanoseconds gpsEpoch = std::chrono::seconds(315'964'800);
constexpr nanoseconds tick = std::chrono::microseconds(1250);

}  // namespace

std::variant<LogRecord, FrameFault> logRecordOf(std::span<const std::uint8_t> frame) {
  LogRecord record;
  if (!frame.empty() && frame[0] == wrapperKind) {
    const ByteView wrapper(frame);
    if (!wrapper.holds(0, wrapperLength) || wrapper.u32(0) != wrapperHead) return FrameFault::malformed;
    record.radio = wrapper.u32(4);
    frame = frame.subspan(wrapperLength);
  }
  const ByteView bytes(frame);
  if (frame.empty() || bytes.u8(0) != recordKind) return FrameFault::otherKind;
  if (!bytes.holds(0, outerHead + innerHead)) return FrameFault::malformed;
  const std::size_t length = bytes.u16(4);
  if (bytes.u16(2) != length || length < innerHead || !bytes.holds(outerHead, length)) return FrameFault::malformed;
  record.code = bytes.u16(6);
  const std::uint64_t ticks = bytes.u64(8) >> 16;
  constexpr auto lastTick = static_cast<std::uint64_t>((nanoseconds::max() - gpsEpoch) / tick);
  if (ticks > lastTick) return FrameFault::timeTooLate;
  record.time = gpsEpoch + static_cast<nanoseconds::rep>(ticks) * tick;
  record.payload = bytes.part(outerHead + innerHead, length - innerHead);
  return record;
}

}  // namespace vespscope::sources::diag
