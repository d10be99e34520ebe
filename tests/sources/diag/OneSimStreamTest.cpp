// The choice of one SIM card of a log: events of other cards are not delivered.
#include <deque>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"
#include "sources/diag/OneSimStream.h"

namespace vespscope::test {
namespace {

using sources::OneSimStream;
using testing::ElementsAre;
using testing::HasSubstr;

class ListedStream final : public sources::EventStream {
 public:
  ListedStream(std::vector<MetricEvent> events, bool rewinds) : events_(std::move(events)), rewinds_(rewinds) {}
  [[nodiscard]] std::string label() const override { return "log"; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  [[nodiscard]] std::optional<MetricEvent> next() override {
    if (next_ == events_.size()) return std::nullopt;
    return events_[next_++];
  }
  [[nodiscard]] bool canRewind() const override { return rewinds_; }
  void rewind() override { next_ = 0; }
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token /*stop*/) override { return std::nullopt; }

 private:
  std::vector<MetricEvent> events_;
  bool rewinds_;
  std::size_t next_ = 0;
};

MetricEvent eventOf(std::int32_t sim) { return {metricIdentifier("K_LTE_RRC_STATE"), sim, {}, {}}; }

MetricEvent bearersOf(std::int32_t sim) {
  KCellularActivatedBearerContexts message;
  message.addBearerContexts(std::make_shared<BearerContext>());
  return {metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), sim, message.encoded(), {}};
}

std::vector<std::int32_t> simsOf(OneSimStream& stream) {
  std::vector<std::int32_t> sims;
  while (const auto event = stream.next()) sims.push_back(event->profileID);
  return sims;
}

OneSimStream streamOf(std::vector<MetricEvent> events, std::optional<std::int32_t> sim = std::nullopt,
                      bool rewinds = true) {
  return {std::make_unique<ListedStream>(std::move(events), rewinds), sim};
}

TEST(OneSimStream, TakesTheCardThatIsAskedFor) {
  auto stream = streamOf({eventOf(1), eventOf(2), bearersOf(1), eventOf(0), eventOf(2)}, 2);
  EXPECT_THAT(simsOf(stream), ElementsAre(2, 0, 2));
  EXPECT_THAT(stream.label(), HasSubstr("SIM 2"));
}

TEST(OneSimStream, PrefersTheCardWithDataBearers) {
  auto stream = streamOf({eventOf(1), eventOf(2), bearersOf(2), eventOf(1)});
  EXPECT_THAT(simsOf(stream), ElementsAre(2, 2));
}

TEST(OneSimStream, TakesTheFirstCardWhereNoneHasBearers) {
  auto stream = streamOf({eventOf(2), eventOf(1), eventOf(2)});
  EXPECT_THAT(simsOf(stream), ElementsAre(2, 2));
}

TEST(OneSimStream, TakesTheFirstCardOfAPipe) {
  auto stream = streamOf({eventOf(1), eventOf(2), bearersOf(2), eventOf(1)}, std::nullopt, false);
  EXPECT_THAT(simsOf(stream), ElementsAre(1, 1));
}

TEST(OneSimStream, LeavesALogOfOneCardAsItIs) {
  auto stream = streamOf({eventOf(0), eventOf(0)});
  EXPECT_THAT(simsOf(stream), ElementsAre(0, 0));
  EXPECT_EQ(stream.label(), "log");
}

}  // namespace
}  // namespace vespscope::test
