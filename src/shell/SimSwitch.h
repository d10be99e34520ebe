// Lets the user switch between the SIM cards of a phone: the choice is made where events arrive, so that none of the
// card shown before comes behind the switch.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <vector>

#include "client/MetricGate.h"
#include "platform/application/Status.h"
#include "shell/SimChoice.h"

namespace vespscope {

class SimSwitch final : public MetricGate, public std::enable_shared_from_this<SimSwitch> {
 public:
  // `wanted`: the card that is shown first; without it, the one that the manager's source names, else SimChoice's rule.
  static std::shared_ptr<SimSwitch> create(std::optional<std::int32_t> wanted);

  // Makes it the gate of the shared wrapper, which is made afterwards.
  void install();

  void take(std::shared_ptr<const Record> dictionary, const Pass& pass) override;

  // The rest belongs to the main thread.

  // Shows the card with the next number. The decoder holds its values alone when the listeners for the end are called.
  void showNext();
  [[nodiscard]] application::SimCards cards() const;
  // When the latest event of the metric came that is shown.
  [[nodiscard]] std::optional<SimChoice::Clock::time_point> arrivalOf(std::int64_t metricID) const;

  // Called when the values of the card shown before are to be forgotten, and when those of the other one are there.
  void onForget(std::function<void()> listener) { forget_.push_back(std::move(listener)); }
  void onShown(std::function<void()> listener) { shown_.push_back(std::move(listener)); }

 private:
  explicit SimSwitch(std::optional<std::int32_t> wanted);
  // Runs `change` on the choice; when another card is shown after it, its events are behind a call of forget_, and
  // ahead of one of shown_.
  template <class Change>
  void perform(const Change& change);
  void callSoon(std::vector<std::function<void()>> SimSwitch::*listeners);

  std::vector<std::function<void()>> forget_;
  std::vector<std::function<void()>> shown_;
  mutable std::mutex mutex_;  // of what follows
  Pass pass_;
  SimChoice choice_;
};

}  // namespace vespscope
