// The frontend that draws the screens as a phone or desktop application: what the module has of its own.
#pragma once

#include <memory>
#include <optional>

#include "frontends/quick/entry/Module.h"

namespace vespscope::quick {

// Why no display opens; empty when one does.
[[nodiscard]] std::optional<Obstacle> displayObstacle();

// At most one at a time. From its making on, SIGINT and SIGTERM end the program in order.
[[nodiscard]] std::unique_ptr<application::Frontend> makeQuickFrontend(RefusalHandler refused);

}  // namespace vespscope::quick
