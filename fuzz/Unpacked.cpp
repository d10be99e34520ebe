// The reader of compressed inputs: for any file, its contents and the error do not depend on how much is read at once,
// and reading ends.
#include <algorithm>
#include <optional>
#include <string>
#include <vector>

#include "Fuzz.h"
#include "MemoryFile.h"
#include "platform/files/UnpackedFile.h"

using namespace vespscope;
using fuzz::require;

namespace {

// A compressed file can decompress to at most a thousand times the fuzzer's input length.
constexpr std::size_t mostContents = std::size_t{8} << 20;

struct Contents {
  std::vector<std::uint8_t> bytes;
  std::optional<std::string> failure;
};

Contents contentsOf(files::UnpackedFile& file, std::size_t pieceLength) {
  Contents contents;
  std::vector<std::uint8_t> piece(pieceLength);
  while (contents.bytes.size() < mostContents) {
    const Result<std::size_t> count = file.read(piece);
    if (!count) {
      contents.failure = count.reason();
      return contents;
    }
    if (*count == 0) return contents;
    require(*count <= pieceLength, "more is read than asked for");
    contents.bytes.insert(contents.bytes.end(), piece.begin(), piece.begin() + static_cast<std::ptrdiff_t>(*count));
  }
  contents.bytes.resize(mostContents);
  return contents;
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  const fuzz::MemoryFile memory(std::span(data + 1, size - 1));
  auto file = files::UnpackedFile::open(memory.path());
  require(file.ok(), "a file in memory cannot be opened");
  const Contents whole = contentsOf(**file, std::size_t{1} << 16);
  require((*file)->rewind() == std::nullopt, "a file cannot be read again");
  const Contents pieces = contentsOf(**file, std::size_t{data[0]} + 1);
  require(whole.bytes == pieces.bytes && whole.failure == pieces.failure, "the contents depend on the pieces");
  return 0;
}
