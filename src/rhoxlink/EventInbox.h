// Events on their way from the connection's thread to the handlers on the serial queue: in order, bounded, the
// oldest dropped first.
#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>

#include "rhoxlink/Rhoxlink.h"

namespace rhox::client {

class EventInbox : public std::enable_shared_from_this<EventInbox> {
 public:
  static constexpr std::size_t capacity = 8192;  // events

  // Makes `handler` the receiver of events of `kind`, in place of an earlier one.
  void setHandler(std::string_view kind, EventHandler handler);

  // Takes an event; true when a drain() must be scheduled, false when one is under way.
  [[nodiscard]] bool add(std::string_view kind, vespscope::ipc::Dictionary event);

  // Hands everything that waits to the handlers; runs on the serial queue.
  void drain();

  // Events that were dropped because the handlers did not keep up.
  [[nodiscard]] std::uint64_t dropped() const;

 private:
  struct Waiting {
    std::string kind;
    vespscope::ipc::Dictionary event;
  };
  using SharedHandler = std::shared_ptr<const EventHandler>;

  mutable std::mutex mutex_;
  std::deque<Waiting> waiting_;
  std::map<std::string, SharedHandler, std::less<>> handlers_;
  std::uint64_t dropped_ = 0;
  bool draining_ = false;
};

}  // namespace rhox::client
