#include "sources/scenario/ScenarioStream.h"

#include <atomic>
#include <optional>
#include <stop_token>
#include <string>

#include "sources/scenario/Phone.h"
#include "sources/scenario/SimCard.h"

namespace vespscope::sources {
namespace {

class ScenarioStream final : public EventStream {
 public:
  ScenarioStream(std::uint64_t seed, std::chrono::nanoseconds start)
      : seed_(seed), start_(start), phone_(std::in_place, seed, start) {}

  [[nodiscard]] std::string label() const override { return "scenario seed=" + std::to_string(seed_); }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::simulated; }

  [[nodiscard]] std::optional<MetricEvent> next() override {
    std::optional<MetricEvent> event = phone_->take();
    while (!event) {
      phone_->tick();
      now_ = phone_->now();
      event = phone_->take();
    }
    return event;
  }

  void rewind() override {
    phone_.emplace(seed_, start_);
    now_ = phone_->now();
  }

  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token /*stop*/) override {
    return scenario::cardFilesEvent(scenario::testCardFiles(), start_ + now_.load());
  }

 private:
  std::uint64_t seed_;
  std::chrono::nanoseconds start_;
  std::optional<scenario::Phone> phone_;
  std::atomic<scenario::Time> now_{};  // of the phone, for other threads
};

}  // namespace

std::unique_ptr<EventStream> makeScenarioStream(std::uint64_t seed, std::chrono::nanoseconds start) {
  return std::make_unique<ScenarioStream>(seed, start);
}

}  // namespace vespscope::sources
