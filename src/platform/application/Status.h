// What a frontend reports to the user about the source of the data, next to the screens.
#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "values/PlaybackPosition.h"
#include "values/SourceKind.h"

namespace vespscope::application {

// The SIM cards of a phone that has several.
struct SimCards {
  std::optional<std::int32_t> shown;  // whose values the screens show; empty until it is known
  std::vector<std::int32_t> others;   // that report too, ascending
};

struct Status {
  SourceKind kind = SourceKind::unknown;
  std::string source;          // "scenario seed=1", "lte-ca-drive.mi2log"
  bool connected = false;      // to the baseband manager
  bool everConnected = false;  // a baseband manager has answered since the start
  std::uint64_t events = 0;    // received since start
  double eventsPerSecond = 0;  // over the last seconds
  std::uint64_t decodeFailures = 0;
  std::uint64_t eventsLost = 0;     // gaps in the manager's sequence numbers
  std::uint64_t interruptions = 0;  // times the connection to the manager was lost and restored; events in between are
                                    // not counted
  std::optional<std::chrono::system_clock::time_point> lastEvent;  // when it was received
  std::string notSubscribed;                 // why no events are expected although connected; empty when some are
  std::optional<PlaybackPosition> playback;  // of a recording; empty for any other source
  std::string problem;                       // why there is no connection, while there is none
  SimCards sims;
};

using StatusProvider = std::function<Status()>;

}  // namespace vespscope::application
