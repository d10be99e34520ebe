// The viewer as a user starts it.
#include <signal.h>

#include <algorithm>
#include <filesystem>
#include <ostream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/Process.h"

namespace vespscope::test {
namespace {

using ::testing::HasSubstr;
using ::testing::StartsWith;

const std::filesystem::path viewer = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope";

// No program listens there.
const std::string nowhere = "unix:path=/nonexistent/manager";

std::size_t lines(const std::string& text) {
  return static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
}

TEST(VespscopeProcess, PrintsItsVersion) {
  Process process(viewer, {"--version"});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(process.output(), "vespscope " VESPSCOPE_VERSION "\n");
  EXPECT_EQ(process.errors(), "");
}

TEST(VespscopeProcess, PrintsItsHelp) {
  Process process(viewer, {"--help"});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_THAT(process.output(), HasSubstr("--manager ADDRESS"));
  EXPECT_THAT(process.output(), HasSubstr("--ui INTERFACE"));
  EXPECT_EQ(process.errors(), "");
}

struct Refusal {
  std::string name;
  std::vector<std::string> arguments;
  std::string message;
};

void PrintTo(const Refusal& refusal, std::ostream* out) { *out << refusal.name; }

class VespscopeProcessRefusal : public ::testing::TestWithParam<Refusal> {};

TEST_P(VespscopeProcessRefusal, IsOneClearLineAndStatusTwo) {
  Process process(viewer, GetParam().arguments);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_EQ(process.output(), "");
  EXPECT_THAT(process.errors(), StartsWith("vespscope: " + GetParam().message));
  EXPECT_EQ(lines(process.errors()), 1U);
}

std::string testName(const ::testing::TestParamInfo<Refusal>& refusal) { return refusal.param.name; }

INSTANTIATE_TEST_SUITE_P(
    BadWords, VespscopeProcessRefusal,
    ::testing::Values(
        Refusal{"UnknownInterface", {"--ui", "window"}, "--ui: \"window\" is no interface"},
        Refusal{"TerminalWithoutOne", {"--ui", "terminal"}, "--ui terminal: there is no terminal"},
        Refusal{"ControlCharacters", {"--ui", "a\n\x1b[31mb"}, "--ui: \"a\u240A\u241B[31mb\" is no"},
        Refusal{"MissingInterface", {"--ui"}, "--ui"},
        Refusal{"UnknownAddress", {"--manager", "embed:scenario"}, "--manager: "},
        Refusal{"EmptyAddress", {"--manager", ""}, "--manager: "},
        Refusal{"UnknownSource", {"--manager", "embedded:bogus"}, "embedded manager: source \"bogus\": "},
        Refusal{"MissingFile", {"--manager", "embedded:replay:/nonexistent"}, "embedded manager: /nonexistent: "},
        Refusal{"UnknownOption", {"--nonsense"}, "The following argument was not expected"},
        Refusal{"AbsentFile", {"drive.pcap"}, "drive.pcap: cannot be opened"}),
    testName);

TEST(VespscopeProcess, SaysWhatThePhoneInterfaceLacks) {
  Process process(viewer, {"--ui", "quick"}, {{"DISPLAY", ""}, {"WAYLAND_DISPLAY", ""}, {"QT_QPA_PLATFORM", ""}});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_EQ(process.output(), "");
  EXPECT_THAT(process.errors(), ::testing::AnyOf(StartsWith("vespscope: --ui quick: there is no display"),
                                                 StartsWith("vespscope: --ui quick: this build has no phone")));
  EXPECT_EQ(lines(process.errors()), 1U);
}

TEST(VespscopeProcess, RefusesABadAddressOfTheEnvironment) {
  Process process(viewer, {"--ui", "none"}, {{"RHOX_ADDRESS", "nowhere"}});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_THAT(process.errors(), StartsWith("vespscope: RHOX_ADDRESS: "));
  EXPECT_EQ(lines(process.errors()), 1U);
}

TEST(VespscopeProcess, RunsWithoutAManagerAndWithoutItsConfiguration) {
  Process process(viewer, {"--ui", "none", "--manager", nowhere}, {{"VESPSCOPE_RESOURCES", "/nonexistent"}});
  ASSERT_TRUE(process.waitForOutput("\n"));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(process.output(), "Metric Log File path doesnt exist\n");
}

}  // namespace
}  // namespace vespscope::test
