// Calls services on the system bus and waits for their answers.
#pragma once

#include <poll.h>

#include <chrono>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>

#include "rhoxlink/bus/BusClient.h"

namespace vespscope::test {

class BusCaller {
 public:
  BusCaller() {
    auto bus = bus::BusClient::openSystem();
    if (!bus) throw std::runtime_error(bus.reason());
    bus_ = std::move(*bus);
  }

  bus::BusClient::Answer call(const bus::BusCall& call) {
    std::optional<bus::BusClient::Answer> answer;
    bus_->call(call, std::chrono::seconds(30), [&answer](const bus::BusClient::Answer& given) { answer = given; });
    while (bus_->process() && !answer) {
      const bus::Wait wait = bus_->wait();
      pollfd ready{wait.descriptor, wait.events, 0};
      ::poll(&ready, 1, 50);
    }
    return answer ? *answer : bus::BusClient::Answer(Failure{bus::BusError{"", "the bus ended the connection"}});
  }

 private:
  std::unique_ptr<bus::BusClient> bus_;
};

}  // namespace vespscope::test
