#include "manager/Payload.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

namespace vespscope::manager {
namespace {

using Input = std::span<const std::uint8_t>;

std::optional<std::uint64_t> takeVarint(Input& input) {
  std::uint64_t value = 0;
  for (std::size_t index = 0; index < input.size() && index < 10; ++index) {
    value |= static_cast<std::uint64_t>(input[index] & 0x7F) << (7 * index);
    if (input[index] < 0x80) {
      input = input.subspan(index + 1);
      return value;
    }
  }
  return std::nullopt;
}

bool skip(Input& input, std::uint64_t size) {
  if (size > input.size()) return false;
  input = input.subspan(static_cast<std::size_t>(size));
  return true;
}

// Skips the value of a field with wire type `type`.
bool skipValue(Input& input, unsigned type) {
  switch (type) {
    case 0:
      return takeVarint(input).has_value();
    case 1:
      return skip(input, 8);
    case 5:
      return skip(input, 4);
    case 2: {
      const std::optional<std::uint64_t> size = takeVarint(input);
      return size && skip(input, *size);
    }
    default:
      return false;
  }
}

std::optional<Bytes> withoutTimestamp(const Bytes& payload) {
  constexpr std::uint64_t timestampField = 1;
  Bytes kept;
  kept.reserve(payload.size());
  Input input(payload);
  while (!input.empty()) {
    const Input field = input;
    const std::optional<std::uint64_t> key = takeVarint(input);
    if (!key || !skipValue(input, static_cast<unsigned>(*key & 7))) return std::nullopt;
    if (*key >> 3 == timestampField) continue;
    kept.insert(kept.end(), field.begin(), field.end() - static_cast<std::ptrdiff_t>(input.size()));
  }
  return kept;
}

}  // namespace

bool sameButForTimestamp(const Bytes& one, const Bytes& other) {
  if (one == other) return true;
  const std::optional<Bytes> first = withoutTimestamp(one);
  return first && first == withoutTimestamp(other);
}

}  // namespace vespscope::manager
