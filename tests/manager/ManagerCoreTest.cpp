// The manager's handling of commands, and when it starts and stops its source; without sockets.
#include "CoreTesting.h"

namespace vespscope::test {
namespace {

class ManagerCore : public CoreTesting {};

TEST_F(ManagerCore, TheSourceStartsWhenAClientListensForAConfiguredApplication) {
  const auto peer = addPeer();
  core->setEvents(peer, true);
  EXPECT_EQ(control->starts, 0);
  add(peer, everyChange);
  EXPECT_EQ(control->starts, 1);
  core->setEvents(peer, false);
  core->setEvents(peer, true);
  EXPECT_EQ(control->starts, 1);
}

TEST_F(ManagerCore, RequestsThatAreNotCompleteAreRefused) {
  const auto peer = addPeer();
  Dictionary noPayload = applicationRequest();
  noPayload.set(rhox::kKeyPayloadType, integer(0));
  Dictionary textPayload = addRequest(everyChange);
  textPayload.set(rhox::kKeyPayload, Object(everyChange));
  Dictionary otherType = addRequest(everyChange);
  otherType.set(rhox::kKeyPayloadType, integer(1));
  Dictionary textApplication = addRequest(everyChange);
  textApplication.set(rhox::kKeyAppID, Object(std::string("2")));
  Dictionary noTrigger = queryRequest();
  noTrigger.set(rhox::kKeyTriggerRef, Object());
  const std::vector<std::tuple<std::string_view, Dictionary, std::string>> table = {
      {rhox::kCommandAddConfiguration, {}, "kKeyAppID must be an integer"},
      {rhox::kCommandAddConfiguration, textApplication, "kKeyAppID must be an integer"},
      {rhox::kCommandAddConfiguration, noPayload, "kKeyPayload must be data"},
      {rhox::kCommandAddConfiguration, textPayload, "kKeyPayload must be data"},
      {rhox::kCommandAddConfiguration, otherType, "kKeyPayloadType must be 0"},
      {rhox::kCommandClearConfiguration, {}, "kKeyAppID must be an integer"},
      {rhox::kCommandQueryMetric, {}, "kKeyAppID must be an integer"},
      {rhox::kCommandQueryMetric, noTrigger, "kKeyTriggerRef must be an integer"},
  };
  for (const auto& [command, request, reason] : table) {
    const Reply reply = ask(peer, command, request);
    EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::badRequest)) << reason;
    EXPECT_EQ(reply.message, "the request is incomplete: " + reason);
  }
}

TEST_F(ManagerCore, AnUnknownCommandIsRefused) {
  const Reply reply = ask(addPeer(), "Dance", {});
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::unknownCommand));
  EXPECT_EQ(reply.message, "there is no such command: Dance");
}

TEST_F(ManagerCore, StopsItsSource) {
  core.reset();
  EXPECT_EQ(control->stops, 1);
}

TEST_F(ManagerCore, KeepsTheConfigurationAcrossARestart) {
  restartWithStore();
  const Peer peer = listener(rrcStateOnly);
  const int starts = control->starts;
  static_cast<void>(peer);
  restartWithStore();
  const Peer again = addPeer();
  core->setEvents(again, true);
  ask(again, rhox::kCommandStatus, applicationRequest());
  EXPECT_EQ(control->starts, starts + 1);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_THAT(taken(again), ElementsAre(rrcState));
}

TEST_F(ManagerCore, RefusesAClientForWhichThereIsNoPlaceAndLogsIt) {
  const LoggedLines lines;
  std::vector<Peer> peers;
  for (std::size_t count = 0; count < 32; ++count) peers.push_back(addPeer());
  EXPECT_EQ(core->addPeer({}).reason(), "32 clients are connected");
  EXPECT_THAT(lines.all(), ElementsAre("refused a client of user 0: 32 clients are connected"));
  core->removePeer(peers.front());
  EXPECT_TRUE(core->addPeer({}).ok());
}

TEST_F(ManagerCore, RepeatsNoMoreOfAnUnknownCommandThanACommandHas) {
  const Reply reply = ask(addPeer(), std::string(100'000, 'x'), {});
  EXPECT_EQ(reply.message, "there is no such command: " + std::string(256, 'x'));
}

TEST_F(ManagerCore, RecordsAllThatTheSourceDeliversWhateverIsAskedForAndStartsItForThat) {
  const auto notes = std::make_shared<NotingRecorder::Notes>();
  EXPECT_EQ(control->starts, 0);
  core->recordTo(std::make_unique<NotingRecorder>(notes));
  EXPECT_EQ(control->starts, 1);
  control->deliver(txPower, {1});
  const auto peer = listener(rrcStateOnly);
  EXPECT_EQ(control->starts, 1);
  for (int round = 0; round < 2; ++round) {
    control->deliver(rrcState, {0x10, 0x01});
    control->deliver(txPower, {1});
  }
  EXPECT_THAT(taken(peer), ElementsAre(rrcState));
  EXPECT_THAT(notes->metrics, ElementsAre(txPower, rrcState, txPower, rrcState, txPower));
}

}  // namespace
}  // namespace vespscope::test
