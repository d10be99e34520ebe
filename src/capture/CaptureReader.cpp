#include "capture/CaptureReader.h"

#include <algorithm>
#include <filesystem>
#include <functional>
#include <system_error>

#include "capture/EventPacket.h"

namespace vespscope::capture {
namespace {

// The captures in a folder, the last name first.
Result<std::vector<std::string>> capturesIn(const std::string& folder) {
  std::vector<std::string> files;
  std::error_code error;
  std::filesystem::directory_iterator entry(folder, error);
  for (const std::filesystem::directory_iterator end; !error && entry != end; entry.increment(error)) {
    const std::filesystem::path extension = entry->path().extension();
    if (extension == ".pcap" || extension == ".pcapng") files.push_back(entry->path().string());
  }
  if (error) return Failure{folder + ": cannot be opened: " + error.message()};
  if (files.empty()) return Failure{folder + ": holds no captures (*.pcap)"};
  std::sort(files.begin(), files.end(), std::greater<>());
  return files;
}

}  // namespace

std::string nameOfInput(const std::string& path) { return path == "-" ? "standard input" : path; }

Result<CaptureReader> CaptureReader::open(const std::string& path) {
  std::error_code absent;
  std::vector<std::string> files = {path};
  if (std::filesystem::is_directory(path, absent)) {
    Result<std::vector<std::string>> found = capturesIn(path);
    if (!found) return Failure{found.reason()};
    files = std::move(*found);
  }
  auto input = PcapInput::open(files.back());
  if (!input) return Failure{nameOfInput(files.back()) + ": " + input.reason()};
  CaptureReader reader(nameOfInput(files.back()), std::move(*input));
  files.pop_back();
  reader.rest_ = std::move(files);
  return reader;
}

Result<bool> CaptureReader::openNext() {
  if (rest_.empty()) return false;
  auto input = PcapInput::open(rest_.back());
  if (!input) return Failure{rest_.back() + ": " + input.reason()};
  input_ = std::move(*input);
  name_ = rest_.back();
  rest_.pop_back();
  before_ = count_;
  return true;
}

Result<std::optional<MetricEvent>> CaptureReader::next() {
  if (failure_) return Failure{*failure_};
  auto packet = input_.next();
  while (packet && !packet->has_value()) {
    const Result<bool> more = openNext();
    if (!more) {
      failure_ = more.reason();
      return Failure{*failure_};
    }
    if (!*more) return std::optional<MetricEvent>{};
    packet = input_.next();
  }
  if (!packet) return fail(packet.reason());
  auto event = eventOf((*packet)->bytes, (*packet)->time);
  if (!event) return fail(event.reason());
  ++count_;
  return std::optional<MetricEvent>(std::move(*event));
}

Result<std::optional<MetricEvent>> CaptureReader::fail(const std::string& reason) {
  failure_ = name_ + ": packet " + std::to_string(count_ - before_) + ": " + reason;
  return Failure{*failure_};
}

}  // namespace vespscope::capture
