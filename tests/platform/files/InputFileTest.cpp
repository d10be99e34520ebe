// Opening and reading files without blocking on another program.
#include <fcntl.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <filesystem>
#include <thread>

#include <gtest/gtest.h>

#include "platform/files/InputFile.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using dispatch::WakeDescriptor;
using files::InputFile;

std::string contentsOf(InputFile& file) {
  std::string contents;
  std::array<std::uint8_t, 3> bytes{};
  while (true) {
    const auto count = file.read(bytes);
    EXPECT_TRUE(count) << count.reason();
    if (!count || *count == 0) return contents;
    contents.append(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(*count));
  }
}

std::string reasonFor(const std::string& path) {
  const auto file = InputFile::open(path);
  return file ? "opened" : file.reason();
}

TEST(InputFile, ReadsARegularFileAgain) {
  const TemporaryFolder folder;
  const auto file = InputFile::open(folder.write("log", "0123456789"));
  ASSERT_TRUE(file) << file.reason();
  EXPECT_EQ(contentsOf(**file), "0123456789");
  EXPECT_EQ((*file)->position(), 10U);
  EXPECT_EQ((*file)->size(), 10U);
  ASSERT_TRUE((*file)->canRewind());
  EXPECT_EQ((*file)->rewind(), std::nullopt);
  EXPECT_EQ(contentsOf(**file), "0123456789");
  EXPECT_EQ((*file)->identity(), *files::identityOf(folder / "log"));
}

TEST(InputFile, RefusesWhatIsNoRegularFileWithoutWaiting) {
  const TemporaryFolder folder;
  ASSERT_EQ(::mkfifo((folder / "pipe").c_str(), 0600), 0);
  EXPECT_EQ(reasonFor(folder / "pipe"), "is a pipe, not a file; read it through standard input (-)");
  EXPECT_EQ(reasonFor(folder.path().string()), "is a folder, not a file");
  EXPECT_EQ(reasonFor("/dev/null"), "is a device, not a file");
  EXPECT_EQ(reasonFor(folder / "absent"), "cannot be opened: No such file or directory");
}

TEST(InputFile, ReadsAnInheritedPipe) {
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  ASSERT_EQ(::write(ends[1], "abcde", 5), 5);
  ::close(ends[1]);
  const auto file = InputFile::open("/dev/fd/" + std::to_string(ends[0]));
  ASSERT_TRUE(file) << file.reason();
  EXPECT_FALSE((*file)->canRewind());
  EXPECT_FALSE((*file)->size());
  EXPECT_EQ(contentsOf(**file), "abcde");
  ::close(ends[0]);
}

TEST(InputFile, ReturnsFromASilentPipeWhenInterrupted) {
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
  const auto interruption = std::make_shared<const WakeDescriptor>();
  const auto file = InputFile::open("-", interruption);
  ASSERT_TRUE(file) << file.reason();
  const std::jthread other([&interruption] {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    interruption->wake();
  });
  EXPECT_EQ(contentsOf(**file), "");
  EXPECT_TRUE((*file)->interrupted());
  // Every later read returns as well.
  EXPECT_EQ(contentsOf(**file), "");
}

TEST(InputFile, NamesAStandardInputThatIsNotForReading) {
  const int output = ::open("/dev/null", O_WRONLY | O_CLOEXEC);
  ASSERT_EQ(::dup2(output, STDIN_FILENO), STDIN_FILENO);
  EXPECT_EQ(reasonFor("-"), "is not open for reading");
}

TEST(InputFile, ReadsTheBeginningOfAFile) {
  const TemporaryFolder folder;
  const std::string file = folder.write("a", "0123456789");
  EXPECT_EQ(*files::readBeginning(file, 4), (Bytes{'0', '1', '2', '3'}));
  EXPECT_EQ(files::readBeginning(file, 11)->size(), 10U);
  ASSERT_EQ(::mkfifo((folder / "pipe").c_str(), 0600), 0);
  EXPECT_FALSE(files::readBeginning(folder / "pipe", 4));
}

}  // namespace
}  // namespace vespscope::test
