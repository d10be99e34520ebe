// How the programs are linked and compiled, to make mistakes in them hard to exploit.
#include <filesystem>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/Process.h"

namespace vespscope::test {
namespace {

using ::testing::ContainsRegex;
using ::testing::HasSubstr;
using ::testing::Not;

class VespscopeHardening : public ::testing::TestWithParam<const char*> {
 protected:
  void SetUp() override {
    if (std::string(VESPSCOPE_SANITIZE) != "") GTEST_SKIP() << "sanitized builds have checks of their own";
  }

  // The output of readelf.
  static std::string told(const std::string& about) {
    Process readelf("/usr/bin/readelf", {"--wide", about, std::filesystem::path(VESPSCOPE_BIN_DIR) / GetParam()});
    EXPECT_EQ(readelf.wait(), (ProcessEnd{false, 0})) << readelf.errors();
    return readelf.output();
  }
};

TEST_P(VespscopeHardening, LoadsAtAnUnpredictableAddress) {
  EXPECT_THAT(told("--file-header"), ContainsRegex("Type: +DYN"));
  EXPECT_THAT(told("--dynamic"), ContainsRegex("Flags:.* PIE"));
  EXPECT_THAT(told("--dynamic"), Not(HasSubstr("TEXTREL")));
}

TEST_P(VespscopeHardening, HasNoTablesThatCanBeOverwrittenOnceItRuns) {
  EXPECT_THAT(told("--program-headers"), HasSubstr("GNU_RELRO"));
  EXPECT_THAT(told("--dynamic"), HasSubstr("BIND_NOW"));
}

TEST_P(VespscopeHardening, HasNoMemoryThatIsBothWrittenAndRun) {
  const std::string segments = told("--program-headers");
  EXPECT_THAT(segments, ContainsRegex("GNU_STACK.* RW +0x"));
  EXPECT_THAT(segments, Not(HasSubstr("RWE")));
}

TEST_P(VespscopeHardening, ChecksItsStack) { EXPECT_THAT(told("--dyn-syms"), HasSubstr("__stack_chk_fail")); }

TEST_P(VespscopeHardening, ChecksTheIndexesOfItsContainers) {
  EXPECT_THAT(told("--dyn-syms"), HasSubstr("glibcxx_assert_fail"));
}

TEST_P(VespscopeHardening, ChecksTheSizesOfItsCopies) {
  if (std::string(VESPSCOPE_BUILD_TYPE) == "Debug") GTEST_SKIP() << "sizes are known when the compiler optimises";
  EXPECT_THAT(told("--dyn-syms"), ContainsRegex("_chk@GLIBC"));
}

TEST_P(VespscopeHardening, LooksForLibrariesWhereTheSystemHasThem) {
  EXPECT_THAT(told("--dynamic"), Not(ContainsRegex("RPATH|RUNPATH")));
}

INSTANTIATE_TEST_SUITE_P(Hardened, VespscopeHardening, ::testing::Values("vespscope", "rhoxd", "vespctl"),
                         [](const auto& program) { return std::string(program.param); });

}  // namespace
}  // namespace vespscope::test
