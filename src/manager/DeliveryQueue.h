// The events that wait for one client, numbered and bounded: if the client does not read, the oldest are dropped.
#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <optional>

#include "manager/DeliveryFilter.h"

namespace vespscope::manager {

class DeliveryQueue {
 public:
  // Holds what a client misses that stops for an eighth of a second at 100,000 events a second; at most about 3 MB.
  struct Bounds {
    std::size_t events = 12'288;
    std::size_t bytes = std::size_t{2} << 20;  // of payload
  };
  struct Numbered {
    std::uint64_t sequence = 0;  // counts from 1; a dropped event leaves a gap
    SharedEvent event;
  };

  DeliveryQueue() = default;
  explicit DeliveryQueue(Bounds bounds) : bounds_(bounds) {}

  void push(SharedEvent event) {
    bytes_ += event->payload.size();
    events_.push_back({++lastSequence_, std::move(event)});
    while (events_.size() > bounds_.events || (bytes_ > bounds_.bytes && events_.size() > 1)) {
      drop();
      ++lost_;
    }
  }

  [[nodiscard]] std::optional<Numbered> take() {
    if (events_.empty()) return std::nullopt;
    Numbered first = events_.front();
    drop();
    return first;
  }

  // Removes the waiting events, which the client no longer wants, and reuses their numbers.
  void clear() {
    lastSequence_ -= events_.size();
    events_.clear();
    bytes_ = 0;
  }

  [[nodiscard]] bool empty() const { return events_.empty(); }
  [[nodiscard]] std::size_t size() const { return events_.size(); }
  [[nodiscard]] std::size_t bytes() const { return bytes_; }
  [[nodiscard]] std::uint64_t lost() const { return lost_; }

 private:
  void drop() {
    bytes_ -= events_.front().event->payload.size();
    events_.pop_front();
  }

  Bounds bounds_;
  std::deque<Numbered> events_;
  std::size_t bytes_ = 0;
  std::uint64_t lastSequence_ = 0;
  std::uint64_t lost_ = 0;
};

}  // namespace vespscope::manager
