// Decides by the application's configuration which of the source's events are due to a client: metrics that it does not
// name never, the others as often as it says, and always the last value.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "manager/Configuration.h"
#include "values/MetricEvent.h"

namespace vespscope::manager {

using SharedEvent = std::shared_ptr<const MetricEvent>;

class DeliveryFilter {
 public:
  using Clock = std::chrono::steady_clock;

  // The maximum number of metrics, by profile, whose last delivery is remembered; our sources use less than a tenth of
  // it. Events of further metrics pass unfiltered.
  static constexpr std::size_t slotLimit = 4096;

  // Sets the configuration. Earlier deliveries stay remembered, so that they are not repeated. Null: no event passes,
  // and all deliveries are forgotten.
  void setConfiguration(std::shared_ptr<const Configuration> configuration);

  // Offers an event that the source made at `now`; appends the events to deliver to `due`. An event within its metric's
  // period waits, replaced by later ones, until the period ends: when an event of a later time arrives, or by the
  // clock.
  void offer(const SharedEvent& event, Clock::time_point now, std::vector<SharedEvent>& due);

  // Appends the waiting events whose period has ended by the clock.
  void collect(Clock::time_point now, std::vector<SharedEvent>& due);
  // When collect() next has an event to append.
  [[nodiscard]] std::optional<Clock::time_point> nextDue() const;

 private:
  struct Slot {
    SharedEvent last;                       // delivered
    std::chrono::nanoseconds periodEnd{0};  // by the events' time
    SharedEvent waiting;                    // the newest within the period
    Clock::time_point due;                  // when the period ends by the clock; used only while an event waits
  };
  using Key = std::pair<std::int32_t, std::int32_t>;  // metric and profile

  void offerPeriodic(Slot& slot, const SharedEvent& event, std::chrono::nanoseconds period, Clock::time_point now,
                     std::vector<SharedEvent>& due);
  void release(Slot& slot, std::chrono::nanoseconds period, std::vector<SharedEvent>& due);
  void releaseUntil(std::chrono::nanoseconds time, std::vector<SharedEvent>& due);

  std::shared_ptr<const Configuration> configuration_;
  std::map<Key, Slot> slots_;
  std::size_t waiting_ = 0;  // slots with a waiting event
};

}  // namespace vespscope::manager
