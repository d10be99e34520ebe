// One screen's page: its title, its filter, and copying from it.
#include <QColor>
#include <QFont>
#include <QJSValue>
#include <chrono>
#include <optional>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

class TablePage : public FakeWindow, public ::testing::WithParamInterface<Fit> {
 protected:
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
};

TEST_F(TablePage, TheFilterOpensByKeyAndShowsMatchingRowsOnly) {
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

TEST_F(TablePage, AFilterThatMatchesNothingSaysSo) {
  Hand hand(fake_.application, phone);
  hand.click(hand.button("Filter rows"));
  hand.type("xyz");
  const auto empty = Hand::itemsOfType(hand.page(), "EmptyState");
  ASSERT_EQ(empty.size(), 1U);
  EXPECT_EQ(empty.front()->property("title").toString(), "No row contains “xyz”");
  hand.click(hand.button("Close the filter"));
  EXPECT_EQ(hand.lines(hand.page()).size(), 3U);
}

TEST_F(TablePage, KeysCopyOneRowOrTheWholeScreen) {
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

TEST_F(TablePage, ATitleThatHasToShrinkIsInTheMiddleOfItsBar) {
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

TEST_P(TablePage, TitlesAreReadWhole) {
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

// The page's text about the age of its values; null if there is none.
QQuickItem* ageOf(Hand& hand) {
  const auto found = Hand::itemsWhere(hand.page(), [](QQuickItem* item) {
    const QString text = item->property("text").toString();
    return item->inherits("QQuickText") && (text.startsWith("updated ") || text.startsWith("last known, "));
  });
  return found.empty() ? nullptr : found.front();
}

TEST_P(TablePage, SaysOutsideTheTableHowOldItsValuesAre) {
  const auto& [size, scale] = GetParam();
  application::ScreenAge age{2s, true, false};
  fake_.application.screenAge =
      [&](const application::ViewController& screen) -> std::optional<application::ScreenAge> {
    if (&screen == fake_.root.get()) return std::nullopt;
    return age;
  };
  Hand hand(fake_.application, size);
  hand.main().appearance().setTextScale(scale);
  hand.settle();
  EXPECT_EQ(ageOf(hand), nullptr) << "a list has no age";
  hand.click(hand.line("Green"));
  ASSERT_NE(ageOf(hand), nullptr);
  EXPECT_EQ(ageOf(hand)->property("text").toString(), "updated 2 s ago");
  const QColor current = ageOf(hand)->property("color").value<QColor>();
  EXPECT_LE(Hand::placeOf(ageOf(hand)).bottom(), Hand::placeOf(hand.list()).top());
  age = {240s, true, true};
  EXPECT_TRUE(Hand::until([&] { return ageOf(hand)->property("text").toString() == "last known, 4 min ago"; }));
  EXPECT_NE(ageOf(hand)->property("color").value<QColor>(), current);
  hand.settle();
  EXPECT_FALSE(ageOf(hand)->property("truncated").toBool());
}

TEST_F(TablePage, TheFilterKeepsTheHeaderOfTheSectionThatItFinds) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.type("/");
  hand.type("light 2");
  ASSERT_EQ(hand.lines(hand.page()).size(), 3U) << "a header that matches keeps its rows";
  EXPECT_TRUE(hand.line("Light 2")->property("header").toBool());
}

INSTANTIATE_TEST_SUITE_P(Sizes, TablePage, fits, nameOfFit);

}  // namespace
}  // namespace vespscope::test
