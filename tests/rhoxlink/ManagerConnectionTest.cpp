// The client library with a scripted manager that rejects, is late, sends invalid data, disconnects and returns.
#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "platform/dispatch/SerialQueue.h"
#include "rhoxlink/EventInbox.h"
#include "rhoxlink/Rhoxlink.h"
#include "rhoxlink/StatusReply.h"
#include "support/Eventually.h"
#include "support/FakeManager.h"
#include "support/TemporaryFolder.h"
#include "values/Text.h"

namespace vespscope::test {
namespace {

using namespace rhox;
using namespace rhox::client;
using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using vespscope::dispatch::SerialQueue;
using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;
using Manner = FakeManager::Answer::Manner;

class ManagerConnection : public testing::Test {
 protected:
  ManagerConnection() {
    setAddress(*Address::parse("unix:path=" + path));
    fake = std::make_unique<FakeManager>(path);
  }

  std::shared_ptr<Manager> connect() { return CreateManager("test", queue); }

  static client::Result ask(const std::shared_ptr<Manager>& manager, std::string_view command) {
    Object reply;
    return PerformCommand(manager, command, Dictionary(), reply);
  }

  // Stores the identifiers of the metrics that arrive.
  void record(const std::shared_ptr<Manager>& manager) {
    RegisterEventHandler(manager, kEventMetric, [this](const Object& event, const DispatchGroup&) {
      const std::lock_guard lock(mutex_);
      received_.push_back(*event.asDictionary()->find(kKeyMetricID)->asInt64());
    });
  }
  std::vector<std::int64_t> received() {
    const std::lock_guard lock(mutex_);
    return received_;
  }

  TemporaryFolder folder;
  const std::string path = folder / "manager";
  std::shared_ptr<SerialQueue> queue = std::make_shared<SerialQueue>("test");
  std::unique_ptr<FakeManager> fake;

 private:
  std::mutex mutex_;
  std::vector<std::int64_t> received_;
};

TEST_F(ManagerConnection, ReportsTheManagersSource) {
  fake->setSource("drive.pcap", "recorded");
  const auto manager = connect();
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(connectionStatus(manager).sourceLabel, "drive.pcap");
  EXPECT_EQ(connectionStatus(manager).sourceKind, vespscope::SourceKind::recorded);
  EXPECT_EQ(connectionStatus(manager).problem, "");
  EXPECT_EQ(connectionStatus(manager).eventsReceived, 0U);
  EXPECT_FALSE(connectionStatus(manager).lastEvent.has_value());
}

TEST_F(ManagerConnection, FollowsTheLabelOfALiveSource) {
  fake->setSource("a modem, searching", "live");
  const auto manager = connect();
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).sourceLabel == "a modem, searching"; }));
  fake->setSource("a modem, registered", "live");
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).sourceLabel == "a modem, registered"; }));
  EXPECT_EQ(connectionStatus(manager).connections, 1U);
  EXPECT_EQ(connectionStatus(manager).sourceKind, vespscope::SourceKind::live);
}

TEST_F(ManagerConnection, AKindThatIsNotKnownIsUnknown) {
  fake->setSource("thing", "imagined");
  const auto manager = connect();
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(connectionStatus(manager).sourceKind, vespscope::SourceKind::unknown);
}

TEST_F(ManagerConnection, ARejectionComesWithItsStatusAndMessage) {
  fake->answer("AddConfiguration", {Manner::reply, 3, "line 4: there is no metric K_NOISE"});
  const client::Result result = ask(connect(), kCommandAddConfiguration);
  EXPECT_EQ(result.status, 3);
  EXPECT_EQ(result.message, "line 4: there is no metric K_NOISE");
}

TEST_F(ManagerConnection, ACommandThatIsNotAnsweredEndsInTime) {
  fake->answer("AddConfiguration", {Manner::silence, 0, ""});
  setCommandTimeout(30ms);
  const auto manager = connect();
  const auto begin = std::chrono::steady_clock::now();
  const client::Result result = ask(manager, kCommandAddConfiguration);
  EXPECT_EQ(result.status, kStatusTimedOut);
  EXPECT_EQ(result.message, "the baseband manager did not answer within 30 ms");
  EXPECT_LT(std::chrono::steady_clock::now() - begin, 2s);
  setCommandTimeout(2000ms);
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, 0);
}

TEST_F(ManagerConnection, AReplyOfAnotherFormIsAnError) {
  fake->answer("AddConfiguration", {Manner::wrongForm, 0, ""});
  const auto manager = connect();
  EXPECT_EQ(ask(manager, kCommandAddConfiguration).status, kStatusBadReply);
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, 0);
}

TEST_F(ManagerConnection, ARefusedCallIsAnErrorWithItsReason) {
  fake->answer("AddConfiguration", {Manner::error, 0, "not today"});
  const client::Result result = ask(connect(), kCommandAddConfiguration);
  EXPECT_EQ(result.status, kStatusRefused);
  EXPECT_EQ(result.message, "the manager refused the call: not today");
}

TEST_F(ManagerConnection, AManagerThatClosesInsteadOfAnsweringIsAnErrorAtOnce) {
  fake->answer("AddConfiguration", {Manner::disconnect, 0, ""});
  const auto manager = connect();
  EXPECT_EQ(ask(manager, kCommandAddConfiguration).status, kStatusConnectionLost);
  EXPECT_TRUE(fake->waitForConnections(2));
}

TEST_F(ManagerConnection, BytesThatAreNoMessageEndTheConnectionAndItIsMadeAgain) {
  fake->answer("AddConfiguration", {Manner::garbage, 0, ""});
  const auto manager = connect();
  EXPECT_EQ(ask(manager, kCommandAddConfiguration).status, kStatusConnectionLost);
  EXPECT_TRUE(fake->waitForConnections(2));
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, 0);
}

TEST_F(ManagerConnection, ARequestThatCannotBeSentIsAnError) {
  Object nested(std::int64_t{1});
  for (int depth = 0; depth < 40; ++depth) nested = Object(vespscope::ipc::Array{nested});
  const auto manager = connect();
  for (const Object& unfit : {nested, Object(vespscope::Bytes((std::size_t{1} << 26) + 1))}) {
    Dictionary request;
    request.set("unfit", unfit);
    Object reply;
    const client::Result result = PerformCommand(manager, kCommandAddConfiguration, request, reply);
    EXPECT_EQ(result.status, kStatusCannotEncode);
    EXPECT_EQ(result.message, "the request cannot be sent: it is too large or nested too deep");
  }
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, 0);
}

TEST_F(ManagerConnection, EventsReachTheHandlerOfTheirKindInOrder) {
  const auto manager = connect();
  record(manager);
  std::atomic<int> triggers = 0;
  RegisterEventHandler(manager, kEventTrigger, [&](const Object&, const DispatchGroup&) { ++triggers; });
  EventsOn(manager);
  for (std::int64_t number = 1; number <= 300; ++number) fake->sendMetric(number, {});
  fake->sendTrigger("end");
  ASSERT_TRUE(eventually([&] { return triggers == 1; }));
  std::vector<std::int64_t> expected;
  for (std::int64_t number = 1; number <= 300; ++number) expected.push_back(number);
  EXPECT_EQ(received(), expected);
  EXPECT_EQ(connectionStatus(manager).eventsReceived, 301U);
  EXPECT_EQ(connectionStatus(manager).eventsLost, 0U);
  EXPECT_TRUE(connectionStatus(manager).lastEvent.has_value());
}

TEST_F(ManagerConnection, AHandlerRegisteredAgainTakesThePlaceOfTheOneBefore) {
  const auto manager = connect();
  std::atomic<int> first = 0;
  std::atomic<int> second = 0;
  RegisterEventHandler(manager, kEventMetric, [&](const Object&, const DispatchGroup&) { ++first; });
  RegisterEventHandler(manager, kEventMetric, [&](const Object&, const DispatchGroup&) { ++second; });
  fake->sendMetric(1, {});
  fake->sendMetric(2, {});
  ASSERT_TRUE(eventually([&] { return second == 2; }));
  EXPECT_EQ(first, 0);
}

TEST_F(ManagerConnection, AGapInTheSequenceIsCountedAsLost) {
  const auto manager = connect();
  record(manager);
  fake->sendMetric(1, {});
  fake->sendMetric(2, {}, 0, 5);
  fake->sendMetric(3, {}, 0, 2);
  ASSERT_TRUE(eventually([&] { return received().size() == 3; }));
  EXPECT_EQ(connectionStatus(manager).eventsLost, 7U);
}

TEST_F(ManagerConnection, AnEventOfAnotherFormIsCountedAndSkipped) {
  const auto manager = connect();
  record(manager);
  fake->sendMalformedEvent();
  fake->sendMetric(1, {});
  ASSERT_TRUE(eventually([&] { return received().size() == 1; }));
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).malformed == 1; }));
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(connectionStatus(manager).connections, 1U);
}

TEST_F(ManagerConnection, AHandlerMayCommand) {
  const auto manager = connect();
  std::atomic<int> status = -1;
  RegisterEventHandler(manager, kEventMetric, [&](const Object&, const DispatchGroup&) {
    status = ask(manager, kCommandClearConfiguration).status;
  });
  fake->sendMetric(1, {});
  EXPECT_TRUE(eventually([&] { return status == 0; }));
  queue->drain();
  RegisterEventHandler(manager, kEventMetric, nullptr);  // the handler kept the connection alive
}

// Blocks a queue's thread until it is released.
class Held {
 public:
  explicit Held(SerialQueue& queue) {
    gate_.lock();
    queue.async([this] { const std::lock_guard wait(gate_); });
  }
  Held(const Held&) = delete;
  Held& operator=(const Held&) = delete;
  ~Held() { letGo(); }
  void letGo() {
    if (std::exchange(held_, false)) gate_.unlock();
  }

 private:
  std::mutex gate_;
  bool held_ = true;
};

TEST_F(ManagerConnection, AHandlerThatIsStuckLeavesTheEventsToTheManagerAndGetsThemLater) {
  const auto manager = connect();
  record(manager);
  Held held(*queue);
  constexpr std::uint64_t sent = 12'000;
  for (std::uint64_t number = 1; number <= sent; ++number) fake->sendMetric(static_cast<std::int64_t>(number), {});
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).eventsReceived >= 4096; }));
  std::this_thread::sleep_for(50ms);
  EXPECT_LT(connectionStatus(manager).eventsReceived, 8192U);
  EXPECT_LE(queue->size(), 1U);
  held.letGo();
  ASSERT_TRUE(eventually([&] { return received().size() == sent; }));
  EXPECT_EQ(received().front(), 1);
  EXPECT_EQ(received().back(), static_cast<std::int64_t>(sent));
  EXPECT_EQ(connectionStatus(manager).eventsLost, 0U);
}

TEST_F(ManagerConnection, WhoWaitsForAnAnswerBehindTooManyEventsLosesTheOldestNotTheMemory) {
  const auto manager = connect();
  record(manager);
  Held held(*queue);
  constexpr std::uint64_t sent = 8192 + 100;
  for (std::uint64_t number = 1; number <= sent; ++number) fake->sendMetric(static_cast<std::int64_t>(number), {});
  fake->finishSending();  // so that the answer comes after all of them
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, 0);
  // The answer is returned before the events just ahead of it are counted.
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).eventsReceived == sent; }));
  EXPECT_EQ(connectionStatus(manager).eventsLost, 100U);
  held.letGo();
  ASSERT_TRUE(eventually([&] { return received().size() == 8192; }));
  EXPECT_EQ(received().front(), 101);
  EXPECT_EQ(received().back(), static_cast<std::int64_t>(sent));
}

TEST_F(ManagerConnection, LargeEventsAreBoundedByTheirBytes) {
  const auto manager = connect();
  record(manager);
  Held held(*queue);
  constexpr std::uint64_t sent = 800;
  const vespscope::Bytes large(15'000, 0x10);
  for (std::uint64_t number = 1; number <= sent; ++number) fake->sendMetric(static_cast<std::int64_t>(number), large);
  fake->answer(kCommandClearConfiguration, {Manner::silence, 0, ""});
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, kStatusTimedOut);
  const auto status = connectionStatus(manager);
  EXPECT_LE(status.eventsReceived - status.eventsLost, (std::size_t{4} << 20) / large.size());
  EXPECT_GT(status.eventsLost, 0U);
  held.letGo();
  ASSERT_TRUE(eventually([&] { return !received().empty() && received().back() == static_cast<std::int64_t>(sent); }));
  EXPECT_EQ(received().size() + connectionStatus(manager).eventsLost, sent);
}

TEST_F(ManagerConnection, AnEventBeyondTheBoundIsCountedAsLost) {
  const auto manager = connect();
  record(manager);
  Dictionary event;
  event.set(kKeyMetricID, Object(std::int64_t{1}));
  event.set(kKeyPayload, Object(vespscope::Bytes()));
  event.set(kKeyProfileID, Object(std::int64_t{0}));
  const std::size_t largest = EventInbox::eventLimit - vespscope::ipc::contentSize(event);
  fake->sendMetric(1, vespscope::Bytes(largest));
  fake->sendMetric(2, vespscope::Bytes(largest + 1));
  fake->sendMetric(3, {});
  ASSERT_TRUE(eventually([&] { return received().size() == 2; }));
  EXPECT_THAT(received(), ElementsAre(1, 3));
  EXPECT_EQ(connectionStatus(manager).eventsLost, 1U);
}

TEST_F(ManagerConnection, KeepsOnlyTheBeginningOfALongLabel) {
  fake->setSource(std::string(60'000, 'x'), "live");
  const auto manager = connect();
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).sourceLabel == std::string(longestLabel, 'x'); }));
  fake->setSource(std::string(longestLabel, 'w'), "live");
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).sourceLabel == std::string(longestLabel, 'w'); }));
  fake->setSource(std::string(longestLabel + 1, 'x'), "live");
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).sourceLabel == std::string(longestLabel, 'x'); }));
  // The whole reply is rejected if a text exceeds its bound.
  fake->setSource(std::string(70'000, 'y'), "simulated");
  EXPECT_TRUE(eventually([&] { return fake->greetings().size() >= 5; }));
  EXPECT_EQ(connectionStatus(manager).sourceLabel, std::string(longestLabel, 'x'));
}

// Handlers that pass each event to another queue, which the test runs.
class ManagerWindow : public ManagerConnection {
 protected:
  ManagerWindow() {
    setAfterwards([this](std::function<void()> task) { submit(std::move(task)); });
    manager = connect();
    setAfterwards(nullptr);
    RegisterEventHandler(manager, kEventMetric, [this](const Object& event, const DispatchGroup&) {
      submit([this, number = *event.asDictionary()->find(kKeyMetricID)->asInt64()] { handled.push_back(number); });
    });
  }
  ~ManagerWindow() override {
    manager.reset();
    queue.reset();
  }

  void submit(std::function<void()> task) {
    const std::lock_guard lock(mutex_);
    tasks_.push_back(std::move(task));
  }
  [[nodiscard]] std::size_t waiting() {
    const std::lock_guard lock(mutex_);
    return tasks_.size();
  }
  void runAll() {
    std::vector<std::function<void()>> tasks;
    {
      const std::lock_guard lock(mutex_);
      tasks.swap(tasks_);
    }
    for (const auto& task : tasks) task();
  }

  std::shared_ptr<Manager> manager;
  std::vector<std::int64_t> handled;

 private:
  std::mutex mutex_;
  std::vector<std::function<void()>> tasks_;
};

TEST_F(ManagerWindow, NoMoreEventsThanAWindowAreUnderWayAndAllArriveInOrder) {
  constexpr std::int64_t sent = 5000;
  for (std::int64_t number = 1; number <= sent; ++number) fake->sendMetric(number, {});
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).eventsReceived >= 4096; }));
  ASSERT_TRUE(eventually([&] { return waiting() >= 1024; }));
  std::this_thread::sleep_for(50ms);
  EXPECT_LE(waiting(), 1024U + 8U);  // events, and the marks after them
  ASSERT_TRUE(eventually([&] {
    runAll();
    return handled.size() == sent;
  }));
  for (std::int64_t number = 1; number <= sent; ++number)
    ASSERT_EQ(handled[static_cast<std::size_t>(number - 1)], number);
  EXPECT_EQ(connectionStatus(manager).eventsLost, 0U);
}

TEST_F(ManagerWindow, AFewLargeEventsFillTheWindowToo) {
  const vespscope::Bytes large(15'000, 0x10);
  constexpr std::size_t window = (std::size_t{1} << 20) / 16'000;
  for (std::int64_t number = 1; number <= 200; ++number) fake->sendMetric(number, large);
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).eventsReceived >= 200 && waiting() >= window; }));
  std::this_thread::sleep_for(50ms);
  EXPECT_LE(waiting(), window + 16U);  // events, and the marks after them
  ASSERT_TRUE(eventually([&] {
    runAll();
    return handled.size() == 200;
  }));
  EXPECT_EQ(connectionStatus(manager).eventsLost, 0U);
}

TEST_F(ManagerConnection, ComesBackByItselfWithDeliveryOnAgain) {
  const auto manager = connect();
  record(manager);
  Dictionary request;
  request.set(kKeyAppID, Object(std::int64_t{2}));
  Object reply;
  EXPECT_EQ(PerformCommand(manager, kCommandClearConfiguration, request, reply).status, 0);
  EventsOn(manager);
  ASSERT_TRUE(fake->waitForCalls(2));
  fake.reset();
  ASSERT_TRUE(eventually([&] { return !connectionStatus(manager).connected; }));
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, kStatusNotConnected);
  fake = std::make_unique<FakeManager>(path);
  fake->sendMetric(5, {});
  ASSERT_TRUE(eventually([&] { return received().size() == 1; }));
  // The event may overtake the manager's answer and further calls.
  ASSERT_TRUE(fake->waitForCalls(1));
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_THAT(fake->callNames(), ElementsAre("EventsOn"));
  EXPECT_EQ(connectionStatus(manager).connections, 2U);
  EXPECT_EQ(connectionStatus(manager).eventsLost, 0U);
  // The client sent its application to the new manager.
  ASSERT_FALSE(fake->greetings().empty());
  EXPECT_EQ(*fake->greetings()[0].find(kKeyAppID)->asInt64(), 2);
  EXPECT_EQ(*fake->greetings()[0].find(kKeyClientName)->asString(), "test");
}

Dictionary configuration(std::int64_t application, const std::string& text) {
  Dictionary request;
  request.set(kKeyAppID, Object(application));
  request.set(kKeyPayload, Object(vespscope::Bytes(text.begin(), text.end())));
  request.set(kKeyPayloadType, Object(std::int64_t{0}));
  return request;
}

TEST_F(ManagerConnection, GivesTheAcceptedConfigurationOfEachApplicationAgainToTheNextManager) {
  const auto manager = connect();
  Object reply;
  for (const auto& [application, text] : {std::pair{2, "first"}, {2, "second"}, {7, "other"}}) {
    ASSERT_EQ(PerformCommand(manager, kCommandAddConfiguration, configuration(application, text), reply).status, 0);
  }
  fake->answer(kCommandAddConfiguration, {Manner::reply, 3, "line 1"});
  ASSERT_EQ(PerformCommand(manager, kCommandAddConfiguration, configuration(2, "refused"), reply).status, 3);
  EventsOn(manager);
  ASSERT_TRUE(fake->waitForCalls(5));
  EXPECT_EQ(connectionStatus(manager).notSubscribed, "");
  fake.reset();
  fake = std::make_unique<FakeManager>(path);
  ASSERT_TRUE(fake->waitForCalls(3));
  EXPECT_THAT(fake->callNames(), ElementsAre("AddConfiguration", "AddConfiguration", "EventsOn"));
  const std::vector<FakeManager::Call> calls = fake->calls();
  EXPECT_EQ(toText(toRecord(calls[0].request)), toText(toRecord(configuration(2, "second"))));
  EXPECT_EQ(toText(toRecord(calls[1].request)), toText(toRecord(configuration(7, "other"))));
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(connectionStatus(manager).notSubscribed, "");
}

TEST_F(ManagerConnection, DoesNotGiveAgainWhatWasCleared) {
  const auto manager = connect();
  Object reply;
  ASSERT_EQ(PerformCommand(manager, kCommandAddConfiguration, configuration(2, "any"), reply).status, 0);
  ASSERT_EQ(PerformCommand(manager, kCommandClearConfiguration, configuration(2, ""), reply).status, 0);
  EventsOn(manager);
  ASSERT_TRUE(fake->waitForCalls(3));
  fake.reset();
  fake = std::make_unique<FakeManager>(path);
  ASSERT_TRUE(fake->waitForCalls(1));
  EXPECT_THAT(fake->callNames(), ElementsAre("EventsOn"));
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(connectionStatus(manager).notSubscribed, "the configuration was cleared");
}

TEST_F(ManagerConnection, ReportsWhyItIsConnectedButNotSubscribed) {
  const auto manager = connect();
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(connectionStatus(manager).notSubscribed, "no configuration has been sent");
  Object reply;
  fake->answer(kCommandAddConfiguration, {Manner::reply, 3, "line 4"});
  ASSERT_EQ(PerformCommand(manager, kCommandAddConfiguration, configuration(2, "any"), reply).status, 3);
  EXPECT_EQ(connectionStatus(manager).notSubscribed, "the manager refused the configuration: line 4");
  fake->answer(kCommandAddConfiguration, {});
  ASSERT_EQ(PerformCommand(manager, kCommandAddConfiguration, configuration(2, "any"), reply).status, 0);
  EXPECT_EQ(connectionStatus(manager).notSubscribed, "delivery of events is off");
  EventsOn(manager);
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).notSubscribed.empty(); }));

  fake.reset();
  ASSERT_TRUE(eventually([&] { return !connectionStatus(manager).connected; }));
  fake = std::make_unique<FakeManager>(path);
  fake->answer(kCommandAddConfiguration, {Manner::reply, 7, "64 applications"});
  EXPECT_TRUE(eventually([&] {
    return connectionStatus(manager).notSubscribed == "the manager refused the configuration: 64 applications";
  }));
}

TEST_F(ManagerConnection, ReportsThatTheConfigurationWasNotSentWithoutAManager) {
  fake.reset();
  const auto manager = connect();
  Object reply;
  EXPECT_EQ(PerformCommand(manager, kCommandAddConfiguration, configuration(2, "any"), reply).status,
            kStatusNotConnected);
  fake = std::make_unique<FakeManager>(path);
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_THAT(connectionStatus(manager).notSubscribed, testing::StartsWith("the configuration was not sent: "));
}

TEST_F(ManagerConnection, ReportsThatALiveManagerLostTheConfiguration) {
  fake->setSource("modem", "live");
  fake->setConfigured(true);
  const auto manager = connect();
  EventsOn(manager);
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).notSubscribed.empty(); }));
  fake->setConfigured(false);  // another client cleared it
  EXPECT_TRUE(eventually([&] {
    return connectionStatus(manager).notSubscribed == "the manager has no configuration for this application";
  }));
}

TEST_F(ManagerConnection, FollowsThePositionOfAPlaybackToItsEndAndAsksNoMore) {
  fake->setSource("drive.pcap", "recorded");
  fake->setPlayback(1'500'000'000, false);
  const auto manager = connect();
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).playback.has_value(); }));
  const vespscope::PlaybackPosition first = *connectionStatus(manager).playback;
  EXPECT_EQ(first.position, 1500ms);
  EXPECT_EQ(first.length, 10s);
  EXPECT_EQ(first.clock, 1'700'000'000s + 1500ms);
  EXPECT_EQ(first.speed, 2.0);
  EXPECT_FALSE(first.ended);
  EXPECT_EQ(connectionStatus(manager).protocol, 2);
  fake->setPlayback(10'000'000'000, true);
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).playback->ended; }));
  EXPECT_EQ(connectionStatus(manager).playback->position, 10s);
  const std::size_t questions = fake->greetings().size();
  std::this_thread::sleep_for(1200ms);
  EXPECT_EQ(fake->greetings().size(), questions);
}

TEST_F(ManagerConnection, AgreesOnTheLowerProtocolVersion) {
  const auto manager = connect();
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }));
  EXPECT_EQ(connectionStatus(manager).protocol, 1);  // the fake reports none
  EXPECT_EQ(*fake->greetings()[0].find(kKeyProtocol)->asInt64(), kProtocol);
}

TEST_F(ManagerConnection, GivesAnObserverTheTimeOfAnEventAndTheHandlerTheEventWithoutIt) {
  const auto manager = connect();
  std::mutex mutex;
  std::vector<std::string> seen;
  std::vector<std::optional<std::chrono::nanoseconds>> times;
  RegisterEventObserver(manager, kEventMetric, [&](const Object& event, const EventFacts& facts) {
    const std::lock_guard lock(mutex);
    seen.push_back("observer " + toText(toRecord(*event.asDictionary())));
    times.push_back(facts.time);
  });
  RegisterEventHandler(manager, kEventMetric, [&](const Object& event, const DispatchGroup&) {
    const std::lock_guard lock(mutex);
    seen.push_back("handler " + toText(toRecord(*event.asDictionary())));
  });
  ASSERT_TRUE(fake->waitForConnections(2));  // the greeting, and the request for times
  EventsOn(manager);
  fake->sendMetricAt(1'700'000'000'000'000'001, 3952132, {0x08});
  fake->sendMetric(3952133, {});
  ASSERT_TRUE(eventually([&] {
    const std::lock_guard lock(mutex);
    return seen.size() == 4;
  }));
  const std::string first = "[kKeyMetricID: 3952132, kKeyPayload: <08>, kKeyProfileID: 0]";
  const std::string second = "[kKeyMetricID: 3952133, kKeyPayload: <>, kKeyProfileID: 0]";
  EXPECT_THAT(seen, ElementsAre("observer " + first, "handler " + first, "observer " + second, "handler " + second));
  EXPECT_THAT(times, ElementsAre(std::chrono::nanoseconds(1'700'000'000'000'000'001), std::nullopt));
  queue->drain();
  RegisterEventObserver(manager, kEventMetric, nullptr);
  RegisterEventHandler(manager, kEventMetric, nullptr);
}

TEST_F(ManagerConnection, ComesBackWithDeliveryOffWhenItWasOff) {
  const auto manager = connect();
  EventsOn(manager);
  EventsOff(manager);
  ASSERT_TRUE(fake->waitForCalls(2));
  fake->disconnect();
  ASSERT_TRUE(fake->waitForConnections(2));
  EXPECT_EQ(ask(manager, kCommandClearConfiguration).status, 0);
  EXPECT_THAT(fake->callNames(), ElementsAre("EventsOn", "EventsOff", "ClearConfiguration"));
}

TEST_F(ManagerConnection, DeliveryWantedWhileThereIsNoManagerIsTurnedOnWhenOneComes) {
  fake.reset();
  const auto manager = connect();
  EXPECT_THAT(connectionStatus(manager).problem, HasSubstr("no manager at " + path));
  EventsOff(manager);
  EventsOn(manager);
  fake = std::make_unique<FakeManager>(path);
  ASSERT_TRUE(fake->waitForCalls(1));
  EXPECT_THAT(fake->callNames(), ElementsAre("EventsOn"));
}

TEST_F(ManagerConnection, ManyThreadsMayCommandAtOnce) {
  const auto manager = connect();
  std::atomic<int> failures = 0;
  std::vector<std::thread> threads;
  for (int thread = 0; thread < 8; ++thread) {
    threads.emplace_back([&] {
      for (int round = 0; round < 25; ++round) {
        if (ask(manager, kCommandClearConfiguration).status != 0) ++failures;
        EventsOn(manager);
        if (!connectionStatus(manager).problem.empty()) ++failures;
      }
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(failures, 0);
  ASSERT_TRUE(fake->waitForCalls(400));
}

TEST_F(ManagerConnection, EndsPromptlyWhileACommandIsUnderWayOnAnotherThread) {
  fake->answer("AddConfiguration", {Manner::silence, 0, ""});
  setCommandTimeout(100ms);
  auto manager = connect();
  // The call's own reference keeps the connection alive until it returns.
  std::thread caller([manager] { EXPECT_EQ(ask(manager, kCommandAddConfiguration).status, kStatusTimedOut); });
  ASSERT_TRUE(fake->waitForCalls(1));
  manager.reset();
  caller.join();
  EXPECT_THAT(received(), IsEmpty());
}

}  // namespace
}  // namespace vespscope::test
