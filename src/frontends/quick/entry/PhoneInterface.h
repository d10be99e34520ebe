// The phone interface as programs use it: asked for here, drawn by a module that is loaded only then, since its toolkit
// costs every start time and memory.
#pragma once

#include <memory>
#include <optional>

#include "frontends/quick/entry/Module.h"
#include "platform/application/Application.h"

namespace vespscope::quick {

// Why this interface cannot be used here: it was left out of the build, the environment names no display, its module
// does not load, or no display opens. Empty when it can.
[[nodiscard]] std::optional<Obstacle> obstacle();

// Where obstacle() found none. At most one at a time. From its making on, SIGINT and SIGTERM end the program in order.
[[nodiscard]] std::unique_ptr<application::Frontend> makeFrontend(RefusalHandler refused);

}  // namespace vespscope::quick
