// Simulates a disk that is full from a given size of a file on, while the object lives: the system's limit on file
// sizes ends a write exactly where a full disk would, even in the middle of a packet.
#pragma once

#include <sys/resource.h>

#include <csignal>

namespace vespscope::test {

class FileLimit {
 public:
  explicit FileLimit(rlim_t bytes) {
    std::signal(SIGXFSZ, SIG_IGN);
    ::getrlimit(RLIMIT_FSIZE, &before_);
    set(bytes);
  }
  FileLimit(const FileLimit&) = delete;
  FileLimit& operator=(const FileLimit&) = delete;
  ~FileLimit() { ::setrlimit(RLIMIT_FSIZE, &before_); }

  void set(rlim_t bytes) const {
    const rlimit limit{bytes, before_.rlim_max};
    ::setrlimit(RLIMIT_FSIZE, &limit);
  }

 private:
  rlimit before_{};
};

}  // namespace vespscope::test
