// The files of stored configurations: their permissions, and which of them are loaded.
#include <sys/stat.h>

#include <filesystem>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/Configuration.h"
#include "manager/ConfigurationStore.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using manager::Configuration;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

Bytes bytesOf(const std::string& text) { return {text.begin(), text.end()}; }

class ConfigurationStore : public testing::Test {
 protected:
  [[nodiscard]] std::string fileOf(int application) const {
    return folder / ("application-" + std::to_string(application) + ".deviceconfig");
  }

  const TemporaryFolder folder;
  const manager::ConfigurationStore store{folder.path()};
};

TEST_F(ConfigurationStore, KeepsAFileForTheManagersUserAlone) {
  const mode_t before = ::umask(0);
  EXPECT_EQ(store.save(2, bytesOf("text")), std::nullopt);
  ::umask(before);
  struct stat status {};
  ASSERT_EQ(::stat(fileOf(2).c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600U);
}

TEST_F(ConfigurationStore, LoadsWhatItSavedAndNothingElse) {
  EXPECT_EQ(store.save(2, bytesOf("two")), std::nullopt);
  EXPECT_EQ(store.save(-5, bytesOf("minus five")), std::nullopt);
  EXPECT_EQ(store.save(7, bytesOf("seven")), std::nullopt);
  EXPECT_EQ(store.remove(7), std::nullopt);
  EXPECT_EQ(store.remove(8), std::nullopt);  // no such file
  for (const char* name :
       {"application-x.deviceconfig", "application-03.deviceconfig", "application-9.deviceconfig.new",
        "application-9.deviceconfig.refused", "application-.deviceconfig", "notes.txt"}) {
    folder.write(name, "not ours");
  }
  const auto kept = store.load(64);
  EXPECT_EQ(kept.configurations, (std::map<std::int64_t, Bytes>{{-5, bytesOf("minus five")}, {2, bytesOf("two")}}));
  EXPECT_THAT(kept.problems, IsEmpty());
}

TEST_F(ConfigurationStore, LoadsNoMoreConfigurationsThanItsLimitAndReportsTheRest) {
  for (int application = 1; application <= 3; ++application) {
    EXPECT_EQ(store.save(application, bytesOf("text")), std::nullopt);
  }
  EXPECT_EQ(store.load(3).configurations.size(), 3U);
  EXPECT_THAT(store.load(3).problems, IsEmpty());
  const auto kept = store.load(2);
  EXPECT_EQ(kept.configurations.size(), 2U);
  EXPECT_TRUE(kept.configurations.contains(1) && kept.configurations.contains(2));
  EXPECT_THAT(kept.problems,
              ElementsAre("more than 2 configurations are kept: those from application 3 on are not used"));
}

TEST_F(ConfigurationStore, LeavesOutWhatIsNotARegularFileWithoutWaitingForIt) {
  EXPECT_EQ(store.save(2, bytesOf("two")), std::nullopt);
  ASSERT_EQ(::mkfifo(fileOf(3).c_str(), 0600), 0);
  std::filesystem::create_directory(fileOf(4));
  const auto kept = store.load(64);
  EXPECT_EQ(kept.configurations.size(), 1U);
  EXPECT_THAT(kept.problems, ElementsAre("cannot read " + fileOf(3) + ": it is not a regular file",
                                         "cannot read " + fileOf(4) + ": it is not a regular file"));
}

TEST_F(ConfigurationStore, ReadsNoMoreOfALargeFileThanShowsThatItIsTooLarge) {
  folder.write("application-2.deviceconfig", "");
  std::filesystem::resize_file(fileOf(2), std::uintmax_t{1} << 40);
  EXPECT_EQ(store.load(64).configurations.at(2).size(), Configuration::sizeLimit + 1);
}

TEST_F(ConfigurationStore, SetsAFileAsideSoThatItIsNotLoadedAgain) {
  EXPECT_EQ(store.save(2, bytesOf("nonsense")), std::nullopt);
  const auto aside = store.setAside(2);
  ASSERT_TRUE(aside.ok()) << aside.reason();
  EXPECT_EQ(*aside, fileOf(2) + ".refused");
  EXPECT_TRUE(std::filesystem::exists(*aside));
  EXPECT_THAT(store.load(64).configurations, IsEmpty());
  EXPECT_EQ(store.setAside(2).reason(), "cannot rename " + fileOf(2) + ": No such file or directory");
}

TEST_F(ConfigurationStore, SaysWhyAFileCannotBeWritten) {
  const manager::ConfigurationStore elsewhere(folder.write("file", "in the way"));
  EXPECT_THAT(elsewhere.save(2, bytesOf("text")).value_or(""), HasSubstr("cannot write "));
}

}  // namespace
}  // namespace vespscope::test
