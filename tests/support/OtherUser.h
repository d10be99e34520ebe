// Runs a part of a test as another user of the machine, in a child process.
#pragma once

#include <sys/types.h>

#include <functional>
#include <string>
#include <vector>

namespace vespscope::test {

inline constexpr uid_t nobody = 65534;

// Returns the result of `action`, run as `user` with `groups` only; requires the administrator.
[[nodiscard]] std::string asUser(uid_t user, const std::vector<gid_t>& groups,
                                 const std::function<std::string()>& action);

}  // namespace vespscope::test
