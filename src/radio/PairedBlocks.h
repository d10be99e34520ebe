// Makes the blocks of a band table from rows that give both directions of a band at once.
#pragma once

#include <array>
#include <cstddef>

#include "radio/Channel.h"

namespace vespscope::radio {

struct BandRow {
  std::uint32_t band = 0;
  std::uint32_t downlinkFirst = 0;
  std::uint32_t downlinkLast = 0;
  std::uint32_t downlinkKilohertz = 0;
  std::uint32_t uplinkFirst = 0;
  std::uint32_t uplinkLast = 0;
  std::uint32_t uplinkKilohertz = 0;
  std::uint32_t step = 1;

  [[nodiscard]] constexpr bool hasUplink() const { return uplinkKilohertz != 0; }
  [[nodiscard]] constexpr bool isShared() const { return uplinkKilohertz == downlinkKilohertz; }
};

template <std::size_t rowCount>
constexpr std::size_t blockCount(const std::array<BandRow, rowCount>& rows) {
  std::size_t count = 0;
  for (const BandRow& row : rows) count += row.hasUplink() && !row.isShared() ? 2 : 1;
  return count;
}

template <std::size_t blocks, std::size_t rowCount>
constexpr std::array<ChannelBlock, blocks> pairedBlocks(const std::array<BandRow, rowCount>& rows) {
  std::array<ChannelBlock, blocks> table{};
  std::size_t next = 0;
  for (const BandRow& row : rows) {
    const bool paired = row.hasUplink() && !row.isShared();
    const auto distance = static_cast<std::int32_t>(row.uplinkFirst) - static_cast<std::int32_t>(row.downlinkFirst);
    table[next++] = {row.band,          row.isShared() ? Direction::both : Direction::downlink,
                     row.downlinkFirst, row.downlinkLast,
                     row.step,          row.downlinkKilohertz,
                     distance};
    if (!paired) continue;
    table[next++] = {row.band, Direction::uplink,   row.uplinkFirst, row.uplinkLast,
                     row.step, row.uplinkKilohertz, -distance};
  }
  return table;
}

}  // namespace vespscope::radio
