// The standard descriptors of a program that was started without them.
#include <fcntl.h>
#include <unistd.h>

#include <cerrno>

#include <gtest/gtest.h>

#include "platform/files/StandardDescriptors.h"

namespace vespscope::test {
namespace {

// Runs in a child process, which reports the result in its exit status.
[[noreturn]] void openAfterClosing(int descriptor) {
  char byte = 0;
  ::close(descriptor);
  files::openStandardDescriptors();
  const bool open = ::fcntl(descriptor, F_GETFD) >= 0;
  const ssize_t used = descriptor == STDIN_FILENO ? ::read(descriptor, &byte, 1) : ::write(descriptor, &byte, 1);
  const bool refused = used < 0 && errno == EBADF;
  const int next = ::open("/dev/null", O_RDONLY | O_CLOEXEC);
  std::_Exit(open && refused && next > STDERR_FILENO ? 0 : 1);
}

TEST(StandardDescriptors, OpensThoseThatAreClosedWithoutMakingThemUsable) {
  for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
    EXPECT_EXIT(openAfterClosing(descriptor), testing::ExitedWithCode(0), "");
  }
}

TEST(StandardDescriptors, LeavesThoseThatAreOpen) {
  const int flags = ::fcntl(STDOUT_FILENO, F_GETFL);
  files::openStandardDescriptors();
  EXPECT_EQ(::fcntl(STDOUT_FILENO, F_GETFL), flags);
}

}  // namespace
}  // namespace vespscope::test
