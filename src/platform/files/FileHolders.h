// Finds the processes that have a file or a device open.
#pragma once

#include <sys/types.h>

#include <optional>
#include <string>
#include <vector>

namespace vespscope::files {

struct Holder {
  pid_t process = 0;
  std::string program;  // its name, as the kernel has it
  bool operator==(const Holder&) const = default;
};

struct Holders {
  std::vector<Holder> found;  // by process number, this process aside
  bool complete = true;       // false when there are processes that this user may not examine
};

[[nodiscard]] Holders holdersOf(const std::string& path);

// The process that a lock file in `folder` names for the serial line `device`, as terminal programs agree on it
// ("LCK..ttyUSB0"); empty without a lock file, or when the process has ended.
[[nodiscard]] std::optional<Holder> lockOwnerOf(const std::string& device, const std::string& folder = "/run/lock");

}  // namespace vespscope::files
