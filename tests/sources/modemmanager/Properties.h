// Properties of objects, as the bus carries them.
#pragma once

#include <cstdint>
#include <initializer_list>
#include <string>
#include <utility>

#include "platform/ipc/IpcObject.h"

namespace vespscope::test {

inline ipc::Object number(std::uint64_t value) { return ipc::Object(value); }
inline ipc::Object text(const char* value) { return ipc::Object(std::string(value)); }

inline ipc::Dictionary dictionary(std::initializer_list<std::pair<const char*, ipc::Object>> entries) {
  ipc::Dictionary made;
  for (const auto& [name, value] : entries) made.set(name, value);
  return made;
}

}  // namespace vespscope::test
