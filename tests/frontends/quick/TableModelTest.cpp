// A table screen as a list model: lines, filter, marks and the minimal changes of a reload.
#include <QAbstractItemModelTester>
#include <QClipboard>
#include <QGuiApplication>
#include <QSignalSpy>
#include <QTest>
#include <chrono>

#include <gtest/gtest.h>

#include "frontends/quick/TableModel.h"
#include "frontends/terminal/FakeScreens.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

class TableModel : public ::testing::Test {
 protected:
  TableModel() {
    screen_->setTitle("Cells");
    screen_->table = {{valueSection("Cell 1", {{"id", "7"}, {"power", "-90"}}),
                       valueSection("Cell 2", {{"id", "8"}, {"power", "-95"}})}};
    model_ = std::make_unique<quick::TableModel>(screen_);
    tester_ =
        std::make_unique<QAbstractItemModelTester>(model_.get(), QAbstractItemModelTester::FailureReportingMode::Fatal);
  }

  // "Cell 1|id=7*|…": the lines, with a star for those marked as changed.
  [[nodiscard]] std::string lines() const {
    std::string text;
    for (int row = 0; row < model_->rowCount(); ++row) {
      const QModelIndex index = model_->index(row);
      if (row > 0) text += '|';
      text += model_->data(index, quick::TableModel::label).toString().toStdString();
      if (model_->data(index, quick::TableModel::hasValue).toBool()) {
        text += '=' + model_->data(index, quick::TableModel::value).toString().toStdString();
      }
      if (model_->data(index, quick::TableModel::changed).toBool()) text += '*';
    }
    return text;
  }
  [[nodiscard]] bool flag(int row, quick::TableModel::Role role) const {
    return model_->data(model_->index(row), role).toBool();
  }
  void show(application::TableSnapshot table) {
    screen_->show(std::move(table));
    model_->refreshIfAsked();
  }

  std::shared_ptr<FakeScreen> screen_ = std::make_shared<FakeScreen>();
  std::unique_ptr<quick::TableModel> model_;
  std::unique_ptr<QAbstractItemModelTester> tester_;
};

TEST_F(TableModel, HoldsHeadersAndRowsInOrderWithoutMarks) {
  EXPECT_EQ(lines(), "Cell 1|id=7|power=-90|Cell 2|id=8|power=-95");
  EXPECT_TRUE(flag(0, quick::TableModel::header));
  EXPECT_FALSE(flag(1, quick::TableModel::header));
  EXPECT_TRUE(flag(1, quick::TableModel::first));
  EXPECT_FALSE(flag(1, quick::TableModel::last));
  EXPECT_TRUE(flag(2, quick::TableModel::last));
}

TEST_F(TableModel, SectionsWithoutHeadersStandApart) {
  show({{valueSection({}, {{"id", "1"}}), valueSection({}, {{"id", "2"}})}});
  EXPECT_EQ(model_->rowCount(), 2);
  EXPECT_FALSE(flag(0, quick::TableModel::apart));
  EXPECT_TRUE(flag(1, quick::TableModel::apart));
}

TEST_F(TableModel, ReadsItsScreenAgainOnlyWhenAsked) {
  screen_->table.sections[0].rows[0].value = "70";
  model_->refreshIfAsked();
  EXPECT_EQ(lines(), "Cell 1|id=7|power=-90|Cell 2|id=8|power=-95");
  screen_->tableView().reloadData();
  model_->refreshIfAsked();
  EXPECT_EQ(lines(), "Cell 1|id=70*|power=-90|Cell 2|id=8|power=-95");
}

TEST_F(TableModel, ANewValueIsOneDataChangeAndAMarkThatGoesAway) {
  QSignalSpy changes(model_.get(), &quick::TableModel::dataChanged);
  QSignalSpy inserted(model_.get(), &quick::TableModel::rowsInserted);
  QSignalSpy removed(model_.get(), &quick::TableModel::rowsRemoved);
  auto table = screen_->table;
  table.sections[1].rows[1].value = "-99";
  show(table);
  ASSERT_EQ(changes.size(), 1);
  EXPECT_EQ(changes[0][0].toModelIndex().row(), 5);
  EXPECT_EQ(changes[0][1].toModelIndex().row(), 5);
  EXPECT_EQ(inserted.size() + removed.size(), 0);
  EXPECT_EQ(lines(), "Cell 1|id=7|power=-90|Cell 2|id=8|power=-99*");
  EXPECT_TRUE(QTest::qWaitFor([&] { return lines() == "Cell 1|id=7|power=-90|Cell 2|id=8|power=-99"; }));
}

TEST_F(TableModel, AnEqualTableChangesNothing) {
  QSignalSpy changes(model_.get(), &quick::TableModel::dataChanged);
  show(screen_->table);
  EXPECT_EQ(changes.size(), 0);
}

TEST_F(TableModel, ASectionMoreIsInsertedAndMarked) {
  QSignalSpy inserted(model_.get(), &quick::TableModel::rowsInserted);
  QSignalSpy removed(model_.get(), &quick::TableModel::rowsRemoved);
  auto table = screen_->table;
  table.sections.push_back(valueSection("Cell 3", {{"id", "9"}}));
  show(table);
  ASSERT_EQ(inserted.size(), 1);
  EXPECT_EQ(inserted[0][1].toInt(), 6);
  EXPECT_EQ(inserted[0][2].toInt(), 7);
  EXPECT_EQ(removed.size(), 0);
  EXPECT_EQ(lines(), "Cell 1|id=7|power=-90|Cell 2|id=8|power=-95|Cell 3|id=9*");
}

TEST_F(TableModel, ASectionLessIsRemoved) {
  QSignalSpy inserted(model_.get(), &quick::TableModel::rowsInserted);
  QSignalSpy removed(model_.get(), &quick::TableModel::rowsRemoved);
  auto table = screen_->table;
  table.sections.pop_back();
  show(table);
  ASSERT_EQ(removed.size(), 1);
  EXPECT_EQ(inserted.size(), 0);
  EXPECT_EQ(lines(), "Cell 1|id=7|power=-90");
}

TEST_F(TableModel, RowsOfOneLabelAreDistinguishedByTheirOrder) {
  show({{valueSection({}, {{"cell", "1"}, {"cell", "2"}})}});
  show({{valueSection({}, {{"cell", "1"}, {"cell", "3"}})}});
  EXPECT_TRUE(QTest::qWaitFor([&] { return lines() == "cell=1|cell=3"; }));
}

TEST_F(TableModel, TheFilterFindsLabelsValuesAndHeadersInAnyCase) {
  model_->setFilter("POW");
  EXPECT_EQ(lines(), "Cell 1|power=-90|Cell 2|power=-95");
  EXPECT_TRUE(flag(1, quick::TableModel::first) && flag(1, quick::TableModel::last));
  model_->setFilter("95");
  EXPECT_EQ(lines(), "Cell 2|power=-95");
  model_->setFilter("cell 1");
  EXPECT_EQ(lines(), "Cell 1|id=7|power=-90");
  model_->setFilter("nothing");
  EXPECT_EQ(lines(), "");
  EXPECT_TRUE(model_->filtered());
  model_->setFilter("");
  EXPECT_EQ(lines(), "Cell 1|id=7|power=-90|Cell 2|id=8|power=-95");
}

TEST_F(TableModel, TheFilterStaysAcrossReloads) {
  model_->setFilter("95");
  auto table = screen_->table;
  table.sections[0].rows[1].value = "-950";
  show(table);
  EXPECT_EQ(lines(), "Cell 1|power=-950*|Cell 2|power=-95");
}

TEST_F(TableModel, WhatIsExpandedStaysAcrossReloadsAndFilters) {
  model_->toggleExpanded(4);
  model_->setFilter("power");
  model_->setFilter("");
  auto table = screen_->table;
  table.sections[1].rows[0].value = "80";
  table.sections[0].rows.pop_back();
  show(table);
  EXPECT_EQ(lines(), "Cell 1|id=7|Cell 2|id=80*|power=-95");
  EXPECT_TRUE(flag(3, quick::TableModel::expanded));
  EXPECT_FALSE(flag(1, quick::TableModel::expanded));
}

TEST_F(TableModel, AHeaderDoesNotExpand) {
  model_->toggleExpanded(0);
  EXPECT_FALSE(flag(0, quick::TableModel::expanded));
}

TEST_F(TableModel, OneRowAtMostIsMarkedAsOpened) {
  model_->setOpened(1);
  model_->setOpened(4);
  EXPECT_FALSE(flag(1, quick::TableModel::opened));
  EXPECT_TRUE(flag(4, quick::TableModel::opened));
  model_->setOpened(-1);
  EXPECT_FALSE(flag(4, quick::TableModel::opened));
}

TEST_F(TableModel, StepsPassHeadersAndHoldAtTheEnds) {
  EXPECT_EQ(model_->rowFrom(-1, 1), 1);
  EXPECT_EQ(model_->rowFrom(2, 1), 4);
  EXPECT_EQ(model_->rowFrom(4, -1), 2);
  EXPECT_EQ(model_->rowFrom(1, -1), 1);
  EXPECT_EQ(model_->rowFrom(5, 1), 5);
  EXPECT_EQ(model_->rowFrom(1, 100), 5);
  EXPECT_EQ(model_->rowFrom(-1, -1), 5);
  model_->setFilter("nothing");
  EXPECT_EQ(model_->rowFrom(-1, 1), -1);
}

TEST_F(TableModel, CopiesOneRowOrTheWholeScreenAsText) {
  EXPECT_EQ(model_->copyRow(2), "Copied “power”");
  EXPECT_EQ(QGuiApplication::clipboard()->text(), "power: -90");
  EXPECT_EQ(model_->copyAll(), "Copied 4 rows");
  EXPECT_EQ(QGuiApplication::clipboard()->text(), "Cells\n\nCell 1\nid: 7\npower: -90\n\nCell 2\nid: 8\npower: -95\n");
  EXPECT_EQ(model_->copyRow(99), "");
}

TEST_F(TableModel, GivesTheAgeOfItsScreenAndMarksAnOldOne) {
  application::ScreenAge age;
  quick::TableModel model(screen_, [&age](const application::ViewController&) { return age; });
  EXPECT_EQ(model.age(), "");
  EXPECT_FALSE(model.reported());
  age = {3s, true, false};
  model.refreshAge();
  EXPECT_EQ(model.age(), "updated 3 s ago");
  EXPECT_TRUE(model.reported());
  EXPECT_FALSE(model.outdated());
  age = {16s, true, false};
  model.refreshAge();
  EXPECT_TRUE(model.outdated());
  age = {240s, true, true};
  model.refreshAge();
  EXPECT_EQ(model.age(), "last known, 4 min ago");
  EXPECT_TRUE(model.outdated());
}

TEST_F(TableModel, OfAScreenWithoutReportsHasNoAge) { EXPECT_EQ(model_->age(), ""); }

}  // namespace
}  // namespace vespscope::test
