// A baseband manager with one client, over a socket pair, that delivers the test's events.
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "rhoxlink/bus/Bus.h"

namespace vespscope::test {

class EventServer final : private bus::Service {
 public:
  // Accepts the client library's next connection; one server at a time.
  EventServer();
  EventServer(const EventServer&) = delete;
  EventServer& operator=(const EventServer&) = delete;
  ~EventServer() override;

  // Returns false when the client has not turned delivery on in time.
  bool waitUntilEventsOn(std::chrono::milliseconds limit);
  // Sends an event of the kind to the client.
  void send(std::string_view kind, ipc::Dictionary event);

 private:
  void performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) override;
  void eventsOn() override;
  void eventsOff() override;
  void run(int descriptor);

  struct Event {
    std::string kind;
    ipc::Dictionary dictionary;
  };

  int wakeDescriptor_ = -1;
  std::mutex mutex_;
  std::condition_variable changed_;
  bool on_ = false;
  bool stopping_ = false;
  std::vector<Event> events_;
  std::thread thread_;
};

// Makes a metric event as the manager sends it.
[[nodiscard]] ipc::Dictionary metricEvent(std::int64_t identifier, Bytes payload);

}  // namespace vespscope::test
