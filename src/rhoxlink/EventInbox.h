// Passes events from the connection's thread to the handlers on the serial queue: in order, bounded, the oldest dropped
// first.
//
// Handlers that pass events to another queue get a window, which limits the events in progress there; the next events
// follow when a mark behind the earlier ones has come through. Events beyond the window wait here, where they are
// bounded. If many wait, the library stops reading from the manager, which queues them.
#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

#include "rhoxlink/Rhoxlink.h"

namespace rhox::client {

class EventInbox : public std::enable_shared_from_this<EventInbox> {
 public:
  static constexpr std::size_t capacity = 8192;                      // events
  static constexpr std::size_t byteCapacity = std::size_t{4} << 20;  // of their content
  static constexpr std::size_t eventLimit = 16 * 1024;               // bytes of one event's content
  static constexpr std::size_t windowEvents = 1024;                  // passed on and not yet completed
  static constexpr std::size_t windowBytes = std::size_t{1} << 20;   // same, in bytes
  static constexpr std::size_t markEvery = windowEvents / 8;         // events
  static constexpr std::size_t markEveryBytes = windowBytes / 8;     // or bytes

  // Handlers run on `queue`. `afterwards` runs a task after everything that the handlers have passed on; without it, an
  // event counts as completed when its handler returns.
  EventInbox(std::weak_ptr<vespscope::dispatch::SerialQueue> queue, Afterwards afterwards);

  // Sets the handler of events of `kind`, replacing an earlier one.
  void setHandler(std::string_view kind, EventHandler handler);
  // Sets the observer, which receives the events with their facts before the handler does.
  void setObserver(std::string_view kind, EventObserver observer);
  // Calls `onRoom` on any thread whenever crowded() becomes false. After it is replaced it is not called again.
  void setRoomHandler(std::function<void()> onRoom);

  struct Arrived {
    std::string kind;
    vespscope::ipc::Dictionary event;
    EventFacts facts;
    std::size_t size = 0;  // bytes of the event's content
  };
  // Moves the events out of `arrived` and schedules the handlers.
  void add(std::vector<Arrived>& arrived);

  // Whether so many events wait that no more should be read from the manager.
  [[nodiscard]] bool crowded() const { return crowded_; }
  // The number of events dropped because the handlers were too slow.
  [[nodiscard]] std::uint64_t dropped() const;

 private:
  // The receivers of one kind of events; either may be empty.
  struct Receivers {
    EventHandler handler;
    EventObserver observer;
  };
  using Handlers = std::map<std::string, std::shared_ptr<const Receivers>, std::less<>>;

  // A number of events and their total bytes.
  struct Amount {
    std::size_t events = 0;
    std::size_t bytes = 0;
  };

  void setReceiver(std::string_view kind, const std::function<void(Receivers&)>& change);
  void scheduleDrain();
  // Passes waiting events to the handlers as far as the window allows; runs on the serial queue.
  void drain();
  // Takes the next few events, oldest first, and their amount; returns false when none waits or the window is closed.
  bool take(std::vector<Arrived>& taken, Amount& amount);
  void removeFirst();
  [[nodiscard]] bool windowTakes(const Amount& more) const;
  // Submits a mark after the events passed on, if they are enough and no other mark is pending; `lock` is released and
  // taken again.
  void mark(std::unique_lock<std::mutex>& lock);
  void passed(const Amount& before);

  const std::weak_ptr<vespscope::dispatch::SerialQueue> queue_;
  const Afterwards afterwards_;

  mutable std::mutex mutex_;
  std::deque<Arrived> waiting_;
  std::size_t waitingBytes_ = 0;
  // Replaced as a whole, so that the serial queue reads them without a lock while they stay the same.
  std::shared_ptr<const Handlers> handlers_ = std::make_shared<const Handlers>();
  std::atomic<std::uint64_t> handlerChanges_ = 0;
  std::function<void()> onRoom_;
  std::atomic<bool> crowded_ = false;
  std::uint64_t dropped_ = 0;
  Amount underWay_;  // passed on, not known to be completed
  bool marked_ = false;
  bool draining_ = false;
};

}  // namespace rhox::client
