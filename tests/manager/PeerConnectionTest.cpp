// The number of events that one client gets before another's turn.
#include <sys/socket.h>

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "manager/ManagerCore.h"
#include "manager/PeerConnection.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "support/ScriptedSource.h"

namespace vespscope::test {
namespace {

constexpr std::int32_t rrcState = 3952132;
constexpr std::size_t turn = 64;

class PeerConnection : public testing::Test {
 protected:
  PeerConnection() : core_(std::make_unique<ScriptedSource>(control_), [] {}) {
    log::discardOutputs();
    int sockets[2] = {-1, -1};
    EXPECT_EQ(::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, sockets), 0);
    connection_ = manager::PeerConnection::open(core_, sockets[0], sockets[0]);
    client_ = std::move(*bus::ClientEnd::overSocket(
        sockets[1],
        [this](std::string_view, std::uint64_t sequence, const ipc::Dictionary&) { received_.push_back(sequence); }));
    client_->setEvents(true);
    const std::string toml = "[metrics]\nK_LTE_RRC_STATE = { on = \"event\" }\n";
    ipc::Dictionary request;
    request.set(rhox::kKeyAppID, ipc::Object(std::int64_t{2}));
    request.set(rhox::kKeyPayload, ipc::Object(Bytes(toml.begin(), toml.end())));
    request.set(rhox::kKeyPayloadType, ipc::Object(std::int64_t{0}));
    EXPECT_EQ(perform(rhox::kCommandAddConfiguration, request), 0);
  }

  void deliver(std::size_t count) {
    for (std::size_t number = 0; number < count; ++number) {
      control_->deliver(rrcState, {0x10, static_cast<std::uint8_t>(number & 0x7F)});
    }
  }
  // Reads everything that was sent.
  void read() {
    while (client_->process() && received_.size() != before_) before_ = received_.size();
  }
  std::optional<std::int32_t> perform(std::string_view command, const ipc::Dictionary& request) {
    std::optional<std::int32_t> status;
    client_->performCommand(std::string(command), request, std::chrono::seconds(2),
                            [&status](const bus::Reply& reply) { status = reply.status; });
    for (int step = 0; step < 100 && !status; ++step) {
      EXPECT_TRUE(connection_->work());
      EXPECT_TRUE(client_->process());
    }
    return status;
  }

  std::shared_ptr<ScriptedSource::Control> control_ = std::make_shared<ScriptedSource::Control>();
  manager::ManagerCore core_;
  std::unique_ptr<manager::PeerConnection> connection_;
  std::unique_ptr<bus::ClientEnd> client_;
  std::vector<std::uint64_t> received_;
  std::size_t before_ = 0;
};

TEST_F(PeerConnection, EndsItsTurnWithEventsWaiting) {
  deliver(4 * turn);
  EXPECT_TRUE(connection_->work());
  EXPECT_TRUE(connection_->hasMore());
  read();
  EXPECT_EQ(received_.size(), turn);
}

TEST_F(PeerConnection, HasAnotherTurnUntilAllIsSent) {
  deliver(3 * turn + 1);
  int turns = 0;
  do {
    ASSERT_TRUE(connection_->work());
    read();
    ++turns;
  } while (connection_->hasMore());
  EXPECT_EQ(turns, 4);
  ASSERT_EQ(received_.size(), 3 * turn + 1);
  for (std::size_t index = 1; index < received_.size(); ++index) EXPECT_EQ(received_[index], received_[index - 1] + 1);
}

TEST_F(PeerConnection, EndsItsTurnWhereTheClientDoesNotRead) {
  deliver(4096);
  int turns = 0;
  while (connection_->work() && connection_->hasMore() && turns < 100) ++turns;
  EXPECT_LT(turns, 16);  // the socket is full long before everything is sent
  EXPECT_FALSE(connection_->hasMore());
}

TEST_F(PeerConnection, AnswersACommandAlsoWhenEventsNeverEnd) {
  for (int round = 0; round < 20; ++round) {
    deliver(2 * turn);
    EXPECT_EQ(perform(rhox::kCommandStatus, {}), 0);
    read();
  }
}

}  // namespace
}  // namespace vespscope::test
