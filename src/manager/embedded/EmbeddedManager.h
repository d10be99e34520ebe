// A baseband manager that runs inside the process of its only client.
#pragma once

#include <string>

#include "rhoxlink/bus/Embedded.h"
#include "values/Result.h"

namespace vespscope::manager {

// Starts a manager with the source that `words` name ("scenario:seed=3", "replay:drive.pcap,loop") and returns the
// client's end of its socket, or why there is no such manager. Client libraries are given this for embedded addresses.
[[nodiscard]] Result<bus::EmbeddedEnd> startEmbeddedManager(const std::string& words);

}  // namespace vespscope::manager
