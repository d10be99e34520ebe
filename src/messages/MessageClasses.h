// Every message class by its name, for tools that handle messages without knowing their classes.
#pragma once

#include <memory>
#include <span>
#include <string_view>

#include "messages/WireMessage.h"

namespace vespscope {

struct MessageClass {
  std::string_view name;
  // An empty message of the class.
  std::shared_ptr<WireMessage> (*make)();
};

// In the order of the schema files and, within each, of declaration.
[[nodiscard]] std::span<const MessageClass> messageClasses();

}  // namespace vespscope
