// The words of a manager's address.
#include <cstdlib>
#include <iostream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "rhoxlink/Rhoxlink.h"

namespace vespscope::test {
namespace {

using namespace rhox;
using namespace rhox::client;
using Kind = Address::Kind;

struct Good {
  std::string words;
  Kind kind;
  std::string detail;
};

TEST(Address, IsUnderstood) {
  const std::vector<Good> table = {{"auto", Kind::automatic, ""},
                                   {"none", Kind::none, ""},
                                   {"system", Kind::system, ""},
                                   {"unix:path=/run/rhoxd", Kind::unixSocket, "/run/rhoxd"},
                                   {"unix:path=odd, name=%20", Kind::unixSocket, "odd, name=%20"},
                                   {"ssh:root@phone", Kind::ssh, "root@phone"},
                                   {"embedded:scenario", Kind::embedded, "scenario"},
                                   {"embedded:replay:a:b.pcap,loop", Kind::embedded, "replay:a:b.pcap,loop"}};
  for (const Good& row : table) {
    SCOPED_TRACE(row.words);
    const auto address = Address::parse(row.words);
    ASSERT_TRUE(address.ok()) << address.reason();
    EXPECT_EQ(address->kind, row.kind);
    EXPECT_EQ(address->detail, row.detail);
  }
}

struct Bad {
  std::string words;
  std::string reason;
};

const std::string kinds = " is not a manager address (auto, system, unix:path=FILE, ssh:HOST or embedded:SOURCE)";
const std::string longPath(108, 'x');

TEST(Address, OfOtherWordsIsRefusedWithAReason) {
  const std::vector<Bad> table = {
      {"", "\"\"" + kinds},
      {"Auto", "\"Auto\"" + kinds},
      {"systemd", "\"systemd\"" + kinds},
      {"unix", "\"unix\" is not a manager address: a socket is written unix:path=FILE"},
      {"unix:/run/rhoxd", "\"unix:/run/rhoxd\" is not a manager address: a socket is written unix:path=FILE"},
      {"unix:path=", "\"unix:path=\" is not a manager address: a socket is written unix:path=FILE"},
      {"unix:path=" + longPath, "the socket's path is longer than 107 bytes: " + longPath},
      {"ssh:", "\"ssh:\" is not a manager address: a machine is written ssh:HOST"},
      {"ssh:-oProxyCommand=x", "\"ssh:-oProxyCommand=x\" is not a manager address: a machine is written ssh:HOST"},
      {"embedded:", "\"embedded:\" names no source: a manager in the process is written embedded:SOURCE"},
      {"embedded", "\"embedded\" names no source: a manager in the process is written embedded:SOURCE"}};
  for (const Bad& row : table) {
    SCOPED_TRACE(row.words);
    const auto address = Address::parse(row.words);
    ASSERT_FALSE(address.ok());
    EXPECT_EQ(address.reason(), row.reason);
  }
}

TEST(AddressOfTheProcess, ComesFromTheEnvironmentUnlessSet) {
  ::unsetenv("RHOX_ADDRESS");
  EXPECT_EQ(address()->kind, Kind::automatic);
  ::setenv("RHOX_ADDRESS", "", 1);
  EXPECT_EQ(address()->kind, Kind::automatic);
  ::setenv("RHOX_ADDRESS", "unix:path=/run/one", 1);
  EXPECT_EQ(address()->detail, "/run/one");
  setAddress(*Address::parse("none"));
  EXPECT_EQ(address()->kind, Kind::none);
}

TEST(AddressOfTheProcess, IsReportedInTheStatusWhenTheEnvironmentIsWrong) {
  // In a separate process, because an address set by another test permanently overrides the environment.
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_EXIT(
      {
        ::setenv("RHOX_ADDRESS", "nowhere", 1);
        std::cerr << address().reason() << '\n';
        std::cerr << connectionStatus(CreateManager("test", nullptr)).problem << '\n';
        std::_Exit(0);
      },
      testing::ExitedWithCode(0),
      testing::Eq("RHOX_ADDRESS: \"nowhere\"" + kinds + "\nRHOX_ADDRESS: \"nowhere\"" + kinds + "\n"));
}

TEST(AddressOfTheProcess, NoneNeverConnects) {
  setAddress(*Address::parse("none"));
  const auto manager = CreateManager("test", nullptr);
  vespscope::ipc::Object reply;
  EXPECT_EQ(PerformCommand(manager, kCommandStatus, {}, reply).status, kStatusNotConnected);
  EXPECT_FALSE(connectionStatus(manager).connected);
}

}  // namespace
}  // namespace vespscope::test
