#include "rhoxlink/StatusReply.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>

#include "rhoxlink/bus/Names.h"
#include "rhoxlink/bus/Playback.h"

namespace rhox::client {
namespace {

using vespscope::SourceKind;
using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;

constexpr std::int64_t firstProtocol = 1;  // assumed of managers that report none

std::string textIn(const Dictionary& reply, std::string_view key) {
  const Object* object = reply.find(key);
  return object == nullptr || object->asString() == nullptr ? std::string() : *object->asString();
}

}  // namespace

void takeStatus(const Dictionary& reply, ConnectionStatus& status) {
  status.sourceLabel = textIn(reply, kKeySourceLabel).substr(0, longestLabel);
  status.sourceKind = vespscope::sourceKindOf(textIn(reply, kKeySourceKind));
  status.playback = vespscope::bus::playbackIn(reply);
  const Object* profile = reply.find(kKeyProfileID);
  const std::int64_t* card = profile == nullptr ? nullptr : profile->asInt64();
  status.simCard.reset();
  if (card != nullptr && std::in_range<std::int32_t>(*card)) status.simCard = static_cast<std::int32_t>(*card);
  const Object* protocol = reply.find(kKeyProtocol);
  const std::int64_t* version = protocol == nullptr ? nullptr : protocol->asInt64();
  status.protocol = version == nullptr ? firstProtocol : std::clamp(*version, firstProtocol, kProtocol);
}

bool changesByItself(const ConnectionStatus& status) {
  switch (status.sourceKind) {
    case SourceKind::live:
      return true;
    case SourceKind::recorded:
      return status.protocol >= kProtocolOfPlayback && !(status.playback && status.playback->ended);
    case SourceKind::simulated:
    case SourceKind::unknown:
      break;
  }
  return false;
}

}  // namespace rhox::client
