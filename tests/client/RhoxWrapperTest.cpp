// The wrapper with a manager that records its calls.
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "client/RhoxWrapper.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "support/Eventually.h"
#include "support/FakeManager.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class RecordingDelegate : public RhoxWrapperDelegate {
 public:
  void eventsDidUpdate(std::shared_ptr<const Record> dictionary) override { take(triggers, dictionary); }
  void metricsDidUpdate(std::shared_ptr<const Record> dictionary) override { take(metrics, dictionary); }

  std::vector<Record> triggers;
  std::vector<Record> metrics;
  std::vector<std::thread::id> threads;

 private:
  void take(std::vector<Record>& list, const std::shared_ptr<const Record>& dictionary) {
    list.push_back(*dictionary);
    threads.push_back(std::this_thread::get_id());
  }
};

class RhoxWrapperSuite : public testing::Test {
 protected:
  RhoxWrapperSuite() {
    log::discardOutputs();
    const auto address = rhox::client::Address::parse(manager.address());
    rhox::client::setAddress(*address);
  }

  // Lines of the system log so far.
  std::vector<std::string> lines() {
    const std::lock_guard lock(mutex_);
    return lines_;
  }

  // Runs the main queue until `condition` holds.
  static bool mainLoopUntil(const std::function<bool()>& condition) {
    return eventually([&condition] {
      dispatch::MainLoop::main().drain();
      return condition();
    });
  }

  TemporaryFolder folder;
  FakeManager manager{folder / "manager"};

 private:
  std::mutex mutex_;
  std::vector<std::string> lines_;
  log::Observation observation_{[this](log::Channel channel, std::string_view line) {
    if (channel != log::Channel::systemLog) return;
    const std::lock_guard lock(mutex_);
    lines_.emplace_back(line);
  }};
};

std::vector<std::string> keysOf(const ipc::Dictionary& request) {
  std::vector<std::string> keys;
  for (const auto& [key, value] : request.entries()) keys.push_back(key);
  return keys;
}

TEST_F(RhoxWrapperSuite, AnIdentifierThatDiffersInCaseOrByATrailingBlankSendsNothing) {
  RhoxWrapper wrapper;
  for (const char* identifier : {"Vespscope", "vespscope ", "VESPSCOPE", ""}) {
    EXPECT_FALSE(wrapper.addOrblConfigForAppId(identifier, "/dev/null")) << identifier;
    EXPECT_FALSE(wrapper.removeOrblConfigForAppid(identifier)) << identifier;
    EXPECT_FALSE(wrapper.querySpecificMetric(identifier, 1, 2, 3, 4, 5)) << identifier;
  }
  EXPECT_THAT(lines(), IsEmpty());
  // Calls arrive in order: any earlier call would have arrived.
  EXPECT_TRUE(wrapper.removeOrblConfigForAppid("vespscope"));
  EXPECT_THAT(manager.callNames(), ElementsAre("ClearConfiguration"));
}

TEST_F(RhoxWrapperSuite, AStatusOfZeroWithAMessageIsSuccess) {
  manager.answer("ClearConfiguration", {FakeManager::Answer::Manner::reply, 0, "there was none"});
  RhoxWrapper wrapper;
  EXPECT_TRUE(wrapper.removeOrblConfigForAppid("vespscope"));
  EXPECT_THAT(lines(), ElementsAre("-[RhoxWrapper removeOrblConfigForAppid:]: error=0 msg=there was none"));
}

TEST_F(RhoxWrapperSuite, ANonZeroStatusIsFailureAndItsMessageIsLogged) {
  manager.answer("AddConfiguration", {FakeManager::Answer::Manner::reply, -7, "line 3: no such metric"});
  RhoxWrapper wrapper;
  EXPECT_FALSE(wrapper.addOrblConfigForAppId("vespscope", folder.write("some.deviceconfig", "x")));
  EXPECT_THAT(lines(), ElementsAre("-[RhoxWrapper addOrblConfigForAppId:andProtofFilePath:]: error=-7 "
                                   "msg=line 3: no such metric"));
}

TEST_F(RhoxWrapperSuite, TheWholeFileIsSentAsItIs) {
  const std::string contents("\x00\xFF any bytes\n\x00", 14);
  RhoxWrapper wrapper;
  EXPECT_TRUE(wrapper.addOrblConfigForAppId("vespscope", folder.write("some.deviceconfig", contents)));
  ASSERT_EQ(manager.calls().size(), 1U);
  const ipc::Dictionary request = manager.calls()[0].request;
  EXPECT_THAT(keysOf(request), ElementsAre("kKeyAppID", "kKeyPayload", "kKeyPayloadType"));
  EXPECT_EQ(*request.find("kKeyAppID")->asInt64(), 2);
  EXPECT_EQ(*request.find("kKeyPayload")->asData(), Bytes(contents.begin(), contents.end()));
  EXPECT_EQ(*request.find("kKeyPayloadType")->asInt64(), 0);
  EXPECT_THAT(lines(), ElementsAre("-[RhoxWrapper addOrblConfigForAppId:andProtofFilePath:]: error=0 msg="));
}

TEST_F(RhoxWrapperSuite, AFileOfManyPiecesIsSentWhole) {
  std::string contents;
  for (int line = 0; line < 3000; ++line) contents += "# line " + std::to_string(line) + '\n';
  RhoxWrapper wrapper;
  EXPECT_TRUE(wrapper.addOrblConfigForAppId("vespscope", folder.write("long.deviceconfig", contents)));
  ASSERT_EQ(manager.calls().size(), 1U);
  EXPECT_EQ(*manager.calls()[0].request.find("kKeyPayload")->asData(), Bytes(contents.begin(), contents.end()));
}

TEST_F(RhoxWrapperSuite, AFileThatCannotBeReadCountsAsEmpty) {
  RhoxWrapper wrapper;
  EXPECT_TRUE(wrapper.addOrblConfigForAppId("vespscope", folder / "absent"));
  EXPECT_TRUE(wrapper.addOrblConfigForAppId("vespscope", folder.path().string()));  // a folder
  ASSERT_EQ(manager.calls().size(), 2U);
  for (const FakeManager::Call& call : manager.calls())
    EXPECT_TRUE(call.request.find("kKeyPayload")->asData()->empty());
}

TEST_F(RhoxWrapperSuite, ClearingSendsTheApplicationNumberAlone) {
  RhoxWrapper wrapper;
  EXPECT_TRUE(wrapper.removeOrblConfigForAppid("vespscope"));
  const ipc::Dictionary request = manager.calls()[0].request;
  EXPECT_THAT(keysOf(request), ElementsAre("kKeyAppID"));
  EXPECT_EQ(*request.find("kKeyAppID")->asInt64(), 2);
}

TEST_F(RhoxWrapperSuite, AQueryCarriesTheApplicationAndTypeZeroBeforeItsFiveNumbers) {
  RhoxWrapper wrapper;
  EXPECT_TRUE(wrapper.querySpecificMetric("vespscope", 9999, 0, 8323091, -1, -2147483648));
  const ipc::Dictionary request = manager.calls()[0].request;
  EXPECT_THAT(keysOf(request), ElementsAre("kKeyAppID", "kKeyPayloadType", "kKeyTriggerRef", "kKeyTriggerType",
                                           "kKeyTriggerID", "kKeyProfileID", "kKeyMetricID"));
  std::vector<std::int64_t> numbers;
  for (const auto& [key, value] : request.entries()) numbers.push_back(*value.asInt64());
  EXPECT_THAT(numbers, ElementsAre(2, 0, 9999, 0, 8323091, -1, -2147483648LL));
  EXPECT_THAT(lines(), ElementsAre("-[RhoxWrapper querySpecificMetric:triggerRef:triggerType:triggerID:profileID:"
                                   "metricID:]: error=0 msg="));
}

TEST_F(RhoxWrapperSuite, ListeningAgainTurnsDeliveryOffAndOnAgain) {
  RhoxWrapper wrapper;
  wrapper.listen();
  wrapper.listen();
  ASSERT_TRUE(manager.waitForCalls(4));
  EXPECT_THAT(manager.callNames(), ElementsAre("EventsOff", "EventsOn", "EventsOff", "EventsOn"));
  EXPECT_THAT(lines(), ElementsAre("-[RhoxWrapper listen]: listening for events",
                                   "-[RhoxWrapper listen]: listening for events"));
}

TEST_F(RhoxWrapperSuite, AfterListeningTwiceAnEventIsDeliveredOnce) {
  RhoxWrapper wrapper;
  const auto delegate = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(delegate);
  wrapper.listen();
  wrapper.listen();
  manager.sendMetric(3952132, {0x08, 0x01}, 0);
  manager.sendMetric(3952133, {}, 0);
  ASSERT_TRUE(mainLoopUntil([&] { return delegate->metrics.size() >= 2; }));
  EXPECT_EQ(delegate->metrics.size(), 2U);
  EXPECT_EQ(delegate->metrics[1].find("kKeyMetricID")->asInteger(), 3952133);
}

TEST_F(RhoxWrapperSuite, AMetricEventIsLoggedAndHandedToTheDelegateOnTheMainThread) {
  RhoxWrapper wrapper;
  const auto delegate = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(delegate);
  wrapper.listen();
  manager.sendMetric(3952132, {0x08, 0x01}, 1);
  ASSERT_TRUE(mainLoopUntil([&] { return !delegate->metrics.empty(); }));
  EXPECT_EQ(delegate->metrics[0], (Record{{"kKeyMetricID", std::int64_t{3952132}},
                                          {"kKeyPayload", Bytes{0x08, 0x01}},
                                          {"kKeyProfileID", std::int64_t{1}}}));
  EXPECT_THAT(delegate->threads, ElementsAre(std::this_thread::get_id()));
  EXPECT_THAT(delegate->triggers, IsEmpty());
  EXPECT_EQ(lines().back(),
            "-[RhoxWrapper listen]_block_invoke: MetricsTrigger dict=[kKeyMetricID: 3952132, kKeyPayload: <08 01>, "
            "kKeyProfileID: 1]");
}

TEST_F(RhoxWrapperSuite, TheTimeThatTheBusCarriesIsNoPartOfAnEvent) {
  RhoxWrapper wrapper;
  const auto delegate = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(delegate);
  wrapper.listen();
  manager.sendMetricAt(1'700'000'000'000'000'000, 3952132, {0x08, 0x01});
  ASSERT_TRUE(mainLoopUntil([&] { return !delegate->metrics.empty(); }));
  EXPECT_EQ(delegate->metrics[0], (Record{{"kKeyMetricID", std::int64_t{3952132}},
                                          {"kKeyPayload", Bytes{0x08, 0x01}},
                                          {"kKeyProfileID", std::int64_t{0}}}));
  EXPECT_EQ(lines().back(),
            "-[RhoxWrapper listen]_block_invoke: MetricsTrigger dict=[kKeyMetricID: 3952132, kKeyPayload: <08 01>, "
            "kKeyProfileID: 0]");
}

TEST_F(RhoxWrapperSuite, ATriggerEventIsLoggedAndHandedToTheDelegateAsAnEvent) {
  RhoxWrapper wrapper;
  const auto delegate = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(delegate);
  wrapper.listen();
  manager.sendTrigger("hello");
  ASSERT_TRUE(mainLoopUntil([&] { return !delegate->triggers.empty(); }));
  EXPECT_EQ(delegate->triggers[0], (Record{{"text", "hello"}}));
  EXPECT_THAT(delegate->metrics, IsEmpty());
  EXPECT_EQ(lines().back(), "-[RhoxWrapper listen]_block_invoke: EventTrigger dict=[text: hello]");
}

TEST_F(RhoxWrapperSuite, EventsReachTheDelegateInTheOrderOfTheirArrival) {
  RhoxWrapper wrapper;
  const auto delegate = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(delegate);
  wrapper.listen();
  for (std::int64_t number = 0; number < 500; ++number) manager.sendMetric(number, {});
  ASSERT_TRUE(mainLoopUntil([&] { return delegate->metrics.size() == 500; }));
  for (std::int64_t number = 0; number < 500; ++number) {
    EXPECT_EQ(delegate->metrics[static_cast<std::size_t>(number)].find("kKeyMetricID")->asInteger(), number);
  }
}

TEST_F(RhoxWrapperSuite, AnEventWithoutADelegateIsLoggedAndDropped) {
  RhoxWrapper wrapper;
  wrapper.listen();
  manager.sendMetric(3952132, {0x08, 0x01});
  ASSERT_TRUE(eventually([this] { return lines().size() == 2; }));
  EXPECT_EQ(lines()[1],
            "-[RhoxWrapper listen]_block_invoke: MetricsTrigger dict=[kKeyMetricID: 3952132, kKeyPayload: <08 01>, "
            "kKeyProfileID: 0]");
  wrapper.queue()->drain();
  const auto delegate = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(delegate);
  dispatch::MainLoop::main().drain();
  EXPECT_THAT(delegate->metrics, IsEmpty());
}

TEST_F(RhoxWrapperSuite, ADelegateThatIsGoneBeforeTheMainQueueRunsGetsNothing) {
  RhoxWrapper wrapper;
  auto delegate = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(delegate);
  wrapper.listen();
  manager.sendMetric(3952132, {});
  ASSERT_TRUE(eventually([this] { return lines().size() == 2; }));
  wrapper.queue()->drain();
  delegate.reset();
  dispatch::MainLoop::main().drain();
  EXPECT_EQ(wrapper.delegate(), nullptr);
}

TEST_F(RhoxWrapperSuite, TheDelegateOfTheMomentGetsTheEvent) {
  RhoxWrapper wrapper;
  const auto first = std::make_shared<RecordingDelegate>();
  const auto second = std::make_shared<RecordingDelegate>();
  wrapper.setDelegate(first);
  wrapper.listen();
  manager.sendMetric(3952132, {});
  ASSERT_TRUE(eventually([this] { return lines().size() == 2; }));
  wrapper.queue()->drain();
  wrapper.setDelegate(second);
  dispatch::MainLoop::main().drain();
  EXPECT_THAT(first->metrics, IsEmpty());
  EXPECT_EQ(second->metrics.size(), 1U);
}

TEST_F(RhoxWrapperSuite, TheQueueIsMadeOnceForTheWrapperThatAsksFirst) {
  RhoxWrapper first;
  RhoxWrapper second;
  ASSERT_NE(first.queue(), nullptr);
  EXPECT_EQ(first.queue()->label(), "org.vespscope.VespMode.serialQ.queue");
  EXPECT_EQ(first.queue(), first.queue());
  EXPECT_EQ(second.queue(), nullptr);
}

TEST_F(RhoxWrapperSuite, TheSharedInstanceIsOne) {
  const std::shared_ptr<RhoxWrapper> shared = RhoxWrapper::sharedInstance();
  EXPECT_EQ(shared, RhoxWrapper::sharedInstance());
  EXPECT_TRUE(shared->removeOrblConfigForAppid("vespscope"));
}

TEST_F(RhoxWrapperSuite, WithoutAManagerACommandFailsWithAMessage) {
  rhox::client::setAddress(*rhox::client::Address::parse("unix:path=" + (folder / "nobody")));
  RhoxWrapper wrapper;
  EXPECT_FALSE(wrapper.removeOrblConfigForAppid("vespscope"));
  ASSERT_EQ(lines().size(), 1U);
  EXPECT_EQ(lines()[0], "-[RhoxWrapper removeOrblConfigForAppid:]: error=" + std::to_string(rhox::kStatusNotConnected) +
                            " msg=not connected to a baseband manager: no manager at " + (folder / "nobody") +
                            ": No such file or directory");
}

}  // namespace
}  // namespace vespscope::test
