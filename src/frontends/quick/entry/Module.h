// The phone interface's module: what it offers to the program that loads it. This header names nothing of the toolkit,
// so that programs compile the same with and without it.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "platform/application/Application.h"
#include "values/Result.h"

namespace vespscope::quick {

struct Obstacle {
  std::string reason;  // one sentence for the user
  // Whether the surroundings promise this frontend, so that a user who did not name it would miss it all the same.
  bool unexpected = false;
};

// Told why the toolkit does not start although nothing stood in its way (it lacks a plugin for the display, say). Must
// not return.
using RefusalHandler = std::function<void(const std::string& reason)>;

struct Module {
  const char* version;  // the program's own: both are built together and share their types
  std::optional<Obstacle> (*obstacle)();
  std::unique_ptr<application::Frontend> (*makeFrontend)(RefusalHandler refused);
};

inline constexpr const char* moduleSymbol = "vespscopeQuickModule";  // under which the module has its `Module`

// Where the module of this program is: lib/vespscope/quick.so beside the program's folder, in a build tree and
// installed.
[[nodiscard]] std::filesystem::path modulePath();

// Loads the module for good, or says why it does not load.
[[nodiscard]] Result<const Module*> loadModule(const std::filesystem::path& path);

}  // namespace vespscope::quick
