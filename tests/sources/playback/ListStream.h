// A stream of events at given times, and a sink that stores the events.
#pragma once

#include <atomic>
#include <chrono>
#include <mutex>
#include <optional>
#include <stop_token>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "sources/playback/RecordedTime.h"
#include "sources/playback/Source.h"

namespace vespscope::test {

// Events at given times, each with its number as payload.
class ListStream final : public sources::EventStream {
 public:
  explicit ListStream(std::vector<std::chrono::milliseconds> times, bool canRewind = true)
      : times_(std::move(times)), canRewind_(canRewind) {}
  [[nodiscard]] std::string label() const override { return "list"; }
  [[nodiscard]] SourceKind kind() const override { return sourceKind; }
  [[nodiscard]] std::optional<MetricEvent> next() override {
    if (next_ == times_.size()) return std::nullopt;
    const auto number = static_cast<std::uint8_t>(next_);
    return MetricEvent{1, 0, {number}, times_[next_++]};
  }
  [[nodiscard]] bool canRewind() const override { return canRewind_; }
  void rewind() override { next_ = 0; }
  [[nodiscard]] std::optional<std::string> failure() const override { return failureText; }
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token stop) override {
    while (searchIsLong && !stop.stop_requested()) std::this_thread::sleep_for(std::chrono::milliseconds(1));
    return MetricEvent{2, 0, {0x42}, std::chrono::milliseconds(0)};
  }
  [[nodiscard]] std::optional<std::chrono::nanoseconds> length(const std::stop_token& stop) override {
    ListStream again(times_);
    return canRewind_ ? sources::lengthOf(again, stop) : std::nullopt;
  }

  SourceKind sourceKind = SourceKind::recorded;
  std::optional<std::string> failureText;
  std::atomic<bool> searchIsLong = false;  // until it is reset

 private:
  std::vector<std::chrono::milliseconds> times_;
  bool canRewind_;
  std::size_t next_ = 0;
};

class Collector final : public sources::EventSink {
 public:
  void deliver(MetricEvent event) override {
    const std::lock_guard lock(mutex_);
    numbers_.push_back(event.payload.at(0));
  }
  std::vector<int> numbers() {
    const std::lock_guard lock(mutex_);
    return numbers_;
  }

 private:
  std::mutex mutex_;
  std::vector<int> numbers_;
};

}  // namespace vespscope::test
