// Reads a manager's answer to kCommandStatus.
#pragma once

#include <cstddef>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/Rhoxlink.h"

namespace rhox::client {

inline constexpr std::size_t longestLabel = 512;  // bytes of a source's label that are stored

// Stores the source, the playback's position and the protocol version in use from `reply`.
void takeStatus(const vespscope::ipc::Dictionary& reply, ConnectionStatus& status);
// Whether the next answer may differ without a command: true for a live source and for a playback that has not ended.
[[nodiscard]] bool changesByItself(const ConnectionStatus& status);

}  // namespace rhox::client
