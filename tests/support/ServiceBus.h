// A system bus of the test, with the manager's installed bus policy.
#pragma once

#include <sys/types.h>

#include <string>
#include <vector>

#include "support/PrivateBus.h"

namespace vespscope::test {

class ServiceBus final : public PrivateBus {
 public:
  // The group that this bus admits in place of the installed one; every Debian system has it.
  static constexpr const char* group = "games";

  // When a client first calls the manager, the bus starts `activated` (a program and its arguments); empty: it cannot
  // be started.
  explicit ServiceBus(const std::vector<std::string>& activated = {});

  // The process that owns the manager's name; 0 if there is none.
  [[nodiscard]] pid_t managerProcess() const;
};

}  // namespace vespscope::test
