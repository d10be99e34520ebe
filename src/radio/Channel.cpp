#include "radio/Channel.h"

#include <algorithm>

namespace vespscope::radio {
namespace {

bool serves(const ChannelBlock& block, Direction direction) {
  return block.direction == direction || block.direction == Direction::both || direction == Direction::both;
}

bool holds(const ChannelBlock& block, std::uint32_t number) {
  return block.first <= number && number <= block.last && (number - block.first) % block.step == 0;
}

}  // namespace

template <class System>
std::vector<Channel<System>> Channel<System>::allWithNumber(std::uint32_t number, Direction direction) {
  std::vector<Channel> channels;
  for (const ChannelBlock& block : System::blocks()) {
    if (serves(block, direction) && holds(block, number)) channels.push_back(Channel(number, block));
  }
  return channels;
}

template <class System>
std::optional<Channel<System>> Channel<System>::fromNumber(std::uint32_t number, Direction direction) {
  std::optional<Channel> only;
  for (const ChannelBlock& block : System::blocks()) {
    // The number first: it excludes most blocks.
    if (!holds(block, number) || !serves(block, direction)) continue;
    if (only) return std::nullopt;
    only = Channel(number, block);
  }
  return only;
}

template <class System>
std::optional<Channel<System>> Channel<System>::fromNumber(std::uint32_t number, Direction direction, Band band) {
  for (const ChannelBlock& block : System::blocks()) {
    if (block.band == static_cast<std::uint32_t>(band) && serves(block, direction) && holds(block, number)) {
      return Channel(number, block);
    }
  }
  return std::nullopt;
}

template <class System>
std::vector<Channel<System>> Channel<System>::allAtFrequency(std::uint32_t kilohertz, Direction direction) {
  std::vector<Channel> channels;
  for (const ChannelBlock& block : System::blocks()) {
    if (!serves(block, direction) || kilohertz < block.kilohertz) continue;
    const std::uint32_t above = kilohertz - block.kilohertz;
    const std::uint32_t number = block.first + above / System::kilohertzPerNumber;
    if (above % System::kilohertzPerNumber == 0 && holds(block, number)) channels.push_back(Channel(number, block));
  }
  return channels;
}

template <class System>
std::uint32_t Channel<System>::kilohertz() const {
  return block_->kilohertz + (number_ - block_->first) * System::kilohertzPerNumber;
}

template <class System>
std::optional<Channel<System>> Channel<System>::paired() const {
  if (block_->direction == Direction::both) return *this;
  if (!block_->pairedBy) return std::nullopt;
  const auto number = static_cast<std::uint32_t>(static_cast<std::int64_t>(number_) + *block_->pairedBy);
  const Direction other = block_->direction == Direction::downlink ? Direction::uplink : Direction::downlink;
  return fromNumber(number, other, band());
}

template class Channel<Eutra>;
template class Channel<Utra>;
template class Channel<Geran>;

}  // namespace vespscope::radio
