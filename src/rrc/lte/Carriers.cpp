#include "rrc/lte/Carriers.h"

namespace vespscope::rrc::lte {
namespace {

constexpr unsigned channelCount = 1024;

}  // namespace

GsmCarriers gsmCarriersOf(const View& carriers) {
  GsmCarriers result;
  const auto first = static_cast<unsigned>(carriers["startingARFCN"].value());
  const auto add = [&](unsigned channel) {
    result.channels.push_back(static_cast<std::uint16_t>(channel % channelCount));
  };
  result.band1900 = carriers["bandIndicator"].item() == "pcs1900";
  add(first);
  for (const View channel : carriers["followingARFCNs.explicitListOfARFCNs"]) {
    add(static_cast<unsigned>(channel.value()));
  }
  if (const View spaced = carriers["followingARFCNs.equallySpacedARFCNs"]) {
    const auto spacing = static_cast<unsigned>(spaced["arfcn-Spacing"].value());
    const auto count = static_cast<unsigned>(spaced["numberOfFollowingARFCNs"].value());
    for (unsigned index = 1; index <= count; ++index) add(first + index * spacing);
  }
  // The first bit belongs to the channel behind the starting one.
  unsigned channel = first;
  for (const std::uint8_t byte : carriers["followingARFCNs.variableBitMapOfARFCNs"].bytes()) {
    for (int bit = 7; bit >= 0; --bit) {
      ++channel;
      if ((byte >> bit & 1) != 0) add(channel);
    }
  }
  return result;
}

std::vector<CellRange> cellRangesOf(const View& list) {
  std::vector<CellRange> ranges;
  for (const View range : list) {
    ranges.push_back({static_cast<std::uint16_t>(range["start"].value()),
                      static_cast<std::uint16_t>(range["range"].itemNumber().value_or(1))});
  }
  return ranges;
}

}  // namespace vespscope::rrc::lte
