// Relays one client's calls to the manager on this machine's system bus, and that manager's events back.
#pragma once

#include <memory>
#include <string>

#include "rhoxlink/bus/Bus.h"

namespace vespscope::bus {

class BusRelay final : private Service {
 public:
  // Serves the client that writes to `input` and reads from `output`, which may be the same and are owned from here on.
  static Result<std::unique_ptr<BusRelay>> open(int input, int output);

  // Runs until one side ends; returns an empty text if it was the client, else why the manager's side ended.
  std::string run();

 private:
  BusRelay() = default;
  void performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) override;
  void eventsOn() override { manager_->setEvents(true); }
  void eventsOff() override { manager_->setEvents(false); }
  void waitForWork() const;

  std::unique_ptr<ServerEnd> client_;
  std::unique_ptr<ClientEnd> manager_;
};

}  // namespace vespscope::bus
