// Writes samples of records that are not read into a folder, one file each.
#pragma once

#include <string>

#include "sources/diag/UnreadSamples.h"
#include "sources/playback/SourceSpec.h"
#include "tools/vespctl/Commands.h"

namespace vespscope::tools {

// Creates the folder where there is none. Without `force` nothing is written when one of the files exists; a file that
// `source` reads is never replaced.
[[nodiscard]] Problem writeSamples(const sources::diag::UnreadSamples& samples, const std::string& folder,
                                   const sources::SourceSpec& source, bool force);

}  // namespace vespscope::tools
