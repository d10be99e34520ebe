// Turns the frames of a modem log into metric events, separately for each radio.
#pragma once

#include <cstdint>
#include <deque>
#include <map>
#include <span>

#include "sources/diag/DiagReport.h"
#include "sources/diag/RecordMapper.h"
#include "sources/diag/UnreadSamples.h"

namespace vespscope::sources::diag {

class FrameMapper {
 public:
  // Appends the frame's events, in order. If the modem reports a SIM's number, its events have that number as their
  // profile.
  void take(std::span<const std::uint8_t> frame, std::deque<MetricEvent>& events);
  // Keeps samples of what is not read from here on; they must live as long as this takes frames.
  void sampleUnread(UnreadSamples& samples) { samples_ = &samples; }
  // The counts of all frames so far, without the frame reader's own counters.
  [[nodiscard]] const DiagReport& report() const { return report_; }

 private:
  static constexpr std::size_t maximumRadios = 4;

  std::map<std::uint32_t, RecordMapper> radios_;
  DiagReport report_;
  UnreadSamples* samples_ = nullptr;
};

}  // namespace vespscope::sources::diag
