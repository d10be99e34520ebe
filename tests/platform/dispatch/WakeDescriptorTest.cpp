// The descriptor that wakes a polling thread.
#include <poll.h>

#include <cerrno>
#include <thread>

#include <gtest/gtest.h>

#include "platform/dispatch/WakeDescriptor.h"

namespace vespscope::test {
namespace {

bool readable(const dispatch::WakeDescriptor& wake, int milliseconds = 0) {
  pollfd ready{wake.descriptor(), POLLIN, 0};
  return ::poll(&ready, 1, milliseconds) == 1;
}

TEST(WakeDescriptor, IsReadableFromAWakeUntilItIsCleared) {
  const dispatch::WakeDescriptor wake;
  EXPECT_FALSE(readable(wake));
  EXPECT_FALSE(wake.clear());
  wake.wake();
  wake.wake();
  EXPECT_TRUE(readable(wake));
  EXPECT_TRUE(wake.clear());
  EXPECT_FALSE(readable(wake));
  EXPECT_FALSE(wake.clear());
}

TEST(WakeDescriptor, WakesAThreadThatWaits) {
  const dispatch::WakeDescriptor wake;
  std::thread other([&wake] { wake.wake(); });
  EXPECT_TRUE(readable(wake, 5000));
  other.join();
}

TEST(WakeDescriptor, KeepsTheErrorNumberOfWhatItInterrupts) {
  const dispatch::WakeDescriptor wake;
  errno = ENOENT;
  wake.wake();
  EXPECT_EQ(errno, ENOENT);
}

}  // namespace
}  // namespace vespscope::test
