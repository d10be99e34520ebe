// Decides which of the source's events one client is due, by its application's configuration: what that does not
// name never, the rest as often as it says, and always the last value.
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

  // Metrics, by profile, of which is remembered what was delivered; no source of ours has a tenth as many. What comes
  // of others passes as it is.
  static constexpr std::size_t slotLimit = 4096;

  // What was delivered under the configuration before is remembered, so that it is not delivered again. Null:
  // nothing passes, and all is forgotten.
  void setConfiguration(std::shared_ptr<const Configuration> configuration);

  // Offers an event that the source made at `now`; appends to `due` what is to be delivered. An event within its
  // metric's period waits, replaced by later ones, until the period ends: when an event of a later time comes, or
  // by the clock.
  void offer(const SharedEvent& event, Clock::time_point now, std::vector<SharedEvent>& due);

  // Appends the waiting events whose period has ended by the clock.
  void collect(Clock::time_point now, std::vector<SharedEvent>& due);
  // When collect() next has something.
  [[nodiscard]] std::optional<Clock::time_point> nextDue() const;

 private:
  struct Slot {
    SharedEvent last;                       // delivered
    std::chrono::nanoseconds periodEnd{0};  // by the events' time
    SharedEvent waiting;                    // the newest within the period
    Clock::time_point due;                  // when the period ends by the clock; only while one waits
  };
  using Key = std::pair<std::int32_t, std::int32_t>;  // metric and profile

  void offerPeriodic(Slot& slot, const SharedEvent& event, std::chrono::nanoseconds period, Clock::time_point now,
                     std::vector<SharedEvent>& due);
  void release(Slot& slot, std::chrono::nanoseconds period, std::vector<SharedEvent>& due);
  void releaseUntil(std::chrono::nanoseconds time, std::vector<SharedEvent>& due);

  std::shared_ptr<const Configuration> configuration_;
  std::map<Key, Slot> slots_;
  std::size_t waiting_ = 0;  // slots in which an event waits
};

}  // namespace vespscope::manager
