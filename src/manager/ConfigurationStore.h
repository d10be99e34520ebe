// Keeps the active configurations beyond the manager's own restart, one file for each application.
#pragma once

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "values/Result.h"
#include "values/Value.h"

namespace vespscope::manager {

class ConfigurationStore {
 public:
  // Keeps files in `folder`, which is created when the first one is written.
  explicit ConfigurationStore(std::filesystem::path folder) : folder_(std::move(folder)) {}

  struct Kept {
    std::map<std::int64_t, Bytes> configurations;  // by application number
    std::vector<std::string> problems;             // a sentence for each file that was left out
  };
  // Reads the kept configurations of at most `limit` applications, those of the lowest numbers. Never waits for a file:
  // what is not a regular file is left out.
  [[nodiscard]] Kept load(std::size_t limit) const;
  // Renames the application's file, so that it is not loaded again; returns where it is now.
  [[nodiscard]] Result<std::string> setAside(std::int64_t application) const;
  // Replaces the application's file in one step; returns the reason on failure.
  [[nodiscard]] std::optional<std::string> save(std::int64_t application, const Bytes& configuration) const;
  // Removes the application's file, if there is one; returns the reason on failure.
  [[nodiscard]] std::optional<std::string> remove(std::int64_t application) const;

 private:
  [[nodiscard]] std::filesystem::path fileOf(std::int64_t application) const;

  std::filesystem::path folder_;
};

}  // namespace vespscope::manager
