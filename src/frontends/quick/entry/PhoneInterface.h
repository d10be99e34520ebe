// The phone interface for programs: requested here, drawn by a module that is loaded only then, because its toolkit
// costs start-up time and memory.
#pragma once

#include <memory>
#include <optional>

#include "frontends/quick/entry/Module.h"
#include "platform/application/Application.h"

namespace vespscope::quick {

// Returns why this interface cannot be used here: it was left out of the build, the environment names no display, its
// module does not load, or no display opens. Empty when it can.
[[nodiscard]] std::optional<Obstacle> obstacle();

// Requires that obstacle() found nothing. At most one exists at a time. From its creation on, SIGINT and SIGTERM end
// the program normally.
[[nodiscard]] std::unique_ptr<application::Frontend> makeFrontend(RefusalHandler refused);

}  // namespace vespscope::quick
