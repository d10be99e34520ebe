// What a manager's answer to the question for its status says.
#pragma once

#include <cstddef>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/Rhoxlink.h"

namespace rhox::client {

inline constexpr std::size_t longestLabel = 512;  // bytes of a source's label that are kept

// Takes the source, the position of its playback and the protocol on which both agree out of `reply`.
void takeStatus(const vespscope::ipc::Dictionary& reply, ConnectionStatus& status);
// Whether the next answer may differ: of a live source, and of a playback that has not ended.
[[nodiscard]] bool changesByItself(const ConnectionStatus& status);

}  // namespace rhox::client
