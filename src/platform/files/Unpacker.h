// Unpacks a compressed stream of bytes piece by piece, in a bounded amount of memory.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "values/Result.h"

namespace vespscope::files {

class Unpacker {
 public:
  struct Step {
    std::size_t taken = 0;  // bytes of the input
    std::size_t given = 0;  // bytes of the output
    bool ended = false;     // the compressed stream is whole
  };

  virtual ~Unpacker() = default;
  // Unpacks from `input` into `output`; `last` says that no input follows. Returns why the input cannot be unpacked.
  virtual Result<Step> step(std::span<const std::uint8_t> input, std::span<std::uint8_t> output, bool last) = 0;
};

// The ways in which an input can be compressed.
enum class Packing { none, gzip, xz };

// The most bytes that packingOf() looks at.
inline constexpr std::size_t packingMarkLength = 6;
// How input that begins with `head` is compressed; empty when more bytes are needed to say so.
[[nodiscard]] std::optional<Packing> packingOf(std::span<const std::uint8_t> head);

// The memory that an xz stream may ask for. `xz -9` needs 65 MiB.
inline constexpr std::uint64_t xzMemoryLimit = std::uint64_t{96} << 20;

// Fails where this build lacks the library for it.
[[nodiscard]] Result<std::unique_ptr<Unpacker>> makeUnpacker(Packing packing);
[[nodiscard]] Result<std::unique_ptr<Unpacker>> makeGzipUnpacker();
[[nodiscard]] Result<std::unique_ptr<Unpacker>> makeXzUnpacker();

}  // namespace vespscope::files
