// The configurations that a manager has accepted from this client, and why no events are expected.
//
// A manager may restart without its state, so each new connection sends them again.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/bus/Bus.h"

namespace rhox::client {

class Subscription {
 public:
  // The application that the last request named.
  [[nodiscard]] std::optional<std::int64_t> application() const { return application_; }
  // Records the application of a request that is about to be sent.
  void sending(const vespscope::ipc::Dictionary& request);
  // Records the result of a caller's command: an accepted configuration replaces the application's earlier one; a
  // cleared one is removed.
  void answered(std::string_view command, const vespscope::ipc::Dictionary& request,
                const vespscope::bus::Reply& reply);

  // Begins a connection: returns the requests that send the stored configurations to its manager. Pass the answer to
  // each to givenAgain().
  [[nodiscard]] std::vector<vespscope::ipc::Dictionary> begin();
  void givenAgain(const vespscope::bus::Reply& reply);
  // Records whether the manager has a configuration for the application, according to its status.
  void reported(bool configured);

  // Why the manager has no configuration that selects events; empty when it has one.
  [[nodiscard]] const std::string& problem() const { return problem_; }

 private:
  std::optional<std::int64_t> application_;
  std::map<std::int64_t, vespscope::ipc::Dictionary> accepted_;  // by application: the request
  std::size_t unanswered_ = 0;                                   // of the requests sent again
  std::string problem_ = "no configuration has been sent";
};

}  // namespace rhox::client
