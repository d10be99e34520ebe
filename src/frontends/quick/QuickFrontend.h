// The frontend that draws the screens as a phone or desktop application. This header names nothing of the toolkit, so
// that programs compile the same with and without it.
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "platform/application/Application.h"

namespace vespscope::quick {

struct Obstacle {
  std::string reason;  // one sentence for the user
  // Whether the surroundings promise this frontend, so that a user who did not name it would miss it all the same.
  bool unexpected = false;
};

// Why this frontend cannot be used here: it was left out of the build, or no display opens. Empty when it can.
[[nodiscard]] std::optional<Obstacle> obstacle();

// Told why the toolkit does not start although nothing stood in its way (it lacks a plugin for the display, say). Must
// not return.
using RefusalHandler = std::function<void(const std::string& reason)>;

// At most one at a time. From its making on, SIGINT and SIGTERM end the program in order.
[[nodiscard]] std::unique_ptr<application::Frontend> makeFrontend(RefusalHandler refused);

}  // namespace vespscope::quick
