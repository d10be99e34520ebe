// Which files a source reads, so that nothing writes over them or removes them.
#pragma once

#include <filesystem>
#include <string>

#include "sources/playback/SourceSpec.h"

namespace vespscope::sources {

// Whether writing to `output` would write into what the source reads: one of its files, by whatever name or link, or
// its folder. "-" is standard input as a source and standard output as an output.
[[nodiscard]] bool readsOutput(const SourceSpec& spec, const std::string& output);

// Whether `folder` holds a file that the source reads, or is the folder that it reads.
[[nodiscard]] bool readsFrom(const SourceSpec& spec, const std::filesystem::path& folder);

}  // namespace vespscope::sources
