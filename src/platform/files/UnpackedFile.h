// An input file that is decompressed while it is read if it is compressed with gzip or xz, whatever its name.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "platform/files/InputFile.h"
#include "platform/files/Unpacker.h"
#include "values/Result.h"

namespace vespscope::files {

class UnpackedFile {
 public:
  // Opens a file as InputFile does.
  static Result<std::unique_ptr<UnpackedFile>> open(
      const std::string& path, std::shared_ptr<const dispatch::WakeDescriptor> interruption = nullptr);

  // Reads up to `bytes.size()` bytes, at least one. Returns 0 at the end and after the interruption. Fails where the
  // compressed data is damaged or truncated; the bytes before that point are valid.
  [[nodiscard]] Result<std::size_t> read(std::span<std::uint8_t> bytes);
  // The error of the last read; after an error only rewind() makes further reads possible.
  [[nodiscard]] const std::optional<std::string>& failure() const { return failure_; }
  [[nodiscard]] bool interrupted() const { return file_->interrupted(); }

  [[nodiscard]] bool canRewind() const { return file_->canRewind(); }
  [[nodiscard]] std::optional<std::string> rewind();

  // The number of decompressed bytes that read() has returned since the beginning.
  [[nodiscard]] std::uint64_t unpacked() const { return unpacked_; }
  // The number of bytes read from the file itself, compressed or not, and its size.
  [[nodiscard]] std::uint64_t position() const { return file_->position(); }
  [[nodiscard]] std::optional<std::uint64_t> size() const { return file_->size(); }

 private:
  explicit UnpackedFile(std::unique_ptr<InputFile> file);
  // Reads more of the file into the buffer; returns false at its end and after the interruption.
  Result<bool> fill();
  // Detects the compression of the next stream in the file.
  std::optional<std::string> examine();
  Result<std::size_t> readSome(std::span<std::uint8_t> bytes);
  Result<std::size_t> copy(std::span<std::uint8_t> bytes);
  Result<std::size_t> unpack(std::span<std::uint8_t> bytes);
  [[nodiscard]] std::span<const std::uint8_t> waiting() const {
    return std::span(piece_).subspan(taken_, held_ - taken_);
  }

  std::unique_ptr<InputFile> file_;
  std::vector<std::uint8_t> piece_;
  std::size_t taken_ = 0;  // of the buffered bytes
  std::size_t held_ = 0;
  bool ended_ = false;  // of the file
  std::optional<Packing> packing_;
  std::unique_ptr<Unpacker> unpacker_;  // of the current stream
  std::uint64_t unpacked_ = 0;
  std::optional<std::string> failure_;
};

}  // namespace vespscope::files
