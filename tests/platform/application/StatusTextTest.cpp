// The words of both frontends for the source of the data and its state.
#include <limits>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "platform/application/StatusText.h"

namespace vespscope::test {
namespace {

using application::connectionText;
using application::Flow;
using application::flowOf;
using application::playbackText;
using application::Status;
using application::waitingText;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using namespace std::chrono_literals;

const std::chrono::system_clock::time_point now{1'700'000'000s};

Status connected() {
  Status status;
  status.connected = true;
  status.events = 10;
  status.lastEvent = now - 3s;
  return status;
}

PlaybackPosition endOfRecording() {
  PlaybackPosition playback;
  playback.position = 123s;
  playback.length = 123s;
  playback.ended = true;
  return playback;
}

TEST(StatusText, NamesEachKindOfSourceAndNeverARecordingAsRecording) {
  EXPECT_EQ(application::sourceName(SourceKind::live), "Live modem");
  EXPECT_EQ(application::sourceName(SourceKind::recorded), "Playback");
  EXPECT_EQ(application::sourceName(SourceKind::simulated), "Simulated drive");
  EXPECT_EQ(application::sourceName(SourceKind::unknown), "Unknown source");
  EXPECT_EQ(application::sourceMark(SourceKind::live), "LIVE");
  EXPECT_EQ(application::sourceMark(SourceKind::recorded), "PLAYBACK");
  EXPECT_EQ(application::sourceMark(SourceKind::simulated), "SIMULATED");
  EXPECT_EQ(application::sourceMark(SourceKind::unknown), "SOURCE UNKNOWN");
}

TEST(StatusText, SaysConnectedWhileEventsFlowAndWhileTheyAreSilent) {
  Status status = connected();
  EXPECT_EQ(flowOf(status, now), Flow::flowing);
  EXPECT_EQ(connectionText(status), "connected");
  status.lastEvent = now - 10s;
  EXPECT_EQ(flowOf(status, now), Flow::silent);
  EXPECT_EQ(connectionText(status), "connected");
  status.lastEvent.reset();
  EXPECT_EQ(flowOf(status, now), Flow::silent);
}

TEST(StatusText, SaysConnectingUntilTheFirstAttemptFailsAndThenNoManager) {
  Status status;
  EXPECT_EQ(connectionText(status), "connecting");
  status.problem = "no such file";
  EXPECT_EQ(connectionText(status), "no manager");
}

TEST(StatusText, SaysReconnectingAndWhyAfterAConnectionWasLost) {
  Status status = connected();
  status.connected = false;
  status.everConnected = true;
  status.problem = "no such\nfile";
  EXPECT_EQ(flowOf(status, now), Flow::disconnected);
  EXPECT_EQ(connectionText(status), "reconnecting");
  EXPECT_EQ(reasonText(status), "no such␊file");
}

TEST(StatusText, SaysNotSubscribedAndWhy) {
  Status status = connected();
  status.notSubscribed = "the manager has no configuration";
  EXPECT_EQ(flowOf(status, now), Flow::notSubscribed);
  EXPECT_EQ(connectionText(status), "connected, not subscribed");
  EXPECT_EQ(reasonText(status), "the manager has no configuration");
}

TEST(StatusText, SaysEndOfRecordingInsteadOfSilence) {
  Status status = connected();
  status.playback = endOfRecording();
  EXPECT_EQ(flowOf(status, now), Flow::ended);
  EXPECT_EQ(connectionText(status), "end of recording");
  status.playback->ended = false;
  EXPECT_EQ(connectionText(status), "connected");
}

TEST(StatusText, WritesThePositionOfTheLengthAndTheSpeed) {
  PlaybackPosition playback = endOfRecording();
  playback.position = 97s;
  EXPECT_EQ(playbackText(playback), "01:37/02:03");
  playback.length.reset();
  EXPECT_EQ(playbackText(playback), "01:37");
  playback.speed = 10;
  EXPECT_EQ(playbackText(playback), "01:37 x10");
  playback.speed = 0.5;
  EXPECT_EQ(playbackText(playback), "01:37 x0.5");
  playback.speed = std::numeric_limits<double>::infinity();
  EXPECT_EQ(playbackText(playback), "01:37");
}

TEST(StatusText, TakesTheClockFromTheRecording) {
  PlaybackPosition playback;
  playback.clock = 1'453'002'134s;
  EXPECT_EQ(application::clockOf(playback).time_since_epoch(), 1'453'002'134s);
}

TEST(StatusText, CountsTroublesOnlyWhenThereAreSome) {
  Status status = connected();
  EXPECT_THAT(troubleTexts(status), IsEmpty());
  status.decodeFailures = 1;
  status.eventsLost = 7;
  status.interruptions = 1;
  EXPECT_THAT(troubleTexts(status), ElementsAre("1 decode failure", "7 lost", "1 gap"));
  status.decodeFailures = 2;
  status.interruptions = 2;
  EXPECT_THAT(troubleTexts(status), ElementsAre("2 decode failures", "7 lost", "2 gaps"));
}

TEST(StatusText, ExplainsWhatATableWithoutRowsWaitsFor) {
  Status status = connected();
  EXPECT_THAT(waitingText(&status, false), HasSubstr("has not reported these values yet"));
  EXPECT_THAT(waitingText(nullptr, false), HasSubstr("has not reported these values yet"));
  EXPECT_THAT(waitingText(&status, true), HasSubstr("had no entries"));
  status.events = 0;
  EXPECT_THAT(waitingText(&status, false), HasSubstr("has not sent any event yet"));
  status.playback = endOfRecording();
  EXPECT_THAT(waitingText(&status, false), HasSubstr("The recording has ended"));
  status.notSubscribed = "no configuration";
  EXPECT_THAT(waitingText(&status, false), HasSubstr("sends no events: no configuration"));
  status.connected = false;
  status.problem = "connection refused";
  EXPECT_THAT(waitingText(&status, false), HasSubstr("not connected (connection refused); the viewer is trying again"));
}

TEST(StatusText, NamesTheSimCardShownAndTheOthers) {
  EXPECT_EQ(application::simText({}), "");
  EXPECT_EQ(application::simText({1, {}}), "");
  EXPECT_EQ(application::simText({1, {2}}), "SIM 1 (also SIM 2)");
  EXPECT_EQ(application::simText({2, {1, 3, 4}}), "SIM 2 (also SIM 1, 3, 4)");
  EXPECT_EQ(application::nextSim({1, {}}), std::nullopt);
  EXPECT_EQ(application::nextSim({1, {2, 3}}), 2);
  EXPECT_EQ(application::nextSim({2, {1, 3}}), 3);
  EXPECT_EQ(application::nextSim({3, {1, 2}}), 1);
}

}  // namespace
}  // namespace vespscope::test
