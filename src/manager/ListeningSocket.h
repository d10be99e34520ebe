// A Unix socket that clients connect to, accessible to this user and the administrator only.
#pragma once

#include <sys/types.h>

#include <string>

#include "values/Result.h"

namespace vespscope::manager {

class ListeningSocket {
 public:
  // Listens at `path`. Replaces a socket file left by a manager that has ended; fails if a manager answers there or the
  // file is of another kind. Of several managers that start at once one succeeds; meanwhile a lock file `path`.lock
  // exists.
  static Result<ListeningSocket> at(const std::string& path);

  ListeningSocket(ListeningSocket&& other) noexcept;
  ListeningSocket& operator=(ListeningSocket&&) = delete;
  // Removes the socket file unless another process has replaced it.
  ~ListeningSocket();

  [[nodiscard]] int descriptor() const { return descriptor_; }
  [[nodiscard]] const std::string& path() const { return path_; }

  enum class Outcome { accepted, refused, noneWaits, exhausted };
  struct Accepted {
    Outcome outcome = Outcome::noneWaits;
    int descriptor = -1;  // owned by the caller if accepted
    std::string refusal;  // a line for the log if rejected
  };
  // Accepts the next connection. A connection of a user other than this one and the administrator is closed and
  // reported as rejected. Exhausted: the system has no descriptor for it now.
  [[nodiscard]] Accepted accept() const;

 private:
  ListeningSocket(int descriptor, std::string path);

  int descriptor_;
  std::string path_;
  dev_t device_ = 0;
  ino_t inode_ = 0;
};

}  // namespace vespscope::manager
