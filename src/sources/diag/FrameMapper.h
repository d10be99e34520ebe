// Turns the frames of a modem log into metric events, each radio for itself.
#pragma once

#include <cstdint>
#include <deque>
#include <map>
#include <span>

#include "sources/diag/DiagReport.h"
#include "sources/diag/RecordMapper.h"

namespace vespscope::sources::diag {

class FrameMapper {
 public:
  // Appends the frame's events, in order. Those of a SIM whose number the modem tells carry it as their profile.
  void take(std::span<const std::uint8_t> frame, std::deque<MetricEvent>& events);
  // Of all frames so far; the frames' own counters are left to their reader.
  [[nodiscard]] const DiagReport& report() const { return report_; }

 private:
  static constexpr std::size_t maximumRadios = 4;

  std::map<std::uint32_t, RecordMapper> radios_;
  DiagReport report_;
};

}  // namespace vespscope::sources::diag
