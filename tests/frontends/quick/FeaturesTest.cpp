// What the window offers around its tables: filter, copying, log, menu, text size, marks, names for screen readers.
#include <QAccessible>
#include <QClipboard>
#include <QFont>
#include <QGuiApplication>
#include <QJSValue>
#include <QTest>
#include <set>

#include <gtest/gtest.h>

#include "frontends/quick/Hand.h"
#include "frontends/terminal/FakeScreens.h"
#include "platform/log/Log.h"

namespace vespscope {
namespace {

using testing::Hand;
using testing::leadingRows;
using testing::valueSection;

constexpr QSize phone(360, 720);
constexpr QSize small(320, 568);
constexpr QSize wide(1280, 800);

class Features : public testing::WindowTest {
 protected:
  Features() {
    fake_.root->table = leadingRows({"Red", "Green", "Blue"});
    fake_.detail->table = {{valueSection("Light 1", {{"wavelength", "532"}, {"unit", "nm"}}),
                            valueSection("Light 2", {{"wavelength", "633"}, {"unit", "nm"}})}};
    fake_.application.status = [this] { return status_; };
  }

  static QString clipboard() { return QGuiApplication::clipboard()->text(); }
  static QString toast(Hand& hand) {
    const auto shown = Hand::itemsOfType(hand.window()->contentItem(), "Toast");
    return shown.empty() ? QString() : QAccessible::queryAccessibleInterface(shown.front())->text(QAccessible::Name);
  }
  static QQuickItem* header(Hand& hand) { return Hand::itemsOfType(hand.window()->contentItem(), "StatusBar").front(); }
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
  // The part of `place` that differs from the colour in its corner.
  static QRectF inked(const QImage& image, QRect place) {
    QRect ink;
    for (int y = place.top(); y <= place.bottom(); ++y) {
      for (int x = place.left(); x <= place.right(); ++x) {
        if (image.pixel(x, y) != image.pixel(place.topLeft())) ink |= QRect(x, y, 1, 1);
      }
    }
    return ink;
  }
  // Opens the menu, which lies in the window's overlay, and clicks a choice.
  static void choose(Hand& hand, const QString& choice) {
    hand.click(hand.button("Menu"));
    ASSERT_TRUE(Hand::until([&] { return hand.button(choice) != nullptr; })) << choice.toStdString();
    hand.click(hand.button(choice));
  }

  application::Status status_;
  testing::FakeApplication fake_;
};

TEST_F(Features, TheFilterOpensByKeyAndShowsMatchingRowsOnly) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.key(Qt::Key_F, Qt::ControlModifier);
  hand.type("63");
  EXPECT_EQ(hand.line("Light 1"), nullptr);
  EXPECT_NE(hand.line("Light 2"), nullptr);
  EXPECT_EQ(hand.lines(hand.page()).size(), 2U);
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), 1);
  hand.key(Qt::Key_F, Qt::ControlModifier);
  hand.key(Qt::Key_Escape);
  EXPECT_EQ(hand.lines(hand.page()).size(), 6U);
  EXPECT_EQ(hand.depth(), 2) << "escape closed the filter only";
}

TEST_F(Features, AFilterThatMatchesNothingSaysSo) {
  Hand hand(fake_.application, phone);
  hand.click(hand.button("Filter rows"));
  hand.type("xyz");
  const auto empty = Hand::itemsOfType(hand.page(), "EmptyState");
  ASSERT_EQ(empty.size(), 1U);
  EXPECT_EQ(empty.front()->property("title").toString(), "No row contains “xyz”");
  hand.click(hand.button("Close the filter"));
  EXPECT_EQ(hand.lines(hand.page()).size(), 3U);
}

TEST_F(Features, KeysCopyOneRowOrTheWholeScreen) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.key(Qt::Key_Down);
  hand.key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(clipboard(), "wavelength: 532");
  EXPECT_TRUE(Hand::until([&] { return toast(hand) == "Copied “wavelength”"; }));
  hand.key(Qt::Key_C, Qt::ControlModifier | Qt::ShiftModifier);
  EXPECT_EQ(clipboard(), "Green\n\nLight 1\nwavelength: 532\nunit: nm\n\nLight 2\nwavelength: 633\nunit: nm\n");
  EXPECT_TRUE(Hand::until([&] { return toast(hand) == "Copied 4 rows"; }));
}

TEST_F(Features, ALongTouchCopiesItsRow) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  const QPoint point = Hand::placeOf(hand.line("unit")).center().toPoint();
  QTest::mousePress(hand.window(), Qt::LeftButton, Qt::NoModifier, point);
  EXPECT_TRUE(Hand::until([] { return clipboard() == "unit: nm"; }));
  QTest::mouseRelease(hand.window(), Qt::LeftButton, Qt::NoModifier, point);
  hand.settle();
  EXPECT_FALSE(hand.line("unit")->property("expanded").toBool());
}

TEST_F(Features, TheTextOfAnExpandedRowIsSelectedByTheMouse) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.click(hand.line("wavelength"));
  const auto editors = Hand::itemsWhere(hand.page(), [](QQuickItem* item) { return item->inherits("QQuickTextEdit"); });
  ASSERT_EQ(editors.size(), 1U);
  const QRectF place = Hand::placeOf(editors.front());
  const QPoint begin(static_cast<int>(place.left()) + 1, static_cast<int>(place.center().y()));
  QTest::mousePress(hand.window(), Qt::LeftButton, Qt::NoModifier, begin);
  for (int step = 1; step <= 10; ++step) QTest::mouseMove(hand.window(), begin + QPoint(step * 10, 0));
  QTest::mouseRelease(hand.window(), Qt::LeftButton, Qt::NoModifier, begin + QPoint(100, 0));
  EXPECT_EQ(editors.front()->property("selectedText").toString(), "532");
  hand.key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(clipboard(), "532");
}

TEST_F(Features, TheMenuCopiesTheScreenAndChangesTheLook) {
  Hand hand(fake_.application, phone);
  choose(hand, "Copy all rows");
  EXPECT_EQ(clipboard(), "vespscope\n\nRed\nGreen\nBlue\n");
  choose(hand, "Dark");
  EXPECT_EQ(hand.main().appearance().mode(), quick::Appearance::Mode::Dark);
  choose(hand, "Light");
  EXPECT_EQ(hand.main().appearance().mode(), quick::Appearance::Mode::Light);
  choose(hand, "Follow the system");
  EXPECT_EQ(hand.main().appearance().mode(), quick::Appearance::Mode::System);
  choose(hand, "Larger text");
  EXPECT_EQ(hand.main().appearance().textScale(), 1.125);
}

TEST_F(Features, TheLogShowsLinesOpensByKeyAndCloses) {
  Hand hand(fake_.application, phone);
  log::print("something happened");
  hand.key(Qt::Key_L, Qt::ControlModifier);
  ASSERT_EQ(Hand::itemsOfType(hand.window()->contentItem(), "LogPage").size(), 1U);
  EXPECT_EQ(hand.main().log().count(), 1);
  hand.key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_TRUE(clipboard().endsWith("something happened"));
  hand.key(Qt::Key_Escape);
  EXPECT_TRUE(Hand::itemsOfType(hand.window()->contentItem(), "LogPage").empty());
  EXPECT_FALSE(hand.main().log().watched());
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), 0) << "the keys are back at the screen";
}

TEST_F(Features, TheHeaderNamesTheSourceAndTheLastEvent) {
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

TEST_F(Features, TheHeaderKeepsTheAgeOfTheLastEventWhileTheConnectionIsMadeAnew) {
  status_.kind = SourceKind::live;
  status_.lastEvent = std::chrono::system_clock::now() - std::chrono::seconds(75);
  Hand hand(fake_.application, small);
  EXPECT_EQ(headerTexts(hand), (QStringList{"Live modem", "reconnecting · 1 min ago"}));
}

TEST_F(Features, TheHeaderTellsOfLostAndUndecodedEvents) {
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

TEST_F(Features, ATitleThatHasToShrinkStandsInTheMiddleOfItsBar) {
  QString words = "Title";
  std::vector<std::string> rows;
  for (const char* word : {" with", " more", " and", " more", " words", " that", " fill", " it"}) {
    words += word;
    rows.push_back(words.toStdString());
  }
  fake_.root->table = leadingRows(rows);
  Hand hand(fake_.application, phone);
  int shrunk = 0;
  for (const std::string& row : rows) {
    hand.click(hand.line(QString::fromStdString(row)));
    ASSERT_EQ(hand.title(), row);
    const auto titles = Hand::itemsWhere(hand.page(), [&](QQuickItem* item) {
      return item->inherits("QQuickText") && item->property("text").toString().toStdString() == row;
    });
    ASSERT_GE(titles.size(), 1U);
    const int wanted = titles.front()->property("font").value<QFont>().pixelSize();
    const int used = titles.front()->property("fontInfo").value<QJSValue>().property("pixelSize").toInt();
    shrunk += used < wanted ? 1 : 0;
    const QRect place = Hand::placeOf(titles.front()).toAlignedRect();
    EXPECT_NEAR(inked(hand.window()->grabWindow(), place).center().y(), Hand::placeOf(hand.button("Back")).center().y(),
                3)
        << row << ", drawn with " << used << " px";
    hand.click(hand.button("Back"));
  }
  EXPECT_GT(shrunk, 0);
}

// Sizes and text scales under which everything has to work.
class Fits : public Features, public ::testing::WithParamInterface<std::tuple<QSize, double>> {
 protected:
  static void checkTargets(Hand& hand) {
    const QRectF all(QPointF(0, 0), hand.window()->size());
    for (QQuickItem* item : Hand::itemsWhere(hand.window()->contentItem(), [](QQuickItem* each) {
           return each->inherits("QQuickAbstractButton") ||
                  (Hand::isOfType(each, "TableLine") && !each->property("header").toBool());
         })) {
      const QRectF place = Hand::placeOf(item);
      if (!place.intersects(all)) continue;
      const auto name = item->property("text").toString() + item->property("label").toString();
      EXPECT_GE(place.width(), 44) << name.toStdString();
      EXPECT_GE(place.height(), 44) << name.toStdString();
      EXPECT_GE(place.left(), 0) << name.toStdString();
      EXPECT_LE(place.right(), all.right()) << name.toStdString();
    }
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
  // No text of a page is cut off at its side or by another one.
  static void checkTexts(Hand& hand) {
    for (QQuickItem* line : hand.lines(hand.page())) {
      const QRectF place = Hand::placeOf(line);
      std::vector<QRectF> texts;
      for (QQuickItem* text : Hand::itemsWhere(line, [](QQuickItem* each) { return each->inherits("QQuickText"); })) {
        EXPECT_FALSE(text->property("truncated").toBool());
        EXPECT_LE(text->property("contentWidth").toDouble(), text->width() + 1);
        EXPECT_TRUE(place.contains(Hand::placeOf(text))) << text->property("text").toString().toStdString();
        for (const QRectF& other : texts) EXPECT_FALSE(other.intersects(Hand::placeOf(text)));
        texts.push_back(Hand::placeOf(text));
      }
    }
  }
};

TEST_P(Fits, TheHeaderHasRoomForTrouble) {
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

TEST_P(Fits, EveryTargetIsLargeEnoughAndEveryTextHasItsPlace) {
  const auto& [size, scale] = GetParam();
  fake_.detail->table.sections[0].rows.push_back(
      {"a_long_label_that_names_something_rare", "ANOTHER_LONG_VALUE", false});
  fake_.detail->table.sections[0].rows.push_back({"list", std::string(400, 'w'), false});
  fake_.detail->table.sections[0].rows.push_back(
      {"words", "[[plmn: <00 f1 10>, tac: 4711], [plmn: <00 f1 10>]]", false});
  Hand hand(fake_.application, size);
  hand.main().appearance().setTextScale(scale);
  hand.settle();
  checkTargets(hand);
  checkTexts(hand);
  hand.click(hand.line("Green"));
  checkTargets(hand);
  checkTexts(hand);
  hand.key(Qt::Key_F, Qt::ControlModifier);
  checkTargets(hand);
  hand.key(Qt::Key_Escape);
  hand.click(hand.line("unit"));
  checkTargets(hand);
  hand.key(Qt::Key_L, Qt::ControlModifier);
  checkTargets(hand);
}

TEST_P(Fits, TitlesAreReadWhole) {
  const auto& [size, scale] = GetParam();
  const std::vector<std::string> names = {"Sel Resel Parameters", "EUTRA Neighbor Info", "LTE Neighbor Cell Meas",
                                          "Connected Serv Cell Meas"};
  fake_.root->table = leadingRows(names);
  Hand hand(fake_.application, size);
  hand.main().appearance().setTextScale(scale);
  hand.settle();
  for (const std::string& name : names) {
    hand.click(hand.line(hand.pages().front(), QString::fromStdString(name)));
    ASSERT_EQ(hand.title(), name);
    for (QQuickItem* text : Hand::itemsWhere(hand.page(), [&](QQuickItem* item) {
           return item->inherits("QQuickText") && item->property("text").toString().toStdString() == name;
         })) {
      EXPECT_FALSE(text->property("truncated").toBool()) << name;
    }
    hand.key(Qt::Key_Escape);
  }
}

std::string nameOf(const ::testing::TestParamInfo<std::tuple<QSize, double>>& fit) {
  const QSize size = std::get<0>(fit.param);
  return std::to_string(size.width()) + "x" + std::to_string(size.height()) +
         (std::get<1>(fit.param) > 1 ? "Large" : "");
}

INSTANTIATE_TEST_SUITE_P(Sizes, Fits,
                         ::testing::Combine(::testing::Values(small, phone, QSize(720, 360), wide),
                                            ::testing::Values(1.0, 1.5)),
                         nameOf);

TEST_F(Features, ScreenReadersGetANameForEverythingThatCanBeUsed) {
  Hand hand(fake_.application, wide);
  hand.click(hand.line("Green"));
  hand.key(Qt::Key_F, Qt::ControlModifier);
  for (QQuickItem* item : Hand::itemsWhere(hand.window()->contentItem(), [](QQuickItem* each) {
         return each->inherits("QQuickAbstractButton") || Hand::isOfType(each, "TableLine") ||
                each->inherits("QQuickTextInput") || each->inherits("QQuickListView");
       })) {
    QAccessibleInterface* reader = QAccessible::queryAccessibleInterface(item);
    ASSERT_NE(reader, nullptr) << item->metaObject()->className();
    EXPECT_FALSE(reader->text(QAccessible::Name).isEmpty()) << item->metaObject()->className();
  }
}

TEST_F(Features, ScreenReadersReadRowsAndOpenThem) {
  Hand hand(fake_.application, phone);
  QAccessibleInterface* row = QAccessible::queryAccessibleInterface(hand.line("Green"));
  EXPECT_EQ(row->role(), QAccessible::ListItem);
  EXPECT_EQ(row->text(QAccessible::Name), "Green");
  row->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
  hand.settle();
  ASSERT_EQ(hand.title(), "Green");
  EXPECT_EQ(QAccessible::queryAccessibleInterface(hand.line("wavelength"))->text(QAccessible::Name), "wavelength, 532");
}

TEST_F(Features, RowsGrowWithTheirText) {
  fake_.detail->table = {{valueSection({}, {{"short", "1"}, {"long", std::string(300, 'm')}})}};
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  EXPECT_GT(hand.line("long")->height(), 3 * hand.line("short")->height());
}

TEST_F(Features, AReloadKeepsThePlaceAndTheSelectionWhenSectionsComeAndGo) {
  application::TableSnapshot many;
  for (int section = 1; section <= 60; ++section) {
    many.sections.push_back(valueSection("Light " + std::to_string(section), {{"number", std::to_string(section)}}));
  }
  fake_.detail->table = many;
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  for (int steps = 0; steps < 31; ++steps) hand.key(Qt::Key_Down);
  ASSERT_NE(hand.line("Light 31"), nullptr);
  const double place = Hand::placeOf(hand.line("Light 31")).y();
  many.sections.pop_back();
  many.sections[3].rows.push_back({"extra", "value", false});
  fake_.detail->show(many);
  hand.main().navigation().refresh();
  hand.settle();
  ASSERT_NE(hand.line("Light 31"), nullptr);
  EXPECT_NEAR(Hand::placeOf(hand.line("Light 31")).y(), place, 1);
  hand.key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(clipboard(), "number: 31");
}

}  // namespace
}  // namespace vespscope
