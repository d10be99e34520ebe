// What the generators of source text have in common: they read a folder and update another.
#pragma once

#include <cstddef>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "values/Result.h"

namespace vespscope::generation {

// File name, within the folder, to content.
using GeneratedFiles = std::map<std::string, std::string>;

// Returns the content of a file; empty if it cannot be read.
[[nodiscard]] std::optional<std::string> contentOf(const std::filesystem::path& path);

// Returns the files of a folder whose names end in `extension`, such as ".proto", in the order of their names.
[[nodiscard]] Result<std::vector<std::filesystem::path>> filesOf(const std::filesystem::path& folder,
                                                                 const std::string& extension);

// Writes those of `files` that differ from the existing ones in `folder`; returns their number, or the error.
[[nodiscard]] Result<std::size_t> writeFiles(const GeneratedFiles& files, const std::filesystem::path& folder);

// The end of a generator's main function: writes the files, prints their number or the error, and returns the exit
// status.
[[nodiscard]] int finish(const std::string& program, const Result<GeneratedFiles>& files,
                         const std::filesystem::path& folder);

}  // namespace vespscope::generation
