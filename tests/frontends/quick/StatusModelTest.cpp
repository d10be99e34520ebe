// The texts about the source of the data.
#include <chrono>

#include <gtest/gtest.h>

#include "frontends/quick/StatusModel.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using application::Status;
using quick::StatusModel;

TEST(AgeText, GrowsFromNowToDays) {
  EXPECT_EQ(ageText(-5s), "now");
  EXPECT_EQ(ageText(999ms), "now");
  EXPECT_EQ(ageText(1s), "1 s ago");
  EXPECT_EQ(ageText(59s), "59 s ago");
  EXPECT_EQ(ageText(60s), "1 min ago");
  EXPECT_EQ(ageText(1h), "1 h ago");
  EXPECT_EQ(ageText(49h), "2 d ago");
}

TEST(StatusModel, NamesEveryKindOfSource) {
  const auto kindOf = [](SourceKind kind) {
    Status status;
    status.kind = kind;
    return StatusModel([status] { return status; }).kind();
  };
  EXPECT_EQ(kindOf(SourceKind::live), "Live modem");
  EXPECT_EQ(kindOf(SourceKind::recorded), "Recording");
  EXPECT_EQ(kindOf(SourceKind::simulated), "Simulated drive");
  EXPECT_EQ(kindOf(SourceKind::unknown), "Unknown source");
}

TEST(StatusModel, ASourceCannotBringControlCharacters) {
  Status status;
  status.source = "a\x1b[31m\u202e\u009b\xff.pcap";
  status.problem = "b\n\x7f";
  const StatusModel model([status] { return status; });
  EXPECT_EQ(model.source(), "a␛[31m\uFFFD\uFFFD\uFFFD.pcap");
  EXPECT_TRUE(model.waiting().contains("(b␊␡)"));
}

TEST(StatusModel, TellsAFlowFromASilenceAndFromALostConnection) {
  Status status;
  StatusModel model([&] { return status; });
  EXPECT_EQ(model.level(), StatusModel::Level::Disconnected);
  EXPECT_EQ(model.connection(), "reconnecting");
  status.connected = true;
  model.refresh();
  EXPECT_EQ(model.level(), StatusModel::Level::Silent);
  EXPECT_EQ(model.lastEvent(), "no event yet");
  status.lastEvent = std::chrono::system_clock::now();
  model.refresh();
  EXPECT_EQ(model.level(), StatusModel::Level::Flowing);
  EXPECT_EQ(model.lastEvent(), "now");
  status.lastEvent = std::chrono::system_clock::now() - 30s;
  model.refresh();
  EXPECT_EQ(model.level(), StatusModel::Level::Silent);
  EXPECT_EQ(model.lastEvent(), "30 s ago");
}

TEST(StatusModel, KeepsTheAgeOfTheLastEventWhileItIsReconnecting) {
  Status status;
  StatusModel model([&] { return status; });
  EXPECT_EQ(model.freshness(), "reconnecting");
  status.connected = true;
  status.lastEvent = std::chrono::system_clock::now() - 30s;
  model.refresh();
  EXPECT_EQ(model.freshness(), "30 s ago");
  status.connected = false;
  model.refresh();
  EXPECT_EQ(model.freshness(), "reconnecting · 30 s ago");
}

TEST(StatusModel, CountsEventsThatWereLostOrNotDecoded) {
  Status status;
  StatusModel model([&] { return status; });
  EXPECT_EQ(model.trouble(), "");
  status.decodeFailures = 2;
  model.refresh();
  EXPECT_EQ(model.trouble(), "2 not decoded");
  status.eventsLost = 31;
  model.refresh();
  EXPECT_EQ(model.trouble(), "31 lost · 2 not decoded");
  status.decodeFailures = 0;
  model.refresh();
  EXPECT_EQ(model.trouble(), "31 lost");
}

TEST(StatusModel, CountsTheGapsThatALostManagerLeft) {
  Status status;
  StatusModel model([&] { return status; });
  status.interruptions = 1;
  model.refresh();
  EXPECT_EQ(model.trouble(), "1 gap");
  status.interruptions = 2;
  status.decodeFailures = 3;
  model.refresh();
  EXPECT_EQ(model.trouble(), "2 gaps · 3 not decoded");
}

TEST(StatusModel, SaysWhatATableWaitsFor) {
  Status status;
  status.problem = "no such file";
  StatusModel model([&] { return status; });
  EXPECT_TRUE(model.waiting().contains("not connected"));
  EXPECT_TRUE(model.waiting().contains("no such file"));
  status.connected = true;
  model.refresh();
  EXPECT_TRUE(model.waiting().contains("has not sent any event yet"));
  status.events = 1;
  model.refresh();
  EXPECT_EQ(model.waiting(), "The modem has not reported these values yet. They appear here with their first report.");
}

TEST(StatusModel, WithoutAProviderTheSourceIsUnknown) {
  const StatusModel model({});
  EXPECT_EQ(model.kind(), "Unknown source");
}

}  // namespace
}  // namespace vespscope::test
