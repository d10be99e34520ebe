#include "sources/SourceInputs.h"

#include <unistd.h>

#include <algorithm>
#include <optional>
#include <system_error>
#include <vector>

#include "capture/CaptureReader.h"
#include "platform/files/FileIdentity.h"

namespace vespscope::sources {
namespace {

using files::FileIdentity;

bool isRecording(const SourceSpec& spec) {
  return spec.kind == SourceSpec::Kind::replay || spec.kind == SourceSpec::Kind::diag;
}

std::vector<FileIdentity> inputsOf(const SourceSpec& spec) {
  std::vector<std::string> paths = {spec.file};
  if (spec.kind == SourceSpec::Kind::replay) {
    if (auto captures = capture::captureFilesOf(spec.file)) paths = std::move(*captures);
  }
  std::vector<FileIdentity> inputs;
  for (const std::string& path : paths) {
    if (const auto identity = files::identityOf(path)) inputs.push_back(*identity);
  }
  return inputs;
}

bool isOneOf(const std::vector<FileIdentity>& inputs, const std::optional<FileIdentity>& file) {
  return file && std::find(inputs.begin(), inputs.end(), *file) != inputs.end();
}

std::optional<FileIdentity> folderOf(const std::filesystem::path& file) {
  return files::identityOf(file.has_parent_path() ? file.parent_path().string() : ".");
}

}  // namespace

bool readsOutput(const SourceSpec& spec, const std::string& output) {
  if (!isRecording(spec)) return false;
  const bool standard = output == "-";
  const auto file = standard ? files::identityOf(STDOUT_FILENO) : files::identityOf(output);
  // A file that is both input and output but not a regular file is a terminal or /dev/null, which store nothing.
  std::error_code error;
  const std::string name = standard ? "/proc/self/fd/1" : output;
  if (std::filesystem::is_regular_file(name, error) && isOneOf(inputsOf(spec), file)) return true;
  return !standard && spec.file != "-" && files::identityOf(spec.file) == folderOf(output);
}

bool readsFrom(const SourceSpec& spec, const std::filesystem::path& folder) {
  if (!isRecording(spec)) return false;
  const auto identity = files::identityOf(folder.string());
  if (identity && spec.file != "-" && files::identityOf(spec.file) == identity) return true;
  const std::vector<FileIdentity> inputs = inputsOf(spec);
  std::error_code error;
  std::filesystem::directory_iterator entry(folder, error);
  for (const std::filesystem::directory_iterator end; !error && entry != end; entry.increment(error)) {
    if (isOneOf(inputs, files::identityOf(entry->path().string()))) return true;
  }
  return false;
}

}  // namespace vespscope::sources
