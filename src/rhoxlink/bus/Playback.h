// The position of a playback as the entry kKeyPlayback of the manager's status.
#pragma once

#include <optional>

#include "platform/ipc/IpcObject.h"
#include "values/PlaybackPosition.h"

namespace vespscope::bus {

[[nodiscard]] ipc::Object toObject(const PlaybackPosition& position);
// The position in a reply to kCommandStatus; empty when it has none, or one of another form.
[[nodiscard]] std::optional<PlaybackPosition> playbackIn(const ipc::Dictionary& reply);

}  // namespace vespscope::bus
