#include "platform/files/FileHolders.h"

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <charconv>
#include <filesystem>
#include <fstream>
#include <system_error>

namespace vespscope::files {
namespace {

namespace fs = std::filesystem;

std::optional<pid_t> processNumber(const std::string& name) {
  pid_t number = 0;
  const auto [end, error] = std::from_chars(name.data(), name.data() + name.size(), number);
  if (name.empty() || error != std::errc() || end != name.data() + name.size()) return std::nullopt;
  return number;
}

std::string programOf(pid_t process) {
  std::ifstream file("/proc/" + std::to_string(process) + "/comm");
  std::string name;
  std::getline(file, name);
  return name;
}

bool isSame(const struct stat& one, const struct stat& other) {
  // A device may have several names.
  if (S_ISCHR(one.st_mode) && S_ISCHR(other.st_mode)) return one.st_rdev == other.st_rdev;
  return one.st_dev == other.st_dev && one.st_ino == other.st_ino;
}

// Whether the process has the file open; empty when it may not be examined.
std::optional<bool> holds(pid_t process, const struct stat& file) {
  std::error_code error;
  fs::directory_iterator entry("/proc/" + std::to_string(process) + "/fd", error);
  if (error == std::errc::permission_denied) return std::nullopt;
  for (const fs::directory_iterator end; !error && entry != end; entry.increment(error)) {
    struct stat open {};
    if (::stat(entry->path().c_str(), &open) == 0 && isSame(open, file)) return true;
  }
  return false;
}

}  // namespace

Holders holdersOf(const std::string& path) {
  Holders holders;
  struct stat file {};
  if (::stat(path.c_str(), &file) != 0) return holders;
  std::error_code error;
  fs::directory_iterator entry("/proc", error);
  for (const fs::directory_iterator end; !error && entry != end; entry.increment(error)) {
    const auto process = processNumber(entry->path().filename().string());
    if (!process || *process == ::getpid()) continue;
    const auto held = holds(*process, file);
    if (!held) holders.complete = false;
    if (held.value_or(false)) holders.found.push_back({*process, programOf(*process)});
  }
  std::sort(holders.found.begin(), holders.found.end(),
            [](const Holder& left, const Holder& right) { return left.process < right.process; });
  return holders;
}

std::optional<Holder> lockOwnerOf(const std::string& device, const std::string& folder) {
  std::ifstream file(folder + "/LCK.." + fs::path(device).filename().string());
  std::string number;
  file >> number;
  const auto process = processNumber(number);
  if (!process) return std::nullopt;
  std::error_code error;
  if (!fs::exists("/proc/" + std::to_string(*process), error)) return std::nullopt;
  return Holder{*process, programOf(*process)};
}

}  // namespace vespscope::files
