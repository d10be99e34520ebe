// A system bus of a test's own, with the manager's bus policy as it is installed.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

#include "support/PrivateBus.h"

namespace vespscope::test {

class ServiceBus final : public PrivateBus {
 public:
  // The group that this bus lets in, in place of the one that the installation makes; every Debian has it.
  static constexpr const char* group = "games";

  // When a client first asks for the manager, the bus starts `activated` (a program and its arguments); empty: it
  // cannot be started.
  explicit ServiceBus(const std::vector<std::string>& activated = {});

  // The process that has the manager's name; 0 when there is none.
  [[nodiscard]] pid_t managerProcess() const;
};

}  // namespace vespscope::test
