#include "messagegen/Generator.h"

#include <optional>
#include <utility>

namespace vespscope::messagegen {

namespace filesystem = std::filesystem;

Result<std::vector<SchemaFile>> readSchema(const filesystem::path& schemaFolder) {
  const auto paths = generation::filesOf(schemaFolder, ".proto");
  if (!paths) return Failure{paths.reason()};
  if (paths->empty()) return Failure{schemaFolder.string() + ": no schema files"};

  std::vector<SchemaFile> files;
  for (const filesystem::path& path : *paths) {
    const std::optional<std::string> text = generation::contentOf(path);
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

}  // namespace vespscope::messagegen
