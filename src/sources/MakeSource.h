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

// Returns a source for words such as "scenario:seed=3" or "replay:drive.pcap,loop", not started yet, or why there is
// none.
[[nodiscard]] Result<std::unique_ptr<Source>> makeSource(std::string_view words);

}  // namespace vespscope::sources
