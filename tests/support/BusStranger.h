// What any program may try on the system bus to get at the manager and its events, past our client library.
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

  // Calls a method of the manager ("EventsOn", "PerformCommand" with the command Status); the error's name, empty when
  // it is answered.
  std::string callManager(const std::string& method);
  // Asks the manager's object what it is; the error's name.
  std::string introspectManager();
  // Asks for the manager's name; the error.
  std::string takeName();
  // Asks the bus for everything, as a monitor does; the error's name.
  std::string becomeMonitor();
  // Asks the bus for all events, to whomever they go; how many come within `time`.
  int overhear(std::chrono::milliseconds time);
  // Sends an event to a client in the manager's place; false when the bus does not take it.
  bool forgeEvent(const std::string& client);

 private:
  sd_bus* bus_ = nullptr;
};

}  // namespace vespscope::test
