// The configurations that a manager has accepted from this client, and why no events are due.
//
// A manager may be restarted without its state: each manager that is connected to is given them again.
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
  // Notes the application of a request that is about to be sent.
  void sending(const vespscope::ipc::Dictionary& request);
  // Notes how a caller's command ended: an accepted configuration is kept in place of the application's earlier one,
  // and forgotten when it is cleared.
  void answered(std::string_view command, const vespscope::ipc::Dictionary& request,
                const vespscope::bus::Reply& reply);

  // Begins a connection: the requests that give the kept configurations to its manager. The answer to each one goes to
  // givenAgain().
  [[nodiscard]] std::vector<vespscope::ipc::Dictionary> begin();
  void givenAgain(const vespscope::bus::Reply& reply);
  // Notes whether the manager has a configuration for the application, as its status says.
  void reported(bool configured);

  // Why the manager has no configuration from which events are due; empty when it has one.
  [[nodiscard]] const std::string& problem() const { return problem_; }

 private:
  std::optional<std::int64_t> application_;
  std::map<std::int64_t, vespscope::ipc::Dictionary> accepted_;  // by application: the request
  std::size_t unanswered_ = 0;                                   // of those that were given again
  std::string problem_ = "no configuration has been sent";
};

}  // namespace rhox::client
