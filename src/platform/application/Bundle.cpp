#include <cstdlib>
#include <string>
#include <system_error>
#include <utility>

#include "platform/application/System.h"

namespace vespscope::application {
namespace {

std::vector<std::filesystem::path> mainFolders() {
  if (const char* given = std::getenv("VESPSCOPE_RESOURCES"); given != nullptr && *given != '\0') return {given};
  std::error_code failure;
  const std::filesystem::path program = std::filesystem::read_symlink("/proc/self/exe", failure);
  if (failure) return {};
  const std::filesystem::path prefix = program.parent_path().parent_path();
  return {prefix / "share" / "vespscope", prefix / "resources"};
}

}  // namespace

Bundle& Bundle::main() {
  static Bundle bundle(mainFolders());
  return bundle;
}

std::optional<std::filesystem::path> Bundle::pathForResource(const std::string& name, const std::string& type) const {
  std::string file = name;
  file += '.';
  file += type;
  for (const std::filesystem::path& folder : folders_) {
    std::filesystem::path path = folder / file;
    std::error_code failure;
    if (std::filesystem::is_regular_file(path, failure)) return path;
  }
  return std::nullopt;
}

}  // namespace vespscope::application
