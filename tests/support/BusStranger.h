// Anything that a program may try on the system bus to reach the manager and its events without our client library.
#pragma once

#include <chrono>
#include <string>

struct sd_bus;

namespace vespscope::test {

class BusStranger {
 public:
  BusStranger();
  BusStranger(const BusStranger&) = delete;
  BusStranger& operator=(const BusStranger&) = delete;
  ~BusStranger();

  // Calls a method of the manager ("EventsOn", "PerformCommand" with the command Status); returns the error's name,
  // empty when it is answered.
  std::string callManager(const std::string& method);
  // Requests the introspection of the manager's object; returns the error's name.
  std::string introspectManager();
  // Requests the manager's name; returns the error.
  std::string takeName();
  // Requests everything from the bus, as a monitor does; returns the error's name.
  std::string becomeMonitor();
  // Subscribes to all events, whatever their destination; returns how many arrive within `time`.
  int overhear(std::chrono::milliseconds time);
  // Sends an event to a client in the manager's name; returns false when the bus rejects it.
  bool forgeEvent(const std::string& client);

 private:
  sd_bus* bus_ = nullptr;
};

}  // namespace vespscope::test
