// The processes that hold a file, and the one that a lock file names.
#include <fcntl.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "platform/files/FileHolders.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using files::Holder;
using files::holdersOf;
using files::lockOwnerOf;

// A child process that has a file open until it is ended.
class Reader {
 public:
  explicit Reader(const std::string& path) {
    int ready[2];
    if (::pipe(ready) != 0) std::abort();
    process_ = ::fork();
    if (process_ == 0) {
      const int descriptor = ::open(path.c_str(), O_RDONLY);
      [[maybe_unused]] const ssize_t written = ::write(ready[1], &descriptor, 1);
      while (true) ::pause();
    }
    char byte = 0;
    [[maybe_unused]] const ssize_t got = ::read(ready[0], &byte, 1);
    ::close(ready[0]);
    ::close(ready[1]);
  }
  Reader(const Reader&) = delete;
  Reader& operator=(const Reader&) = delete;
  ~Reader() { end(); }

  void end() {
    if (process_ < 0) return;
    ::kill(process_, SIGKILL);
    ::waitpid(process_, nullptr, 0);
    process_ = -1;
  }
  [[nodiscard]] pid_t process() const { return process_; }

 private:
  pid_t process_ = -1;
};

TEST(FileHolders, AreTheProcessesThatHaveTheFileOpenUnderAnyName) {
  const TemporaryFolder folder;
  const std::string path = folder.write("port", "");
  std::filesystem::create_symlink(path, folder / "link");
  Reader reader(path);
  const auto found = holdersOf(folder / "link").found;
  ASSERT_EQ(found.size(), 1U);
  EXPECT_EQ(found[0].process, reader.process());
  EXPECT_THAT(found[0].program, testing::StartsWith("test_files"));
  reader.end();
  EXPECT_THAT(holdersOf(path).found, testing::IsEmpty());
}

TEST(FileHolders, LeaveOutThisProcess) {
  const TemporaryFolder folder;
  const std::ifstream file(folder.write("port", ""));
  EXPECT_THAT(holdersOf(folder / "port").found, testing::IsEmpty());
  EXPECT_THAT(holdersOf(folder / "none").found, testing::IsEmpty());
}

TEST(FileHolders, OfALockFileAreTheProcessThatItNamesWhileThatRuns) {
  const TemporaryFolder folder;
  Reader reader("/dev/null");
  static_cast<void>(folder.write("LCK..ttyUSB2", "      " + std::to_string(reader.process()) + "\n"));
  const auto owner = lockOwnerOf("/dev/ttyUSB2", folder.path().string());
  ASSERT_TRUE(owner);
  EXPECT_EQ(owner->process, reader.process());
  reader.end();
  EXPECT_FALSE(lockOwnerOf("/dev/ttyUSB2", folder.path().string()));
  EXPECT_FALSE(lockOwnerOf("/dev/ttyUSB1", folder.path().string()));
  static_cast<void>(folder.write("LCK..ttyUSB1", "no number"));
  EXPECT_FALSE(lockOwnerOf("/dev/ttyUSB1", folder.path().string()));
}

}  // namespace
}  // namespace vespscope::test
