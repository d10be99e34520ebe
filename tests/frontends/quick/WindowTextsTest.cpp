// The texts around the tables: the source's state, the log, and what the desktop prefers.
#include <QClipboard>
#include <QDBusVariant>
#include <QGuiApplication>
#include <QSignalSpy>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <regex>
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include "frontends/quick/Appearance.h"
#include "frontends/quick/LogModel.h"
#include "frontends/quick/StatusModel.h"
#include "platform/log/Log.h"

namespace vespscope::quick {
namespace {

using namespace std::chrono_literals;
using application::Status;

TEST(AgeText, GrowsFromNowToDays) {
  EXPECT_EQ(ageText(-5s), "now");
  EXPECT_EQ(ageText(999ms), "now");
  EXPECT_EQ(ageText(1s), "1 s ago");
  EXPECT_EQ(ageText(59s), "59 s ago");
  EXPECT_EQ(ageText(60s), "1 min ago");
  EXPECT_EQ(ageText(1h), "1 h ago");
  EXPECT_EQ(ageText(49h), "2 d ago");
}

// Text that looks like markup is otherwise shown as such, and could load pictures from anywhere.
TEST(TheWindow, ShowsPlainTextAlone) {
  const std::regex element("\\b(Text|TextEdit|TextArea|Label) \\{");
  const std::regex plain("textFormat: (Text|TextEdit)\\.PlainText");
  const auto count = [](const std::string& text, const std::regex& wanted) {
    return std::distance(std::sregex_iterator(text.begin(), text.end(), wanted), {});
  };
  std::ptrdiff_t all = 0;
  for (const auto& file : std::filesystem::directory_iterator(VESPSCOPE_SOURCE_DIR "/src/frontends/quick/qml")) {
    std::ifstream stream(file.path());
    const std::string text(std::istreambuf_iterator<char>(stream), {});
    EXPECT_EQ(count(text, element), count(text, plain)) << file.path();
    all += count(text, element);
  }
  EXPECT_GE(all, 15);
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

class LogList : public ::testing::Test {
 protected:
  [[nodiscard]] QString text(int row) const { return model_.data(model_.index(row), LogModel::text).toString(); }

  LogModel model_;
};

TEST_F(LogList, TakesOverLinesOfBothChannelsInOrderWhenLookedAt) {
  log::print("first");
  log::system("second");
  EXPECT_EQ(model_.count(), 0);
  model_.setWatched(true);
  ASSERT_EQ(model_.count(), 2);
  EXPECT_EQ(text(0), "first");
  EXPECT_EQ(text(1), "second");
  EXPECT_TRUE(model_.data(model_.index(1), LogModel::isSystem).toBool());
}

TEST_F(LogList, TakesLinesFromOtherThreads) {
  std::thread([] { log::print("from elsewhere"); }).join();
  model_.takeOver();
  ASSERT_EQ(model_.count(), 1);
  EXPECT_EQ(text(0), "from elsewhere");
}

TEST_F(LogList, KeepsTheLatestLinesOnly) {
  for (std::size_t line = 0; line < LogModel::capacity + 10; ++line) log::print("line " + std::to_string(line));
  model_.takeOver();
  ASSERT_EQ(model_.count(), static_cast<int>(LogModel::capacity));
  EXPECT_EQ(text(0), "line 10");
  log::print("one more");
  model_.takeOver();
  EXPECT_EQ(model_.count(), static_cast<int>(LogModel::capacity));
  EXPECT_EQ(text(0), "line 11");
  EXPECT_EQ(text(model_.count() - 1), "one more");
}

TEST_F(LogList, CopiesItsLines) {
  log::print("a line");
  model_.takeOver();
  EXPECT_EQ(model_.copyAll(), "Copied 1 line");
  EXPECT_TRUE(QGuiApplication::clipboard()->text().endsWith(" a line"));
}

class DesktopSettings : public ::testing::Test {
 protected:
  void colours(uint preference) {
    appearance_.settingChanged("org.freedesktop.appearance", "color-scheme",
                               QVariant::fromValue(QDBusVariant(QVariant::fromValue(QDBusVariant(preference)))));
  }

  Appearance appearance_;
};

TEST_F(DesktopSettings, DarkAndLightFollowTheDesktop) {
  EXPECT_FALSE(appearance_.dark());
  QSignalSpy changes(&appearance_, &Appearance::changed);
  colours(1);
  EXPECT_TRUE(appearance_.dark());
  EXPECT_EQ(changes.size(), 1);
  colours(2);
  EXPECT_FALSE(appearance_.dark());
  colours(0);
  EXPECT_FALSE(appearance_.dark());
}

TEST_F(DesktopSettings, TheUsersChoiceStandsAboveTheDesktops) {
  appearance_.setMode(Appearance::Mode::Light);
  colours(1);
  EXPECT_FALSE(appearance_.dark());
  appearance_.setMode(Appearance::Mode::System);
  EXPECT_TRUE(appearance_.dark());
  appearance_.toggle();
  EXPECT_FALSE(appearance_.dark());
}

TEST_F(DesktopSettings, TheTextSizeFollowsUntilTheUserChangesIt) {
  const auto scale = [&](double factor) {
    appearance_.settingChanged("org.gnome.desktop.interface", "text-scaling-factor", factor);
  };
  scale(1.5);
  EXPECT_EQ(appearance_.textScale(), 1.5);
  appearance_.zoom(1);
  EXPECT_EQ(appearance_.textScale(), 1.625);
  scale(1.25);
  EXPECT_EQ(appearance_.textScale(), 1.625);
  appearance_.zoom(0);
  EXPECT_EQ(appearance_.textScale(), 1.25);
  for (int steps = 0; steps < 20; ++steps) appearance_.zoom(1);
  EXPECT_EQ(appearance_.textScale(), Appearance::largestTextScale);
}

TEST_F(DesktopSettings, NonsenseIsPassedOver) {
  appearance_.settingChanged("org.gnome.desktop.interface", "text-scaling-factor", "large");
  appearance_.settingChanged("org.gnome.desktop.interface", "text-scaling-factor", -1.0);
  appearance_.settingChanged("org.gnome.desktop.interface", "gtk-theme", "dark");
  EXPECT_EQ(appearance_.textScale(), 1);
  EXPECT_FALSE(appearance_.dark());
}

}  // namespace
}  // namespace vespscope::quick
