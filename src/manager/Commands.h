// Reading requests of clients and making replies, shared by all commands.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "manager/CommandStatus.h"
#include "rhoxlink/bus/Bus.h"

namespace vespscope::manager {

[[nodiscard]] inline bus::Reply replyOf(CommandStatus status, std::string_view detail = {}) {
  return {static_cast<std::int32_t>(status), messageOf(status, detail), {}};
}

// The request's integer under `key`; null when it has none.
[[nodiscard]] inline const std::int64_t* integerIn(const ipc::Dictionary& request, std::string_view key) {
  const ipc::Object* object = request.find(key);
  return object == nullptr ? nullptr : object->asInt64();
}

// The reply to a request that has no value of the right kind under `key`.
[[nodiscard]] inline bus::Reply lacks(std::string_view key, std::string_view kind) {
  return replyOf(CommandStatus::badRequest, std::string(key) + " must be " + std::string(kind));
}

}  // namespace vespscope::manager
