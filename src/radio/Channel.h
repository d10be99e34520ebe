// Channel numbers of LTE, UMTS and GSM: the operating bands that have a number, and its frequency in each.
//
// The same number may belong to several bands: GSM 1800 and 1900 share theirs, and so do UMTS V and VI. LTE's numbers
// belong to one band each, but several bands have a number for the same frequency.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

namespace vespscope::radio {

enum class Direction : std::uint8_t {
  downlink,
  uplink,
  both,  // one frequency for both in turn (TDD)
};

// Numbers of one band that follow each other with even steps in number and in frequency.
struct ChannelBlock {
  std::uint32_t band = 0;
  Direction direction = Direction::downlink;
  std::uint32_t first = 0;
  std::uint32_t last = 0;
  std::uint32_t step = 1;
  std::uint32_t kilohertz = 0;           // of `first`
  std::optional<std::int32_t> pairedBy;  // what to add for the number of the other direction
};

// `System` gives the blocks, the frequency of one number's step, and the type of its bands.
template <class System>
class Channel {
 public:
  using Band = typename System::Band;

  // Every band's channel with this number, in the order of the bands; empty when no band has it.
  [[nodiscard]] static std::vector<Channel> allWithNumber(std::uint32_t number, Direction direction);
  // The channel of the only band that has the number; empty when there is none or a choice.
  [[nodiscard]] static std::optional<Channel> fromNumber(std::uint32_t number, Direction direction);
  // The channel of a given band; empty when the band does not have the number.
  [[nodiscard]] static std::optional<Channel> fromNumber(std::uint32_t number, Direction direction, Band band);
  // Every band's channel at this frequency; empty where no channel lies.
  [[nodiscard]] static std::vector<Channel> allAtFrequency(std::uint32_t kilohertz, Direction direction);

  [[nodiscard]] std::uint32_t number() const { return number_; }
  [[nodiscard]] Band band() const { return static_cast<Band>(block_->band); }
  [[nodiscard]] Direction direction() const { return block_->direction; }
  [[nodiscard]] std::uint32_t kilohertz() const;
  [[nodiscard]] double megahertz() const { return kilohertz() / 1000.0; }
  // The channel of the other direction at the band's usual distance; empty where one direction is all there is, and
  // the channel itself where one frequency serves both.
  [[nodiscard]] std::optional<Channel> paired() const;

  friend bool operator==(const Channel& left, const Channel& right) {
    return left.number_ == right.number_ && left.block_->band == right.block_->band &&
           left.block_->direction == right.block_->direction;
  }

 private:
  Channel(std::uint32_t number, const ChannelBlock& block) : number_(number), block_(&block) {}

  std::uint32_t number_;
  const ChannelBlock* block_;  // into the table
};

// LTE (3GPP TS 36.101 5.7.3): 100 kHz a number, bands by number.
struct Eutra {
  using Band = std::uint32_t;
  static constexpr std::uint32_t kilohertzPerNumber = 100;
  [[nodiscard]] static std::span<const ChannelBlock> blocks();
};
// UMTS FDD (3GPP TS 25.101 5.4), the additional channels between the 200 kHz raster included; bands by number.
struct Utra {
  using Band = std::uint32_t;
  static constexpr std::uint32_t kilohertzPerNumber = 200;
  [[nodiscard]] static std::span<const ChannelBlock> blocks();
};
// GSM (3GPP TS 45.005 2). The T-GSM bands and GSM 710 are left out: their numbers are assigned by each cell.
enum class GsmBand : std::uint8_t {
  gsm450,
  gsm480,
  gsm750,
  gsm850,
  primary900,
  extended900,
  railways900,
  extendedRailways900,
  dcs1800,
  pcs1900,
};
struct Geran {
  using Band = GsmBand;
  static constexpr std::uint32_t kilohertzPerNumber = 200;
  [[nodiscard]] static std::span<const ChannelBlock> blocks();
};

using Earfcn = Channel<Eutra>;
using Uarfcn = Channel<Utra>;
using Arfcn = Channel<Geran>;

extern template class Channel<Eutra>;
extern template class Channel<Utra>;
extern template class Channel<Geran>;

}  // namespace vespscope::radio
