// A transport by which clients reach the manager: a socket with one client at its other end, or the system bus with
// many.
#pragma once

#include <cstddef>

#include "rhoxlink/bus/Bus.h"

namespace vespscope::manager {

class Connection {
 public:
  virtual ~Connection() = default;
  // Sends queued events and answers received messages, a bounded number of each, so that other connections get their
  // turn; returns false when the connection is closed.
  virtual bool work() = 0;
  // Whether work() stopped at its bound although more can be done.
  [[nodiscard]] virtual bool hasMore() const = 0;
  [[nodiscard]] virtual bus::Wait wait() const = 0;
  [[nodiscard]] virtual std::size_t clients() const = 0;
  // Whether the client has one of the manager's places; false before its first call.
  [[nodiscard]] virtual bool hasPlace() const = 0;
};

}  // namespace vespscope::manager
