// The phone interface's module: its interface to the program that loads it. This header names nothing of the toolkit,
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
  // Whether the environment suggests this frontend, so that a user who did not request it would expect it nevertheless.
  bool unexpected = false;
};

// Called with the reason why the toolkit does not start although obstacle() found nothing (for example, a missing
// display plugin). Must not return.
using RefusalHandler = std::function<void(const std::string& reason)>;

struct Module {
  const char* version;  // equals the program's version: both are built together and share their types
  std::optional<Obstacle> (*obstacle)();
  std::unique_ptr<application::Frontend> (*makeFrontend)(RefusalHandler refused);
};

inline constexpr const char* moduleSymbol = "vespscopeQuickModule";  // the symbol of the module's `Module`

// The path of this program's module: lib/vespscope/quick.so next to the program's folder, in a build tree and
// installed.
[[nodiscard]] std::filesystem::path modulePath();

// Loads the module permanently, or returns why it does not load.
[[nodiscard]] Result<const Module*> loadModule(const std::filesystem::path& path);

}  // namespace vespscope::quick
