// Writes the tables as source text that rrc/ includes.
#pragma once

#include <filesystem>
#include <map>
#include <string>

#include "rrcgen/Tables.h"
#include "values/Result.h"

namespace vespscope::rrcgen {

// File name to content.
using GeneratedFiles = std::map<std::string, std::string>;

[[nodiscard]] GeneratedFiles write(const Tables& tables);

// The files from each *.asn in `definitions` and the selection in the file `selection`, or a failure that states what
// is wrong where.
[[nodiscard]] Result<GeneratedFiles> generateFrom(const std::filesystem::path& definitions,
                                                  const std::filesystem::path& selection);

// Writes the files that differ from those in `folder`. Returns how many it has written, or which one it cannot write.
[[nodiscard]] Result<std::size_t> writeFiles(const GeneratedFiles& files, const std::filesystem::path& folder);

}  // namespace vespscope::rrcgen
