#include "platform/files/Unpacker.h"

#include <algorithm>
#include <array>

namespace vespscope::files {
namespace {

constexpr std::array<std::uint8_t, 2> gzipMark = {0x1F, 0x8B};
constexpr std::array<std::uint8_t, packingMarkLength> xzMark = {0xFD, '7', 'z', 'X', 'Z', 0x00};

// Whether `head` agrees with the magic number as far as both go.
bool agrees(std::span<const std::uint8_t> head, std::span<const std::uint8_t> mark) {
  const std::size_t length = std::min(head.size(), mark.size());
  return std::equal(mark.begin(), mark.begin() + static_cast<std::ptrdiff_t>(length), head.begin());
}

}  // namespace

std::optional<Packing> packingOf(std::span<const std::uint8_t> head) {
  if (head.empty()) return std::nullopt;
  if (agrees(head, gzipMark)) return head.size() < gzipMark.size() ? std::nullopt : std::optional(Packing::gzip);
  if (agrees(head, xzMark)) return head.size() < xzMark.size() ? std::nullopt : std::optional(Packing::xz);
  return Packing::none;
}

Result<std::unique_ptr<Unpacker>> makeUnpacker(Packing packing) {
  switch (packing) {
    case Packing::gzip:
      return makeGzipUnpacker();
    case Packing::xz:
      return makeXzUnpacker();
    case Packing::none:
      break;
  }
  return Failure{std::string("is not compressed")};
}

}  // namespace vespscope::files
