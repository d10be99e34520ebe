// Input files that are decompressed while they are read.
#include <fcntl.h>
#include <sys/resource.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "platform/files/UnpackedFile.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using files::UnpackedFile;

// The contents, or what was read and the error.
std::string contentsOf(UnpackedFile& file, std::size_t pieceLength = 1000) {
  std::string contents;
  std::vector<std::uint8_t> piece(pieceLength);
  while (true) {
    const Result<std::size_t> count = file.read(piece);
    if (!count) return contents + " [" + count.reason() + "]";
    if (*count == 0) return contents;
    contents.append(piece.begin(), piece.begin() + static_cast<std::ptrdiff_t>(*count));
  }
}

std::string contentsOf(const std::string& path, std::size_t pieceLength = 1000) {
  const auto file = UnpackedFile::open(path);
  return file ? contentsOf(**file, pieceLength) : "[" + file.reason() + "]";
}

// A text that does not compress to almost nothing.
std::string sample() {
  std::string text;
  std::uint32_t state = 1;
  for (int line = 0; line < 20'000; ++line) {
    state = state * 1664525 + 1013904223;
    text += std::to_string(state) + "\n";
  }
  return text;
}

void compress(const std::string& command, const std::string& from, const std::string& to) {
  ASSERT_EQ(std::system((command + " < " + from + " > " + to).c_str()), 0) << command;
}

TEST(UnpackedFile, ReadsPlainGzipAndXzFilesAlike) {
  const TemporaryFolder folder;
  const std::string text = sample();
  const std::string plain = folder.write("plain", text);
  compress("gzip", plain, folder / "packed.gz");
  compress("xz", plain, folder / "packed.xz");
  for (const char* name : {"plain", "packed.gz", "packed.xz"}) {
    SCOPED_TRACE(name);
    EXPECT_EQ(contentsOf(folder / name), text);
    EXPECT_EQ(contentsOf(folder / name, 1), text);
    EXPECT_EQ(contentsOf(folder / name, 1U << 20), text);
    const auto file = UnpackedFile::open(folder / name);
    ASSERT_TRUE(file) << file.reason();
    for (int round = 0; round < 2; ++round) {
      EXPECT_EQ(contentsOf(**file), text);
      EXPECT_EQ((*file)->unpacked(), text.size());
      EXPECT_EQ((*file)->position(), std::filesystem::file_size(folder / name));
      EXPECT_EQ((*file)->rewind(), std::nullopt);
    }
  }
}

TEST(UnpackedFile, ReadsStreamsOneAfterTheOther) {
  const TemporaryFolder folder;
  const std::string plain = folder.write("plain", "one and two, ");
  for (const std::string command : {"gzip", "xz"}) {
    compress("(" + command + "; echo three | " + command + ")", plain, folder / "two");
    EXPECT_EQ(contentsOf(folder / "two"), "one and two, three\n");
  }
}

TEST(UnpackedFile, ReadsInputShorterThanAMarkAsItIs) {
  const TemporaryFolder folder;
  for (const std::string text : {"", "\x1F", "\xFD",
                                 "\xFD"
                                 "7zXZ",
                                 "\xFD"
                                 "7zXZ!",
                                 "a"}) {
    EXPECT_EQ(contentsOf(folder.write("short", text)), text);
  }
}

TEST(UnpackedFile, ReturnsWhatComesBeforeDamageAndSaysWhy) {
  const TemporaryFolder folder;
  const std::string text = sample();
  const std::string plain = folder.write("plain", text);
  for (const std::string command : {"gzip", "xz"}) {
    SCOPED_TRACE(command);
    compress(command, plain, folder / "packed");
    std::filesystem::resize_file(folder / "packed", std::filesystem::file_size(folder / "packed") / 2);
    const std::string cut = contentsOf(folder / "packed");
    EXPECT_TRUE(cut.ends_with(" [the compressed data is truncated]")) << cut.substr(cut.size() - 100);
    EXPECT_GT(cut.size(), text.size() / 4);
    EXPECT_EQ(cut.substr(0, 1000), text.substr(0, 1000));
  }
  const auto damaged = UnpackedFile::open(folder.write("bad", std::string("\x1F\x8B\x08\0\0\0\0\0\0\0", 10) + text));
  ASSERT_TRUE(damaged);
  EXPECT_TRUE(contentsOf(**damaged).ends_with("[the gzip data is damaged]"));
  EXPECT_EQ((*damaged)->failure(), "the gzip data is damaged");
}

TEST(UnpackedFile, TakesLittleMemoryForMuchThatUnpacksFromLittle) {
  const TemporaryFolder folder;
  constexpr std::size_t length = std::size_t{64} << 20;
  for (const std::string command : {"gzip -1", "xz -0"}) {
    ASSERT_EQ(
        std::system(
            ("head -c " + std::to_string(length) + " /dev/zero | " + command + " > " + (folder / "bomb")).c_str()),
        0);
    ASSERT_LT(std::filesystem::file_size(folder / "bomb"), length / 100);
    const auto file = UnpackedFile::open(folder / "bomb");
    ASSERT_TRUE(file);
    rusage before{};
    ::getrusage(RUSAGE_SELF, &before);
    std::vector<std::uint8_t> piece(65'536);
    for (Result<std::size_t> count = (*file)->read(piece); count && *count != 0; count = (*file)->read(piece)) {
    }
    EXPECT_EQ((*file)->unpacked(), length);
    rusage after{};
    ::getrusage(RUSAGE_SELF, &after);
    EXPECT_LT(after.ru_maxrss - before.ru_maxrss, 16 * 1024) << command;
  }
}

TEST(UnpackedFile, RefusesXzDataThatNeedsMoreMemoryThanItsLimit) {
  const TemporaryFolder folder;
  const std::string plain = folder.write("plain", "little");
  compress("xz --lzma2=dict=64MiB", plain, folder / "fits");
  EXPECT_EQ(contentsOf(folder / "fits"), "little");
  compress("xz --lzma2=dict=128MiB", plain, folder / "large");
  EXPECT_EQ(contentsOf(folder / "large"), " [the xz data needs more than 96 MiB of memory to unpack]");
}

}  // namespace
}  // namespace vespscope::test
