// Messages to a manager as bytes, which no library would send: of any size, unfinished, filled with anything.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace vespscope::test {

// D-Bus as bytes, little-endian.
class Wire {
 public:
  Wire& align(std::size_t boundary) {
    while (bytes.size() % boundary != 0) bytes.push_back('\0');
    return *this;
  }
  Wire& number(std::uint32_t value) {
    align(4);
    for (int shift = 0; shift < 32; shift += 8) bytes.push_back(static_cast<char>(value >> shift));
    return *this;
  }
  Wire& signature(const std::string& text) {
    bytes += static_cast<char>(text.size()) + text + '\0';
    return *this;
  }
  Wire& text(const std::string& value) {
    number(static_cast<std::uint32_t>(value.size())).bytes += value + '\0';
    return *this;
  }

  std::string bytes;
};

// A call of PerformCommand with a body of `size` bytes, of which `body` are the first.
[[nodiscard]] std::string callOf(const std::string& signature, const std::string& body, std::size_t size,
                                 std::uint32_t serial = 1);

// A request of AddConfiguration for an application, as the body of a call.
[[nodiscard]] std::string configurationBody(const std::string& toml);

}  // namespace vespscope::test
