// Hashes of what is not a single number: bytes, texts and lists.
#pragma once

#include <cstdint>

namespace vespscope {

// FNV-1a over 64 bits.
template <class Content>
std::uint64_t contentHash(const Content& content) {
  std::uint64_t hash = 0xCBF29CE484222325;
  for (const auto element : content) hash = (hash ^ static_cast<std::uint8_t>(element)) * 0x100000001B3;
  return hash;
}

// The hash of a list whose hash was `hash`, with one more element at its end; an empty list hashes to zero.
constexpr std::uint64_t addToHash(std::uint64_t hash, std::uint64_t element) {
  const std::uint64_t mixed = (hash + element + 1) * 0x9E3779B97F4A7C15;
  return mixed ^ mixed >> 32;
}

}  // namespace vespscope
