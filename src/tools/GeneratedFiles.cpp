#include "tools/GeneratedFiles.h"

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <system_error>

namespace vespscope::generation {

namespace filesystem = std::filesystem;

std::optional<std::string> contentOf(const filesystem::path& path) {
  std::ifstream file(path, std::ios::binary);
  if (!file) return std::nullopt;
  return std::string(std::istreambuf_iterator<char>(file), {});
}

Result<std::vector<filesystem::path>> filesOf(const filesystem::path& folder, const std::string& extension) {
  std::vector<filesystem::path> paths;
  std::error_code error;
  for (const filesystem::directory_entry& entry : filesystem::directory_iterator(folder, error)) {
    if (entry.path().extension() == extension) paths.push_back(entry.path());
  }
  if (error) return Failure{folder.string() + ": " + error.message()};
  std::sort(paths.begin(), paths.end());
  return paths;
}

Result<std::size_t> writeFiles(const GeneratedFiles& files, const filesystem::path& folder) {
  std::size_t written = 0;
  for (const auto& [name, content] : files) {
    const filesystem::path path = folder / name;
    if (contentOf(path) == content) continue;
    std::error_code error;
    filesystem::create_directories(path.parent_path(), error);
    if (error) return Failure{path.parent_path().string() + ": " + error.message()};
    std::ofstream file(path, std::ios::binary);
    file << content;
    file.close();
    if (!file) return Failure{path.string() + ": cannot be written"};
    ++written;
  }
  return written;
}

int finish(const std::string& program, const Result<GeneratedFiles>& files, const filesystem::path& folder) {
  constexpr int failureStatus = 2;
  const Result<std::size_t> written = files ? writeFiles(*files, folder) : Result<std::size_t>(Failure{files.reason()});
  if (!written) {
    std::fprintf(stderr, "%s: %s\n", program.c_str(), written.reason().c_str());
    return failureStatus;
  }
  std::printf("%zu files, %zu written\n", files->size(), *written);
  return 0;
}

}  // namespace vespscope::generation
