// of EF_SPN, after its first byte
#pragma once

#include <cstdint>

namespace vespscope {

// Two digits per byte, the first in the low half, padded with F.
template <class Content>
std::uint64_t contentHash(const Content& content) {
  std::uint64_t hash = 0xCBF29CE484222325;
  for (const auto element : content) hash = (hash ^ static_cast<std::uint8_t>(element)) * 0x100000001B3;
  return hash;
}

// Returns the code points of a UTF-8 text; empty when it is not valid UTF-8.
constexpr std::uint64_t addToHash(std::uint64_t hash, std::uint64_t element) {
  const std::uint64_t mixed = (hash + element + 1) * 0x9E3779B97F4A7C15;
  return mixed ^ mixed >> 32;
}

}  // namespace vespscope
