// The protocol's texts and dictionaries inside D-Bus messages. Like sd-bus, each function gives a negative error number
// when it fails.
#pragma once

#include <memory>
#include <string>

#include "platform/ipc/IpcObject.h"

struct sd_bus_message;

namespace vespscope::bus {

struct MessageUnref {
  void operator()(sd_bus_message* message) const;
};
using Message = std::unique_ptr<sd_bus_message, MessageUnref>;

// D-Bus text is UTF-8 without zero bytes; any other text is appended as people can read it.
int appendText(sd_bus_message* message, const std::string& text);
// Appends an a{sv}; objects nested too deep, and data beyond what D-Bus carries, are not sent.
int appendDictionary(sd_bus_message* message, const ipc::Dictionary& dictionary);
// Reads an a{sv} of the interface's types.
int readDictionary(sd_bus_message* message, ipc::Dictionary& out);

}  // namespace vespscope::bus
