// A file in memory that can be opened by a path.
#pragma once

#include <sys/mman.h>
#include <unistd.h>

#include <span>
#include <string>

#include "Fuzz.h"

namespace vespscope::fuzz {

class MemoryFile {
 public:
  explicit MemoryFile(std::span<const std::uint8_t> content = {}) : descriptor_(::memfd_create("fuzz", MFD_CLOEXEC)) {
    require(descriptor_ >= 0, "cannot create a file in memory");
    const auto written = ::write(descriptor_, content.data(), content.size());
    require(written == static_cast<ssize_t>(content.size()), "a file in memory cannot be written");
  }
  MemoryFile(const MemoryFile&) = delete;
  MemoryFile& operator=(const MemoryFile&) = delete;
  ~MemoryFile() { ::close(descriptor_); }

  [[nodiscard]] int descriptor() const { return descriptor_; }
  [[nodiscard]] std::string path() const { return "/proc/self/fd/" + std::to_string(descriptor_); }
  [[nodiscard]] off_t size() const { return ::lseek(descriptor_, 0, SEEK_END); }
  void cut(off_t size) const { require(::ftruncate(descriptor_, size) == 0, "a file in memory cannot be cut"); }

 private:
  int descriptor_;
};

}  // namespace vespscope::fuzz
