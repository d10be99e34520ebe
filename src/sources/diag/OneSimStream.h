// The events of one SIM card, from the log of a phone with several.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "sources/playback/Source.h"

namespace vespscope::sources {

class OneSimStream final : public EventStream {
 public:
  // `sim` is the modem's number of the SIM card, which its events have as their profile. Without it, selects the card
  // with data bearers in the log, else the first one; if the log cannot be read twice, its first card. Events without a
  // card (profile 0) always pass.
  OneSimStream(std::unique_ptr<EventStream> all, std::optional<std::int32_t> sim);

  // "drive.mi2log (SIM 1)", if the log has another SIM as well.
  [[nodiscard]] std::string label() const override;
  [[nodiscard]] SourceKind kind() const override { return all_->kind(); }
  [[nodiscard]] std::optional<MetricEvent> next() override;
  [[nodiscard]] bool canRewind() const override { return all_->canRewind(); }
  void rewind() override { all_->rewind(); }
  void interrupt() override { all_->interrupt(); }
  [[nodiscard]] InputProgress progress() const override { return all_->progress(); }
  [[nodiscard]] std::optional<std::string> failure() const override { return all_->failure(); }
  [[nodiscard]] std::string summary() const override { return all_->summary(); }
  [[nodiscard]] std::string report() const override { return all_->report(); }
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token stop) override {
    return all_->simCardFiles(stop);
  }
  [[nodiscard]] std::optional<std::chrono::nanoseconds> length(const std::stop_token& stop) override {
    return all_->length(stop);
  }

 private:
  void lookAhead();

  std::unique_ptr<EventStream> all_;
  std::optional<std::int32_t> sim_;
  bool several_ = false;
};

}  // namespace vespscope::sources
