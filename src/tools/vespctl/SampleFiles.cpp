#include "tools/vespctl/SampleFiles.h"

#include <unistd.h>

#include <cerrno>
#include <filesystem>
#include <span>
#include <system_error>

#include "platform/files/NewFile.h"
#include "sources/SourceInputs.h"

namespace vespscope::tools {
namespace {

namespace fs = std::filesystem;
using files::NewFile;

std::string pathOf(const std::string& folder, const sources::diag::UnreadSamples::Kind& kind) {
  return (fs::path(folder) / (fileNameOf(kind) + ".mi2log")).string();
}

Problem writeAll(int descriptor, std::span<const std::uint8_t> bytes, const std::string& path) {
  while (!bytes.empty()) {
    const ssize_t written = ::write(descriptor, bytes.data(), bytes.size());
    if (written < 0 && errno == EINTR) continue;
    if (written <= 0) return path + ": cannot be written: " + std::generic_category().message(errno);
    bytes = bytes.subspan(static_cast<std::size_t>(written));
  }
  return std::nullopt;
}

Problem writeFile(const std::string& path, std::span<const std::uint8_t> bytes, bool force) {
  auto file = NewFile::create(path, force ? NewFile::Existing::replace : NewFile::Existing::refuse);
  if (!file) return file.reason();
  if (Problem problem = writeAll(file->descriptor(), bytes, path)) {
    file->discard();
    return problem;
  }
  return file->finish();
}

}  // namespace

Problem writeSamples(const sources::diag::UnreadSamples& samples, const std::string& folder,
                     const sources::SourceSpec& source, bool force) {
  std::error_code error;
  fs::create_directories(folder, error);
  if (error) return folder + ": cannot be created: " + error.message();
  for (const auto& [kind, log] : samples.samples()) {
    const std::string path = pathOf(folder, kind);
    if (sources::readsOutput(source, path)) return path + ": is the source itself";
    if (!force && fs::exists(fs::symlink_status(path, error))) return path + ": exists already; --force replaces it";
  }
  for (const auto& [kind, log] : samples.samples()) {
    if (Problem problem = writeFile(pathOf(folder, kind), log, force)) return problem;
  }
  return std::nullopt;
}

}  // namespace vespscope::tools
