// Decompresses a stream piece by piece in a bounded amount of memory.
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
    std::size_t taken = 0;  // consumed bytes of the input
    std::size_t given = 0;  // produced bytes of the output
    bool ended = false;     // the compressed stream is complete
  };

  virtual ~Unpacker() = default;
  // Decompresses from `input` into `output`; `last` means that no more input follows. Returns an error when the input
  // is damaged.
  virtual Result<Step> step(std::span<const std::uint8_t> input, std::span<std::uint8_t> output, bool last) = 0;
};

// The supported compressions.
enum class Packing { none, gzip, xz };

// The maximum number of bytes that packingOf() examines.
inline constexpr std::size_t packingMarkLength = 6;
// The compression of input that begins with `head`; empty when more bytes are needed to decide.
[[nodiscard]] std::optional<Packing> packingOf(std::span<const std::uint8_t> head);

// The memory limit for decompressing an xz stream. `xz -9` needs 65 MiB.
inline constexpr std::uint64_t xzMemoryLimit = std::uint64_t{96} << 20;

// Fails if this build lacks the library.
[[nodiscard]] Result<std::unique_ptr<Unpacker>> makeUnpacker(Packing packing);
[[nodiscard]] Result<std::unique_ptr<Unpacker>> makeGzipUnpacker();
[[nodiscard]] Result<std::unique_ptr<Unpacker>> makeXzUnpacker();

}  // namespace vespscope::files
