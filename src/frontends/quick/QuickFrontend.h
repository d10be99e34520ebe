// The frontend that draws the screens as a phone or desktop application: the module's own part.
#pragma once

#include <memory>
#include <optional>

#include "frontends/quick/entry/Module.h"

namespace vespscope::quick {

// Returns why no display opens; empty when one does.
[[nodiscard]] std::optional<Obstacle> displayObstacle();

// At most one exists at a time. From its creation on, SIGINT and SIGTERM end the program normally.
[[nodiscard]] std::unique_ptr<application::Frontend> makeQuickFrontend(RefusalHandler refused);

}  // namespace vespscope::quick
