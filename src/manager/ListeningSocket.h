// A Unix socket that clients connect to, open to this user and the administrator only.
#pragma once

#include <sys/types.h>

#include <string>

#include "values/Result.h"

namespace vespscope::manager {

class ListeningSocket {
 public:
  // Listens at `path`. A socket file left by a manager that is gone is replaced; one that is answered, or a file of
  // another kind, is left alone. Of managers that start at once one gets the place; a lock file beside it, `path`.lock,
  // is there meanwhile.
  static Result<ListeningSocket> at(const std::string& path);

  ListeningSocket(ListeningSocket&& other) noexcept;
  ListeningSocket& operator=(ListeningSocket&&) = delete;
  // Removes the socket file, unless somebody else has put another in its place.
  ~ListeningSocket();

  [[nodiscard]] int descriptor() const { return descriptor_; }
  [[nodiscard]] const std::string& path() const { return path_; }

  enum class Outcome { accepted, refused, noneWaits, exhausted };
  struct Accepted {
    Outcome outcome = Outcome::noneWaits;
    int descriptor = -1;  // owned by the caller when accepted
    std::string refusal;  // a line for the log when refused
  };
  // The next connection. One of another user than this and the administrator is closed, and refused. Exhausted: the
  // system has no descriptor for it now.
  [[nodiscard]] Accepted accept() const;

 private:
  ListeningSocket(int descriptor, std::string path);

  int descriptor_;
  std::string path_;
  dev_t device_ = 0;
  ino_t inode_ = 0;
};

}  // namespace vespscope::manager
