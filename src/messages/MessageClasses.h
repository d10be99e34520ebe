// Every message class by its name, for tools that handle messages without knowing their classes.
#pragma once

#include <memory>
#include <span>
#include <string_view>

#include "messages/WireMessage.h"

namespace vespscope {

struct MessageClass {
  std::string_view name;
  // guards the members below
  std::shared_ptr<WireMessage> (*make)();
};

// The state of one modem at one moment as ModemManager reports it. Unreported values are empty.
[[nodiscard]] std::span<const MessageClass> messageClasses();

}  // namespace vespscope
