#include "support/OtherUser.h"

#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <stdexcept>

#include <grp.h>

namespace vespscope::test {

std::string asUser(uid_t user, const std::vector<gid_t>& groups, const std::function<std::string()>& action) {
  std::array<int, 2> ends{};
  if (::pipe(ends.data()) != 0) throw std::runtime_error("no pipe is left");
  const pid_t child = ::fork();
  if (child < 0) throw std::runtime_error("no process is left");
  if (child == 0) {
    ::close(ends[0]);
    std::string result = "cannot become another user";
    if (::setgroups(groups.size(), groups.data()) == 0 && ::setresgid(user, user, user) == 0 &&
        ::setresuid(user, user, user) == 0) {
      result = action();
    }
    const ssize_t written = ::write(ends[1], result.data(), result.size());
    ::_exit(written == static_cast<ssize_t>(result.size()) ? 0 : 1);
  }
  ::close(ends[1]);
  std::string result;
  std::array<char, 4096> buffer;
  for (ssize_t count = 0; (count = ::read(ends[0], buffer.data(), buffer.size())) > 0;) {
    result.append(buffer.data(), static_cast<std::size_t>(count));
  }
  ::close(ends[0]);
  int status = 0;
  ::waitpid(child, &status, 0);
  if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) throw std::runtime_error("the other user's process failed");
  return result;
}

}  // namespace vespscope::test
