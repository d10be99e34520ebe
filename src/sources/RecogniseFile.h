// Distinguishes captures and modem logs by their contents, so that a user only names the file.
#pragma once

#include <string>

#include "values/Result.h"

namespace vespscope::sources {

enum class FileKind { capture, modemLog };

// Whether the file begins like a modem's diagnostic log. Standard input is not examined.
[[nodiscard]] bool isModemLog(const std::string& path);

// Returns the kind of a recording; a folder is one of captures. Otherwise fails with an error that names the file.
[[nodiscard]] Result<FileKind> recogniseFile(const std::string& path);

// Returns the words that name such a file as a source: "diag:drive,,2.mi2log" for "drive,2.mi2log".
[[nodiscard]] std::string sourceWords(FileKind kind, const std::string& path);

}  // namespace vespscope::sources
