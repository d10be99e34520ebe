#include "capture/CaptureReader.h"

#include <algorithm>
#include <filesystem>
#include <initializer_list>
#include <system_error>
#include <utility>

#include "capture/EventPacket.h"

namespace vespscope::capture {
namespace {

bool isFolder(const std::string& path) {
  std::error_code absent;
  return path != "-" && std::filesystem::is_directory(path, absent);
}

// "drive.pcap", also compressed: "drive.pcap.gz".
bool isNamedAsCapture(std::filesystem::path path) {
  const auto isOneOf = [&path](std::initializer_list<const char*> extensions) {
    return std::find(extensions.begin(), extensions.end(), path.extension()) != extensions.end();
  };
  if (isOneOf({".gz", ".xz"})) path.replace_extension();
  return isOneOf({".pcap", ".pcapng"});
}

std::uint64_t sizeOf(const std::string& path) {
  std::error_code error;
  const std::uintmax_t size = std::filesystem::file_size(path, error);
  return error ? 0 : size;
}

}  // namespace

std::string nameOfInput(const std::string& path) { return path == "-" ? "standard input" : path; }

Result<std::vector<std::string>> captureFilesOf(const std::string& path) {
  if (!isFolder(path)) return std::vector<std::string>{path};
  std::vector<std::string> files;
  std::error_code error;
  std::filesystem::directory_iterator entry(path, error);
  for (const std::filesystem::directory_iterator end; !error && entry != end; entry.increment(error)) {
    if (isNamedAsCapture(entry->path())) files.push_back(entry->path().string());
  }
  if (error) return Failure{path + ": cannot be opened: " + error.message()};
  if (files.empty()) return Failure{path + ": contains no captures (*.pcap, *.pcap.gz, *.pcap.xz)"};
  std::sort(files.begin(), files.end());
  return files;
}

Result<CaptureReader> CaptureReader::open(const std::string& path,
                                          std::shared_ptr<const dispatch::WakeDescriptor> interruption) {
  Result<std::vector<std::string>> files = captureFilesOf(path);
  if (!files) return Failure{files.reason()};
  CaptureReader reader(std::move(*files), isFolder(path), std::move(interruption));
  if (reader.ofFolder_) return reader;
  if (auto reason = reader.openNext()) return Failure{*std::move(reason)};
  return reader;
}

std::optional<std::string> CaptureReader::openNext() {
  const std::string& path = files_[opened_++];
  before_ = count_;
  auto input = PcapInput::open(path, interruption_);
  if (input) {
    input_.emplace(std::move(*input));
    return std::nullopt;
  }
  bytesBefore_ += sizeOf(path);
  return nameOfInput(path) + ": " + input.reason() + (ofFolder_ ? "; the file is skipped" : "");
}

void CaptureReader::close() {
  input_.reset();
  bytesBefore_ += sizeOf(files_[opened_ - 1]);
}

Result<std::optional<MetricEvent>> CaptureReader::next() {
  while (true) {
    if (!input_) {
      if (opened_ == files_.size()) return std::optional<MetricEvent>{};
      if (auto reason = openNext()) return Failure{*std::move(reason)};
    }
    const auto packet = input_->next();
    if (input_->interrupted()) return std::optional<MetricEvent>{};
    if (!packet) return fail(packet.reason());
    if (!packet->has_value()) {
      close();
      continue;
    }
    auto event = eventOf((*packet)->bytes, (*packet)->time);
    if (!event) return fail(event.reason());
    ++count_;
    return std::optional<MetricEvent>(std::move(*event));
  }
}

Result<std::optional<MetricEvent>> CaptureReader::fail(const std::string& reason) {
  close();
  return Failure{nameOfInput(files_[opened_ - 1]) + ": packet " + std::to_string(count_ - before_) + ": " + reason +
                 (ofFolder_ ? "; the rest of the file is skipped" : "")};
}

std::uint64_t CaptureReader::bytesInAll() const {
  std::uint64_t bytes = 0;
  for (const std::string& file : files_) bytes += sizeOf(file);
  return bytes;
}

}  // namespace vespscope::capture
