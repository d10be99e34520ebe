// The line with the source of the data and its state.
#include <algorithm>
#include <cctype>
#include <clocale>
#include <cstdlib>

#include <gtest/gtest.h>

#include "frontends/terminal/StatusLine.h"

namespace vespscope::test {
namespace {

using namespace terminal;
using application::Status;
using namespace std::chrono_literals;

const std::chrono::system_clock::time_point now{1'700'000'000s};  // 22:13:20 UTC

class StatusLine : public ::testing::Test {
 protected:
  void SetUp() override {
    ::setenv("TZ", "UTC", 1);
    ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr);
    status.kind = SourceKind::simulated;
    status.source = "scenario seed=1";
    status.connected = true;
    status.events = 1234;
    status.eventsPerSecond = 12.4;
    status.lastEvent = now - 3s;
  }

  [[nodiscard]] std::string text(int width, bool utf8 = true) const {
    std::string joined;
    for (const StatusPart& part : statusParts(status, now, width, utf8)) joined += part.text;
    return joined;
  }

  Status status;
};

TEST_F(StatusLine, WithRoomItSaysEverythingInWords) {
  EXPECT_EQ(
      text(120),
      "SIMULATED scenario seed=1 · connected · 12 events/s · 1234 events · 0 decode failures · last 22:13:17, 3 s ago");
}

TEST_F(StatusLine, AtEightyCellsItIsShorter) {
  EXPECT_EQ(text(97), "SIMULATED scenario seed=1 · connected · 12/s · 1234 events · 0 decode failures · 22:13:17 3s");
  EXPECT_EQ(text(80), "SIMULATED scenario seed=1 · connected · 12/s · 0 decode failures · 22:13:17 3s");
  EXPECT_EQ(text(79), "SIMULATED scenario seed=1 · connected · 12/s · 22:13:17 3s");
}

TEST_F(StatusLine, NumbersThatGrowALittleTakeNothingAway) {
  const auto shape = [this] {
    std::string kept;
    for (const char character : text(97)) {
      if (std::isdigit(static_cast<unsigned char>(character)) == 0 && character != '.') kept += character;
    }
    return kept;
  };
  const std::string before = shape();
  status.events = 98'765;
  status.eventsPerSecond = 4.25;
  status.lastEvent = now - 58s;
  EXPECT_EQ(shape(), before);
}

TEST_F(StatusLine, AtFortyCellsTheEssentialsStay) { EXPECT_EQ(text(40), "SIMULATED · 12/s · 22:13:17 3s"); }

TEST_F(StatusLine, NamesTheSimCardOfSeveralAtEveryWidth) {
  status.sims = {2, {1}};
  EXPECT_EQ(text(120),
            "SIMULATED scenario seed=1 · SIM 2 (also SIM 1) · connected · 12/s · 1234 events · 0 decode failures "
            "· 22:13:17 3s");
  for (int width = 40; width <= 200; ++width) {
    EXPECT_NE(text(width).find("SIM 2"), std::string::npos) << width;
    EXPECT_LE(widthOf(text(width), true), width);
  }
  status.sims = {2, {}};
  EXPECT_EQ(text(120).find("SIM 2"), std::string::npos) << "one card needs no name";
}

TEST_F(StatusLine, WithoutUtf8ItIsAscii) {
  EXPECT_EQ(text(97, false),
            "SIMULATED scenario seed=1 | connected | 12/s | 1234 events | 0 decode failures | 22:13:17 3s");
}

TEST_F(StatusLine, ItFitsAnyWidthFromFortyOn) {
  for (int width = 40; width <= 200; ++width) EXPECT_LE(widthOf(text(width), true), width);
}

TEST_F(StatusLine, EveryKindOfSourceIsNamed) {
  status.kind = SourceKind::live;
  EXPECT_EQ(text(120).substr(0, 5), "LIVE ");
  status.kind = SourceKind::recorded;
  EXPECT_EQ(text(120).substr(0, 9), "PLAYBACK ");
  status.kind = SourceKind::unknown;
  EXPECT_EQ(text(120).substr(0, 15), "SOURCE UNKNOWN ");
}

TEST_F(StatusLine, TheKindOfSourceStaysInWhateverRoom) {
  status.connected = false;
  status.decodeFailures = 1'000'000;
  status.eventsLost = 1'000'000;
  for (const int width : {1, 10, 20, 40}) EXPECT_EQ(text(width).substr(0, 9), "SIMULATED") << width;
}

TEST_F(StatusLine, AMissingConnectionIsAWarningAndStays) {
  status.connected = false;
  status.everConnected = true;
  EXPECT_NE(text(40).find("reconnecting"), std::string::npos);
  bool warned = false;
  for (const StatusPart& part : statusParts(status, now, 80, true)) {
    warned |= part.text == "reconnecting" && part.role == Role::warning;
  }
  EXPECT_TRUE(warned);
}

TEST_F(StatusLine, AManagerThatNeverAnsweredIsNotReconnecting) {
  status.connected = false;
  status.problem = "no such file";
  EXPECT_NE(text(80).find("no manager"), std::string::npos);
  EXPECT_EQ(text(200).find("reconnecting"), std::string::npos);
}

TEST_F(StatusLine, LostEventsAreNamedOnlyWhenThereAreSome) {
  EXPECT_EQ(text(200).find("lost"), std::string::npos);
  status.eventsLost = 7;
  const auto parts = statusParts(status, now, 200, true);
  const auto lost = std::find_if(parts.begin(), parts.end(), [](const auto& part) { return part.text == "7 lost"; });
  ASSERT_NE(lost, parts.end());
  EXPECT_EQ(lost->role, Role::warning);
}

TEST_F(StatusLine, TheGapsThatALostManagerLeftAreCounted) {
  EXPECT_EQ(text(200).find("gap"), std::string::npos);
  status.interruptions = 1;
  EXPECT_NE(text(200).find(" 1 gap "), std::string::npos) << text(200);
  status.interruptions = 2;
  EXPECT_NE(text(200).find(" 2 gaps "), std::string::npos) << text(200);
}

TEST_F(StatusLine, DecodeFailuresAreAWarningOnlyWhenThereAreSome) {
  const auto roleOf = [this](const std::string& wanted) {
    for (const StatusPart& part : statusParts(status, now, 200, true)) {
      if (part.text == wanted) return part.role;
    }
    ADD_FAILURE() << wanted << " is missing";
    return Role::text;
  };
  EXPECT_EQ(roleOf("0 decode failures"), Role::text);
  status.decodeFailures = 2;
  EXPECT_EQ(roleOf("2 decode failures"), Role::warning);
}

TEST_F(StatusLine, BeforeTheFirstEventItSaysSo) {
  status.lastEvent.reset();
  EXPECT_NE(text(120).find("no event yet"), std::string::npos);
}

TEST_F(StatusLine, InPlaybackItShowsTheRecordingsClockAndPositionAndNoAge) {
  status.kind = SourceKind::recorded;
  status.source = "lte-ca-drive.mi2log";
  status.playback.emplace();
  status.playback->position = 97s;
  status.playback->length = 123s;
  status.playback->clock = 1'453'002'134s;
  EXPECT_EQ(text(140),
            "PLAYBACK lte-ca-drive.mi2log · connected · 12 events/s · 1234 events · 0 decode failures · "
            "2016-01-17 03:42:14 · 01:37/02:03");
  EXPECT_EQ(text(80), "PLAYBACK lte-ca-drive.mi2log · connected · 12/s · 03:42:14 · 01:37/02:03");
  EXPECT_EQ(text(40), "PLAYBACK  12/s  03:42:14  01:37/02:03");
  for (int width = 40; width <= 200; ++width) {
    EXPECT_LE(widthOf(text(width), true), width);
    EXPECT_EQ(text(width).find("ago"), std::string::npos);
  }
}

TEST_F(StatusLine, AtTheEndOfARecordingItSaysSoInsteadOfARate) {
  status.kind = SourceKind::recorded;
  status.source = "lte-ca-drive.mi2log";
  status.eventsPerSecond = 0;
  status.playback.emplace();
  status.playback->position = 123s;
  status.playback->length = 123s;
  status.playback->clock = 1'453'002'160s;
  status.playback->ended = true;
  EXPECT_EQ(text(80), "PLAYBACK lte-ca-drive.mi2log · end of recording · 03:42:40 · 02:03/02:03");
  EXPECT_EQ(text(40), "PLAYBACK  end of recording  02:03/02:03");
}

TEST_F(StatusLine, AMissingSubscriptionIsAWarningWithItsReason) {
  status.notSubscribed = "the manager has no configuration of this client";
  EXPECT_NE(text(170).find("connected, not subscribed (the manager has no configuration of this client)"),
            std::string::npos)
      << text(170);
  EXPECT_NE(text(40).find("connected, not subscribed"), std::string::npos) << text(40);
  const auto parts = statusParts(status, now, 80, true);
  EXPECT_TRUE(std::any_of(parts.begin(), parts.end(), [](const auto& part) {
    return part.text == "connected, not subscribed" && part.role == Role::warning;
  }));
}

TEST_F(StatusLine, LowRatesHaveATenth) {
  status.eventsPerSecond = 0.24;
  EXPECT_NE(text(200).find(" 0.2 events/s"), std::string::npos);
  status.eventsPerSecond = 5;
  EXPECT_NE(text(200).find(" 5.0 events/s"), std::string::npos);
  status.eventsPerSecond = 9.96;
  EXPECT_NE(text(200).find(" 10 events/s"), std::string::npos);
  status.eventsPerSecond = 0;
  EXPECT_NE(text(200).find(" 0 events/s"), std::string::npos);
}

TEST_F(StatusLine, ALongSourceIsCutBeforeOtherPartsGo) {
  status.source = std::string(100, 'x');
  const std::string line = text(80);
  EXPECT_NE(line.find("…"), std::string::npos);
  EXPECT_NE(line.find("connected"), std::string::npos);
}

TEST_F(StatusLine, ASourceCannotBringControlCharacters) {
  status.source = "evil\x1b[2J";
  Grid grid({80, 1}, true);
  drawStatus(grid, 0, status, now);
  EXPECT_EQ(grid.text().find('\x1b'), std::string::npos);
  EXPECT_NE(grid.text().find("evil␛[2J"), std::string::npos);
}

}  // namespace
}  // namespace vespscope::test
