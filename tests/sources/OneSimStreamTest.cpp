// One SIM card out of several in a recording: events of other cards are not delivered.
#include <deque>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"
#include "sources/OneSimStream.h"

namespace vespscope::test {
namespace {

using sources::OneSimStream;
using sources::simCardOfData;
using testing::ElementsAre;

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

std::vector<std::int32_t> simsOf(sources::EventStream& stream) {
  std::vector<std::int32_t> sims;
  while (const auto event = stream.next()) sims.push_back(event->profileID);
  return sims;
}

TEST(OneSimStream, PassesItsCardAndWhatBelongsToNone) {
  OneSimStream stream(std::make_unique<ListedStream>(
                          std::vector<MetricEvent>{eventOf(1), eventOf(2), bearersOf(1), eventOf(0), eventOf(2)}, true),
                      2);
  EXPECT_THAT(simsOf(stream), ElementsAre(2, 0, 2));
  stream.rewind();
  EXPECT_THAT(simsOf(stream), ElementsAre(2, 0, 2));
  EXPECT_EQ(stream.label(), "log");
}

std::optional<std::int32_t> cardOf(std::vector<MetricEvent> events, bool rewinds = true) {
  ListedStream stream(std::move(events), rewinds);
  const auto card = simCardOfData(stream);
  EXPECT_TRUE(stream.next().has_value()) << "rewound";
  return card;
}

TEST(OneSimStreamCardOfData, IsTheFirstOfSeveralWithBearers) {
  EXPECT_EQ(cardOf({eventOf(1), eventOf(2), bearersOf(2), bearersOf(1)}), 2);
  EXPECT_EQ(cardOf({bearersOf(1), eventOf(2)}), 1);
}

TEST(OneSimStreamCardOfData, IsUnknownWithoutBearersOrWithoutAnotherCard) {
  EXPECT_EQ(cardOf({eventOf(2), eventOf(1)}), std::nullopt);
  EXPECT_EQ(cardOf({eventOf(1), bearersOf(1), eventOf(0)}), std::nullopt);
  EXPECT_EQ(cardOf({eventOf(0), bearersOf(0)}), std::nullopt);
}

TEST(OneSimStreamCardOfData, IsUnknownOfAPipe) {
  EXPECT_EQ(cardOf({eventOf(1), eventOf(2), bearersOf(2)}, false), std::nullopt);
}

}  // namespace
}  // namespace vespscope::test
