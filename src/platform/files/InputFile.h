// A file or pipe that is read front to back. Opening never blocks, and a blocked read can be interrupted.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>

#include "platform/dispatch/WakeDescriptor.h"
#include "platform/files/FileIdentity.h"
#include "values/Result.h"
#include "values/Value.h"

namespace vespscope::files {

class InputFile {
 public:
  // Opens a regular file. "-" is standard input and "/dev/fd/N" an inherited descriptor; these may also be pipes,
  // sockets or terminals. Any other pipe, device, socket or folder is rejected at once. Once `interruption` is woken
  // (it is never cleared), every read returns. Errors do not name the file.
  static Result<std::unique_ptr<InputFile>> open(
      const std::string& path, std::shared_ptr<const dispatch::WakeDescriptor> interruption = nullptr);

  InputFile(const InputFile&) = delete;
  InputFile& operator=(const InputFile&) = delete;
  ~InputFile();

  // Reads up to `bytes.size()` bytes, at least one. Returns 0 at the end and after the interruption.
  [[nodiscard]] Result<std::size_t> read(std::span<std::uint8_t> bytes);
  // Whether the last read returned because of the interruption.
  [[nodiscard]] bool interrupted() const { return interrupted_; }

  // Whether the file can be read again from its beginning; false for a pipe.
  [[nodiscard]] bool canRewind() const { return size_.has_value(); }
  // Returns the error when it cannot be read again.
  [[nodiscard]] std::optional<std::string> rewind();

  // The number of bytes read since the beginning.
  [[nodiscard]] std::uint64_t position() const { return position_; }
  // The size when the file was opened, in bytes; empty for a pipe.
  [[nodiscard]] std::optional<std::uint64_t> size() const { return size_; }
  [[nodiscard]] const FileIdentity& identity() const { return identity_; }

 private:
  InputFile(int descriptor, std::shared_ptr<const dispatch::WakeDescriptor> interruption)
      : descriptor_(descriptor), interruption_(std::move(interruption)) {}
  std::optional<std::string> examine(bool inherited);
  // Waits until there is something to read; returns false when interrupted.
  bool wait();

  int descriptor_;
  std::shared_ptr<const dispatch::WakeDescriptor> interruption_;
  FileIdentity identity_;
  std::optional<std::uint64_t> size_;
  std::uint64_t position_ = 0;
  bool interrupted_ = false;
};

// Returns the first `limit` bytes of a regular file, or all when it has fewer. Never blocks. Errors do not name the
// file.
[[nodiscard]] Result<Bytes> readBeginning(const std::string& path, std::size_t limit);

}  // namespace vespscope::files
