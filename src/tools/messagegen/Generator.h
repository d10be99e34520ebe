// Reads a folder of schema files and updates a folder of headers.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "messagegen/Schema.h"
#include "messagegen/Writer.h"

namespace vespscope::messagegen {

// Returns the schema files *.proto of a folder in the order of their names, or an error that names file and line.
[[nodiscard]] Result<std::vector<SchemaFile>> readSchema(const std::filesystem::path& schemaFolder);

// Returns the files made from every *.proto in `schemaFolder`, or an error that names file and line.
[[nodiscard]] Result<GeneratedFiles> generateFrom(const std::filesystem::path& schemaFolder);

}  // namespace vespscope::messagegen
