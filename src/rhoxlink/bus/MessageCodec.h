// The protocol's texts and dictionaries inside D-Bus messages. Like sd-bus, each function gives a negative error number
// when it fails.
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

// Bounds on what is sent and on what is taken. Nothing of ours comes near any of them; a peer shall choose neither the
// depth of our stack nor how long entries are compared nor what a small message takes of memory.
inline constexpr int depthLimit = 16;
inline constexpr std::size_t entryLimit = 1024;      // of a dictionary
inline constexpr std::size_t objectLimit = 4096;     // of a message
inline constexpr std::size_t textLimit = 64 * 1024;  // bytes of a text or a key

// D-Bus text is UTF-8 without zero bytes; any other text is appended as people can read it.
int appendText(sd_bus_message* message, const std::string& text);
// Appends an a{sv}; fails when it exceeds a bound, or the message would exceed messageLimit.
int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary);
// Reads an a{sv} of the interface's types.
int readDictionary(sd_bus_message* message, ipc::Dictionary& out);

}  // namespace vespscope::bus
