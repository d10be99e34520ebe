#include "support/HostileMessages.h"

namespace vespscope::test {

std::string callOf(const std::string& signature, const std::string& body, std::size_t size, std::uint32_t serial) {
  Wire fields;
  const auto field = [&fields](char code, const std::string& type, const std::string& value) {
    fields.align(8).bytes += code;
    fields.signature(type);
    type == "g" ? fields.signature(value) : fields.text(value);
  };
  field(1, "o", "/org/vespscope/BasebandManager1");
  field(2, "s", "org.vespscope.BasebandManager1");
  field(3, "s", "PerformCommand");
  field(8, "g", signature);
  Wire call;
  call.bytes = std::string("l\1\0\1", 4);
  call.number(static_cast<std::uint32_t>(size)).number(serial);
  call.number(static_cast<std::uint32_t>(fields.bytes.size())).bytes += fields.bytes;
  return call.align(8).bytes + body;
}

std::string configurationBody(const std::string& toml) {
  Wire body;
  body.text("AddConfiguration");
  const auto entry = [](Wire& entries, const std::string& key, const std::string& type) -> Wire& {
    return entries.align(8).text(key).signature(type);
  };
  Wire entries;  // begins at a multiple of 8, as it does in the body
  entry(entries, "kKeyAppID", "x").align(8).bytes += std::string("\7\0\0\0\0\0\0\0", 8);
  entry(entries, "kKeyPayload", "ay").number(static_cast<std::uint32_t>(toml.size())).bytes += toml;
  entry(entries, "kKeyPayloadType", "x").align(8).bytes += std::string(8, '\0');
  body.number(static_cast<std::uint32_t>(entries.bytes.size()));
  return body.align(8).bytes + entries.bytes;
}

}  // namespace vespscope::test
