// What makes two names name the same file: its device and inode.
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

// The identity of what `path` names, symbolic links followed; "-" is standard input. Empty when there is nothing.
[[nodiscard]] std::optional<FileIdentity> identityOf(const std::string& path);
[[nodiscard]] std::optional<FileIdentity> identityOf(int descriptor);

}  // namespace vespscope::files
