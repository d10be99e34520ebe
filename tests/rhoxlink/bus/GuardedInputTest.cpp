// A manager's end with a peer that writes raw bytes: too large, too slow, or ambiguous.
#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <cstdint>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "rhoxlink/bus/Bus.h"
#include "rhoxlink/bus/GuardedInput.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using bus::ServerEnd;
using bus::WireLimits;
using Clock = std::chrono::steady_clock;

const std::string authentication("\0AUTH EXTERNAL\r\nDATA\r\nBEGIN\r\n", 29);

// The header of a message with a body of this size and no fields.
std::string header(std::uint32_t body) {
  std::string bytes("l\4\0\1", 4);
  for (const std::uint32_t number : {body, 1U, 0U}) {
    for (unsigned shift = 0; shift < 32; shift += 8) bytes += static_cast<char>(number >> shift & 0xFF);
  }
  return bytes;
}

class Silent final : public bus::Service {
 public:
  void performCommand(const std::string&, const ipc::Dictionary&, const Answer&) override { ++commands; }
  void eventsOn() override {}
  void eventsOff() override {}
  int commands = 0;
};

class GuardedInput : public testing::Test {
 protected:
  ~GuardedInput() override { ::close(peer_); }

  void serve(const WireLimits& limits = {}, std::shared_ptr<bus::MemoryBudget> budget = nullptr) {
    std::array<int, 2> ends{};
    ASSERT_EQ(::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends.data()), 0);
    peer_ = ends[1];
    auto end = ServerEnd::overSocket(ends[0], service_, std::move(budget), limits);
    ASSERT_TRUE(end.ok()) << end.reason();
    end_ = std::move(*end);
  }

  // Sends all of it while the end runs; returns why the end has closed, empty if it has not.
  std::string send(std::string bytes) {
    while (!bytes.empty()) {
      const ssize_t count = ::send(peer_, bytes.data(), bytes.size(), MSG_NOSIGNAL);
      if (count > 0) bytes.erase(0, static_cast<std::size_t>(count));
      if (!end_->process()) return reason();
    }
    for (int round = 0; round < 10; ++round) {
      if (!end_->process()) return reason();
    }
    return "";
  }

  // Runs the end for this time, as its owner does; returns why the end has closed, empty if it has not.
  std::string workFor(std::chrono::milliseconds duration) {
    const auto until = Clock::now() + duration;
    while (Clock::now() < until) {
      if (!end_->process()) return reason();
      const bus::Wait wait = end_->wait();
      EXPECT_GE(wait.timeout.count(), 0);  // the time limit is observed
      pollfd ready{wait.descriptor, wait.events, 0};
      ::poll(&ready, 1, 5);
    }
    return "";
  }

  std::string reason() { return end_->ending().empty() ? "over" : end_->ending(); }

  Silent service_;
  std::unique_ptr<ServerEnd> end_;
  int peer_ = -1;
};

TEST_F(GuardedInput, EndsTheConnectionAtAHeaderThatAnnouncesTooMuch) {
  serve();
  ASSERT_EQ(send(authentication), "");
  EXPECT_EQ(send(header(60U << 20)), "the peer's message has 62914576 bytes: the limit is 1052672 bytes");
  EXPECT_FALSE(end_->process());
  EXPECT_EQ(end_->wait().timeout, 0us);
}

TEST_F(GuardedInput, EndsTheConnectionOfAPeerThatDoesNotAuthenticate) {
  WireLimits limits;
  limits.authenticationTime = 50ms;
  serve(limits);
  EXPECT_EQ(workFor(10s), "the peer did not authenticate within 50 ms");
}

TEST_F(GuardedInput, EndsTheConnectionOfAPeerThatDoesNotFinishAMessage) {
  WireLimits limits;
  limits.messageTime = 50ms;
  serve(limits);
  ASSERT_EQ(send(authentication + header(1000) + "part"), "");
  EXPECT_EQ(workFor(10s), "the peer did not finish a message within 50 ms");
}

TEST_F(GuardedInput, EndsTheConnectionOfAPeerThatSendsAByteNowAndThen) {
  WireLimits limits;
  limits.messageTime = 200ms;
  serve(limits);
  ASSERT_EQ(send(authentication + header(1'000'000)), "");
  std::string ending;
  for (int round = 0; round < 1000 && ending.empty(); ++round) {
    ASSERT_GE(::send(peer_, "x", 1, MSG_NOSIGNAL), 0);
    ending = workFor(10ms);
  }
  EXPECT_EQ(ending, "the peer did not finish a message within 200 ms");
}

TEST_F(GuardedInput, DoesNotTakeAPauseOfItsOwnForThePeers) {
  WireLimits limits;
  limits.messageTime = 1500ms;
  serve(limits);
  ASSERT_EQ(send(authentication + header(1000) + "part"), "");
  std::this_thread::sleep_for(2500ms);  // the program was stopped
  EXPECT_EQ(send(""), "");
}

TEST_F(GuardedInput, IsNotMisledAboutWhereTheFirstMessageBegins) {
  // The library and the guard agree on data that looks like the end of the authentication but is not.
  const std::string huge = header(100U << 20);
  for (const std::string& opening :
       {std::string("\0BEGIN\r\n", 8), std::string("\0AUTH EXTERNAL\r\nBEGIN \r\n", 24), std::string("\0l\r\n", 4),
        std::string("\0AUTH EXTERNAL\r\nDATA\r\nBEGIN foo\r\n", 33), authentication}) {
    serve();
    std::string bytes = opening + header(16) + authentication.substr(1) + huge;
    for (int round = 0; round < 4; ++round) bytes += huge;
    bytes.resize(bytes.size() + 200'000);
    EXPECT_NE(send(bytes), "") << opening;
    ::close(peer_);
  }
  peer_ = -1;
}

TEST_F(GuardedInput, ReadsNoFurtherWhileItsLargeMessageWaitsForRoom) {
  const auto budget = std::make_shared<bus::MemoryBudget>(500'000);
  serve({}, budget);
  ASSERT_TRUE(budget->take(450'000));
  ASSERT_EQ(send(authentication + header(100'000)), "");
  EXPECT_EQ(end_->wait().events & POLLIN, 0);
  EXPECT_EQ(end_->wait().timeout, 10ms);
  budget->giveBack(450'000);
  ASSERT_EQ(send(""), "");
  EXPECT_EQ(budget->taken(), 100'016U);
  EXPECT_NE(end_->wait().events & POLLIN, 0);
}

TEST_F(GuardedInput, ClosesFileDescriptorsThatAPeerPasses) {
  serve();
  ASSERT_EQ(send(authentication), "");
  std::array<int, 2> passed{};
  ASSERT_EQ(::pipe2(passed.data(), O_CLOEXEC | O_NONBLOCK), 0);
  std::string bytes = header(1000);
  iovec part{bytes.data(), bytes.size()};
  alignas(cmsghdr) std::array<char, CMSG_SPACE(sizeof(int))> control{};
  msghdr message{};
  message.msg_iov = &part;
  message.msg_iovlen = 1;
  message.msg_control = control.data();
  message.msg_controllen = control.size();
  cmsghdr* entry = CMSG_FIRSTHDR(&message);
  entry->cmsg_level = SOL_SOCKET;
  entry->cmsg_type = SCM_RIGHTS;
  entry->cmsg_len = CMSG_LEN(sizeof(int));
  *reinterpret_cast<int*>(CMSG_DATA(entry)) = passed[1];
  ASSERT_GT(::sendmsg(peer_, &message, MSG_NOSIGNAL), 0);
  ::close(passed[1]);
  EXPECT_EQ(send(""), "");
  // No writing end is open any more.
  char byte = 0;
  EXPECT_EQ(::read(passed[0], &byte, 1), 0);
  ::close(passed[0]);
}

}  // namespace
}  // namespace vespscope::test
