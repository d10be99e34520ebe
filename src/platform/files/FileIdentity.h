// Identifies a file whatever its name: its device and inode.
#pragma once

#include <sys/types.h>

#include <optional>
#include <string>

namespace vespscope::files {

struct FileIdentity {
  dev_t device = 0;
  ino_t inode = 0;
  friend bool operator==(const FileIdentity&, const FileIdentity&) = default;
};

// Identifies the file that `path` names, following symbolic links; "-" is standard input. Empty when there is no such
// file.
[[nodiscard]] std::optional<FileIdentity> identityOf(const std::string& path);
[[nodiscard]] std::optional<FileIdentity> identityOf(int descriptor);

}  // namespace vespscope::files
