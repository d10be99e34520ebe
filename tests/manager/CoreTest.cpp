// The manager's commands and what they do to delivery, without sockets.
#include <filesystem>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/CommandStatus.h"
#include "manager/ManagerCore.h"
#include "platform/log/Log.h"
#include "support/ScriptedSource.h"
#include "support/TemporaryFolder.h"

namespace vespscope::manager {
namespace {

using namespace std::chrono_literals;
using bus::Reply;
using ipc::Dictionary;
using ipc::Object;
using test::ScriptedSource;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr std::int32_t rrcState = 3952132;
constexpr std::int32_t txPower = 3986178;
constexpr std::int32_t simCardFiles = 3932179;

const std::string everyChange =
    "[metrics]\nK_LTE_RRC_STATE = { on = \"change\" }\nK_LTE_TX_POWER = { on = \"change\" }\n";
const std::string rrcStateOnly = "[metrics]\nK_LTE_RRC_STATE = { on = \"change\" }\n";

Object integer(std::int64_t number) { return Object(number); }

Dictionary addRequest(const std::string& toml, std::int64_t application = 2) {
  Dictionary request;
  request.set(rhox::kKeyAppID, integer(application));
  request.set(rhox::kKeyPayload, Object(Bytes(toml.begin(), toml.end())));
  request.set(rhox::kKeyPayloadType, integer(0));
  return request;
}

Dictionary applicationRequest(std::int64_t application = 2) {
  Dictionary request;
  request.set(rhox::kKeyAppID, integer(application));
  return request;
}

Dictionary queryRequest() {
  Dictionary request;
  request.set(rhox::kKeyAppID, integer(2));
  request.set(rhox::kKeyPayloadType, integer(0));
  request.set(rhox::kKeyTriggerRef, integer(9999));
  request.set(rhox::kKeyTriggerType, integer(0));
  request.set(rhox::kKeyTriggerID, integer(8323091));
  request.set(rhox::kKeyProfileID, integer(0));
  request.set(rhox::kKeyMetricID, integer(0));
  return request;
}

class Core : public testing::Test {
 protected:
  explicit Core(std::optional<ConfigurationStore> store = std::nullopt)
      : core(
            std::make_unique<ScriptedSource>(control), [this] { ++wakes; }, std::move(store)) {
    log::discardOutputs();
  }

  Reply ask(ManagerCore::PeerIdentifier peer, std::string_view command, const Dictionary& request) {
    return core.performCommand(peer, std::string(command), request);
  }
  Reply add(ManagerCore::PeerIdentifier peer, const std::string& toml, std::int64_t application = 2) {
    return ask(peer, rhox::kCommandAddConfiguration, addRequest(toml, application));
  }

  // A client that listens for application 2 with the given configuration.
  ManagerCore::PeerIdentifier listener(const std::string& toml, std::int64_t application = 2) {
    const ManagerCore::PeerIdentifier peer = core.addPeer();
    EXPECT_EQ(add(peer, toml, application).status, 0);
    core.setEvents(peer, true);
    return peer;
  }

  std::vector<std::int32_t> taken(ManagerCore::PeerIdentifier peer) {
    std::vector<std::int32_t> metrics;
    while (const auto next = core.take(peer)) metrics.push_back(next->event->metricID);
    return metrics;
  }

  std::shared_ptr<ScriptedSource::Control> control = std::make_shared<ScriptedSource::Control>();
  int wakes = 0;
  ManagerCore core;
};

TEST_F(Core, TheSourceStartsWhenSomebodyListensForAConfiguredApplication) {
  const auto peer = core.addPeer();
  core.setEvents(peer, true);
  EXPECT_EQ(control->starts, 0);
  add(peer, everyChange);
  EXPECT_EQ(control->starts, 1);
  core.setEvents(peer, false);
  core.setEvents(peer, true);
  EXPECT_EQ(control->starts, 1);
}

TEST_F(Core, DeliversWhatTheConfigurationNamesAndNothingElse) {
  const auto peer = listener(rrcStateOnly);
  control->deliver(rrcState, {0x10, 1});
  control->deliver(txPower, {0x10, 1});
  EXPECT_EQ(wakes, 2);  // delivery on, and one event
  EXPECT_THAT(taken(peer), ElementsAre(rrcState));
}

TEST_F(Core, AfterClearingThereIsSilence) {
  const auto peer = listener(everyChange);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_EQ(ask(peer, rhox::kCommandClearConfiguration, applicationRequest()).status, 0);
  control->deliver(rrcState, {0x10, 2});
  control->deliver(txPower, {0x10, 2});
  EXPECT_THAT(taken(peer), IsEmpty());
}

TEST_F(Core, ClearingWhatWasNotThereSucceeds) {
  EXPECT_EQ(ask(core.addPeer(), rhox::kCommandClearConfiguration, applicationRequest()).status, 0);
}

TEST_F(Core, ARefusedConfigurationLeavesTheOneBefore) {
  const auto peer = listener(rrcStateOnly);
  const Reply reply = add(peer, "[metrics]\nK_NOISE = { period_ms = 1 }\n");
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::badConfiguration));
  EXPECT_EQ(reply.message, "the configuration is refused: line 2: there is no metric K_NOISE");
  control->deliver(rrcState, {0x10, 1});
  EXPECT_THAT(taken(peer), ElementsAre(rrcState));
}

TEST_F(Core, AnEmptyPayloadIsRefused) {
  const Reply reply = add(core.addPeer(), "");
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::badConfiguration));
  EXPECT_EQ(reply.message, "the configuration is refused: the configuration is empty");
}

TEST_F(Core, RequestsThatAreNotCompleteAreRefused) {
  const auto peer = core.addPeer();
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
    EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::badRequest)) << reason;
    EXPECT_EQ(reply.message, "the request is not complete: " + reason);
  }
}

TEST_F(Core, AnUnknownCommandIsRefused) {
  const Reply reply = ask(core.addPeer(), "Dance", {});
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::unknownCommand));
  EXPECT_EQ(reply.message, "there is no such command: Dance");
}

TEST_F(Core, TheSimCardFilesGoToTheClientThatAskedAlone) {
  control->simCardFiles = MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms};
  const auto asking = listener(rrcStateOnly);
  const auto other = listener(rrcStateOnly);
  EXPECT_EQ(ask(asking, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  const auto answer = core.take(asking);
  ASSERT_TRUE(answer.has_value());
  EXPECT_EQ(answer->sequence, 1U);
  EXPECT_EQ(answer->event->metricID, 3932179);
  EXPECT_EQ(answer->event->payload, (Bytes{0x08, 0x01}));
  EXPECT_FALSE(core.take(asking).has_value());
  EXPECT_THAT(taken(other), IsEmpty());
}

TEST_F(Core, EveryQueryIsAnsweredAlsoTheSameAgain) {
  control->simCardFiles = MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms};
  const auto peer = listener(rrcStateOnly);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_THAT(taken(peer), ElementsAre(simCardFiles, simCardFiles));
}

TEST_F(Core, AQueryWhoseAnswerIsStillSearchedForIsAcceptedAndTheFilesFollow) {
  control->searches = true;
  const auto asking = listener(rrcStateOnly);
  const auto leaving = core.addPeer();
  ask(leaving, rhox::kCommandAddConfiguration, addRequest(rrcStateOnly));
  core.setEvents(leaving, true);
  EXPECT_EQ(ask(asking, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_EQ(ask(leaving, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_FALSE(core.take(asking).has_value());
  core.removePeer(leaving);
  ASSERT_EQ(control->waiting.size(), 2U);
  for (const auto& found : control->waiting) found(MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms});
  EXPECT_THAT(taken(asking), ElementsAre(simCardFiles));
}

TEST_F(Core, FilesThatAreFoundForAnotherApplicationAreNotDelivered) {
  control->searches = true;
  const auto peer = listener(rrcStateOnly);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_EQ(ask(peer, rhox::kCommandStatus, applicationRequest(7)).status, 0);
  control->waiting.at(0)(MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms});
  EXPECT_THAT(taken(peer), IsEmpty());
}

TEST_F(Core, QueriesThatWaitForASearchAreLimited) {
  control->searches = true;
  const auto peer = listener(rrcStateOnly);
  for (int query = 0; query < 64; ++query) EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  const Reply reply = ask(peer, rhox::kCommandQueryMetric, queryRequest());
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::tooManyQueries));
  EXPECT_EQ(reply.message, "as many queries wait for the SIM card files as there can be: 64");
  ASSERT_EQ(control->waiting.size(), 64U);
  for (const auto& found : control->waiting) found(MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms});
  EXPECT_EQ(taken(peer).size(), 64U);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
}

TEST_F(Core, ASearchThatFindsNothingIsLogged) {
  log::discardOutputs();
  std::vector<std::string> lines;
  const log::Observation observation([&](log::Channel, std::string_view line) { lines.emplace_back(line); });
  control->searches = true;
  const auto peer = listener(rrcStateOnly);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  control->waiting.at(0)(std::nullopt);
  EXPECT_THAT(taken(peer), IsEmpty());
  EXPECT_THAT(lines, ElementsAre("the source has no SIM card files: scripted"));
}

TEST_F(Core, QueriesThatCannotBeAnsweredAreRefusedWithAMessage) {
  const auto peer = listener(rrcStateOnly);
  Reply reply = ask(peer, rhox::kCommandQueryMetric, queryRequest());
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::noSimCardFiles));
  EXPECT_EQ(reply.message, "the source has no SIM card files: scripted");

  control->simCardFiles = MetricEvent{simCardFiles, 0, {}, 0ms};
  Dictionary otherProfile = queryRequest();
  otherProfile.set(rhox::kKeyProfileID, integer(1));
  reply = ask(peer, rhox::kCommandQueryMetric, otherProfile);
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::noSimCardFiles));
  EXPECT_EQ(reply.message, "the source has no SIM card files: profile 1");

  Dictionary otherTrigger = queryRequest();
  otherTrigger.set(rhox::kKeyTriggerID, integer(0x7F0014));
  reply = ask(peer, rhox::kCommandQueryMetric, otherTrigger);
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::unknownTrigger));
  EXPECT_EQ(reply.message, "nothing answers this trigger: 8323092");

  core.setEvents(peer, false);
  reply = ask(peer, rhox::kCommandQueryMetric, queryRequest());
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(CommandStatus::deliveryOff));
  EXPECT_EQ(reply.message, "delivery of events is off, so the answer cannot be delivered");
  core.setEvents(peer, true);
  EXPECT_THAT(taken(peer), IsEmpty());
}

TEST_F(Core, EveryStatusHasItsText) {
  std::set<CommandStatus> seen;
  for (const auto& [status, text] : commandStatusTexts) {
    EXPECT_TRUE(seen.insert(status).second);
    EXPECT_EQ(text.empty(), status == CommandStatus::ok);
  }
  // One after another from 0: a status without a text would leave a hole or come after the last.
  std::int32_t expected = 0;
  for (const CommandStatus status : seen) EXPECT_EQ(static_cast<std::int32_t>(status), expected++);
  EXPECT_EQ(*seen.rbegin(), CommandStatus::tooManyQueries);
}

TEST_F(Core, TwoApplicationsHaveTheirOwnConfigurations) {
  const auto viewer = listener(everyChange, 2);
  const auto recorder = listener(rrcStateOnly, 3);
  control->deliver(rrcState, {0x10, 1});
  control->deliver(txPower, {0x10, 1});
  EXPECT_THAT(taken(viewer), ElementsAre(rrcState, txPower));
  EXPECT_THAT(taken(recorder), ElementsAre(rrcState));
  EXPECT_EQ(ask(recorder, rhox::kCommandClearConfiguration, applicationRequest(3)).status, 0);
  control->deliver(rrcState, {0x10, 2});
  EXPECT_THAT(taken(viewer), ElementsAre(rrcState));
  EXPECT_THAT(taken(recorder), IsEmpty());
}

TEST_F(Core, ClientsOfOneApplicationShareItsConfiguration) {
  const auto first = listener(everyChange);
  const auto second = core.addPeer();
  core.setEvents(second, true);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_THAT(taken(second), IsEmpty());  // it has named no application
  EXPECT_EQ(ask(second, rhox::kCommandStatus, applicationRequest()).status, 0);
  EXPECT_THAT(taken(second), ElementsAre(rrcState));
  add(first, rrcStateOnly);
  control->deliver(txPower, {0x10, 1});
  control->deliver(rrcState, {0x10, 2});
  EXPECT_THAT(taken(first), ElementsAre(rrcState, rrcState));
  EXPECT_THAT(taken(second), ElementsAre(rrcState));
}

TEST_F(Core, AClientThatJoinsSeesTheCurrentValuesInTheOrderOfTheirTimes) {
  listener(everyChange);
  control->deliver(txPower, {0x10, 1}, 20ms);
  control->deliver(rrcState, {0x10, 1}, 10ms);
  control->deliver(txPower, {0x10, 2}, 30ms);
  const auto late = core.addPeer();
  ask(late, rhox::kCommandStatus, applicationRequest());
  core.setEvents(late, true);
  const auto first = core.take(late);
  const auto second = core.take(late);
  ASSERT_TRUE(first && second);
  EXPECT_EQ(first->event->metricID, rrcState);
  EXPECT_EQ(second->event->payload, (Bytes{0x10, 2}));
  EXPECT_FALSE(core.take(late).has_value());
}

TEST_F(Core, TurningDeliveryOffAndOnNeitherRepeatsNorLosesEvents) {
  const auto peer = listener(everyChange);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_THAT(taken(peer), ElementsAre(rrcState));
  control->deliver(txPower, {0x10, 1});
  core.setEvents(peer, false);
  EXPECT_THAT(taken(peer), IsEmpty());
  control->deliver(rrcState, {0x10, 2});
  core.setEvents(peer, true);
  EXPECT_THAT(taken(peer), ElementsAre(txPower, rrcState));
}

TEST_F(Core, AClientThatDoesNotListenGetsNothing) {
  const auto peer = core.addPeer();
  add(peer, everyChange);
  listener(everyChange);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_FALSE(core.take(peer).has_value());
}

TEST_F(Core, WhatWaitsForItsPeriodIsCollectedWhenThatEnds) {
  const auto peer = listener("[metrics]\nK_LTE_TX_POWER = { period_ms = 1000 }\n");
  EXPECT_EQ(core.collectDue(ManagerCore::Clock::now()), std::nullopt);
  control->deliver(txPower, {0x10, 1}, 0ms);
  EXPECT_THAT(taken(peer), ElementsAre(txPower));
  const int before = wakes;
  control->deliver(txPower, {0x10, 2}, 100ms);
  EXPECT_EQ(wakes, before + 1);  // there is a time to wake at now
  control->deliver(txPower, {0x10, 3}, 200ms);
  const auto now = ManagerCore::Clock::now();
  const auto due = core.collectDue(now);
  ASSERT_TRUE(due.has_value());
  EXPECT_GT(*due, now);
  EXPECT_LE(*due, now + 900ms);
  EXPECT_THAT(taken(peer), IsEmpty());
  EXPECT_EQ(core.collectDue(*due), std::nullopt);
  const auto last = core.take(peer);
  ASSERT_TRUE(last.has_value());
  EXPECT_EQ(last->event->payload, (Bytes{0x10, 3}));
}

TEST_F(Core, TellsItsStatus) {
  const auto peer = core.addPeer();
  Reply reply = ask(peer, rhox::kCommandStatus, {});
  EXPECT_EQ(reply.status, 0);
  EXPECT_EQ(*reply.values.find(rhox::kKeySourceLabel)->asString(), "scripted");
  EXPECT_EQ(*reply.values.find(rhox::kKeySourceKind)->asString(), "recorded");
  EXPECT_EQ(ipc::toValue(*reply.values.find(rhox::kKeyConfigured)), Value(false));
  EXPECT_EQ(*reply.values.find(rhox::kKeyEventsLost)->asInt64(), 0);
  add(peer, everyChange);
  reply = ask(peer, rhox::kCommandStatus, applicationRequest());
  EXPECT_EQ(ipc::toValue(*reply.values.find(rhox::kKeyConfigured)), Value(true));
}

TEST_F(Core, AClientThatIsGoneIsForgotten) {
  const auto peer = listener(everyChange);
  core.removePeer(peer);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_EQ(core.collectDue(ManagerCore::Clock::now()), std::nullopt);
}

TEST(ACore, StopsItsSource) {
  const auto control = std::make_shared<ScriptedSource::Control>();
  {
    const ManagerCore core(std::make_unique<ScriptedSource>(control), [] {});
  }
  EXPECT_EQ(control->stops, 1);
}

// Takes note of what it is given, and tells a status that the test sets.
class NotingRecorder final : public EventRecorder {
 public:
  struct Notes {
    std::vector<std::int32_t> metrics;
    RecordingStatus status;
  };
  explicit NotingRecorder(std::shared_ptr<Notes> notes) : notes_(std::move(notes)) {}
  void record(SharedEvent event) override { notes_->metrics.push_back(event->metricID); }
  [[nodiscard]] RecordingStatus status() const override { return notes_->status; }

 private:
  std::shared_ptr<Notes> notes_;
};

TEST_F(Core, RecordsAllThatTheSourceDeliversWhateverIsAskedForAndStartsItForThat) {
  const auto notes = std::make_shared<NotingRecorder::Notes>();
  EXPECT_EQ(control->starts, 0);
  core.recordTo(std::make_unique<NotingRecorder>(notes));
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

TEST_F(Core, TellsHowItsRecordingGoes) {
  const auto peer = core.addPeer();
  Dictionary values = ask(peer, rhox::kCommandStatus, {}).values;
  for (const auto key : {rhox::kKeyEventsRecorded, rhox::kKeyRecordingLost, rhox::kKeyRecordingProblem}) {
    EXPECT_EQ(values.find(key), nullptr);
  }
  const auto notes = std::make_shared<NotingRecorder::Notes>();
  notes->status = {.recorded = 7, .lost = 3, .problem = ""};
  core.recordTo(std::make_unique<NotingRecorder>(notes));
  values = ask(peer, rhox::kCommandStatus, {}).values;
  EXPECT_EQ(*values.find(rhox::kKeyEventsRecorded)->asInt64(), 7);
  EXPECT_EQ(*values.find(rhox::kKeyRecordingLost)->asInt64(), 3);
  EXPECT_EQ(values.find(rhox::kKeyRecordingProblem), nullptr);
  notes->status.problem = "the disk is full";
  values = ask(peer, rhox::kCommandStatus, {}).values;
  EXPECT_EQ(*values.find(rhox::kKeyRecordingProblem)->asString(), "the disk is full");
}

TEST_F(Core, HasNoMoreConfigurationsThanItCanKeep) {
  const auto peer = core.addPeer();
  for (std::int64_t application = 1; application <= 64; ++application) {
    EXPECT_EQ(add(peer, rrcStateOnly, application).status, 0);
  }
  const Reply refused = add(peer, rrcStateOnly, 65);
  EXPECT_EQ(refused.status, static_cast<std::int32_t>(CommandStatus::tooManyApplications));
  EXPECT_THAT(refused.message, HasSubstr("as many applications"));
  EXPECT_EQ(add(peer, everyChange, 64).status, 0);  // another one in the place of its own
  EXPECT_EQ(ask(peer, rhox::kCommandClearConfiguration, applicationRequest(3)).status, 0);
  EXPECT_EQ(add(peer, rrcStateOnly, 65).status, 0);
}

TEST_F(Core, KeepsNoMoreOfAClientsNameThanANameHas) {
  const auto peer = core.addPeer();
  Dictionary request;
  request.set(rhox::kKeyClientName, Object(std::string(1'000'000, 'n')));
  request.set(rhox::kKeyDetails, Object(true));
  const Reply reply = ask(peer, rhox::kCommandStatus, request);
  const Dictionary& client = *reply.values.find(rhox::kKeyClients)->asArray()->front().asDictionary();
  EXPECT_EQ(*client.find(rhox::kKeyClientName)->asString(), std::string(256, 'n'));
}

TEST_F(Core, DeliversMetricsOfProfilesWithoutNumberAndRemembersSomeOfThem) {
  const auto peer = listener(rrcStateOnly);
  for (std::int32_t profile = 0; profile < 10'000; ++profile) {
    control->deliver(rrcState, {0x10, 1}, std::chrono::milliseconds(profile), profile);
    EXPECT_EQ(taken(peer).size(), 1U);
  }
  // Who joins sees what is remembered.
  const auto late = listener(rrcStateOnly);
  EXPECT_EQ(taken(late).size(), 4096U);
}

TEST(AKeptConfiguration, IsActiveAfterARestart) {
  log::discardOutputs();
  const test::TemporaryFolder folder;
  const ConfigurationStore store(folder / "state");
  const auto control = std::make_shared<ScriptedSource::Control>();
  {
    ManagerCore core(
        std::make_unique<ScriptedSource>(control), [] {}, store);
    const auto peer = core.addPeer();
    EXPECT_EQ(core.performCommand(peer, "AddConfiguration", addRequest(rrcStateOnly, 2)).status, 0);
    EXPECT_EQ(core.performCommand(peer, "AddConfiguration", addRequest(everyChange, -5)).status, 0);
    EXPECT_EQ(core.performCommand(peer, "AddConfiguration", addRequest(everyChange, 7)).status, 0);
    EXPECT_EQ(core.performCommand(peer, "ClearConfiguration", applicationRequest(7)).status, 0);
    EXPECT_NE(core.performCommand(peer, "AddConfiguration", addRequest("nonsense", 2)).status, 0);
  }
  folder.write("state/application-9.deviceconfig", "nonsense");
  folder.write("state/application-x.deviceconfig", rrcStateOnly);
  folder.write("state/notes.txt", "not ours");
  ManagerCore core(
      std::make_unique<ScriptedSource>(control), [] {}, store);
  const auto configured = [&core](std::int64_t application) {
    const Reply reply = core.performCommand(core.addPeer(), "Status", applicationRequest(application));
    return ipc::toValue(*reply.values.find(rhox::kKeyConfigured)) == Value(true);
  };
  EXPECT_TRUE(configured(2));
  EXPECT_TRUE(configured(-5));
  EXPECT_FALSE(configured(7));
  EXPECT_FALSE(configured(9));
}

TEST(AKeptConfiguration, ThatIsRefusedIsSetAsideWithAMessageAndTheManagerStarts) {
  log::discardOutputs();
  std::vector<std::string> lines;
  const log::Observation observation([&](log::Channel, std::string_view line) { lines.emplace_back(line); });
  const test::TemporaryFolder folder;
  std::string deep = "a";
  for (int part = 1; part < 30'000; ++part) deep += ".a";
  const std::string file = folder.write("application-9.deviceconfig", deep + "=1");
  folder.write("application-2.deviceconfig", rrcStateOnly);
  const auto control = std::make_shared<ScriptedSource::Control>();
  for (int start = 0; start < 2; ++start) {
    ManagerCore core(
        std::make_unique<ScriptedSource>(control), [] {}, ConfigurationStore(folder.path()));
    const Reply reply = core.performCommand(core.addPeer(), "Status", applicationRequest(2));
    EXPECT_EQ(ipc::toValue(*reply.values.find(rhox::kKeyConfigured)), Value(true));
  }
  EXPECT_THAT(lines, ElementsAre("the configuration kept for application 9 is not used: line 1: a key has more than 8 "
                                 "parts (it is now " +
                                 file + ".refused)"));
  EXPECT_FALSE(std::filesystem::exists(file));
  EXPECT_TRUE(std::filesystem::exists(file + ".refused"));
}

TEST(AKeptConfiguration, BeyondTheLimitOfApplicationsIsNotLoaded) {
  log::discardOutputs();
  std::vector<std::string> lines;
  const log::Observation observation([&](log::Channel, std::string_view line) { lines.emplace_back(line); });
  const test::TemporaryFolder folder;
  for (int application = 1; application <= 66; ++application) {
    folder.write("application-" + std::to_string(application) + ".deviceconfig", rrcStateOnly);
  }
  const auto control = std::make_shared<ScriptedSource::Control>();
  ManagerCore core(
      std::make_unique<ScriptedSource>(control), [] {}, ConfigurationStore(folder.path()));
  Dictionary details;
  details.set(rhox::kKeyDetails, Object(true));
  const Reply reply = core.performCommand(core.addPeer(), "Status", details);
  EXPECT_EQ(reply.values.find(rhox::kKeyConfigurations)->asArray()->size(), 64U);
  EXPECT_THAT(lines, ElementsAre("more than 64 configurations are kept: those from application 65 on are not used"));
}

TEST(AKeptConfiguration, ThatCannotBeWrittenIsActiveAllTheSameAndLogged) {
  log::discardOutputs();
  std::vector<std::string> lines;
  const log::Observation observation([&](log::Channel, std::string_view line) { lines.emplace_back(line); });
  const test::TemporaryFolder folder;
  folder.write("state", "a file where the folder should be");
  const auto control = std::make_shared<ScriptedSource::Control>();
  ManagerCore core(
      std::make_unique<ScriptedSource>(control), [] {}, ConfigurationStore(folder / "state"));
  EXPECT_EQ(core.performCommand(core.addPeer(), "AddConfiguration", addRequest(rrcStateOnly)).status, 0);
  EXPECT_THAT(lines, ElementsAre(HasSubstr("cannot write")));
}

}  // namespace
}  // namespace vespscope::manager
