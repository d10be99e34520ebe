// Opens the socket to the manager that an address means.
#pragma once

#include "rhoxlink/Address.h"
#include "rhoxlink/bus/Embedded.h"
#include "values/Result.h"

namespace rhox::client {

// A connected socket and what keeps its other end alive, or why there is none. Does not wait for the other end.
vespscope::Result<vespscope::bus::EmbeddedEnd> openSocket(const Address& address,
                                                          const vespscope::bus::EmbeddedFactory& factory);

}  // namespace rhox::client
