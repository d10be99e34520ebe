// Configurations that the manager accepts, activates and stores, and its answers.
#include "CoreTesting.h"

namespace vespscope::test {
namespace {

class ConfigurationBook : public CoreTesting {};

TEST_F(ConfigurationBook, ARefusedConfigurationLeavesTheOneBefore) {
  const auto peer = listener(rrcStateOnly);
  const Reply reply = add(peer, "[metrics]\nK_NOISE = { period_ms = 1 }\n");
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::badConfiguration));
  EXPECT_EQ(reply.message, "the configuration is refused: line 2: there is no metric K_NOISE");
  control->deliver(rrcState, {0x10, 1});
  EXPECT_THAT(taken(peer), ElementsAre(rrcState));
}

TEST_F(ConfigurationBook, AnEmptyPayloadIsRefused) {
  const Reply reply = add(addPeer(), "");
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::badConfiguration));
  EXPECT_EQ(reply.message, "the configuration is refused: the configuration is empty");
}

TEST_F(ConfigurationBook, ClearingWhatWasNotThereSucceeds) {
  EXPECT_EQ(ask(addPeer(), rhox::kCommandClearConfiguration, applicationRequest()).status, 0);
}

TEST_F(ConfigurationBook, HasNoMoreConfigurationsThanItCanKeep) {
  const auto peer = addPeer();
  for (std::int64_t application = 1; application <= 64; ++application) {
    EXPECT_EQ(add(peer, rrcStateOnly, application).status, 0);
  }
  const Reply refused = add(peer, rrcStateOnly, 65);
  EXPECT_EQ(refused.status, static_cast<std::int32_t>(manager::CommandStatus::tooManyApplications));
  EXPECT_THAT(refused.message, HasSubstr("too many applications have a configuration: 64"));
  EXPECT_EQ(add(peer, everyChange, 64).status, 0);  // it may replace its own
  EXPECT_EQ(ask(peer, rhox::kCommandClearConfiguration, applicationRequest(3)).status, 0);
  EXPECT_EQ(add(peer, rrcStateOnly, 65).status, 0);
}

TEST_F(ConfigurationBook, HasWhatWasKeptAfterARestart) {
  restartWithStore();
  const Peer peer = addPeer();
  EXPECT_EQ(add(peer, rrcStateOnly, 2).status, 0);
  EXPECT_EQ(add(peer, everyChange, -5).status, 0);
  EXPECT_EQ(add(peer, everyChange, 7).status, 0);
  EXPECT_EQ(ask(peer, rhox::kCommandClearConfiguration, applicationRequest(7)).status, 0);
  EXPECT_NE(add(peer, "nonsense", 2).status, 0);
  restartWithStore();
  EXPECT_TRUE(isConfigured(2));
  EXPECT_TRUE(isConfigured(-5));
  EXPECT_FALSE(isConfigured(7));
}

TEST_F(ConfigurationBook, AnswersOnceTheDiskHasTheConfiguration) {
  restartWithStore();
  const std::string file = folder / "application-2.deviceconfig";
  const Reply added = add(addPeer(), rrcStateOnly);
  EXPECT_TRUE(std::filesystem::exists(file));
  EXPECT_EQ(added.message, "");
  EXPECT_EQ(ipc::toValue(*added.values.find(rhox::kKeyKept)), Value(true));
  const Reply cleared = ask(addPeer(), rhox::kCommandClearConfiguration, applicationRequest());
  EXPECT_FALSE(std::filesystem::exists(file));
  EXPECT_EQ(ipc::toValue(*cleared.values.find(rhox::kKeyKept)), Value(true));
}

TEST_F(ConfigurationBook, SaysWhenAConfigurationIsActiveButNotKept) {
  restart(manager::ConfigurationStore(folder.write("state", "a file where the folder should be")));
  const LoggedLines lines;
  const std::string file = folder / "state/application-2.deviceconfig";
  const Reply reply = add(addPeer(), rrcStateOnly);
  EXPECT_EQ(reply.status, 0);
  EXPECT_EQ(reply.message,
            "the configuration is active, but could not be saved: cannot write " + file + ": Not a directory");
  EXPECT_EQ(ipc::toValue(*reply.values.find(rhox::kKeyKept)), Value(false));
  EXPECT_THAT(lines.all(), ElementsAre("cannot write " + file + ": Not a directory"));
  EXPECT_TRUE(isConfigured(2));
}

TEST_F(ConfigurationBook, SaysWhenAConfigurationIsClearedButStillKept) {
  std::filesystem::create_directories(folder / "application-2.deviceconfig/occupied");
  restartWithStore();
  const Reply reply = ask(addPeer(), rhox::kCommandClearConfiguration, applicationRequest());
  EXPECT_EQ(reply.status, 0);
  EXPECT_THAT(reply.message, HasSubstr("the configuration is cleared, but could not be deleted: cannot remove "));
  EXPECT_EQ(ipc::toValue(*reply.values.find(rhox::kKeyKept)), Value(false));
}

TEST_F(ConfigurationBook, SaysNothingOfKeepingWhereNothingIsKept) {
  const Reply reply = add(addPeer(), rrcStateOnly);
  EXPECT_EQ(reply.message, "");
  EXPECT_EQ(reply.values.find(rhox::kKeyKept), nullptr);
}

TEST_F(ConfigurationBook, SetsAKeptConfigurationThatIsRefusedAside) {
  std::string deep = "a";
  for (int part = 1; part < 30'000; ++part) deep += ".a";
  const std::string file = folder.write("application-9.deviceconfig", deep + "=1");
  folder.write("application-2.deviceconfig", rrcStateOnly);
  const LoggedLines lines;
  for (int start = 0; start < 2; ++start) {
    restartWithStore();
    EXPECT_TRUE(isConfigured(2));
    EXPECT_FALSE(isConfigured(9));
  }
  EXPECT_THAT(lines.all(),
              ElementsAre("the configuration kept for application 9 is not used: line 1: a key has more than "
                          "8 parts (it is now " +
                          file + ".refused)"));
  EXPECT_FALSE(std::filesystem::exists(file));
  EXPECT_TRUE(std::filesystem::exists(file + ".refused"));
}

TEST_F(ConfigurationBook, LoadsNoMoreConfigurationsThanItsLimit) {
  for (int application = 1; application <= 66; ++application) {
    folder.write("application-" + std::to_string(application) + ".deviceconfig", rrcStateOnly);
  }
  const LoggedLines lines;
  restartWithStore();
  const Reply reply = ask(addPeer(), rhox::kCommandStatus, detailsRequest());
  EXPECT_EQ(reply.values.find(rhox::kKeyConfigurations)->asArray()->size(), 64U);
  EXPECT_THAT(lines.all(),
              ElementsAre("more than 64 configurations are kept: those from application 65 on are not used"));
}

}  // namespace
}  // namespace vespscope::test
