// The events that a client's queue keeps.
#include <chrono>
#include <memory>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/DeliveryQueue.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

class DeliveryQueue : public testing::Test {
 protected:
  static manager::SharedEvent event(std::size_t bytes) {
    return std::make_shared<const MetricEvent>(MetricEvent{1, 0, Bytes(bytes), 0ms});
  }
  static std::vector<std::uint64_t> drain(manager::DeliveryQueue& queue) {
    std::vector<std::uint64_t> sequences;
    while (const auto next = queue.take()) sequences.push_back(next->sequence);
    return sequences;
  }
};

TEST_F(DeliveryQueue, NumbersEventsFromOne) {
  manager::DeliveryQueue queue;
  queue.push(event(1));
  queue.push(event(1));
  EXPECT_THAT(drain(queue), ElementsAre(1, 2));
  queue.push(event(1));
  EXPECT_THAT(drain(queue), ElementsAre(3));
  EXPECT_TRUE(queue.empty());
  EXPECT_EQ(queue.bytes(), 0U);
}

TEST_F(DeliveryQueue, TooManyEventsCostTheOldestAndShowAsAGap) {
  manager::DeliveryQueue queue(manager::DeliveryQueue::Bounds{3, 1000});
  for (int count = 0; count < 5; ++count) queue.push(event(1));
  EXPECT_EQ(queue.lost(), 2U);
  EXPECT_EQ(queue.size(), 3U);
  EXPECT_THAT(drain(queue), ElementsAre(3, 4, 5));
}

TEST_F(DeliveryQueue, TooManyBytesCostTheOldestAndTheNewestStays) {
  manager::DeliveryQueue queue(manager::DeliveryQueue::Bounds{100, 10});
  queue.push(event(4));
  queue.push(event(4));
  queue.push(event(4));
  EXPECT_EQ(queue.bytes(), 8U);
  queue.push(event(50));
  EXPECT_EQ(queue.size(), 1U);
  EXPECT_EQ(queue.lost(), 3U);
  EXPECT_THAT(drain(queue), ElementsAre(4));
}

TEST_F(DeliveryQueue, HoldsAsManyEventsAndBytesAsItsUsualBounds) {
  constexpr manager::DeliveryQueue::Bounds usual;
  manager::DeliveryQueue events(usual);
  for (std::size_t count = 0; count < usual.events; ++count) events.push(event(1));
  EXPECT_EQ(events.lost(), 0U);
  events.push(event(1));
  EXPECT_EQ(events.lost(), 1U);
  EXPECT_EQ(events.size(), usual.events);
  manager::DeliveryQueue bytes(usual);
  for (int count = 0; count < 2; ++count) bytes.push(event(usual.bytes / 2));
  EXPECT_EQ(bytes.lost(), 0U);
  EXPECT_EQ(bytes.bytes(), usual.bytes);
  bytes.push(event(1));
  EXPECT_EQ(bytes.lost(), 1U);
}

TEST_F(DeliveryQueue, WhatIsClearedLeavesNoGap) {
  manager::DeliveryQueue queue(manager::DeliveryQueue::Bounds{3, 1000});
  for (int count = 0; count < 4; ++count) queue.push(event(1));
  ASSERT_TRUE(queue.take().has_value());
  queue.clear();
  EXPECT_TRUE(queue.empty());
  EXPECT_EQ(queue.bytes(), 0U);
  queue.push(event(1));
  EXPECT_THAT(drain(queue), ElementsAre(3));
}

}  // namespace
}  // namespace vespscope::test
