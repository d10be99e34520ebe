// The status line: where the data comes from and how well it flows, in as much room as there is.
#pragma once

#include <chrono>
#include <string>
#include <vector>

#include "frontends/terminal/Grid.h"
#include "platform/application/Status.h"

namespace vespscope::terminal {

struct StatusPart {
  std::string text;
  Role role = Role::text;
};

// The kind as a mark: "LIVE", "PLAYBACK", "SIMULATED", or "SOURCE UNKNOWN" until it is known.
[[nodiscard]] StatusPart sourceKindPart(SourceKind kind);

// What fits into `width` cells, from left to right; first words get shorter, then the least needed parts are left out.
// The kind of source always stays, and so do failures and losses while there are any, a missing connection or
// subscription, and the end of a recording.
[[nodiscard]] std::vector<StatusPart> statusParts(const application::Status& status,
                                                  std::chrono::system_clock::time_point now, int width, bool utf8);

// Draws the parts that fit into one line of the grid.
void drawStatus(Grid& grid, int line, const application::Status& status, std::chrono::system_clock::time_point now);

}  // namespace vespscope::terminal
