// The platform's version, bundle and timers.
#include <array>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <limits>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/application/System.h"
#include "platform/application/Timer.h"

namespace vespscope::test {
namespace {

using namespace application;

TEST(VersionOfThePlatform, IsThirteenUnlessSetOtherwise) {
  EXPECT_TRUE(isPlatformAtLeast({13, 0, 0}));
  EXPECT_TRUE(isPlatformAtLeast({12, 9, 9}));
  EXPECT_FALSE(isPlatformAtLeast({13, 0, 1}));
  setPlatformVersion({12, 4, 1});
  EXPECT_FALSE(isPlatformAtLeast({13, 0, 0}));
  EXPECT_TRUE(isPlatformAtLeast({12, 4, 1}));
}

class BundleResources : public testing::Test {
 protected:
  void SetUp() override {
    std::string name = (std::filesystem::temp_directory_path() / "vespscope-bundle-XXXXXX").string();
    ASSERT_NE(::mkdtemp(name.data()), nullptr);
    folder_ = name;
  }
  void TearDown() override { std::filesystem::remove_all(folder_); }
  [[nodiscard]] std::filesystem::path make(const std::string& name) const {
    std::filesystem::create_directories((folder_ / name).parent_path());
    std::ofstream(folder_ / name) << "content";
    return folder_ / name;
  }
  std::filesystem::path folder_;
};

TEST_F(BundleResources, TheFirstFolderThatHasTheFileWins) {
  const auto first = make("one/both.type");
  const auto hidden = make("two/both.type");
  const auto second = make("two/only.type");
  const Bundle bundle({folder_ / "absent", folder_ / "one", folder_ / "two"});
  EXPECT_EQ(bundle.pathForResource("both", "type"), first);
  EXPECT_EQ(bundle.pathForResource("only", "type"), second);
}

TEST_F(BundleResources, AnAbsentFileAndAFolderAreNoResources) {
  std::filesystem::create_directories(folder_ / "folder.type");
  const Bundle bundle({folder_});
  EXPECT_FALSE(bundle.pathForResource("absent", "type"));
  EXPECT_FALSE(bundle.pathForResource("folder", "type"));
}

TEST_F(BundleResources, TheMainBundleIsTheFolderThatTheEnvironmentGives) {
  const auto path = make("given.type");
  ::setenv("VESPSCOPE_RESOURCES", folder_.c_str(), 1);
  EXPECT_EQ(Bundle::main().pathForResource("given", "type"), path);
}

struct Target {
  void update() { ++updates; }
  int updates = 0;
};

TEST(Timers, ATimerKeepsItsTargetAliveUntilItIsCancelled) {
  auto& loop = dispatch::MainLoop::main();
  auto target = std::make_shared<Target>();
  const std::weak_ptr<Target> watch = target;
  const auto timer = scheduleTimer(std::chrono::milliseconds(5000), std::move(target), &Target::update);
  loop.advance(std::chrono::milliseconds(4999));
  loop.runOnce(std::chrono::milliseconds(0));
  ASSERT_FALSE(watch.expired());
  EXPECT_EQ(watch.lock()->updates, 0);
  loop.advance(std::chrono::milliseconds(1));
  loop.runOnce(std::chrono::milliseconds(0));
  EXPECT_EQ(watch.lock()->updates, 1);
  loop.cancel(timer);
  EXPECT_TRUE(watch.expired());
}

}  // namespace
}  // namespace vespscope::test
