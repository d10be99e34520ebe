// Shown instead of rows when a table has none.
#pragma once

#include <string>

#include "frontends/terminal/ScreenModel.h"
#include "platform/application/Status.h"

namespace vespscope::terminal {

struct EmptyState {
  std::string title;
  std::string explanation;
};

// `status` is null when nothing is known about the source.
[[nodiscard]] EmptyState emptyStateOf(const ScreenModel& screen, const application::Status* status, bool utf8);

}  // namespace vespscope::terminal
