// Only the application number two is accepted.
#include <gtest/gtest.h>

#include "shell/AppIDValidator.h"

namespace vespscope::test {
namespace {

TEST(AppIDValidator, IsCreatedWithItsDefaults) {
  const AppIDValidator validator;
  EXPECT_EQ(validator.myAppID, 2);
  EXPECT_EQ(validator.appIDKey, "kKeyAppID");
  EXPECT_FALSE(validator.appID);
}

TEST(AppIDValidator, TakesTheNumberTwo) {
  AppIDValidator validator;
  EXPECT_TRUE(validator.check({{"kKeyAppID", std::int64_t{2}}}));
  EXPECT_EQ(validator.appID, 2);
}

TEST(AppIDValidator, RefusesTheTextTwoAndForgetsTheLastNumber) {
  AppIDValidator validator;
  validator.appID = 2;
  EXPECT_FALSE(validator.check({{"kKeyAppID", "2"}}));
  EXPECT_FALSE(validator.appID);
}

TEST(AppIDValidator, KeepsAnotherNumberButRefusesIt) {
  AppIDValidator validator;
  EXPECT_FALSE(validator.check({{"kKeyAppID", 3}}));
  EXPECT_EQ(validator.appID, 3);
}

TEST(AppIDValidator, RefusesADictionaryWithoutTheKey) {
  AppIDValidator validator;
  EXPECT_FALSE(validator.check({{"kkeyAppID", 2}, {"AppID", 2}}));
  EXPECT_FALSE(validator.appID);
}

TEST(AppIDValidator, ABooleanAndAFractionAreNoNumbersOfAnApplication) {
  AppIDValidator validator;
  EXPECT_FALSE(validator.check({{"kKeyAppID", true}}));
  EXPECT_FALSE(validator.check({{"kKeyAppID", 2.0}}));
  EXPECT_FALSE(validator.appID);
}

}  // namespace
}  // namespace vespscope::test
