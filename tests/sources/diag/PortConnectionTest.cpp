// Which specifications name a TCP port.
#include <gtest/gtest.h>

#include "sources/diag/PortConnection.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(PortConnection, ATcpPortIsTwoNumbers) {
  for (const char* name : {"tcp:127.0.0.1:5000", "tcp:[::1]:5000", "tcp:localhost:1"}) {
    EXPECT_FALSE(problemWithTcpPort(name)) << name;
  }
  for (const char* name : {"tcp:", "tcp:5000", "tcp::5000", "tcp:127.0.0.1:", "tcp:127.0.0.1:http", "tcp:modem:5000"}) {
    EXPECT_TRUE(problemWithTcpPort(name)) << name;
  }
}

}  // namespace
}  // namespace vespscope::test
