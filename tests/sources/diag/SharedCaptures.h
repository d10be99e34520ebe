// Real modem logs that lie beside the tree, not in it. Tests that need one are skipped where it is absent.
#pragma once

#include <filesystem>
#include <string>

#include <gtest/gtest.h>

namespace vespscope::test {

inline std::string sharedCapture(const std::string& name) {
  return std::filesystem::path(VESPSCOPE_SOURCE_DIR) / ".." / "shared" / "captures" / name;
}

}  // namespace vespscope::test

#define SKIP_WITHOUT_CAPTURE(path) \
  if (!std::filesystem::exists(path)) GTEST_SKIP() << (path) << " is not here"
