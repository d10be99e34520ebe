// Reads a folder of schema files and brings a folder of headers up to date with them.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "messagegen/Schema.h"
#include "messagegen/Writer.h"

namespace vespscope::messagegen {

// The schema files *.proto of a folder in the order of their names, or a fault that names file and line.
[[nodiscard]] Result<std::vector<SchemaFile>> readSchema(const std::filesystem::path& schemaFolder);

// The files made from every *.proto in `schemaFolder`, or a fault that names file and line.
[[nodiscard]] Result<GeneratedFiles> generateFrom(const std::filesystem::path& schemaFolder);

// Writes those of `files` that differ from what lies in `folder`; the number written, or why one could not be.
[[nodiscard]] Result<std::size_t> writeFiles(const GeneratedFiles& files, const std::filesystem::path& folder);

}  // namespace vespscope::messagegen
