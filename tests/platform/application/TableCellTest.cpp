// Cells made of prototypes.
#include <gtest/gtest.h>

#include "platform/application/TableCell.h"
#include "platform/application/TableViewController.h"

namespace vespscope::test {
namespace {

using namespace application;

TEST(TableCellPrototypes, ABasicPrototypeGivesOneLabelWithoutText) {
  const auto cell = makeCell({"Row", CellStyle::basic, true, "next"});
  EXPECT_EQ(cell->reuseIdentifier, "Row");
  EXPECT_TRUE(cell->disclosure);
  EXPECT_EQ(cell->segueTo, "next");
  ASSERT_TRUE(cell->textLabel);
  EXPECT_FALSE(cell->textLabel->text);
  EXPECT_FALSE(cell->detailTextLabel);
}

TEST(TableCellPrototypes, AValuePrototypeGivesTwoLabelsWithoutText) {
  const auto cell = makeCell({"Row", CellStyle::value, false, ""});
  ASSERT_TRUE(cell->textLabel && cell->detailTextLabel);
  EXPECT_FALSE(cell->textLabel->text);
  EXPECT_FALSE(cell->detailTextLabel->text);
}

TEST(TableCellPrototypes, AnUnknownIdentifierIsAProgrammingError) {
  TableView table;
  table.registerPrototype({"Row", CellStyle::basic, false, ""});
  EXPECT_EQ(table.dequeueReusableCell("Row", {})->reuseIdentifier, "Row");
  EXPECT_DEATH((void)table.dequeueReusableCell("row", {}), "fatal: no cell prototype \"row\"");
}

}  // namespace
}  // namespace vespscope::test
