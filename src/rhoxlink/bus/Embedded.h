// How a program gives its client library a baseband manager that runs inside the process.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "values/Result.h"

namespace vespscope::bus {

// A running manager: the client's end of a socket pair, and what keeps the manager alive.
struct EmbeddedEnd {
  int descriptor = -1;  // a connected stream socket, owned by the caller
  std::shared_ptr<void> keeper;
};

// Makes a manager for the words of a source ("scenario:seed=3", "replay:drive.pcap,loop").
using EmbeddedFactory = std::function<Result<EmbeddedEnd>(const std::string& sourceWords)>;

}  // namespace vespscope::bus
