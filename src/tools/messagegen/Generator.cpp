#include "messagegen/Generator.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <optional>
#include <system_error>

namespace vespscope::messagegen {
namespace {

namespace filesystem = std::filesystem;

std::optional<std::string> contentOf(const filesystem::path& path) {
  std::ifstream file(path, std::ios::binary);
  if (!file) return std::nullopt;
  return std::string(std::istreambuf_iterator<char>(file), {});
}

}  // namespace

Result<std::vector<SchemaFile>> readSchema(const filesystem::path& schemaFolder) {
  std::vector<filesystem::path> paths;
  std::error_code error;
  for (const filesystem::directory_entry& entry : filesystem::directory_iterator(schemaFolder, error)) {
    if (entry.path().extension() == ".proto") paths.push_back(entry.path());
  }
  if (error) return Failure{schemaFolder.string() + ": " + error.message()};
  if (paths.empty()) return Failure{schemaFolder.string() + ": no schema files"};
  std::sort(paths.begin(), paths.end());

  std::vector<SchemaFile> files;
  for (const filesystem::path& path : paths) {
    const std::optional<std::string> text = contentOf(path);
    if (!text) return Failure{path.string() + ": cannot be read"};
    auto file = parseSchema(path.stem().string(), *text);
    if (!file) return Failure{file.reason()};
    files.push_back(std::move(*file));
  }
  return files;
}

Result<GeneratedFiles> generateFrom(const filesystem::path& schemaFolder) {
  const auto files = readSchema(schemaFolder);
  if (!files) return Failure{files.reason()};
  const auto models = buildModel(*files);
  if (!models) return Failure{models.reason()};
  return generate(*models);
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

}  // namespace vespscope::messagegen
