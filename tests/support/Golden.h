// Compares text with a golden file and shows the difference line by line.
#pragma once

#include <filesystem>
#include <string>

#include <gtest/gtest.h>

namespace vespscope::test {

// Success when the file `golden` contains exactly `actual`, else a failure that shows the lines that differ ("-" only
// in the file, "+" only in `actual`).
//
// With VESPSCOPE_UPDATE_GOLDEN=1 in the environment the file is rewritten if it differs, and the comparison still
// fails: check the new file and run the test again without the variable.
[[nodiscard]] ::testing::AssertionResult matchesGolden(const std::filesystem::path& golden, const std::string& actual);

// The lines that differ, with up to two equal lines around them; empty when nothing differs.
[[nodiscard]] std::string lineDifference(const std::string& expected, const std::string& actual);

}  // namespace vespscope::test
