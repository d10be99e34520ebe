// Tells captures and modem logs apart by their contents, so that a user only names the file.
#pragma once

#include <string>

#include "values/Result.h"

namespace vespscope::sources {

enum class FileKind { capture, modemLog };

// Whether the file begins like a modem's diagnostic log. Standard input is not looked at.
[[nodiscard]] bool isModemLog(const std::string& path);

// What kind of recording the file is; a folder is one of captures. Fails, naming the file, when it is neither.
[[nodiscard]] Result<FileKind> recogniseFile(const std::string& path);

// The words that name such a file as a source: "diag:drive,,2.mi2log" for "drive,2.mi2log".
[[nodiscard]] std::string sourceWords(FileKind kind, const std::string& path);

}  // namespace vespscope::sources
