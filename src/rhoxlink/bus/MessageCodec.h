// The protocol's texts and dictionaries inside D-Bus messages. Like sd-bus, each function returns a negative error
// number on failure.
#pragma once

#include <cstddef>
#include <memory>
#include <string>

#include "platform/ipc/IpcObject.h"

struct sd_bus_message;

namespace vespscope::bus {

struct MessageUnref {
  void operator()(sd_bus_message* message) const;
};
using Message = std::unique_ptr<sd_bus_message, MessageUnref>;

// Bounds on sent and received messages. Our own messages stay far below them. They keep a peer from choosing the depth
// of our stack, how long entries are compared, and how much memory a small message takes.
inline constexpr int depthLimit = 16;
inline constexpr std::size_t entryLimit = 1024;      // of a dictionary
inline constexpr std::size_t objectLimit = 4096;     // of a message
inline constexpr std::size_t textLimit = 64 * 1024;  // bytes of a text or a key

// Appends a text. D-Bus text is UTF-8 without zero bytes; any other text is appended in printable form.
int appendText(sd_bus_message* message, const std::string& text);
// Appends an a{sv}; fails when it exceeds a bound, or the message would exceed messageLimit.
int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary);
// Reads an a{sv} of the interface's types.
int readDictionary(sd_bus_message* message, ipc::Dictionary& out);

}  // namespace vespscope::bus
