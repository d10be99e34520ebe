// The address of a baseband manager, parsed from the words that a user gives.
#pragma once

#include <string>
#include <string_view>

#include "values/Result.h"

namespace rhox::client {

struct Address {
  enum class Kind {
    none,        // "none": never connects, for tools that decode files
    automatic,   // "auto": resolved to one of the others, whichever fits this machine
    system,      // "system": the bus name org.vespscope.BasebandManager1
    unixSocket,  // "unix:path=…": a socket on which rhoxd listens; the path is taken literally
    ssh,         // "ssh:HOST": a manager on another machine, reached through ssh
    embedded,    // "embedded:SOURCE": a manager inside this process
  };

  Kind kind = Kind::automatic;
  std::string detail;  // the path, the host or the source's words

  // Returns the address that `words` mean, or why they are invalid.
  static vespscope::Result<Address> parse(std::string_view words);
};

}  // namespace rhox::client
