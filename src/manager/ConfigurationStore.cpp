#include "manager/ConfigurationStore.h"

#include <charconv>
#include <fstream>
#include <iterator>
#include <system_error>

namespace vespscope::manager {
namespace {

constexpr std::string_view prefix = "application-";
constexpr std::string_view suffix = ".deviceconfig";

std::optional<std::int64_t> applicationOf(const std::string& name) {
  if (!name.starts_with(prefix) || !name.ends_with(suffix) || name.size() <= prefix.size() + suffix.size()) {
    return std::nullopt;
  }
  std::int64_t application = 0;
  const char* end = name.data() + name.size() - suffix.size();
  const auto [parsed, error] = std::from_chars(name.data() + prefix.size(), end, application);
  return error == std::errc() && parsed == end ? std::optional(application) : std::nullopt;
}

}  // namespace

std::filesystem::path ConfigurationStore::fileOf(std::int64_t application) const {
  return folder_ / (std::string(prefix) + std::to_string(application) + std::string(suffix));
}

std::map<std::int64_t, Bytes> ConfigurationStore::load() const {
  std::map<std::int64_t, Bytes> kept;
  std::error_code error;
  for (std::filesystem::directory_iterator entry(folder_, error), end; !error && entry != end; entry.increment(error)) {
    const std::optional<std::int64_t> application = applicationOf(entry->path().filename().string());
    std::ifstream file(entry->path(), std::ios::binary);
    if (!application || !file) continue;
    kept[*application] = Bytes(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
  }
  return kept;
}

std::optional<std::string> ConfigurationStore::save(std::int64_t application, const Bytes& configuration) const {
  std::error_code error;
  std::filesystem::create_directories(folder_, error);
  const std::filesystem::path file = fileOf(application);
  const std::filesystem::path fresh = file.string() + ".new";
  {
    std::ofstream out(fresh, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(configuration.data()), static_cast<std::streamsize>(configuration.size()));
    if (!out.flush()) return "cannot write " + fresh.string();
  }
  std::filesystem::rename(fresh, file, error);
  if (error) return "cannot write " + file.string() + ": " + error.message();
  return std::nullopt;
}

void ConfigurationStore::remove(std::int64_t application) const {
  std::error_code ignored;  // a file that is not there is as good as removed
  std::filesystem::remove(fileOf(application), ignored);
}

}  // namespace vespscope::manager
