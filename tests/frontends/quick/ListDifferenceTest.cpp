// Turning one list into another by few edits.
#include <random>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frontends/quick/ListDifference.h"

namespace vespscope::test {
namespace {

std::vector<quick::Edit> between(const std::string& before, const std::string& now) {
  return quick::differenceOf(before.size(), now.size(),
                             [&](std::size_t i, std::size_t j) { return before[i] == now[j]; });
}

std::string applied(std::string text, const std::string& now, const std::vector<quick::Edit>& edits) {
  for (const quick::Edit& edit : edits) {
    if (edit.kind == quick::Edit::Kind::remove) {
      text.erase(edit.at, edit.count);
    } else {
      text.insert(edit.at, now.substr(edit.from, edit.count));
    }
  }
  return text;
}

using quick::Edit;
using Kind = Edit::Kind;

TEST(ListDifference, EqualListsNeedNoEdit) {
  EXPECT_TRUE(between("abc", "abc").empty());
  EXPECT_TRUE(between("", "").empty());
}

TEST(ListDifference, ARunOfNewItemsIsOneInsertion) {
  EXPECT_THAT(between("ad", "abcd"), ::testing::ElementsAre(Edit{Kind::insert, 1, 2, 1}));
  EXPECT_THAT(between("", "ab"), ::testing::ElementsAre(Edit{Kind::insert, 0, 2, 0}));
}

TEST(ListDifference, ARunOfLostItemsIsOneRemoval) {
  EXPECT_THAT(between("abcd", "ad"), ::testing::ElementsAre(Edit{Kind::remove, 1, 2, 0}));
  EXPECT_THAT(between("ab", ""), ::testing::ElementsAre(Edit{Kind::remove, 0, 2, 0}));
}

TEST(ListDifference, WhatStaysInTheMiddleIsLeftAlone) {
  EXPECT_THAT(between("abXcd", "efXgh"),
              ::testing::ElementsAre(Edit{Kind::remove, 0, 2, 0}, Edit{Kind::insert, 0, 2, 0},
                                     Edit{Kind::remove, 3, 2, 0}, Edit{Kind::insert, 3, 2, 3}));
}

TEST(ListDifference, AMiddleTooLargeToCompareIsReplaced) {
  const std::string before(1500, 'a');
  const std::string now = std::string(1500, 'b');
  EXPECT_THAT(between(before, now),
              ::testing::ElementsAre(Edit{Kind::remove, 0, 1500, 0}, Edit{Kind::insert, 0, 1500, 0}));
}

TEST(ListDifference, AnyListTurnsIntoAnyOther) {
  std::mt19937 random(7);
  const auto list = [&] {
    std::string items(random() % 12, ' ');
    for (char& item : items) item = static_cast<char>('a' + random() % 4);
    return items;
  };
  for (int round = 0; round < 5000; ++round) {
    const std::string before = list();
    const std::string now = list();
    EXPECT_EQ(applied(before, now, between(before, now)), now) << before << " to " << now;
  }
}

}  // namespace
}  // namespace vespscope::test
