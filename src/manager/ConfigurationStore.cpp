#include "manager/ConfigurationStore.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <charconv>
#include <cstdio>
#include <cstring>
#include <set>
#include <string_view>
#include <system_error>
#include <utility>

#include "manager/Configuration.h"

namespace vespscope::manager {
namespace {

constexpr std::string_view prefix = "application-";
constexpr std::string_view suffix = ".deviceconfig";
constexpr std::string_view asideSuffix = ".refused";

std::optional<std::int64_t> applicationOf(const std::string& name) {
  if (!name.starts_with(prefix) || !name.ends_with(suffix) || name.size() <= prefix.size() + suffix.size()) {
    return std::nullopt;
  }
  std::int64_t application = 0;
  const char* end = name.data() + name.size() - suffix.size();
  const auto [parsed, error] = std::from_chars(name.data() + prefix.size(), end, application);
  return error == std::errc() && parsed == end ? std::optional(application) : std::nullopt;
}

// Returns the contents of a regular file, but at most one byte more than a configuration may have.
Result<Bytes> readFile(const std::filesystem::path& file) {
  const auto failure = [&file](const char* reason) { return Failure{"cannot read " + file.string() + ": " + reason}; };
  // Opens without blocking: a FIFO may have no writer, and a device may never answer.
  const int descriptor = ::open(file.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
  if (descriptor < 0) return failure(std::strerror(errno));
  struct stat status {};
  Bytes bytes(Configuration::sizeLimit + 1);
  std::size_t size = 0;
  ssize_t count = -1;
  if (::fstat(descriptor, &status) == 0 && !S_ISREG(status.st_mode)) {
    ::close(descriptor);
    return failure("it is not a regular file");
  }
  while ((count = ::read(descriptor, bytes.data() + size, bytes.size() - size)) != 0) {
    if (count < 0 && errno == EINTR) continue;
    if (count < 0) break;
    size += static_cast<std::size_t>(count);
  }
  const int error = errno;
  ::close(descriptor);
  if (count < 0) return failure(std::strerror(error));
  bytes.resize(size);
  return bytes;
}

bool writeAll(int descriptor, const Bytes& bytes) {
  std::size_t written = 0;
  while (written < bytes.size()) {
    const ssize_t count = ::write(descriptor, bytes.data() + written, bytes.size() - written);
    if (count < 0 && errno == EINTR) continue;
    if (count < 0) return false;
    written += static_cast<std::size_t>(count);
  }
  return true;
}

// Closes `descriptor`; after a failure, keeps that failure's errno.
bool closeAfter(bool success, int descriptor) {
  const int before = errno;
  if (::close(descriptor) != 0 && success) return false;
  if (!success) errno = before;
  return success;
}

// Writes a file that only this user can read, and syncs it to the disk; on failure errno has the reason.
bool writeThrough(const std::filesystem::path& file, const Bytes& bytes) {
  const int descriptor = ::open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC | O_NOFOLLOW, S_IRUSR | S_IWUSR);
  if (descriptor < 0) return false;
  return closeAfter(writeAll(descriptor, bytes) && ::fsync(descriptor) == 0, descriptor);
}

bool syncFolder(const std::filesystem::path& folder) {
  const int descriptor = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (descriptor < 0) return false;
  return closeAfter(::fsync(descriptor) == 0, descriptor);
}

}  // namespace

std::filesystem::path ConfigurationStore::fileOf(std::int64_t application) const {
  return folder_ / (std::string(prefix) + std::to_string(application) + std::string(suffix));
}

ConfigurationStore::Kept ConfigurationStore::load(std::size_t limit) const {
  std::set<std::int64_t> applications;
  std::error_code error;
  for (std::filesystem::directory_iterator entry(folder_, error), end; !error && entry != end; entry.increment(error)) {
    const std::string name = entry->path().filename().string();
    const std::optional<std::int64_t> application = applicationOf(name);
    if (application && name == fileOf(*application).filename()) applications.insert(*application);
  }
  Kept kept;
  for (const std::int64_t application : applications) {
    if (kept.configurations.size() == limit) {
      kept.problems.push_back("more than " + std::to_string(limit) +
                              " configurations are kept: those from application " + std::to_string(application) +
                              " on are not used");
      break;
    }
    Result<Bytes> bytes = readFile(fileOf(application));
    if (bytes) {
      kept.configurations.emplace(application, std::move(*bytes));
    } else {
      kept.problems.push_back(bytes.reason());
    }
  }
  return kept;
}

Result<std::string> ConfigurationStore::setAside(std::int64_t application) const {
  const std::string file = fileOf(application).string();
  const std::string aside = file + std::string(asideSuffix);
  if (::rename(file.c_str(), aside.c_str()) != 0) {
    return Failure{"cannot rename " + file + ": " + std::strerror(errno)};
  }
  return aside;
}

std::optional<std::string> ConfigurationStore::save(std::int64_t application, const Bytes& configuration) const {
  std::error_code error;
  std::filesystem::create_directories(folder_, error);
  const std::filesystem::path file = fileOf(application);
  const std::filesystem::path fresh = file.string() + ".new";
  // The new file is complete and synced before it replaces the old one, and the folder is synced before the client is
  // answered: a crash or a power cut leaves the old file or the new one.
  if (!writeThrough(fresh, configuration) || ::rename(fresh.c_str(), file.c_str()) != 0 || !syncFolder(folder_)) {
    const int reason = errno;
    ::unlink(fresh.c_str());
    return "cannot write " + file.string() + ": " + std::strerror(reason);
  }
  return std::nullopt;
}

std::optional<std::string> ConfigurationStore::remove(std::int64_t application) const {
  const std::string file = fileOf(application).string();
  if (::unlink(file.c_str()) == 0) {
    if (syncFolder(folder_)) return std::nullopt;
  } else if (errno == ENOENT || errno == ENOTDIR) {
    return std::nullopt;
  }
  return "cannot remove " + file + ": " + std::strerror(errno);
}

}  // namespace vespscope::manager
