// New files, which get their names only when they are complete.
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>

#include <gtest/gtest.h>

#include "platform/files/InputFile.h"
#include "platform/files/NewFile.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using files::NewFile;

std::string contentsOf(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

NewFile newFile(const std::string& path, NewFile::Existing existing = NewFile::Existing::refuse) {
  auto file = NewFile::create(path, existing);
  EXPECT_TRUE(file) << file.reason();
  return std::move(*file);
}

TEST(NewFile, TakesItsNameOnlyAtTheEnd) {
  const TemporaryFolder folder;
  NewFile file = newFile(folder / "out.pcap");
  EXPECT_EQ(file.partialName(), folder / "out.partial.pcap");
  ASSERT_EQ(::write(file.descriptor(), "new", 3), 3);
  EXPECT_FALSE(std::filesystem::exists(folder / "out.pcap"));
  EXPECT_EQ(file.finish(), std::nullopt);
  EXPECT_EQ(contentsOf(folder / "out.pcap"), "new");
  EXPECT_FALSE(std::filesystem::exists(folder / "out.partial.pcap"));
}

TEST(NewFile, ThatIsNotFinishedStaysAsAPartialFile) {
  const TemporaryFolder folder;
  static_cast<void>(newFile(folder / "out.pcap"));
  static_cast<void>(newFile(folder / "out.pcap"));
  static_cast<void>(newFile(folder / "plain"));
  EXPECT_FALSE(std::filesystem::exists(folder / "out.pcap"));
  EXPECT_TRUE(std::filesystem::exists(folder / "out.partial.pcap"));
  EXPECT_TRUE(std::filesystem::exists(folder / "out.partial-2.pcap"));
  EXPECT_TRUE(std::filesystem::exists(folder / "plain.partial"));
}

TEST(NewFile, RefusesAnExistingFileAlsoWhenItAppearsMeanwhile) {
  const TemporaryFolder folder;
  const std::string path = folder.write("out.pcap", "old");
  EXPECT_EQ(NewFile::create(path, NewFile::Existing::refuse).reason(), path + ": exists already; --force replaces it");
  EXPECT_FALSE(std::filesystem::exists(folder / "out.partial.pcap"));
  NewFile late = newFile(folder / "late.pcap");
  static_cast<void>(folder.write("late.pcap", "old"));
  EXPECT_EQ(late.finish(), folder / "late.pcap" + std::string(": exists already; --force replaces it"));
  EXPECT_EQ(contentsOf(folder / "late.pcap"), "old");
  EXPECT_TRUE(std::filesystem::exists(folder / "late.partial.pcap"));
}

TEST(NewFile, ReplacesAFileWithOneThatIsItsOwnersAlone) {
  const TemporaryFolder folder;
  const std::string path = folder.write("out.pcap", "old");
  ASSERT_EQ(::chmod(path.c_str(), 0666), 0);
  const mode_t mask = ::umask(0);
  NewFile file = newFile(path, NewFile::Existing::replace);
  ::umask(mask);
  EXPECT_EQ(contentsOf(path), "old");
  EXPECT_EQ(file.finish(), std::nullopt);
  EXPECT_EQ(contentsOf(path), "");
  struct stat status {};
  ASSERT_EQ(::stat(path.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600U);
}

TEST(NewFile, ReplacesALinkAndNotWhatItPointsAt) {
  const TemporaryFolder folder;
  const std::string target = folder.write("target", "precious");
  std::filesystem::create_symlink(target, folder / "out.pcap");
  EXPECT_FALSE(NewFile::create(folder / "out.pcap", NewFile::Existing::refuse));
  NewFile file = newFile(folder / "out.pcap", NewFile::Existing::replace);
  EXPECT_EQ(file.finish(), std::nullopt);
  EXPECT_EQ(contentsOf(target), "precious");
  EXPECT_FALSE(std::filesystem::is_symlink(folder / "out.pcap"));
}

TEST(NewFile, DoesNotReplaceAFileThatIsBeingRead) {
  const TemporaryFolder folder;
  const std::string path = folder.write("out.pcap", "old");
  const auto reader = files::InputFile::open(path);
  ASSERT_TRUE(reader);
  EXPECT_EQ(NewFile::create(path, NewFile::Existing::replace).reason(), path + ": is being read by another program");
}

TEST(NewFile, NamesAFolderThatCannotTakeIt) {
  const TemporaryFolder folder;
  EXPECT_EQ(NewFile::create("/nowhere/out.pcap", NewFile::Existing::refuse).reason(),
            "/nowhere/out.pcap: cannot be created: No such file or directory");
  const std::string path = folder.path().string();
  EXPECT_EQ(NewFile::create(path, NewFile::Existing::replace).reason(), path + ": is a folder");
}

TEST(NewFile, CanBeDiscarded) {
  const TemporaryFolder folder;
  NewFile file = newFile(folder / "out.pcap");
  file.discard();
  EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

}  // namespace
}  // namespace vespscope::test
