// The manager's report about itself, its recording and its clients.
#include "CoreTesting.h"

namespace vespscope::test {
namespace {

class StatusReport : public CoreTesting {};

TEST_F(StatusReport, HasTheSourceAndWhatTheClientIsDue) {
  const auto peer = addPeer();
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

TEST_F(StatusReport, HasTheProgressOfTheRecording) {
  const auto peer = addPeer();
  Dictionary values = ask(peer, rhox::kCommandStatus, {}).values;
  for (const auto key : {rhox::kKeyEventsRecorded, rhox::kKeyRecordingLost, rhox::kKeyRecordingProblem}) {
    EXPECT_EQ(values.find(key), nullptr);
  }
  const auto notes = std::make_shared<NotingRecorder::Notes>();
  notes->status = {.recorded = 7, .lost = 3, .problem = ""};
  core->recordTo(std::make_unique<NotingRecorder>(notes));
  values = ask(peer, rhox::kCommandStatus, {}).values;
  EXPECT_EQ(*values.find(rhox::kKeyEventsRecorded)->asInt64(), 7);
  EXPECT_EQ(*values.find(rhox::kKeyRecordingLost)->asInt64(), 3);
  EXPECT_EQ(values.find(rhox::kKeyRecordingProblem), nullptr);
  notes->status.problem = "the disk is full";
  values = ask(peer, rhox::kCommandStatus, {}).values;
  EXPECT_EQ(*values.find(rhox::kKeyRecordingProblem)->asString(), "the disk is full");
}

TEST_F(StatusReport, KeepsNoMoreOfAClientsNameThanANameHas) {
  const auto peer = addPeer();
  Dictionary request;
  request.set(rhox::kKeyClientName, Object(std::string(1'000'000, 'n')));
  request.set(rhox::kKeyDetails, Object(true));
  const Reply reply = ask(peer, rhox::kCommandStatus, request);
  const Dictionary& client = *reply.values.find(rhox::kKeyClients)->asArray()->front().asDictionary();
  EXPECT_EQ(*client.find(rhox::kKeyClientName)->asString(), std::string(256, 'n'));
}

}  // namespace
}  // namespace vespscope::test
