// A file is the same file under each of its names.
#include <filesystem>

#include <gtest/gtest.h>

#include "platform/files/FileIdentity.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

TEST(FileIdentity, IsThatOfTheFileBehindLinks) {
  const TemporaryFolder folder;
  const std::string file = folder.write("a", "x");
  std::filesystem::create_symlink(file, folder / "symbolic");
  std::filesystem::create_hard_link(file, folder / "hard");
  EXPECT_EQ(files::identityOf(folder / "symbolic"), files::identityOf(file));
  EXPECT_EQ(files::identityOf(folder / "hard"), files::identityOf(file));
  EXPECT_NE(files::identityOf(folder.write("b", "x")), files::identityOf(file));
  EXPECT_EQ(files::identityOf(folder / "absent"), std::nullopt);
}

}  // namespace
}  // namespace vespscope::test
