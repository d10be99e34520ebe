// The phone interface as a module: found next to the viewer wherever that is, and the viewer's message without it.
#include <filesystem>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frontends/quick/entry/Module.h"
#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;
using ::testing::StartsWith;

const std::filesystem::path built = std::filesystem::path(VESPSCOPE_BIN_DIR).parent_path();

// A viewer that was copied to another folder, without its module.
class Module : public ::testing::Test {
 protected:
  Module() {
    std::filesystem::create_directories(folder_ / "bin");
    std::filesystem::create_directories(module_.parent_path());
    std::filesystem::copy_file(built / "bin/vespscope", viewer_);
  }

  TemporaryFolder folder_;
  const std::filesystem::path viewer_ = folder_ / "bin/vespscope";
  const std::filesystem::path module_ = folder_ / "lib/vespscope/quick.so";
  const std::map<std::string, std::string> offscreen_ = {
      {"QT_QPA_PLATFORM", "offscreen"}, {"QT_QUICK_BACKEND", "software"}, {"QT_LOGGING_RULES", "vespscope.quick=true"}};
};

TEST_F(Module, FindsItsModuleWhereItHasBeenMovedTo) {
  std::filesystem::copy_file(built / "lib/vespscope/quick.so", module_);
  Process process(viewer_, {"--ui", "quick", "--manager", "embedded:scenario"}, offscreen_);
  EXPECT_TRUE(process.waitForErrors("first frame"));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

TEST_F(Module, AskedForItSaysThatItsModuleIsMissing) {
  Process process(viewer_, {"--ui", "quick"}, offscreen_);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_EQ(process.errors(), "vespscope: --ui quick: the phone interface is not there: " + module_.string() +
                                  " does not load: cannot open shared object file: No such file or directory\n");
}

TEST_F(Module, WithoutTheModuleTheViewerContinuesWithLogLines) {
  Process process(viewer_, {"--manager", "embedded:scenario"}, offscreen_);
  EXPECT_TRUE(process.waitForOutput("\n"));
  EXPECT_THAT(process.errors(), StartsWith("vespscope: the phone interface is not there: " + module_.string()));
  EXPECT_THAT(process.errors(), HasSubstr("; without a terminal too, there are log lines only\n"));
}

TEST_F(Module, WithABrokenModuleSaysWhatIsWrongWithIt) {
  folder_.write("lib/vespscope/quick.so", "no library");
  Process process(viewer_, {"--ui", "quick"}, offscreen_);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_THAT(process.errors(), HasSubstr(module_.string() + " does not load: file too short\n"));
}

TEST_F(Module, WithoutADisplayDoesNotLookForItsModule) {
  Process process(viewer_, {"--ui", "quick"}, {{"QT_QPA_PLATFORM", ""}, {"DISPLAY", ""}, {"WAYLAND_DISPLAY", ""}});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_THAT(process.errors(), Not(HasSubstr("quick.so")));
}

TEST_F(Module, OfAnotherVersionIsRefused) {
  const std::filesystem::path other = VESPSCOPE_OTHER_MODULE;
  const auto module = quick::loadModule(other);
  ASSERT_FALSE(module);
  EXPECT_EQ(module.reason(), other.string() + " does not load: it is of version 0.0.0, not " VESPSCOPE_VERSION);
}

TEST_F(Module, AnyOtherLibraryIsNone) {
  const auto module = quick::loadModule("libc.so.6");
  ASSERT_FALSE(module);
  EXPECT_EQ(module.reason(), "libc.so.6 does not load: it is no phone interface");
}

}  // namespace
}  // namespace vespscope::test
