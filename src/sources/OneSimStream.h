// The events of one SIM card, out of a recording of a phone with several.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "sources/playback/Source.h"

namespace vespscope::sources {

class OneSimStream final : public EventStream {
 public:
  // `sim` is the number that the modem gives the SIM card, which events carry as their profile. Events of no card in
  // particular (profile 0) pass too.
  OneSimStream(std::unique_ptr<EventStream> all, std::int32_t sim) : all_(std::move(all)), sim_(sim) {}

  [[nodiscard]] std::string label() const override { return all_->label(); }
  [[nodiscard]] SourceKind kind() const override { return all_->kind(); }
  [[nodiscard]] std::optional<MetricEvent> next() override;
  [[nodiscard]] bool canRewind() const override { return all_->canRewind(); }
  void rewind() override { all_->rewind(); }
  void interrupt() override { all_->interrupt(); }
  [[nodiscard]] InputProgress progress() const override { return all_->progress(); }
  [[nodiscard]] std::optional<std::string> failure() const override { return all_->failure(); }
  [[nodiscard]] std::string summary() const override { return all_->summary(); }
  [[nodiscard]] std::string report() const override { return all_->report(); }
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token stop) override;
  [[nodiscard]] std::optional<std::chrono::nanoseconds> length(const std::stop_token& stop) override {
    return all_->length(stop);
  }

 private:
  [[nodiscard]] bool passes(const MetricEvent& event) const { return event.profileID == 0 || event.profileID == sim_; }

  std::unique_ptr<EventStream> all_;
  std::int32_t sim_;
};

// The SIM card that has data bearers first, in the beginning of the stream, which is rewound afterwards. Empty when
// none of several cards has, when there is one card at most, and for a stream that cannot be rewound.
[[nodiscard]] std::optional<std::int32_t> simCardOfData(EventStream& stream);

}  // namespace vespscope::sources
