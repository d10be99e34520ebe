// One screen's page: its title, its filter, and copying from it.
#include <QFont>
#include <QJSValue>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

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

TEST_F(TablePage, ATitleThatHasToShrinkStandsInTheMiddleOfItsBar) {
  QString words = "Title";
  std::vector<std::string> rows;
  for (const char* word : {" with", " more", " and", " more", " words", " that", " fill", " it"}) {
    words += word;
    rows.push_back(words.toStdString());
  }
  fake_.root->table = testing::leadingRows(rows);
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
  fake_.root->table = testing::leadingRows(names);
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

INSTANTIATE_TEST_SUITE_P(Sizes, TablePage, fits, nameOfFit);

}  // namespace
}  // namespace vespscope::test
