#include "sources/diag/RrcMeaning.h"

#include "sources/diag/BitReader.h"

namespace vespscope::sources::diag {
namespace {

// UL-CCCH: the choice between the two requests, then criticalExtensions, where 0 is the form of release 8.
std::optional<RrcMeaning> uplinkCcch(BitReader bits) {
  const auto choice = bits.read(1);
  if (!choice) return std::nullopt;
  RrcMeaning meaning{*choice == 1 ? RrcEvent::connectionRequest : RrcEvent::reestablishmentRequest, std::nullopt};
  if (bits.read(1) != 0U) return meaning;
  if (meaning.event == RrcEvent::connectionRequest) {
    bits.skip(1 + 40);  // S-TMSI or random value: a choice, then 40 bits either way
    meaning.cause = bits.read(3);
  } else {
    bits.skip(16 + 9 + 16);  // C-RNTI, physical cell identity, shortMAC-I
    meaning.cause = bits.read(2);
  }
  return meaning;
}

std::optional<RrcMeaning> downlinkCcch(BitReader bits) {
  const auto choice = bits.read(2);
  if (choice == 1U) return RrcMeaning{RrcEvent::reestablishmentReject, std::nullopt};
  if (choice == 2U) return RrcMeaning{RrcEvent::connectionReject, std::nullopt};
  return std::nullopt;  // a setup or a re-establishment: its answer is evaluated instead
}

// RRCConnectionRelease: transaction identifier, criticalExtensions, the choice in c1, three flags of optional parts.
std::optional<unsigned> releaseCause(BitReader bits) {
  bits.skip(2);
  if (bits.read(1) != 0U || bits.read(2) != 0U) return std::nullopt;
  bits.skip(3);
  return bits.read(2);
}

std::optional<RrcMeaning> downlinkDcch(BitReader bits) {
  const auto choice = bits.read(4);
  if (!choice) return std::nullopt;
  if (choice == 3U) return RrcMeaning{RrcEvent::mobilityFromEutra, std::nullopt};
  if (choice == 5U) return RrcMeaning{RrcEvent::connectionRelease, releaseCause(bits)};
  return RrcMeaning{RrcEvent::dedicatedMessage, std::nullopt};
}

std::optional<RrcMeaning> uplinkDcch(BitReader bits) {
  const auto choice = bits.read(4);
  if (!choice) return std::nullopt;
  if (choice == 2U) return RrcMeaning{RrcEvent::reconfigurationComplete, std::nullopt};
  if (choice == 3U) return RrcMeaning{RrcEvent::reestablishmentComplete, std::nullopt};
  if (choice == 4U) return RrcMeaning{RrcEvent::connectionSetupComplete, std::nullopt};
  return RrcMeaning{RrcEvent::dedicatedMessage, std::nullopt};
}

// Of the later releases' messages, only the request and the completion of a resume matter.
std::optional<RrcMeaning> laterMessage(RrcChannel channel, BitReader bits) {
  constexpr unsigned resumeComplete = 4;
  if (bits.read(1) != 0U) return std::nullopt;  // c2, or later still
  if (channel == RrcChannel::uplinkCcch) return RrcMeaning{RrcEvent::connectionRequest, std::nullopt};
  if (channel != RrcChannel::uplinkDcch || bits.read(4) != resumeComplete) return std::nullopt;
  return RrcMeaning{RrcEvent::connectionSetupComplete, std::nullopt};
}

}  // namespace

std::optional<RrcMeaning> rrcMeaningOf(RrcChannel channel, std::span<const std::uint8_t> message) {
  if (!isDedicated(channel)) return std::nullopt;
  BitReader bits(message);
  const auto extension = bits.read(1);  // of every message class: c1, or what later releases have added
  if (!extension) return std::nullopt;
  if (*extension == 1U) return laterMessage(channel, bits);
  switch (channel) {
    case RrcChannel::uplinkCcch:
      return uplinkCcch(bits);
    case RrcChannel::downlinkCcch:
      return downlinkCcch(bits);
    case RrcChannel::downlinkDcch:
      return downlinkDcch(bits);
    case RrcChannel::uplinkDcch:
      return uplinkDcch(bits);
    case RrcChannel::broadcast:
    case RrcChannel::systemInformation:
    case RrcChannel::multicast:
    case RrcChannel::paging:
    case RrcChannel::other:
      break;
  }
  return std::nullopt;
}

}  // namespace vespscope::sources::diag
