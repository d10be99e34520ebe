// Keeps the active configurations across a restart of the manager, one file per application.
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
    std::vector<std::string> problems;             // one sentence per file that was skipped
  };
  // Reads the kept configurations of at most `limit` applications, those with the lowest numbers. Never blocks:
  // anything that is not a regular file is skipped.
  [[nodiscard]] Kept load(std::size_t limit) const;
  // Renames the application's file, so that it is not loaded again; returns the new name.
  [[nodiscard]] Result<std::string> setAside(std::int64_t application) const;
  // Replaces the application's file atomically; returns the error on failure.
  [[nodiscard]] std::optional<std::string> save(std::int64_t application, const Bytes& configuration) const;
  // Removes the application's file, if it exists; returns the error on failure.
  [[nodiscard]] std::optional<std::string> remove(std::int64_t application) const;

 private:
  [[nodiscard]] std::filesystem::path fileOf(std::int64_t application) const;

  std::filesystem::path folder_;
};

}  // namespace vespscope::manager
