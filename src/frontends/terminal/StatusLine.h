// The status line: the source of the data and its flow, in the available width.
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

// Returns the parts that fit into `width` cells, from left to right; words are shortened first, then the least
// important parts are left out. The kind of source and the SIM card shown always stay, as do failures and losses, a
// missing connection or subscription, and the end of a recording.
[[nodiscard]] std::vector<StatusPart> statusParts(const application::Status& status,
                                                  std::chrono::system_clock::time_point now, int width, bool utf8);

// Draws the parts that fit into one line of the grid.
void drawStatus(Grid& grid, int line, const application::Status& status, std::chrono::system_clock::time_point now);

}  // namespace vespscope::terminal
