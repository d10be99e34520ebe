// The frontend that draws the screens as a phone or desktop application. This header names nothing of the toolkit, so
// that programs compile the same with and without it.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/application/Application.h"

namespace vespscope::quick {

// Why this frontend cannot be used here, one sentence for the user: it was left out of the build, or there is no
// display. Empty when it can.
[[nodiscard]] std::optional<std::string> obstacle();

// At most one at a time; with an obstacle, a programming error. From its making on, SIGINT and SIGTERM end the program
// in order.
[[nodiscard]] std::unique_ptr<application::Frontend> makeFrontend();

}  // namespace vespscope::quick
