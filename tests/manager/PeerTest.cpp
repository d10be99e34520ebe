// One client of the manager: when it takes its place, and how many of its commands may wait.
#include <string>
#include <vector>

#include "CoreTesting.h"
#include "manager/Peer.h"

namespace vespscope::test {
namespace {

using manager::CommandStatus;

class Peer : public CoreTesting {
 protected:
  // Stores the status of a command once it is answered.
  static void ask(manager::Peer& peer, std::string_view command, const Dictionary& request,
                  std::vector<std::int32_t>& statuses) {
    peer.performCommand(std::string(command), request,
                        [&statuses](const Reply& reply) { statuses.push_back(reply.status); });
  }
};

TEST_F(Peer, TakesAPlaceWithItsFirstCallAndGivesItBack) {
  std::vector<std::int32_t> statuses;
  {
    manager::Peer peer(*core, {});
    EXPECT_FALSE(peer.hasPlace());
    ask(peer, rhox::kCommandStatus, {}, statuses);
    EXPECT_TRUE(peer.hasPlace());
    manager::Peer listening(*core, {});
    listening.eventsOn();
    EXPECT_TRUE(listening.hasPlace());
    std::vector<CoreTesting::Peer> others;
    while (const auto other = core->addPeer({})) others.push_back(*other);
    EXPECT_EQ(others.size(), 30U);
    manager::Peer late(*core, {});
    late.eventsOn();
    ask(late, rhox::kCommandStatus, {}, statuses);
    EXPECT_FALSE(late.hasPlace());
  }
  EXPECT_THAT(statuses, ElementsAre(0, rhox::kStatusNoPlace));
  EXPECT_TRUE(core->addPeer({}).ok());
}

TEST_F(Peer, HasNoMoreThanTwoCommandsThatWaitForTheDisk) {
  restartWithStore();
  std::vector<std::int32_t> statuses;
  manager::Peer peer(*core, {});
  for (int count = 0; count < 3; ++count) {
    ask(peer, rhox::kCommandAddConfiguration, addRequest(rrcStateOnly), statuses);
  }
  EXPECT_THAT(statuses, ElementsAre(static_cast<std::int32_t>(CommandStatus::tooManyCommands)));
  manager::Peer other(*core, {});
  ask(other, rhox::kCommandStatus, {}, statuses);
  EXPECT_EQ(statuses.back(), 0);
  ASSERT_TRUE(eventually([&] {
    core->sendAnswers();
    return statuses.size() == 4;
  }));
  ask(peer, rhox::kCommandStatus, {}, statuses);
  EXPECT_EQ(statuses.back(), 0);
}

TEST_F(Peer, ThatHasLeftIsAnsweredWithoutHarm) {
  restartWithStore();
  std::vector<std::int32_t> statuses;
  {
    manager::Peer peer(*core, {});
    ask(peer, rhox::kCommandAddConfiguration, addRequest(rrcStateOnly), statuses);
  }
  EXPECT_TRUE(eventually([&] {
    core->sendAnswers();
    return statuses.size() == 1;
  }));
  EXPECT_TRUE(isConfigured(2));
}

}  // namespace
}  // namespace vespscope::test
