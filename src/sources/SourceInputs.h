// The files that a source reads, which must not be overwritten or removed.
#pragma once

#include <filesystem>
#include <string>

#include "sources/playback/SourceSpec.h"

namespace vespscope::sources {

// Whether writing to `output` would write to an input of the source: one of its files, by whatever name or link, or its
// folder. "-" is standard input as a source and standard output as an output.
[[nodiscard]] bool readsOutput(const SourceSpec& spec, const std::string& output);

// Whether `folder` contains a file that the source reads, or is the folder that it reads.
[[nodiscard]] bool readsFrom(const SourceSpec& spec, const std::filesystem::path& folder);

}  // namespace vespscope::sources
