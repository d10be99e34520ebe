// The texts about the source of the data, and its colour.
#include <chrono>
#include <string>

#include <gtest/gtest.h>

#include "frontends/quick/StatusModel.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using application::Status;
using Tone = quick::StatusModel::Tone;

class StatusModel : public ::testing::Test {
 protected:
  // The value of a fact, empty if there is no such fact.
  [[nodiscard]] QString fact(const char* name) const {
    const auto index = model_.factNames().indexOf(QLatin1String(name));
    return index < 0 ? QString() : model_.factValues().at(index);
  }
  void connect(SourceKind kind) {
    status_.kind = kind;
    status_.connected = true;
    status_.everConnected = true;
    status_.events = 1;
    status_.lastEvent = std::chrono::system_clock::now();
    model_.refresh();
  }
  void play(std::chrono::nanoseconds position, bool ended) {
    connect(SourceKind::recorded);
    status_.lastEvent = std::chrono::system_clock::now() - 1h;
    // 2016-01-17 03:42:14 UTC.
    status_.playback = PlaybackPosition{position, 123s, 1'453'002'134s, 1, ended};
    model_.refresh();
  }

  Status status_;
  quick::StatusModel model_{[this] { return status_; }};
};

TEST_F(StatusModel, IsGreenForALiveModemAlone) {
  const auto toneOf = [&](SourceKind kind) {
    connect(kind);
    return model_.tone();
  };
  EXPECT_EQ(toneOf(SourceKind::live), Tone::Live);
  EXPECT_EQ(toneOf(SourceKind::recorded), Tone::Playback);
  EXPECT_EQ(toneOf(SourceKind::simulated), Tone::Simulated);
  EXPECT_EQ(toneOf(SourceKind::unknown), Tone::Unknown);
}

TEST_F(StatusModel, NamesTheSimCardShownAndTheNextOne) {
  connect(SourceKind::live);
  EXPECT_EQ(model_.sim(), "");
  EXPECT_EQ(model_.nextSim(), "");
  EXPECT_EQ(fact("SIM card shown"), "");
  status_.sims = {1, {2}};
  model_.refresh();
  EXPECT_EQ(model_.sim(), "SIM 1 (also SIM 2)");
  EXPECT_EQ(model_.nextSim(), "SIM 2");
  EXPECT_EQ(fact("SIM card shown"), "SIM 1 (also SIM 2)");
  EXPECT_TRUE(model_.summary().contains("SIM 1 (also SIM 2)"));
}

TEST_F(StatusModel, NamesARecordingPlayback) {
  connect(SourceKind::recorded);
  EXPECT_EQ(model_.kind(), "Playback");
  connect(SourceKind::live);
  EXPECT_EQ(model_.kind(), "Live modem");
}

TEST_F(StatusModel, ASourceCannotBringControlCharacters) {
  status_.source = "a\x1b[31m\u202e\u009b\xff.pcap";
  status_.problem = "b\n\x7f";
  model_.refresh();
  EXPECT_EQ(model_.source(), "a␛[31m\uFFFD\uFFFD\uFFFD.pcap");
  EXPECT_TRUE(model_.waiting().contains("(b␊␡)"));
  EXPECT_EQ(model_.reason(), "b␊␡");
}

TEST_F(StatusModel, SaysConnectingThenNoManagerAndWhyUntilOneAnswers) {
  model_.refresh();
  EXPECT_EQ(model_.time(), "connecting");
  status_.problem = "no such file";
  model_.refresh();
  EXPECT_EQ(model_.tone(), Tone::Disconnected);
  EXPECT_EQ(model_.time(), "no manager");
  EXPECT_EQ(model_.reason(), "no such file");
  EXPECT_EQ(fact("Baseband manager"), "no manager");
  EXPECT_EQ(fact("Reason"), "no such file");
}

TEST_F(StatusModel, KeepsTheAgeOfTheLastEventWhileItIsReconnecting) {
  connect(SourceKind::live);
  EXPECT_EQ(model_.time(), "now");
  status_.lastEvent = std::chrono::system_clock::now() - 75s;
  status_.connected = false;
  model_.refresh();
  EXPECT_EQ(model_.time(), "reconnecting · 1 min ago");
}

TEST_F(StatusModel, TurnsFromItsKindsColourWhenEventsStop) {
  connect(SourceKind::live);
  status_.lastEvent = std::chrono::system_clock::now() - 30s;
  model_.refresh();
  EXPECT_EQ(model_.tone(), Tone::Waiting);
  EXPECT_EQ(model_.time(), "30 s ago");
  status_.lastEvent.reset();
  model_.refresh();
  EXPECT_EQ(model_.tone(), Tone::Waiting);
  EXPECT_EQ(model_.time(), "no event yet");
}

TEST_F(StatusModel, SaysConnectedButNotSubscribedAndWhy) {
  connect(SourceKind::live);
  status_.lastEvent.reset();
  status_.notSubscribed = "the manager has no configuration";
  model_.refresh();
  EXPECT_EQ(model_.tone(), Tone::Waiting);
  EXPECT_EQ(model_.time(), "connected, not subscribed");
  EXPECT_EQ(model_.reason(), "the manager has no configuration");
  EXPECT_EQ(fact("Baseband manager"), "connected, not subscribed");
  EXPECT_TRUE(model_.waiting().contains("the manager has no configuration"));
}

TEST_F(StatusModel, ShowsARecordingsOwnClockAndPositionAndNoAge) {
  play(97s, false);
  EXPECT_EQ(model_.tone(), Tone::Playback);
  EXPECT_EQ(model_.time(), "03:42:14 · 01:37/02:03");
  EXPECT_EQ(fact("Position"), "01:37/02:03");
  EXPECT_EQ(fact("Recording's clock"), "2016-01-17 03:42:14");
  EXPECT_EQ(fact("Last event"), QString());
  EXPECT_FALSE(model_.summary().contains("ago"));
}

TEST_F(StatusModel, SaysEndOfRecordingInsteadOfSilence) {
  play(123s, true);
  EXPECT_EQ(model_.tone(), Tone::Playback);
  EXPECT_EQ(model_.time(), "end of recording · 02:03/02:03");
  EXPECT_EQ(fact("Position"), "02:03/02:03 · end of recording");
  EXPECT_EQ(fact("Baseband manager"), "connected");
}

TEST_F(StatusModel, OfARecordingAtAnUnknownPositionGivesNoAge) {
  connect(SourceKind::recorded);
  EXPECT_EQ(model_.time(), "connected");
}

TEST_F(StatusModel, CountsWhatWentWrong) {
  EXPECT_EQ(model_.trouble(), "");
  status_.decodeFailures = 2;
  model_.refresh();
  EXPECT_EQ(model_.trouble(), "2 decode failures");
  status_.eventsLost = 31;
  status_.interruptions = 1;
  model_.refresh();
  EXPECT_EQ(model_.trouble(), "2 decode failures · 31 lost · 1 gap");
  EXPECT_EQ(fact("Decode failures"), "2");
  EXPECT_EQ(fact("Gaps"), "1");
}

TEST_F(StatusModel, SaysWhatATableWaitsFor) {
  status_.problem = "no such file";
  model_.refresh();
  EXPECT_TRUE(model_.waiting().contains("not connected (no such file)"));
  connect(SourceKind::live);
  EXPECT_EQ(model_.waiting(), "The modem has not reported these values yet. They appear here with their first report.");
  EXPECT_EQ(model_.waitingForEntries(),
            "The latest report had no entries. They appear here when a report brings some.");
}

TEST_F(StatusModel, WithoutAProviderTheSourceIsUnknown) {
  const quick::StatusModel model({});
  EXPECT_EQ(model.kind(), "Unknown source");
}

}  // namespace
}  // namespace vespscope::test
