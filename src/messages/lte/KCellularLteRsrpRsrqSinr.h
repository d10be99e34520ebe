// LTE signal quality over a period: the average and the single samples.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/lte/RsrpRsrqSinr.h"

namespace vespscope {

class KCellularLteRsrpRsrqSinr final : public Message<KCellularLteRsrpRsrqSinr> {
 public:
  static constexpr std::string_view className = "KCellularLteRsrpRsrqSinr";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  // Null when absent.
  [[nodiscard]] const std::string* callId() const noexcept { return _callId.get(); }
  void setCallId(std::string callId) { _callId = std::make_shared<const std::string>(std::move(callId)); }
  void clearCallId() noexcept { _callId = nullptr; }
  [[nodiscard]] bool hasCallId() const noexcept { return _callId != nullptr; }

  [[nodiscard]] std::uint32_t lastXSeconds() const noexcept { return _lastXSeconds; }
  void setLastXSeconds(std::uint32_t lastXSeconds) noexcept {
    _lastXSeconds = lastXSeconds;
    _has.set(2);
  }
  void setHasLastXSeconds(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasLastXSeconds() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t lastYSamples() const noexcept { return _lastYSamples; }
  void setLastYSamples(std::uint32_t lastYSamples) noexcept {
    _lastYSamples = lastYSamples;
    _has.set(3);
  }
  void setHasLastYSamples(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasLastYSamples() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t samplePeriodMs() const noexcept { return _samplePeriodMs; }
  void setSamplePeriodMs(std::uint32_t samplePeriodMs) noexcept {
    _samplePeriodMs = samplePeriodMs;
    _has.set(5);
  }
  void setHasSamplePeriodMs(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasSamplePeriodMs() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t durationMs() const noexcept { return _durationMs; }
  void setDurationMs(std::uint32_t durationMs) noexcept {
    _durationMs = durationMs;
    _has.set(1);
  }
  void setHasDurationMs(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasDurationMs() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t numSamples() const noexcept { return _numSamples; }
  void setNumSamples(std::uint32_t numSamples) noexcept {
    _numSamples = numSamples;
    _has.set(4);
  }
  void setHasNumSamples(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasNumSamples() const noexcept { return _has.test(4); }

  // Null when absent.
  [[nodiscard]] std::shared_ptr<RsrpRsrqSinr> avgValues() const noexcept { return _avgValues; }
  void setAvgValues(std::shared_ptr<RsrpRsrqSinr> avgValues) noexcept { _avgValues = std::move(avgValues); }
  [[nodiscard]] bool hasAvgValues() const noexcept { return _avgValues != nullptr; }

  void clearInstValues() noexcept { _instValues.clear(); }
  void addInstValues(std::shared_ptr<RsrpRsrqSinr> instValues) { _instValues.add(std::move(instValues)); }
  [[nodiscard]] std::size_t instValuesCount() const noexcept { return _instValues.size(); }
  [[nodiscard]] const std::shared_ptr<RsrpRsrqSinr>& instValuesAtIndex(std::size_t index) const { return _instValues.at(index); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        contentField(3, "call_id", &Self::_callId),
        numberField<NumberKind::uint32>(6, "last_x_seconds", &Self::_lastXSeconds, 2),
        numberField<NumberKind::uint32>(7, "last_y_samples", &Self::_lastYSamples, 3),
        numberField<NumberKind::uint32>(8, "sample_period_ms", &Self::_samplePeriodMs, 5),
        numberField<NumberKind::uint32>(10, "duration_ms", &Self::_durationMs, 1),
        numberField<NumberKind::uint32>(11, "num_samples", &Self::_numSamples, 4),
        messageField(14, "avg_values", &Self::_avgValues),
        messageListField(15, "inst_values", &Self::_instValues));
  }

 private:
  friend class Message<KCellularLteRsrpRsrqSinr>;

  std::uint64_t _timestamp = 0;
  std::shared_ptr<const std::string> _callId;
  std::shared_ptr<RsrpRsrqSinr> _avgValues;
  MessageList<RsrpRsrqSinr> _instValues;
  std::uint32_t _lastXSeconds = 0;
  std::uint32_t _lastYSamples = 0;
  std::uint32_t _samplePeriodMs = 0;
  std::uint32_t _durationMs = 0;
  std::uint32_t _numSamples = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteRsrpRsrqSinr>;

}  // namespace vespscope
