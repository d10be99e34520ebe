// Where a bundle finds its resources.
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include <gtest/gtest.h>

#include "platform/application/System.h"

namespace vespscope::test {
namespace {

using namespace application;

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

}  // namespace
}  // namespace vespscope::test
