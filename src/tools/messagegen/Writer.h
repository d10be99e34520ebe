// Turns the model of the schema into C++ headers.
#pragma once

#include <vector>

#include "messagegen/Model.h"
#include "tools/GeneratedFiles.h"

namespace vespscope::messagegen {

// The paths are relative to the folder of the messages.
using generation::GeneratedFiles;

[[nodiscard]] GeneratedFiles generate(const std::vector<FileModel>& models);

}  // namespace vespscope::messagegen
