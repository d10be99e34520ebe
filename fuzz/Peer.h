// The messages as another implementation of the wire format reads them, and calls of all accessors.
#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string_view>

#include "messages/ProtobufPeer.h"
#include "messages/WireMessage.h"

namespace vespscope::fuzz {

// Null when the other implementation rejects the bytes.
[[nodiscard]] std::unique_ptr<google::protobuf::Message> readByPeer(std::string_view messageClass,
                                                                    std::span<const std::uint8_t> bytes);

// Returns true when both implementations follow the same rules for these bytes. Ours differs, on purpose, for keys and
// numbers that no valid writer makes, groups, metric tags as field numbers, known fields of another wire type, and
// embedded messages and enumerations that occur twice.
[[nodiscard]] bool rulesAgree(std::string_view messageClass, std::span<const std::uint8_t> bytes);

// Calls every accessor; generated from the schema.
void callAccessors(const WireMessage& message);

}  // namespace vespscope::fuzz
