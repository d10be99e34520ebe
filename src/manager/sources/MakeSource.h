// Makes the running source that a user's words name.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "manager/Source.h"
#include "manager/SourceSpec.h"
#include "rhoxlink/bus/Embedded.h"
#include "values/Result.h"

namespace vespscope::manager {

// The stream of the source that `spec` names, for who pulls its events as fast as it goes (its playing options are
// not applied), or why there is none.
[[nodiscard]] Result<std::unique_ptr<EventStream>> makeStream(const SourceSpec& spec);

// A source for words such as "scenario:seed=3" or "replay:drive.pcap,loop", not started yet, or why there is none.
[[nodiscard]] Result<std::unique_ptr<Source>> makeSource(std::string_view words);

// A manager inside this process with such a source, and the client's end of its socket; what client libraries are
// given for embedded addresses.
[[nodiscard]] Result<bus::EmbeddedEnd> startEmbeddedManager(const std::string& words);

}  // namespace vespscope::manager
