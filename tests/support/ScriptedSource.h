// A source whose events a test delivers one by one.
#pragma once

#include <atomic>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "sources/playback/Source.h"

namespace vespscope::test {

class ScriptedSource final : public sources::Source {
 public:
  // The test's access to the source, which the manager owns.
  struct Control {
    std::atomic<sources::EventSink*> sink = nullptr;
    std::atomic<int> starts = 0;
    std::atomic<int> stops = 0;
    std::optional<MetricEvent> simCardFiles;
    bool searches = false;  // they are found when the test calls for it
    std::vector<sources::SimCardFilesHandler> waiting;

    // Delivers an event; the source has been started.
    void deliver(std::int32_t metricID, Bytes payload, std::chrono::milliseconds time = {},
                 std::int32_t profileID = 0) const {
      sink.load()->deliver({metricID, profileID, std::move(payload), time});
    }
  };

  explicit ScriptedSource(std::shared_ptr<Control> control) : control_(std::move(control)) {}

  [[nodiscard]] std::string label() const override { return "scripted"; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  void start(sources::EventSink& sink) override {
    control_->sink = &sink;
    ++control_->starts;
  }
  void stop() override { ++control_->stops; }
  void findSimCardFiles(sources::SimCardFilesHandler found) override {
    if (control_->searches) {
      control_->waiting.push_back(std::move(found));
    } else {
      found(control_->simCardFiles);
    }
  }

 private:
  std::shared_ptr<Control> control_;
};

}  // namespace vespscope::test
