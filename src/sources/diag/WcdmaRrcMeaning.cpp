#include "sources/diag/WcdmaRrcMeaning.h"

#include <array>

#include "sources/diag/BitReader.h"

namespace vespscope::sources::diag {
namespace {

using Event = WcdmaRrcEvent;
using Meaning = std::optional<WcdmaRrcMeaning>;

WcdmaRrcMeaning meaningOf(Event event, std::optional<unsigned> cause = std::nullopt) {
  WcdmaRrcMeaning meaning;
  meaning.event = event;
  meaning.cause = cause;
  return meaning;
}

// LAI: three digits of the MCC, two or three of the MNC, the location area code.
bool skipLocationArea(BitReader& bits) {
  bits.skip(3 * 4);
  const auto third = bits.read(1);
  if (!third) return false;
  bits.skip((2 + *third) * 4 + 16);
  return true;
}

// InitialUE-Identity; returns false for the identities of another system.
bool skipInitialIdentity(BitReader& bits) {
  switch (bits.read(3).value_or(7)) {
    case 0: {  // IMSI of 6 to 21 digits
      const auto more = bits.read(4);
      if (!more) return false;
      bits.skip((6 + *more) * 4);
      return true;
    }
    case 1:  // TMSI
      bits.skip(32);
      return skipLocationArea(bits);
    case 2:  // P-TMSI
      bits.skip(32);
      if (!skipLocationArea(bits)) return false;
      bits.skip(8);
      return true;
    case 3:  // IMEI
      bits.skip(15 * 4);
      return true;
    default:
      return false;
  }
}

Meaning connectionRequest(BitReader bits) {
  bits.skip(2);  // whether there are measurements, extensions
  if (!skipInitialIdentity(bits)) return meaningOf(Event::connectionRequest);
  return meaningOf(Event::connectionRequest, bits.read(5));
}

Meaning cellUpdate(BitReader bits) {
  constexpr unsigned radioLinkFailure = 5;
  bits.skip(3 + 32);  // three optional parts, U-RNTI
  const auto more = bits.read(2);
  if (!more) return std::nullopt;
  bits.skip((1 + *more) * (1 + 20) + 2);  // START of each domain, two flags of errors
  const auto cause = bits.read(3);
  if (!cause) return std::nullopt;
  return meaningOf(*cause == radioLinkFailure ? Event::radioLinkFailure : Event::cellUpdate);
}

Meaning connectionReject(BitReader bits) {
  if (bits.read(1) != 0U) return meaningOf(Event::connectionReject);  // of a later release
  bits.skip(1);
  WcdmaRrcMeaning meaning = meaningOf(Event::connectionReject);
  meaning.redirected = bits.read(1) == 1U;
  if (!skipInitialIdentity(bits)) return meaning;
  bits.skip(2);  // transaction
  meaning.cause = bits.read(1);
  return meaning;
}

// The beginning of RRCConnectionSetup, by release: flags of optional parts. The one with this index announces an
// activation time of 8 bits before the U-RNTI, and those after it identities of 16 bits after the U-RNTI.
struct SetupForm {
  unsigned flags;
  unsigned activationTime;
  unsigned identities;
};
constexpr SetupForm firstSetupForm = {11, 1, 1};
constexpr std::array<SetupForm, 8> laterSetupForms = {
    {{13, 1, 1}, {10, 2, 1}, {15, 2, 4}, {19, 2, 4}, {22, 2, 4}, {22, 2, 4}, {24, 2, 4}, {25, 2, 4}}};

struct SetupFlags {
  bool activationTime = false;
  unsigned identities = 0;
};
std::optional<SetupFlags> readSetupFlags(BitReader& bits, const SetupForm& form) {
  const auto flags = bits.read(form.flags);
  if (!flags) return std::nullopt;
  const auto isSet = [&](unsigned index) { return (*flags >> (form.flags - 1 - index) & 1U) != 0; };
  SetupFlags read{isSet(form.activationTime), 0};
  for (unsigned i = 1; i <= form.identities; ++i) read.identities += isSet(form.activationTime + i) ? 1 : 0;
  return read;
}

std::optional<unsigned> readStateIndicator(BitReader& bits, const SetupFlags& flags) {
  bits.skip((flags.activationTime ? 8 : 0) + 32 + flags.identities * 16);
  return bits.read(2);
}

std::optional<unsigned> setupState(BitReader bits) {
  const auto later = bits.read(1);
  if (!later) return std::nullopt;
  if (*later == 0) {
    const auto flags = readSetupFlags(bits, firstSetupForm);
    if (!flags || !skipInitialIdentity(bits)) return std::nullopt;
    bits.skip(2);  // transaction
    return readStateIndicator(bits, *flags);
  }
  if (!skipInitialIdentity(bits)) return std::nullopt;
  bits.skip(2);
  // Each critical extension contains the form of one release, or the next extension.
  for (const SetupForm& form : laterSetupForms) {
    const auto next = bits.read(1);
    if (!next) return std::nullopt;
    if (*next == 1) continue;
    const auto flags = readSetupFlags(bits, form);
    return flags ? readStateIndicator(bits, *flags) : std::nullopt;
  }
  return std::nullopt;
}

Meaning connectionSetup(BitReader bits) {
  WcdmaRrcMeaning meaning = meaningOf(Event::connectionSetup);
  meaning.state = setupState(bits);
  return meaning;
}

// On DCCH; the forms of the first release and of release 4 differ in the position of the transaction.
Meaning connectionRelease(BitReader bits) {
  WcdmaRrcMeaning meaning = meaningOf(Event::connectionRelease);
  const auto later = bits.read(1);
  if (!later) return meaning;
  if (*later == 1) {
    bits.skip(2);
    if (bits.read(1) != 0U) return meaning;  // of an even later release
  }
  bits.skip(1);
  const auto quantity = bits.read(1);  // how often the answer is repeated
  bits.skip(1);
  if (*later == 0) bits.skip(2);
  if (quantity == 1U) bits.skip(3);
  meaning.cause = bits.read(3);
  return meaning;
}

Meaning directTransfer(BitReader bits) {
  const auto length = bits.read(12);
  if (!length) return std::nullopt;
  WcdmaRrcMeaning meaning = meaningOf(Event::directTransfer);
  for (unsigned left = *length + 1; left > 0; --left) {
    const auto octet = bits.read(8);
    if (!octet) return std::nullopt;
    meaning.nasMessage.push_back(static_cast<std::uint8_t>(*octet));
  }
  return meaning;
}

Meaning uplinkDirectTransfer(BitReader bits, bool initial) {
  bits.skip(2 + 1 + (initial ? 16 : 0));  // optional parts, domain, the network's node selection
  return directTransfer(bits);
}

Meaning downlinkDirectTransfer(BitReader bits) {
  if (bits.read(1) != 0U) return std::nullopt;  // of a later release
  bits.skip(1 + 2 + 1);                         // extensions, transaction, domain
  return directTransfer(bits);
}

Meaning uplinkCcch(BitReader bits) {
  switch (bits.read(2).value_or(3)) {
    case 0:
      return cellUpdate(bits);
    case 1:
      return connectionRequest(bits);
    case 2:
      return meaningOf(Event::cellUpdate);
    default:
      return std::nullopt;
  }
}

Meaning downlinkCcch(BitReader bits) {
  switch (bits.read(3).value_or(7)) {
    case 1:
      return connectionReject(bits);
    case 2:
      return meaningOf(Event::connectionRelease);
    case 3:
      return connectionSetup(bits);
    default:
      return std::nullopt;
  }
}

Meaning uplinkDcch(BitReader bits) {
  switch (bits.read(5).value_or(31)) {
    case 0:  // active set update complete
    case 4:  // handover to UTRAN complete
      return meaningOf(Event::dedicatedChannelMessage);
    case 5:
      return uplinkDirectTransfer(bits, true);
    case 17:
      return meaningOf(Event::connectionReleaseComplete);
    case 18:
      return meaningOf(Event::connectionSetupComplete);
    case 22:
      return meaningOf(Event::signallingReleaseIndication);
    case 27:
      return uplinkDirectTransfer(bits, false);
    default:
      return std::nullopt;
  }
}

Meaning downlinkDcch(BitReader bits) {
  switch (bits.read(5).value_or(31)) {
    case 0:  // active set update
      return meaningOf(Event::dedicatedChannelMessage);
    case 5:
      return downlinkDirectTransfer(bits);
    case 15:
      return connectionRelease(bits);
    default:
      return std::nullopt;
  }
}

}  // namespace

std::optional<WcdmaRrcMeaning> wcdmaRrcMeaningOf(WcdmaChannel channel, std::span<const std::uint8_t> message) {
  BitReader bits(message);
  const auto integrity = bits.read(1);
  if (!integrity) return std::nullopt;
  if (*integrity == 1) bits.skip(32 + 4);  // message authentication code, sequence number
  switch (channel) {
    case WcdmaChannel::uplinkCcch:
      return uplinkCcch(bits);
    case WcdmaChannel::uplinkDcch:
      return uplinkDcch(bits);
    case WcdmaChannel::downlinkCcch:
      return downlinkCcch(bits);
    case WcdmaChannel::downlinkDcch:
      return downlinkDcch(bits);
  }
  return std::nullopt;
}

}  // namespace vespscope::sources::diag
