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

// Returns the files made from each *.asn in `definitions` and the selection in the file `selection`, or an error that
// names the file.
[[nodiscard]] Result<GeneratedFiles> generateFrom(const std::filesystem::path& definitions,
                                                  const std::filesystem::path& selection);

// Writes the files that differ from those in `folder`. Returns their number, or the error.
[[nodiscard]] Result<std::size_t> writeFiles(const GeneratedFiles& files, const std::filesystem::path& folder);

}  // namespace vespscope::rrcgen
