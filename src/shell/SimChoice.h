// Chooses the SIM card whose events are shown, of a phone with several, and keeps the latest events of every card for
// the moment when another one is chosen.
#pragma once

#include <array>
#include <chrono>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <vector>

#include "registry/MetricRows.h"
#include "values/Value.h"

namespace vespscope {

// Belongs to one thread at a time.
class SimChoice {
 public:
  using Clock = std::chrono::steady_clock;
  using Event = std::shared_ptr<const Record>;  // the dictionary of a metric event

  // A phone has no more; events of further ones are dropped.
  static constexpr std::size_t mostCards = 4;

  struct Output {
    std::function<void()> forget;     // what was passed so far: it belongs to a card that is no longer shown
    std::function<void(Event)> pass;  // an event of the card that is shown, or of no card in particular
  };

  // `wanted` is shown whatever comes. `preferred` is asked once, when the first event of a card comes, and may return
  // none; it may be empty.
  SimChoice(Output output, std::optional<std::int32_t> wanted,
            std::function<std::optional<std::int32_t>()> preferred = {});

  // Shown is the wanted card, else the preferred one, else the first one seen until another reports data bearers before
  // it does. Events of no card in particular (profile 0) always pass.
  void take(Event event, Clock::time_point arrival);
  // Shows `card` from now on, of which the latest events are passed again in the order in which they came.
  void show(std::int32_t card);
  // Shows the card with the next number; nothing changes while there is one card.
  void showNext();

  [[nodiscard]] std::optional<std::int32_t> shown() const { return shown_; }
  // The numbers of the cards that were seen, ascending.
  [[nodiscard]] std::vector<std::int32_t> seen() const;
  // When the latest event of the metric came that is shown; empty when there is none.
  [[nodiscard]] std::optional<Clock::time_point> arrivalOf(std::int64_t metricID) const;

 private:
  struct Held {
    Event event;
    std::uint64_t number = 0;  // in the order in which events came
    Clock::time_point arrival;
  };
  using Latest = std::array<Held, metricRows.size()>;

  void choose(std::int32_t card);

  Output output_;
  std::function<std::optional<std::int32_t>()> preferred_;
  std::optional<std::int32_t> shown_;
  bool decided_;                           // shown_ does not change by itself
  std::map<std::int32_t, Latest> latest_;  // by card; 0 is none in particular
  std::uint64_t taken_ = 0;
};

}  // namespace vespscope
