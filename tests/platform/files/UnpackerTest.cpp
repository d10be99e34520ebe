// How input is compressed, by its first bytes.
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include <gtest/gtest.h>

#include "platform/files/Unpacker.h"

namespace vespscope::test {
namespace {

using files::Packing;
using files::packingOf;

TEST(Unpacker, SaysAsSoonAsPossibleHowInputIsCompressed) {
  const std::vector<std::uint8_t> gzip = {0x1F, 0x8B};
  const std::vector<std::uint8_t> xz = {0xFD, '7', 'z', 'X', 'Z', 0};
  EXPECT_EQ(packingOf({}), std::nullopt);
  EXPECT_EQ(packingOf(std::span(gzip).first(1)), std::nullopt);
  EXPECT_EQ(packingOf(gzip), Packing::gzip);
  EXPECT_EQ(packingOf(std::span(xz).first(5)), std::nullopt);
  EXPECT_EQ(packingOf(xz), Packing::xz);
  EXPECT_EQ(packingOf(std::span(xz).subspan(1)), Packing::none);
}

}  // namespace
}  // namespace vespscope::test
