// The end of a connection, read from literal bytes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/lte/Release.h"

namespace vespscope::test {
namespace {

using namespace rrc::lte;
using ::testing::ElementsAre;
using Technology = Redirection::Technology;

TEST(Release, ReadsTheCauseAlone) {
  const ReadMessage message("release");
  const auto release = releaseOf(*message);
  ASSERT_TRUE(release);
  EXPECT_EQ(release->cause, "other");
  EXPECT_FALSE(release->redirection);
  EXPECT_FALSE(release->priorities);
}

TEST(Release, ReadsARedirectionToGsm) {
  const ReadMessage message("release-geran");
  const auto release = releaseOf(*message);
  ASSERT_TRUE(release && release->redirection);
  EXPECT_EQ(release->cause, "cs-FallbackHighPriority-v1020");
  EXPECT_EQ(release->redirection->technology, Technology::gsm);
  EXPECT_EQ(release->redirection->gsmCarriers, (GsmCarriers{false, {20}}));
}

TEST(Release, ReadsPriorities) {
  const ReadMessage message("release-geran");
  const auto release = releaseOf(*message);
  ASSERT_TRUE(release && release->priorities);
  const DedicatedPriorities& priorities = *release->priorities;
  ASSERT_EQ(priorities.lte.size(), 3U);
  EXPECT_EQ(priorities.lte[0].carrier, 66436U);
  EXPECT_EQ(priorities.lte[0].priority, 7);
  EXPECT_EQ(priorities.lte[1].carrier, 300U);
  EXPECT_EQ(priorities.lte[1].priority, 5);
  EXPECT_EQ(priorities.lte[2].carrier, 66999U);
  EXPECT_EQ(priorities.lte[2].priority, 2);
  ASSERT_EQ(priorities.gsm.size(), 1U);
  EXPECT_EQ(priorities.gsm[0].carriers, (GsmCarriers{true, {1}}));
  EXPECT_EQ(priorities.gsm[0].priority, 0);
  ASSERT_EQ(priorities.umtsFdd.size(), 1U);
  EXPECT_EQ(priorities.umtsFdd[0].carrier, 10588U);
  EXPECT_EQ(priorities.umtsFdd[0].priority, 3);
  ASSERT_EQ(priorities.nr.size(), 1U);
  EXPECT_EQ(priorities.nr[0].carrier, 641280U);
  EXPECT_EQ(priorities.nr[0].priority, 6);
  EXPECT_EQ(priorities.validity, 30);
}

TEST(Release, ReadsALargeChannelFromTheLateExtension) {
  const ReadMessage message("release-eutra");
  const auto release = releaseOf(*message);
  ASSERT_TRUE(release && release->redirection);
  EXPECT_EQ(release->cause, "loadBalancingTAUrequired");
  EXPECT_EQ(release->redirection->technology, Technology::lte);
  EXPECT_THAT(release->redirection->carriers, ElementsAre(66536U));
}

TEST(Release, ReadsARedirectionToNr) {
  const ReadMessage message("release-nr");
  const auto release = releaseOf(*message);
  ASSERT_TRUE(release && release->redirection);
  EXPECT_EQ(release->redirection->technology, Technology::nr);
  EXPECT_THAT(release->redirection->carriers, ElementsAre(620000U));
}

}  // namespace
}  // namespace vespscope::test
