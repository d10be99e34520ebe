// The header of the window: the source of the data and how current it is.
#include <QColor>
#include <QStringList>
#include <algorithm>
#include <chrono>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

class StatusBar : public FakeWindow, public ::testing::WithParamInterface<Fit> {
 protected:
  // The texts of the header, from left to right.
  static QStringList headerTexts(Hand& hand) {
    auto texts = Hand::itemsWhere(header(hand), [](QQuickItem* item) {
      return item->inherits("QQuickText") && !item->property("text").toString().isEmpty();
    });
    std::sort(texts.begin(), texts.end(), [](const QQuickItem* one, const QQuickItem* other) {
      return Hand::placeOf(one).x() < Hand::placeOf(other).x();
    });
    QStringList words;
    for (const QQuickItem* text : texts) words << text->property("text").toString();
    return words;
  }
  // The header's texts are inside it and do not overlap, and only names are shortened.
  static void checkHeader(Hand& hand) {
    std::vector<QRectF> texts;
    for (QQuickItem* text :
         Hand::itemsWhere(header(hand), [](QQuickItem* each) { return each->inherits("QQuickText"); })) {
      const QRectF place = Hand::placeOf(text);
      const auto words = text->property("text").toString().toStdString();
      EXPECT_TRUE(Hand::placeOf(header(hand)).contains(place)) << words;
      EXPECT_LE(text->property("contentWidth").toDouble(), text->width() + 1) << words;
      for (const QRectF& other : texts) EXPECT_FALSE(other.intersects(place)) << words;
      texts.push_back(place);
    }
  }
};

TEST_F(StatusBar, NamesThePlaybackAndItsPositionToScreenReaders) {
  status_.kind = SourceKind::recorded;
  status_.source = "drive.pcap";
  status_.connected = true;
  status_.playback = PlaybackPosition{97s, 123s, 1'453'002'134s, 1, false};
  Hand hand(fake_.application, phone);
  EXPECT_EQ(QAccessible::queryAccessibleInterface(header(hand))->text(QAccessible::Name),
            "Playback drive.pcap, 03:42:14 · 01:37/02:03");
  EXPECT_TRUE(headerTexts(hand).contains("03:42:14 · 01:37/02:03"));
}

TEST_F(StatusBar, KeepsTheAgeOfTheLastEventWhileReconnecting) {
  status_.kind = SourceKind::live;
  status_.everConnected = true;
  status_.lastEvent = std::chrono::system_clock::now() - 75s;
  Hand hand(fake_.application, smallPhone);
  EXPECT_EQ(headerTexts(hand), (QStringList{"Live modem", "reconnecting · 1 min ago"}));
}

TEST_F(StatusBar, SaysWhyThereIsNoManager) {
  status_.problem = "no such file";
  Hand hand(fake_.application, smallPhone);
  EXPECT_TRUE(headerTexts(hand).contains("no manager"));
  EXPECT_TRUE(headerTexts(hand).contains("no such file"));
  EXPECT_FALSE(headerTexts(hand).contains("reconnecting"));
}

TEST_F(StatusBar, SaysWhyNothingIsSubscribed) {
  status_.kind = SourceKind::live;
  status_.connected = true;
  status_.notSubscribed = "the manager has no configuration";
  Hand hand(fake_.application, phone);
  EXPECT_TRUE(headerTexts(hand).contains("connected, not subscribed"));
  EXPECT_TRUE(headerTexts(hand).contains("the manager has no configuration"));
}

TEST_F(StatusBar, ShowsTheWholeNameOfASourceInTrouble) {
  status_.kind = SourceKind::live;
  status_.source = "ModemManager is unreachable (no system bus: No such file or directory)";
  status_.connected = true;
  Hand hand(fake_.application, smallPhone);
  checkHeader(hand);
  const auto texts = Hand::itemsWhere(header(hand), [&](QQuickItem* item) {
    return item->property("text").toString().toStdString() == status_.source;
  });
  ASSERT_EQ(texts.size(), 1U);
  EXPECT_FALSE(texts.front()->property("truncated").toBool());
}

TEST_F(StatusBar, IsGreenForALiveModemAlone) {
  status_.connected = true;
  status_.lastEvent = std::chrono::system_clock::now();
  Hand hand(fake_.application, phone);
  QColor live;
  for (const SourceKind kind : {SourceKind::live, SourceKind::recorded, SourceKind::simulated, SourceKind::unknown}) {
    status_.kind = kind;
    status_.lastEvent = std::chrono::system_clock::now();
    hand.main().status().refresh();
    const QColor tone = header(hand)->property("tone").value<QColor>();
    if (kind == SourceKind::live) live = tone;
    EXPECT_EQ(tone == live, kind == SourceKind::live) << wordOf(kind);
    EXPECT_EQ(tone.green() > tone.red() && tone.green() > tone.blue(), kind == SourceKind::live) << wordOf(kind);
  }
}

TEST_F(StatusBar, CountsLostEventsAndDecodeFailures) {
  status_.kind = SourceKind::live;
  status_.source = "ttyUSB0";
  status_.connected = true;
  status_.lastEvent = std::chrono::system_clock::now();
  Hand hand(fake_.application, wide);
  EXPECT_EQ(headerTexts(hand), (QStringList{"Live modem", "ttyUSB0", "0 events · 0.0 per second", "now"}));
  status_.eventsLost = 12;
  status_.decodeFailures = 3;
  EXPECT_TRUE(Hand::until([&] { return headerTexts(hand).contains("3 decode failures · 12 lost"); }));
  EXPECT_TRUE(QAccessible::queryAccessibleInterface(header(hand))
                  ->text(QAccessible::Name)
                  .endsWith(", 3 decode failures · 12 lost"));
}

TEST_P(StatusBar, HasRoomForEverything) {
  const auto& [size, scale] = GetParam();
  status_.kind = SourceKind::simulated;
  status_.source = "scenario seed=1234567890,speed=10,loop";
  status_.events = 12'345'678;
  status_.lastEvent = std::chrono::system_clock::now() - std::chrono::minutes(59);
  status_.eventsLost = 1'234'567;
  status_.decodeFailures = 765'432;
  Hand hand(fake_.application, size);
  hand.main().appearance().setTextScale(scale);
  hand.settle();
  checkHeader(hand);
  status_.connected = true;
  status_.notSubscribed = "the manager knows none of the configuration's messages: no subscription is possible";
  hand.main().status().refresh();
  hand.settle();
  checkHeader(hand);
  status_.notSubscribed.clear();
  status_.kind = SourceKind::recorded;
  status_.playback = PlaybackPosition{3h, 3h, 1'453'002'134s, 1000, true};
  hand.main().status().refresh();
  hand.settle();
  checkHeader(hand);
}

INSTANTIATE_TEST_SUITE_P(Sizes, StatusBar, fits, nameOfFit);

}  // namespace
}  // namespace vespscope::test
