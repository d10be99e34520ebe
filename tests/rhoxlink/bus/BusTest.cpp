// Both ends of the protocol over a socket pair, and invalid messages to the manager's end.
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <fstream>
#include <iterator>
#include <memory>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "platform/ipc/IpcObject.h"
#include "rhoxlink/bus/Bus.h"
#include "rhoxlink/bus/MessageCodec.h"
#include "support/RawBus.h"
#include "values/Text.h"

namespace vespscope::test {
namespace {

using namespace bus;
using ipc::Array;
using ipc::Dictionary;
using ipc::Object;
using testing::ElementsAre;

std::array<int, 2> socketPair() {
  std::array<int, 2> ends{};
  EXPECT_EQ(::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends.data()), 0);
  return ends;
}

// Answers with the request itself.
class Echo : public Service {
 public:
  void performCommand(const std::string& command, const Dictionary& request, const Answer& answer) override {
    commands.push_back(command);
    answer({7, "seven", request});
  }
  void eventsOn() override { commands.emplace_back("on"); }
  void eventsOff() override { commands.emplace_back("off"); }

  std::vector<std::string> commands;
};

class BusEnds : public testing::Test {
 protected:
  BusEnds() {
    const std::array<int, 2> sockets = socketPair();
    server = std::move(*ServerEnd::overSocket(sockets[0], service));
    client = std::move(
        *ClientEnd::overSocket(sockets[1], [this](std::string_view kind, std::uint64_t sequence, Dictionary event) {
          events.push_back(std::string(kind) + " " + std::to_string(sequence) + " " + toText(toRecord(event)));
        }));
  }

  // Runs both ends until `done`, at most a few seconds.
  bool workUntil(const std::function<bool()>& done) {
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(5);
    while (!done() && std::chrono::steady_clock::now() < end) {
      if (!server->process() || !client->process()) return done();
      const Wait one = server->wait();
      const Wait other = client->wait();
      std::array<pollfd, 2> ready{{{one.descriptor, one.events, 0}, {other.descriptor, other.events, 0}}};
      ::poll(ready.data(), ready.size(), one.timeout.count() == 0 || other.timeout.count() == 0 ? 0 : 50);
    }
    return done();
  }

  Reply ask(const std::string& command, const Dictionary& request) {
    std::optional<Reply> reply;
    EXPECT_TRUE(client->performCommand(command, request, std::chrono::seconds(5),
                                       [&](Reply given) { reply = std::move(given); }));
    EXPECT_TRUE(workUntil([&] { return reply.has_value(); }));
    return reply.value_or(Reply{});
  }

  Echo service;
  std::unique_ptr<ServerEnd> server;
  std::unique_ptr<ClientEnd> client;
  std::vector<std::string> events;
};

TEST_F(BusEnds, EveryKindOfObjectArrivesAsItWasSent) {
  Dictionary inner;
  inner.set("deep", Object(std::string("text")));
  Dictionary request;
  request.set("null", Object());
  request.set("true", Object(true));
  request.set("false", Object(false));
  request.set("negative", Object(std::int64_t{-9223372036854775807LL - 1}));
  request.set("unsigned", Object(std::uint64_t{18446744073709551615ULL}));
  request.set("real", Object(-0.1));
  request.set("text", Object(std::string("Grüße")));
  request.set("empty text", Object(std::string()));
  request.set("data", Object(Bytes{0, 255, 1}));
  request.set("empty data", Object(Bytes{}));
  request.set("array", Object(Array{Object(std::int64_t{1}), Object(), Object(std::string("two")), Object(Array{})}));
  request.set("dictionary", Object(inner));
  request.set("empty dictionary", Object(Dictionary{}));
  const Reply reply = ask("Echo", request);
  EXPECT_EQ(reply.status, 7);
  EXPECT_EQ(reply.message, "seven");
  EXPECT_THAT(service.commands, ElementsAre("Echo"));
  ASSERT_EQ(reply.values.size(), request.size());
  for (std::size_t index = 0; index < request.size(); ++index) {
    const auto& [key, sent] = request.entries()[index];
    const auto& [gotKey, got] = reply.values.entries()[index];
    EXPECT_EQ(gotKey, key);
    EXPECT_EQ(got.type(), sent.type()) << key;
    EXPECT_EQ(ipc::toValue(got), ipc::toValue(sent)) << key;
  }
}

TEST_F(BusEnds, TextThatIsNoUtf8OrHoldsAZeroArrivesReadable) {
  Dictionary request;
  request.set("broken", Object(std::string("a\xFFz")));
  request.set("zero", Object(std::string("a\0z", 3)));
  const Reply reply = ask("Echo", request);
  EXPECT_EQ(*reply.values.find("broken")->asString(), "a\uFFFDz");
  EXPECT_EQ(*reply.values.find("zero")->asString(), "a\u2400z");
}

TEST_F(BusEnds, AMegabyteOfDataArrivesWhole) {
  Bytes data(std::size_t{1} << 20);
  for (std::size_t index = 0; index < data.size(); ++index) data[index] = static_cast<std::uint8_t>(index * 7);
  Dictionary request;
  request.set("data", Object(data));
  EXPECT_EQ(*ask("Echo", request).values.find("data")->asData(), data);
}

TEST_F(BusEnds, AMessageHasAtMostFourThousandAndNinetySixObjects) {
  Dictionary request;
  request.set("array", Object(Array(objectLimit - 1)));  // the array counts as well
  EXPECT_EQ(ask("Echo", request).status, 7);
  request.set("array", Object(Array(objectLimit)));
  EXPECT_EQ(ask("Echo", request).status, rhox::kStatusRefused);
  EXPECT_THAT(service.commands, ElementsAre("Echo"));
}

TEST_F(BusEnds, ATextOrKeyBeyondTheBoundIsNotSent) {
  const std::string longest(textLimit, 'x');
  Dictionary request;
  request.set("text", Object(longest));
  request.set(longest, Object(true));
  EXPECT_EQ(*ask("Echo", request).values.find("text")->asString(), longest);
  for (const std::string& text : {longest + "x", std::string(textLimit / 2, '\xFF')}) {  // three bytes per character
    Dictionary unfit;
    unfit.set("text", Object(text));
    EXPECT_FALSE(client->performCommand("Echo", unfit, std::chrono::seconds(5), [](const Reply&) {}));
    Dictionary key;
    key.set(text, Object(true));
    EXPECT_FALSE(client->performCommand("Echo", key, std::chrono::seconds(5), [](const Reply&) {}));
  }
}

TEST_F(BusEnds, ARequestLargerThanAMessageMayBeIsNotSent) {
  Dictionary request;
  request.set("data", Object(Bytes(messageLimit)));
  EXPECT_FALSE(client->performCommand("Echo", request, std::chrono::seconds(5), [](const Reply&) {}));
  EXPECT_FALSE(server->sendEvent("Metric", 1, request));
}

TEST_F(BusEnds, WhatNestsTooDeepIsNotSent) {
  const auto arrays = [](int depth) {
    Object nested(std::int64_t{1});
    for (int count = 0; count < depth; ++count) nested = Object(Array{nested});
    return nested;
  };
  // Beside the arrays there is the dictionary that holds them.
  Dictionary deepest;
  deepest.set("nested", arrays(depthLimit - 1));
  EXPECT_EQ(ask("Echo", deepest).status, 7);
  deepest.set("nested", arrays(depthLimit));
  EXPECT_FALSE(client->performCommand("Echo", deepest, std::chrono::seconds(5), [](const Reply&) {}));
  const Object nested = arrays(40);
  Dictionary request;
  request.set("nested", nested);
  EXPECT_FALSE(client->performCommand("Echo", request, std::chrono::seconds(5), [](const Reply&) {}));
  EXPECT_FALSE(server->sendEvent("Metric", 1, request));
  EXPECT_EQ(ask("Echo", {}).status, 7);
}

TEST_F(BusEnds, EventsArriveInOrderWithTheirNumbers) {
  Dictionary event;
  event.set("key", Object(std::int64_t{1}));
  EXPECT_TRUE(server->sendEvent("Metric", 1, event));
  EXPECT_TRUE(server->sendEvent("Trigger", 3, Dictionary{}));
  ASSERT_TRUE(workUntil([this] { return events.size() == 2; }));
  EXPECT_THAT(events, ElementsAre("Metric 1 [key: 1]", "Trigger 3 []"));
}

TEST_F(BusEnds, DeliveryIsTurnedOnAndOff) {
  EXPECT_TRUE(client->setEvents(true));
  EXPECT_TRUE(client->setEvents(false));
  ASSERT_TRUE(workUntil([this] { return service.commands.size() == 2; }));
  EXPECT_THAT(service.commands, ElementsAre("on", "off"));
}

TEST_F(BusEnds, APendingCommandReportsThatTheConnectionEnded) {
  std::optional<Reply> reply;
  ASSERT_TRUE(client->performCommand("Echo", {}, std::chrono::seconds(5), [&](Reply given) { reply = given; }));
  server.reset();
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(5);
  while (client->process() && std::chrono::steady_clock::now() < end) {
  }
  ASSERT_TRUE(reply.has_value());
  EXPECT_EQ(reply->status, rhox::kStatusConnectionLost);
}

TEST_F(BusEnds, ALateAnswerIsReportedAsSuch) {
  ask("Echo", {});
  std::optional<Reply> reply;
  ASSERT_TRUE(client->performCommand("Echo", {}, std::chrono::milliseconds(5), [&](Reply given) { reply = given; }));
  // The manager's end is not run meanwhile.
  while (!reply && client->process()) {
    const Wait wait = client->wait();
    pollfd ready{wait.descriptor, wait.events, 0};
    ::poll(&ready, 1, static_cast<int>(wait.timeout.count() / 1000) + 1);
  }
  ASSERT_TRUE(reply.has_value());
  EXPECT_EQ(reply->status, rhox::kStatusTimedOut);
}

TEST(BusEnd, OverADescriptorThatIsNoSocketIsRefused) {
  Echo service;
  const auto end = ServerEnd::overSocket(-1, service);
  ASSERT_FALSE(end.ok());
  EXPECT_THAT(end.reason(), testing::HasSubstr("cannot use D-Bus"));
}

// A manager's end on its own thread, for clients that block.
class BusService : public testing::Test {
 protected:
  BusService() {
    const std::array<int, 2> sockets = socketPair();
    client_ = sockets[1];
    thread_ = std::thread([this, descriptor = sockets[0]] {
      const auto server = ServerEnd::overSocket(descriptor, service);
      while (server && !stopping_ && (*server)->process()) {
        const Wait wait = (*server)->wait();
        pollfd ready{wait.descriptor, wait.events, 0};
        ::poll(&ready, 1, 10);
      }
    });
  }
  ~BusService() override {
    stopping_ = true;
    thread_.join();
  }

  [[nodiscard]] int takeClient() const { return client_; }

  Echo service;

 private:
  int client_ = -1;
  std::atomic<bool> stopping_ = false;
  std::thread thread_;
};

// The interface's element without comments and blanks between elements.
std::string interfaceOf(const std::string& xml) {
  const std::string open = "<interface name=\"org.vespscope.BasebandManager1\">";
  const std::size_t begin = xml.find(open);
  const std::size_t end = xml.find("</interface>", begin);
  if (begin == std::string::npos || end == std::string::npos) return "";
  std::string element = xml.substr(begin, end - begin);
  for (std::size_t comment = element.find("<!--"); comment != std::string::npos; comment = element.find("<!--")) {
    element.erase(comment, element.find("-->", comment) + 3 - comment);
  }
  std::string tidy;
  std::istringstream lines(element);
  for (std::string line; std::getline(lines, line);) {
    const std::size_t first = line.find_first_not_of(" \t");
    if (first != std::string::npos) tidy += line.substr(first) + "\n";
  }
  return tidy;
}

TEST_F(BusService, TheObjectDescribesItselfAsTheContractDoes) {
  std::ifstream file(VESPSCOPE_SOURCE_DIR "/src/rhoxlink/bus/org.vespscope.BasebandManager1.xml");
  const std::string contract{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  ASSERT_NE(interfaceOf(contract), "");
  RawBus client(takeClient());
  EXPECT_EQ(interfaceOf(client.introspect()), interfaceOf(contract));
}

TEST_F(BusService, AStrangersCallsOfAnotherFormAreRefusedAndTheNextIsAnswered) {
  RawBus client(takeClient());
  EXPECT_EQ(client.performCommandWithANumber(), "org.freedesktop.DBus.Error.InvalidArgs");
  EXPECT_EQ(client.callUnknownMethod(), "org.freedesktop.DBus.Error.UnknownMethod");
  EXPECT_NE(client.performCommandNested(20), "");
  EXPECT_NE(client.performCommandWithAnUnknownType(), "");
  EXPECT_NE(client.performCommandWithEntries(1025), "");
  EXPECT_EQ(client.performCommandWithEntries(1024), "");
  EXPECT_EQ(client.performCommandNested(2), "");
  EXPECT_EQ(client.performCommand("Status"), "");
  EXPECT_THAT(service.commands, ElementsAre("Status", "Status", "Status"));
}

TEST_F(BusService, BytesThatAreNoMessageEndTheConnection) {
  const int descriptor = takeClient();
  const std::string noise(4096, '\xA5');
  ASSERT_GT(::send(descriptor, noise.data(), noise.size(), MSG_NOSIGNAL), 0);
  pollfd ready{descriptor, POLLIN, 0};
  ASSERT_EQ(::poll(&ready, 1, 5000), 1);
  std::array<char, 256> answer{};
  EXPECT_LE(::recv(descriptor, answer.data(), answer.size(), 0), 0);
  ::close(descriptor);
}

}  // namespace
}  // namespace vespscope::test
