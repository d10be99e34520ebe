#include "platform/files/FileIdentity.h"

#include <sys/stat.h>
#include <unistd.h>

namespace vespscope::files {

std::optional<FileIdentity> identityOf(const std::string& path) {
  if (path == "-") return identityOf(STDIN_FILENO);
  struct stat found {};
  if (::stat(path.c_str(), &found) != 0) return std::nullopt;
  return FileIdentity{found.st_dev, found.st_ino};
}

std::optional<FileIdentity> identityOf(int descriptor) {
  struct stat found {};
  if (::fstat(descriptor, &found) != 0) return std::nullopt;
  return FileIdentity{found.st_dev, found.st_ino};
}

}  // namespace vespscope::files
