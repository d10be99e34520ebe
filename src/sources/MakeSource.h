// Makes the running source that a user's words name.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "sources/playback/Source.h"
#include "sources/playback/SourceSpec.h"
#include "values/Result.h"

namespace vespscope::sources {

// The stream of the source that `spec` names, for a caller that pulls its events as fast as it goes (its playing
// options are not applied), or why there is none. A SIM card that `spec` names is the only one in it.
[[nodiscard]] Result<std::unique_ptr<EventStream>> makeStream(const SourceSpec& spec);

// A source for words such as "scenario:seed=3" or "replay:drive.pcap,loop", not started yet, or why there is none. It
// delivers every SIM card of a recording or a modem; the one that the words name, else the one with data bearers, is
// the one to be shown first.
[[nodiscard]] Result<std::unique_ptr<Source>> makeSource(std::string_view words);

}  // namespace vespscope::sources
