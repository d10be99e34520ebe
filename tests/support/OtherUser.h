// Runs a piece of a test as another user of the machine, in a process of its own.
#pragma once

#include <sys/types.h>

#include <functional>
#include <string>
#include <vector>

namespace vespscope::test {

inline constexpr uid_t nobody = 65534;

// What `action` gives when `user`, a member of `groups` only, does it; only the administrator can have that done.
[[nodiscard]] std::string asUser(uid_t user, const std::vector<gid_t>& groups,
                                 const std::function<std::string()>& action);

}  // namespace vespscope::test
