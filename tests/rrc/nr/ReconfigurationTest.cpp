// The cell groups of an NR reconfiguration, read from literal bytes: separate, of a channel and inside one of LTE.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/lte/Reconfiguration.h"
#include "rrc/nr/Reconfiguration.h"

namespace vespscope::test {
namespace {

using namespace rrc::nr;
using ::testing::ElementsAre;

void expectSecondaryGroup(const std::optional<Reconfiguration>& reconfiguration) {
  ASSERT_TRUE(reconfiguration && reconfiguration->secondary);
  EXPECT_FALSE(reconfiguration->master);
  const CellGroup& group = *reconfiguration->secondary;
  EXPECT_EQ(group.id, 1);
  ASSERT_TRUE(group.main);
  EXPECT_EQ(group.main->physicalCell, 321);
  EXPECT_EQ(group.main->synchronisationBlock, 641280U);
  EXPECT_EQ(group.main->pointA, 640000U);
  EXPECT_THAT(group.main->bands, ElementsAre(78, 77));
  EXPECT_EQ(group.main->bandwidth, 273);
  EXPECT_EQ(group.main->carrierSpacing, 30);
  EXPECT_EQ(group.main->spacing, 30);
  EXPECT_EQ(group.cRnti, 0xC0DE);
  ASSERT_EQ(group.added.size(), 1U);
  EXPECT_EQ(group.added[0].index, 2);
  EXPECT_EQ(group.added[0].cell.physicalCell, 7);
  EXPECT_EQ(group.added[0].cell.synchronisationBlock, 2079427U);
  EXPECT_EQ(group.added[0].cell.carrierSpacing, 120);
  EXPECT_FALSE(group.added[0].cell.spacing);
  EXPECT_THAT(group.released, ElementsAre(5));
}

TEST(ReconfigurationOfNr, ReadsTheSecondaryGroup) {
  const ReadMessage message("nr-reconfiguration");
  expectSecondaryGroup(reconfigurationOf(*message));
}

TEST(ReconfigurationOfNr, ReadsTheMasterGroupOfAChannel) {
  const ReadMessage message("nr-reconfiguration-dcch");
  const auto reconfiguration = reconfigurationOf(*message);
  ASSERT_TRUE(reconfiguration && reconfiguration->master);
  EXPECT_FALSE(reconfiguration->secondary);
  EXPECT_EQ(reconfiguration->master->id, 0);
  EXPECT_FALSE(reconfiguration->master->main);
  EXPECT_THAT(reconfiguration->master->released, ElementsAre(1));
}

TEST(ReconfigurationOfNr, IsReadInsideOneOfLte) {
  const ReadMessage message("recon-nr");
  const auto reconfiguration = rrc::lte::reconfigurationOf(*message);
  ASSERT_TRUE(reconfiguration);
  EXPECT_FALSE(reconfiguration->nrReleased);
  expectSecondaryGroup(reconfigurationOf(reconfiguration->nrConfiguration));
  const ReadMessage released("recon-nr-release");
  EXPECT_TRUE(rrc::lte::reconfigurationOf(*released)->nrReleased);
  EXPECT_FALSE(rrc::lte::reconfigurationOf(*released)->nrConfiguration);
}

}  // namespace
}  // namespace vespscope::test
