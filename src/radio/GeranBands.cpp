// GSM's frequency bands and their channel numbers: 3GPP TS 45.005 clause 2, table 2-1.
#include <array>

#include "radio/Channel.h"

namespace vespscope::radio {
namespace {

struct Row {
  GsmBand band;
  std::uint32_t first;
  std::uint32_t last;
  std::uint32_t uplink;    // kHz, of `first`
  std::uint32_t downlink;  // kHz
};
// The extensions of GSM 900 downwards continue its numbers below 1024.
constexpr std::array<Row, 13> rows = {{
    {GsmBand::gsm450, 259, 293, 450'600, 460'600},
    {GsmBand::gsm480, 306, 340, 479'000, 489'000},
    {GsmBand::gsm750, 438, 511, 777'200, 747'200},
    {GsmBand::gsm850, 128, 251, 824'200, 869'200},
    {GsmBand::primary900, 1, 124, 890'200, 935'200},
    {GsmBand::extended900, 0, 124, 890'000, 935'000},
    {GsmBand::extended900, 975, 1023, 880'200, 925'200},
    {GsmBand::railways900, 0, 124, 890'000, 935'000},
    {GsmBand::railways900, 955, 1023, 876'200, 921'200},
    {GsmBand::extendedRailways900, 0, 124, 890'000, 935'000},
    {GsmBand::extendedRailways900, 940, 1023, 873'200, 918'200},
    {GsmBand::dcs1800, 512, 885, 1'710'200, 1'805'200},
    {GsmBand::pcs1900, 512, 810, 1'850'200, 1'930'200},
}};

// Both directions of a GSM channel have one number.
constexpr std::array<ChannelBlock, 2 * rows.size()> blocksOf() {
  std::array<ChannelBlock, 2 * rows.size()> table{};
  std::size_t next = 0;
  for (const Row& row : rows) {
    const auto band = static_cast<std::uint32_t>(row.band);
    table[next++] = {band, Direction::downlink, row.first, row.last, 1, row.downlink, 0};
    table[next++] = {band, Direction::uplink, row.first, row.last, 1, row.uplink, 0};
  }
  return table;
}
constexpr auto table = blocksOf();

}  // namespace

std::span<const ChannelBlock> Geran::blocks() { return table; }

}  // namespace vespscope::radio
