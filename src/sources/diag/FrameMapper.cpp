#include "sources/diag/FrameMapper.h"

#include <utility>

#include "sources/diag/LogRecord.h"

namespace vespscope::sources::diag {

void FrameMapper::take(std::span<const std::uint8_t> frame, std::deque<MetricEvent>& events) {
  const auto parsed = logRecordOf(frame);
  if (const auto* fault = std::get_if<FrameFault>(&parsed)) {
    ++(*fault == FrameFault::otherKind ? report_.otherFrames : report_.malformedFrames);
    return;
  }
  const auto& record = std::get<LogRecord>(parsed);
  if (!radios_.contains(record.radio) && radios_.size() == maximumRadios) {
    ++report_.otherRadios;
    return;
  }
  for (MetricEvent& event : radios_[record.radio].take(record, report_)) events.push_back(std::move(event));
  if (samples_ != nullptr) samples_->take(record, report_);
}

}  // namespace vespscope::sources::diag
