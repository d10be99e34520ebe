// The header of the window: where the data comes from and how current it is.
#include <QStringList>
#include <algorithm>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class StatusBar : public FakeWindow, public ::testing::WithParamInterface<Fit> {
 protected:
  // What the header shows, from left to right.
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
  // The header's texts stand in it without touching each other, and only names are shortened.
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

TEST_F(StatusBar, TheHeaderNamesTheSourceAndTheLastEvent) {
  status_.kind = SourceKind::recorded;
  status_.source = "drive.pcap";
  status_.connected = true;
  status_.lastEvent = std::chrono::system_clock::now() - std::chrono::seconds(75);
  Hand hand(fake_.application, phone);
  const auto bars = Hand::itemsOfType(hand.window()->contentItem(), "StatusBar");
  ASSERT_EQ(bars.size(), 1U);
  EXPECT_EQ(QAccessible::queryAccessibleInterface(bars.front())->text(QAccessible::Name),
            "Recording drive.pcap, connected, last event 1 min ago");
}

TEST_F(StatusBar, TheHeaderKeepsTheAgeOfTheLastEventWhileTheConnectionIsMadeAnew) {
  status_.kind = SourceKind::live;
  status_.lastEvent = std::chrono::system_clock::now() - std::chrono::seconds(75);
  Hand hand(fake_.application, smallPhone);
  EXPECT_EQ(headerTexts(hand), (QStringList{"Live modem", "reconnecting · 1 min ago"}));
}

TEST_F(StatusBar, TheHeaderTellsOfLostAndUndecodedEvents) {
  status_.kind = SourceKind::live;
  status_.source = "ttyUSB0";
  status_.connected = true;
  status_.lastEvent = std::chrono::system_clock::now();
  Hand hand(fake_.application, wide);
  EXPECT_EQ(headerTexts(hand), (QStringList{"Live modem", "ttyUSB0", "0 events · 0.0 per second", "now"}));
  status_.eventsLost = 12;
  status_.decodeFailures = 3;
  EXPECT_TRUE(Hand::until([&] { return headerTexts(hand).contains("12 lost · 3 not decoded"); }));
  EXPECT_TRUE(QAccessible::queryAccessibleInterface(header(hand))
                  ->text(QAccessible::Name)
                  .endsWith(", 12 lost · 3 not decoded"));
}

TEST_P(StatusBar, TheHeaderHasRoomForTrouble) {
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
  hand.main().status().refresh();
  hand.settle();
  checkHeader(hand);
}

INSTANTIATE_TEST_SUITE_P(Sizes, StatusBar, fits, nameOfFit);

}  // namespace
}  // namespace vespscope::test
