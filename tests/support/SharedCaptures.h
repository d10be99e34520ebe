// Real modem logs outside the tree: in the folder that the environment variable VESPSCOPE_CAPTURES names, else in
// ../shared/captures. Tests that need one are skipped without it.
#pragma once

#include <cstdlib>
#include <filesystem>
#include <string>

#include <gtest/gtest.h>

namespace vespscope::test {

inline std::string sharedCapture(const std::string& name) {
  const char* folder = std::getenv("VESPSCOPE_CAPTURES");
  const std::filesystem::path captures =
      folder != nullptr && *folder != '\0' ? std::filesystem::path(folder)
                                           : std::filesystem::path(VESPSCOPE_SOURCE_DIR) / ".." / "shared" / "captures";
  return (captures / name).string();
}

}  // namespace vespscope::test

#define SKIP_WITHOUT_CAPTURE(path)    \
  if (!std::filesystem::exists(path)) \
  GTEST_SKIP() << "not run: no capture " << (path) << "; VESPSCOPE_CAPTURES names another folder"
