// The socket that clients connect to: its permissions, and which of several managers owns it.
#include <fcntl.h>
#include <sys/file.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <barrier>
#include <cstring>
#include <memory>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/ListeningSocket.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using manager::ListeningSocket;
using testing::HasSubstr;

int connectTo(const std::string& path) {
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, path.c_str(), sizeof name.sun_path - 1);
  if (::connect(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name) == 0) return descriptor;
  ::close(descriptor);
  return -1;
}

TEST(ListeningSocket, IsOpenToItsOwnerOnlyAndGoesWithItsOwner) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  {
    const mode_t before = ::umask(0);
    const auto socket = ListeningSocket::at(path);
    ::umask(before);
    ASSERT_TRUE(socket.ok()) << socket.reason();
    struct stat status {};
    ASSERT_EQ(::stat(path.c_str(), &status), 0);
    EXPECT_TRUE(S_ISSOCK(status.st_mode));
    EXPECT_EQ(status.st_mode & 0777, 0600U);
  }
  EXPECT_NE(::access(path.c_str(), F_OK), 0);
}

TEST(ListeningSocket, TakesThePlaceOfOneThatNobodyAnswers) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  const int stale = ::socket(AF_UNIX, SOCK_STREAM, 0);
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, path.c_str(), sizeof name.sun_path - 1);
  ASSERT_EQ(::bind(stale, reinterpret_cast<const sockaddr*>(&name), sizeof name), 0);
  ::close(stale);
  const auto socket = ListeningSocket::at(path);
  ASSERT_TRUE(socket.ok()) << socket.reason();
  const int client = connectTo(path);
  EXPECT_GE(client, 0);
  EXPECT_EQ(socket->accept().outcome, ListeningSocket::Outcome::accepted);
  ::close(client);
}

TEST(ListeningSocket, LeavesALiveOneAndOtherFilesAlone) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  const auto first = ListeningSocket::at(path);
  ASSERT_TRUE(first.ok());
  EXPECT_EQ(ListeningSocket::at(path).reason(), "another manager listens at " + path);
  EXPECT_EQ(::access(path.c_str(), F_OK), 0);
  const std::string file = folder.write("file", "precious");
  EXPECT_EQ(ListeningSocket::at(file).reason(), file + " exists and is not a socket");
  EXPECT_EQ(ListeningSocket::at(folder / "no/such/folder").reason(),
            "cannot listen at " + (folder / "no/such/folder") + ": No such file or directory");
  EXPECT_THAT(ListeningSocket::at(std::string(108, 'x')).reason(), HasSubstr("1 to 107 bytes"));
  EXPECT_THAT(ListeningSocket::at("").reason(), HasSubstr("1 to 107 bytes"));
}

TEST(ListeningSocket, DoesNotRemoveTheSocketOfItsSuccessor) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  auto first = std::make_unique<Result<ListeningSocket>>(ListeningSocket::at(path));
  ASSERT_TRUE(first->ok());
  ::unlink(path.c_str());
  const auto second = ListeningSocket::at(path);
  ASSERT_TRUE(second.ok());
  first.reset();
  EXPECT_EQ(::access(path.c_str(), F_OK), 0);
}

// Several managers started at once by mistake, on the socket of a killed manager.
TEST(ListeningSocket, IsOneOfAllThatTakeAStalePlaceAtOnce) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  constexpr int starts = 8;
  for (int round = 0; round < 150; ++round) {
    const int stale = ::socket(AF_UNIX, SOCK_STREAM, 0);
    sockaddr_un name{};
    name.sun_family = AF_UNIX;
    std::strncpy(name.sun_path, path.c_str(), sizeof name.sun_path - 1);
    ASSERT_EQ(::bind(stale, reinterpret_cast<const sockaddr*>(&name), sizeof name), 0);
    ::close(stale);
    std::vector<std::optional<ListeningSocket>> sockets(starts);
    std::vector<std::string> refusals(starts);
    std::barrier ready(starts);
    std::vector<std::thread> threads;
    for (std::size_t number = 0; number < starts; ++number) {
      threads.emplace_back([&, number] {
        ready.arrive_and_wait();
        auto socket = ListeningSocket::at(path);
        if (socket) {
          sockets[number].emplace(std::move(*socket));
        } else {
          refusals[number] = socket.reason();
        }
      });
    }
    for (std::thread& thread : threads) thread.join();
    const auto live = std::count_if(sockets.begin(), sockets.end(), [](const auto& socket) { return bool(socket); });
    ASSERT_EQ(live, 1) << "round " << round;
    EXPECT_EQ(std::count(refusals.begin(), refusals.end(), "another manager listens at " + path), starts - 1);
    const auto winner = std::find_if(sockets.begin(), sockets.end(), [](const auto& socket) { return bool(socket); });
    const int client = connectTo(path);
    EXPECT_EQ((*winner)->accept().outcome, ListeningSocket::Outcome::accepted);
    ::close(client);
    EXPECT_NE(::access((path + ".lock").c_str(), F_OK), 0);
  }
}

TEST(ListeningSocket, DoesNotWaitForEverForALockThatIsHeld) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  const int held = ::open((path + ".lock").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0600);
  ASSERT_EQ(::flock(held, LOCK_EX), 0);
  EXPECT_EQ(ListeningSocket::at(path).reason(),
            "cannot lock " + path + ".lock: another starting manager holds the lock");
  ::close(held);
}

TEST(ListeningSocket, TakesALockFileThatAKilledManagerLeft) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  folder.write("socket.lock", "");
  EXPECT_TRUE(ListeningSocket::at(path).ok());
}

}  // namespace
}  // namespace vespscope::test
