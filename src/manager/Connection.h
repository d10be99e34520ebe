// A way by which clients reach the manager: a socket with one client at its other end, or the system bus with many.
#pragma once

#include <cstddef>

#include "rhoxlink/bus/Bus.h"

namespace vespscope::manager {

class Connection {
 public:
  virtual ~Connection() = default;
  // Sends what waits and answers what has come, each in a bounded number, so that the others get their turn however
  // fast events come; false when the connection is over.
  virtual bool work() = 0;
  // True when the bound ended what work() did: more can be done at once.
  [[nodiscard]] virtual bool hasMore() const = 0;
  [[nodiscard]] virtual bus::Wait wait() const = 0;
  [[nodiscard]] virtual std::size_t clients() const = 0;
  // False while the client at the other end has none of the manager's places, as before its first call.
  [[nodiscard]] virtual bool hasPlace() const = 0;
};

}  // namespace vespscope::manager
