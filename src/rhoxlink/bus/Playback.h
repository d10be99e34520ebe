// Reads and writes the position of a playback as the entry kKeyPlayback of the manager's status.
#pragma once

#include <optional>

#include "platform/ipc/IpcObject.h"
#include "values/PlaybackPosition.h"

namespace vespscope::bus {

[[nodiscard]] ipc::Object toObject(const PlaybackPosition& position);
// Returns the position in a reply to kCommandStatus; empty if there is none or its form is unknown.
[[nodiscard]] std::optional<PlaybackPosition> playbackIn(const ipc::Dictionary& reply);

}  // namespace vespscope::bus
