// Events on their way from the connection's thread to the handlers on the serial queue: in order, bounded, the
// oldest dropped first.
//
// Where handlers hand events on to another queue, they are given a window: no more than that is under way there, and
// the next events follow when a mark behind the earlier ones has come through. So what waits waits here, where it is
// bounded, and before that at the manager, which is not read from while much waits here.
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
  static constexpr std::size_t windowEvents = 1024;                  // that are handed on and not done with
  static constexpr std::size_t windowBytes = std::size_t{1} << 20;   // likewise
  static constexpr std::size_t markEvery = windowEvents / 8;         // events
  static constexpr std::size_t markEveryBytes = windowBytes / 8;     // or bytes

  // Events are handled on `queue`. `afterwards` leads behind what handlers have handed on; without it, they are done
  // with an event when they return.
  EventInbox(std::weak_ptr<vespscope::dispatch::SerialQueue> queue, Afterwards afterwards);

  // Makes `handler` the receiver of events of `kind`, in place of an earlier one.
  void setHandler(std::string_view kind, EventHandler handler);
  // Makes `observer` the one that receives them first, with what came beside them.
  void setObserver(std::string_view kind, EventObserver observer);
  // Calls `onRoom` whenever crowded() ends, on any thread. Once it is replaced it is not called any more.
  void setRoomHandler(std::function<void()> onRoom);

  struct Arrived {
    std::string kind;
    vespscope::ipc::Dictionary event;
    EventFacts facts;
    std::size_t size = 0;  // bytes of the event's content
  };
  // Takes events, which are gone from `arrived` then, and has them handled.
  void add(std::vector<Arrived>& arrived);

  // Whether so much waits that no more should be taken from the manager.
  [[nodiscard]] bool crowded() const { return crowded_; }
  // Events that were dropped because the handlers did not keep up.
  [[nodiscard]] std::uint64_t dropped() const;

 private:
  // Of one kind of events; either may be empty.
  struct Receivers {
    EventHandler handler;
    EventObserver observer;
  };
  using Handlers = std::map<std::string, std::shared_ptr<const Receivers>, std::less<>>;

  // A number of events and their bytes.
  struct Amount {
    std::size_t events = 0;
    std::size_t bytes = 0;
  };

  void setReceiver(std::string_view kind, const std::function<void(Receivers&)>& change);
  void scheduleDrain();
  // Hands what waits to the handlers, as far as the window goes; runs on the serial queue.
  void drain();
  // The next few events, oldest first, and how much they are; false when none waits or the window is closed.
  bool take(std::vector<Arrived>& taken, Amount& amount);
  void removeFirst();
  [[nodiscard]] bool windowTakes(const Amount& more) const;
  // Sends a mark behind what is under way, when that is enough and none is on its way; takes the lock for itself.
  void mark(std::unique_lock<std::mutex>& lock);
  void passed(const Amount& before);

  const std::weak_ptr<vespscope::dispatch::SerialQueue> queue_;
  const Afterwards afterwards_;

  mutable std::mutex mutex_;
  std::deque<Arrived> waiting_;
  std::size_t waitingBytes_ = 0;
  // Replaced as a whole, so that who hands out events looks them up without a lock while they stay the same.
  std::shared_ptr<const Handlers> handlers_ = std::make_shared<const Handlers>();
  std::atomic<std::uint64_t> handlerChanges_ = 0;
  std::function<void()> onRoom_;
  std::atomic<bool> crowded_ = false;
  std::uint64_t dropped_ = 0;
  Amount underWay_;  // handed on, and not known to be done with
  bool marked_ = false;
  bool draining_ = false;
};

}  // namespace rhox::client
