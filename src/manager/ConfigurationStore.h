// Keeps the active configurations beyond the manager's own restart, one file for each application.
#pragma once

#include <cstdint>
#include <filesystem>
#include <map>
#include <optional>
#include <string>

#include "values/Value.h"

namespace vespscope::manager {

class ConfigurationStore {
 public:
  // Keeps files in `folder`, which is made when the first one is written.
  explicit ConfigurationStore(std::filesystem::path folder) : folder_(std::move(folder)) {}

  // The configurations kept, by application number. A file that cannot be read is left out.
  [[nodiscard]] std::map<std::int64_t, Bytes> load() const;
  // Replaces the application's file in one step; the reason when it could not.
  [[nodiscard]] std::optional<std::string> save(std::int64_t application, const Bytes& configuration) const;
  void remove(std::int64_t application) const;

 private:
  [[nodiscard]] std::filesystem::path fileOf(std::int64_t application) const;

  std::filesystem::path folder_;
};

}  // namespace vespscope::manager
