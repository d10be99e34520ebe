// The master information block of NR, read from literal bytes.
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/nr/MasterInformation.h"

namespace vespscope::test {
namespace {

using namespace rrc::nr;

TEST(MasterInformationOfNr, ReadsTheBlock) {
  const ReadMessage message("nr-mib");
  const auto block = masterInformationOf(*message);
  ASSERT_TRUE(block);
  EXPECT_EQ(block->frameNumber, 0b101010);
  EXPECT_TRUE(block->wideSpacing);
  EXPECT_EQ(block->subcarrierOffset, 6);
  EXPECT_EQ(block->controlResourceSet, 12);
  EXPECT_EQ(block->searchSpace, 4);
  EXPECT_FALSE(block->barred);
  EXPECT_TRUE(block->intraFrequencyReselection);
}

TEST(MasterInformationOfNr, IsNotOneOfLte) {
  const ReadMessage message("mib");
  EXPECT_FALSE(masterInformationOf(*message));
}

}  // namespace
}  // namespace vespscope::test
