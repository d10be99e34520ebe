// Writes the tables as source text that rrc/ includes.
#pragma once

#include <filesystem>
#include <string>

#include "rrcgen/Tables.h"
#include "tools/GeneratedFiles.h"
#include "values/Result.h"

namespace vespscope::rrcgen {

using generation::GeneratedFiles;

[[nodiscard]] GeneratedFiles write(const Tables& tables);

// Returns the files made from each *.asn in `definitions` and the selection in the file `selection`, or an error that
// names the file.
[[nodiscard]] Result<GeneratedFiles> generateFrom(const std::filesystem::path& definitions,
                                                  const std::filesystem::path& selection);

}  // namespace vespscope::rrcgen
