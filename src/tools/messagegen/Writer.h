// Turns the model of the schema into C++ headers.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "messagegen/Model.h"

namespace vespscope::messagegen {

// The path, relative to the folder of the messages, and the content of every generated file.
using GeneratedFiles = std::map<std::string, std::string>;

[[nodiscard]] GeneratedFiles generate(const std::vector<FileModel>& models);

}  // namespace vespscope::messagegen
