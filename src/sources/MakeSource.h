// Makes the running source that a user's words describe.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "sources/playback/Source.h"
#include "sources/playback/SourceSpec.h"
#include "values/Result.h"

namespace vespscope::sources {

// Returns the stream of the source in `spec`, for callers that read its events as fast as possible (playing options are
// not applied), or why there is none.
[[nodiscard]] Result<std::unique_ptr<EventStream>> makeStream(const SourceSpec& spec);

// Of a modem log that holds several SIM cards: all for a recording, one for a screen.
enum class SimCards { all, one };

// Returns a source for words such as "scenario:seed=3" or "replay:drive.pcap,loop", not started yet, or why there is
// none. Words that name a SIM card choose it in either case.
[[nodiscard]] Result<std::unique_ptr<Source>> makeSource(std::string_view words, SimCards cards = SimCards::all);

}  // namespace vespscope::sources
