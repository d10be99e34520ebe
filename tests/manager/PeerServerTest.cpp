// The manager serving clients over sockets: several at once, slow ones, other users, and stale sockets.
#include <poll.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LoggedLines.h"
#include "manager/ListeningSocket.h"
#include "manager/PeerServer.h"
#include "platform/dispatch/SerialQueue.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "support/Eventually.h"
#include "support/ScriptedSource.h"
#include "support/TemporaryFolder.h"
#include "values/Sanitized.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using ipc::Dictionary;
using ipc::Object;
using manager::ConfigurationStore;
using manager::DeliveryQueue;
using manager::ListeningSocket;
using rhox::client::Manager;
using testing::ElementsAre;
using testing::HasSubstr;

constexpr std::int32_t rrcState = 3952132;
constexpr std::int32_t txPower = 3986178;

int connectTo(const std::string& path) {
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, path.c_str(), sizeof name.sun_path - 1);
  if (::connect(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name) == 0) return descriptor;
  ::close(descriptor);
  return -1;
}

// A client that records the metrics that arrive.
class Client {
 public:
  Client(const std::string& path, std::int64_t application) : application_(application) {
    rhox::client::setAddress(*rhox::client::Address::parse("unix:path=" + path));
    manager = rhox::client::CreateManager("client", queue_);
    rhox::client::RegisterEventHandler(manager, rhox::kEventMetric,
                                       [this](const Object& event, const rhox::client::DispatchGroup&) {
                                         const std::lock_guard lock(mutex_);
                                         metrics_.push_back(*event.asDictionary()->find("kKeyMetricID")->asInt64());
                                       });
  }
  Client(const Client&) = delete;
  Client& operator=(const Client&) = delete;
  ~Client() {
    manager.reset();
    queue_->drain();
  }

  rhox::client::Result add(const std::string& toml) {
    Dictionary request;
    request.set(rhox::kKeyAppID, Object(application_));
    request.set(rhox::kKeyPayload, Object(Bytes(toml.begin(), toml.end())));
    request.set(rhox::kKeyPayloadType, Object(std::int64_t{0}));
    Object reply;
    return rhox::client::PerformCommand(manager, rhox::kCommandAddConfiguration, request, reply);
  }
  rhox::client::Result ask(std::string_view command) {
    Dictionary request;
    request.set(rhox::kKeyAppID, Object(application_));
    Object reply;
    return rhox::client::PerformCommand(manager, command, request, reply);
  }
  // Configures and listens; events that the source delivers from here on arrive.
  void listen(const std::string& toml) {
    rhox::client::EventsOn(manager);
    EXPECT_EQ(add(toml).message, "");
  }
  std::vector<std::int64_t> metrics() {
    const std::lock_guard lock(mutex_);
    return metrics_;
  }

  std::shared_ptr<Manager> manager;

 private:
  const std::int64_t application_;
  std::shared_ptr<dispatch::SerialQueue> queue_ = std::make_shared<dispatch::SerialQueue>("client");
  std::mutex mutex_;
  std::vector<std::int64_t> metrics_;
};

const std::string both = "[metrics]\nK_LTE_RRC_STATE = { on = \"change\" }\nK_LTE_TX_POWER = { on = \"change\" }\n";
const std::string rrcStateOnly = "[metrics]\nK_LTE_RRC_STATE = { on = \"change\" }\n";

class PeerServer : public testing::Test {
 protected:
  PeerServer() {
    log::discardOutputs();
    serve();
  }

  void serve(DeliveryQueue::Bounds bounds = {}, std::optional<ConfigurationStore> store = std::nullopt) {
    server.reset();
    server = std::make_unique<manager::PeerServer>(std::make_unique<ScriptedSource>(control), std::move(store), bounds);
    auto socket = ListeningSocket::at(path);
    ASSERT_TRUE(socket.ok()) << socket.reason();
    server->listenOn(std::move(*socket));
    server->start();
  }

  TemporaryFolder folder;
  const std::string path = folder / "manager";
  std::shared_ptr<ScriptedSource::Control> control = std::make_shared<ScriptedSource::Control>();
  std::unique_ptr<manager::PeerServer> server;
  std::vector<int> held;
};

TEST_F(PeerServer, ServesClientsWithDifferentConfigurationsAtOnce) {
  Client viewer(path, 2);
  Client recorder(path, 3);
  viewer.listen(both);
  recorder.listen(rrcStateOnly);
  EXPECT_EQ(server->peerCount(), 2U);
  control->deliver(txPower, {0x10, 1});
  control->deliver(rrcState, {0x10, 1});
  ASSERT_TRUE(eventually([&] { return viewer.metrics().size() == 2 && recorder.metrics().size() == 1; }));
  EXPECT_THAT(viewer.metrics(), ElementsAre(txPower, rrcState));
  EXPECT_THAT(recorder.metrics(), ElementsAre(rrcState));
  EXPECT_EQ(viewer.ask(rhox::kCommandClearConfiguration).status, 0);
  control->deliver(txPower, {0x10, 2});
  control->deliver(rrcState, {0x10, 2});
  ASSERT_TRUE(eventually([&] { return recorder.metrics().size() == 2; }));
  EXPECT_EQ(viewer.ask(rhox::kCommandStatus).status, 0);  // earlier messages have arrived
  EXPECT_EQ(viewer.metrics().size(), 2U);
}

TEST_F(PeerServer, AClientThatLeavesIsForgotten) {
  {
    Client client(path, 2);
    client.listen(both);
    EXPECT_EQ(server->peerCount(), 1U);
  }
  EXPECT_TRUE(eventually([this] { return server->peerCount() == 0; }));
  control->deliver(rrcState, {0x10, 1});
}

TEST_F(PeerServer, TheLastValueOfAPeriodArrivesByItself) {
  Client client(path, 2);
  client.listen("[metrics]\nK_LTE_TX_POWER = { period_ms = 40 }\n");
  control->deliver(txPower, {0x10, 1}, 0ms);
  control->deliver(txPower, {0x10, 2}, 10ms);
  control->deliver(txPower, {0x10, 3}, 20ms);
  ASSERT_TRUE(eventually([&] { return client.metrics().size() == 2; }));
}

TEST_F(PeerServer, AClientThatDoesNotReadLosesTheOldestAndCostsNobodyElseAnything) {
  serve({.events = 50, .bytes = std::size_t{1} << 20});
  Client good(path, 3);
  good.listen("[metrics]\nK_LTE_TX_POWER = { period_ms = 1 }\n");

  // This client turns delivery on and then stops reading.
  std::uint64_t received = 0;
  std::uint64_t last = 0;
  const auto stuck =
      bus::ClientEnd::overSocket(connectTo(path), [&](std::string_view, std::uint64_t sequence, const Dictionary&) {
        ++received;
        EXPECT_GT(sequence, last);
        last = sequence;
      });
  ASSERT_TRUE(stuck.ok());
  Dictionary request;
  request.set(rhox::kKeyAppID, Object(std::int64_t{3}));
  bool greeted = false;
  std::int64_t lost = -1;
  const auto greet = [&] {
    greeted = false;
    ASSERT_TRUE((*stuck)->performCommand("Status", request, 5s, [&](const bus::Reply& reply) {
      greeted = true;
      lost = *reply.values.find(rhox::kKeyEventsLost)->asInt64();
    }));
    ASSERT_TRUE(eventually([&] { return (*stuck)->process() && greeted; }));
  };
  ASSERT_TRUE((*stuck)->setEvents(true));
  greet();
  EXPECT_EQ(lost, 0);

  // More than the socket's buffers and the queue can hold together.
  constexpr std::uint64_t count = 6000;
  const Bytes payload(5000, 0x10);  // the system may let a socket hold several megabytes
  for (std::uint64_t number = 0; number < count; ++number) {
    control->deliver(txPower, payload, std::chrono::milliseconds(number));
    if (number % 16 != 0) continue;
    ASSERT_TRUE(eventually([&] { return good.metrics().size() + 32 > number; }));
  }
  ASSERT_TRUE(eventually([&] { return good.metrics().size() == count; }));
  EXPECT_EQ(rhox::client::connectionStatus(good.manager).eventsLost, 0U);

  // When it reads again, it finds the last event, and the gap that shows how many were dropped.
  ASSERT_TRUE(eventually([&] { return (*stuck)->process() && last == count; }));
  EXPECT_LT(received, count);
  greet();
  EXPECT_EQ(received + static_cast<std::uint64_t>(lost), count);
}

// Returns true when the other end closes the connection.
bool isClosed(int descriptor) {
  pollfd ready{descriptor, POLLIN, 0};
  char byte = 0;
  return ::poll(&ready, 1, 20'000) == 1 && ::recv(descriptor, &byte, 1, 0) == 0;
}

TEST_F(PeerServer, ClosesTheOldestConnectionWithoutAPlaceForANewOne) {
  std::vector<int> descriptors;
  for (int count = 0; count < 32; ++count) descriptors.push_back(connectTo(path));
  ASSERT_TRUE(eventually([this] { return server->peerCount() == 32; }));
  Client client(path, 2);
  client.listen(both);
  EXPECT_TRUE(isClosed(descriptors.front()));
  EXPECT_EQ(server->peerCount(), 32U);
  for (const int descriptor : descriptors) ::close(descriptor);
  EXPECT_TRUE(eventually([this] { return server->peerCount() == 1; }));
}

TEST_F(PeerServer, ClosesAConnectionThatSaysNothing) {
  const auto begin = std::chrono::steady_clock::now();
  const int silent = connectTo(path);
  Client client(path, 2);
  client.listen(both);
  EXPECT_TRUE(isClosed(silent));
  EXPECT_GT(std::chrono::steady_clock::now() - begin, 9s);
  EXPECT_LT(std::chrono::steady_clock::now() - begin, 15s);
  EXPECT_TRUE(eventually([this] { return server->peerCount() == 1; }));
  // A client with a place may be silent.
  EXPECT_TRUE(rhox::client::connectionStatus(client.manager).connected);
  ::close(silent);
}

TEST_F(PeerServer, ReportsToAClientThatNoPlaceIsFree) {
  std::vector<std::unique_ptr<Client>> clients;
  const std::size_t places = ::geteuid() == 0 ? 32 : 28;
  for (std::size_t count = 0; count < places; ++count) {
    clients.push_back(std::make_unique<Client>(path, 2));
    EXPECT_EQ(clients.back()->ask(rhox::kCommandStatus).status, 0);
  }
  Client refused(path, 2);
  EXPECT_THAT(refused.ask(rhox::kCommandStatus).message, HasSubstr("the manager has no free place: "));
  EXPECT_TRUE(eventually([&] {
    const auto status = rhox::client::connectionStatus(refused.manager);
    return !status.connected && status.problem.starts_with("the manager has no free place: ");
  }));
  // It gets the first free place.
  clients.pop_back();
  EXPECT_TRUE(eventually([&] { return rhox::client::connectionStatus(refused.manager).connected; }));
}

TEST_F(PeerServer, WritesFewLogLinesWhateverConnects) {
  const LoggedLines lines;
  for (int count = 0; count < 2000; ++count) {
    const int descriptor = connectTo(path);
    ASSERT_GE(descriptor, 0);
    if (count % 2 == 0) ::close(descriptor);
    if (count % 2 != 0) held.push_back(descriptor);
    if (held.size() > 64) {
      ::close(held.front());
      held.erase(held.begin());
    }
  }
  for (const int descriptor : held) ::close(descriptor);
  EXPECT_LE(lines.all().size(), 2 * manager::LogRate::lineLimit + 2);
}

TEST_F(PeerServer, AcceptsLaterWhatItHasNoDescriptorForNow) {
  // The server is running: it has the descriptors for everything that it (and a sanitizer) sets up once.
  const int first = connectTo(path);
  ASSERT_TRUE(eventually([this] { return server->peerCount() == 1; }));
  ::close(first);
  ASSERT_TRUE(eventually([this] { return server->peerCount() == 0; }));
  rlimit before{};
  ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &before), 0);
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, path.c_str(), sizeof name.sun_path - 1);
  const rlimit none{0, before.rlim_max};
  ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &none), 0);
  EXPECT_EQ(::connect(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name), 0);
  std::this_thread::sleep_for(20ms);  // the server tries to accept and fails
  EXPECT_EQ(server->peerCount(), 0U);
  ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &before), 0);
  EXPECT_TRUE(eventually([this] { return server->peerCount() == 1; }));
  ::close(descriptor);
}

TEST_F(PeerServer, NoiseFromAClientEndsThatClientAlone) {
  Client good(path, 2);
  good.listen(both);
  const int noisy = connectTo(path);
  const std::string noise(100'000, '\xA5');
  [[maybe_unused]] const ssize_t ignored = ::send(noisy, noise.data(), noise.size(), MSG_NOSIGNAL | MSG_DONTWAIT);
  ASSERT_TRUE(eventually([this] { return server->peerCount() == 1; }));
  control->deliver(rrcState, {0x10, 1});
  EXPECT_TRUE(eventually([&] { return good.metrics().size() == 1; }));
  ::close(noisy);
}

TEST_F(PeerServer, AClientThatAsksWithoutReadingTheAnswersIsLeft) {
  const int bare = connectTo(path);
  const auto end = bus::ClientEnd::overSocket(::dup(bare), [](std::string_view, std::uint64_t, Dictionary) {});
  ASSERT_TRUE(end.ok());
  bool greeted = false;
  ASSERT_TRUE((*end)->performCommand("Status", {}, 5s, [&](const bus::Reply&) { greeted = true; }));
  ASSERT_TRUE(eventually([&] { return (*end)->process() && greeted; }));
  // The answers contain the unknown command's name, a kilobyte each, and fill the socket.
  const std::string unknown(1000, 'x');
  const bool left = eventually([&] {
    for (int count = 0; count < 64; ++count) (*end)->performCommand(unknown, {}, 60s, [](const bus::Reply&) {});
    return server->peerCount() == 0;
  });
  EXPECT_TRUE(left);
  ::close(bare);
}

TEST_F(PeerServer, ComesBackWithItsConfigurationAndItsClientsComeBackToIt) {
  const ConfigurationStore store(folder / "state");
  serve({}, store);
  Client client(path, 2);
  client.listen(rrcStateOnly);
  control->deliver(rrcState, {0x10, 1});
  ASSERT_TRUE(eventually([&] { return client.metrics().size() == 1; }));
  server.reset();
  ASSERT_TRUE(eventually([&] { return !rhox::client::connectionStatus(client.manager).connected; }));
  const int starts = control->starts;
  serve({}, store);
  ASSERT_TRUE(eventually([&] { return control->starts == starts + 1; }));  // a client listens again
  control->deliver(rrcState, {0x10, 2});
  EXPECT_TRUE(eventually([&] { return client.metrics().size() == 2; }));
  EXPECT_EQ(rhox::client::connectionStatus(client.manager).connections, 2U);
}

// This process's resources: resident memory (KiB), descriptors and threads.
struct Holdings {
  long memory = 0;
  long descriptors = 0;
  long threads = 0;

  static Holdings now() {
    Holdings holdings;
    std::ifstream file("/proc/self/status");
    for (std::string word; file >> word;) {
      if (word == "VmRSS:") file >> holdings.memory;
    }
    holdings.descriptors = std::distance(std::filesystem::directory_iterator("/proc/self/fd"), {});
    holdings.threads = std::distance(std::filesystem::directory_iterator("/proc/self/task"), {});
    return holdings;
  }
  // The least in a quarter of a second: a file of the configuration being written, say, is open for a moment only.
  static Holdings atRest() {
    Holdings least = now();
    for (int count = 0; count < 50; ++count) {
      std::this_thread::sleep_for(5ms);
      const Holdings holdings = now();
      least.memory = std::min(least.memory, holdings.memory);
      least.descriptors = std::min(least.descriptors, holdings.descriptors);
      least.threads = std::min(least.threads, holdings.threads);
    }
    return least;
  }
};

TEST_F(PeerServer, TwoThousandReconnectsLeaveNothingBehind) {
  const ConfigurationStore store(folder / "state");
  serve({}, store);
  constexpr std::uint64_t clients = 28;
  constexpr std::uint64_t rounds = 72;
  std::vector<std::unique_ptr<Client>> all;
  for (std::uint64_t number = 0; number < clients; ++number) {
    all.push_back(std::make_unique<Client>(path, 2));
    all.back()->listen(rrcStateOnly);
  }
  Holdings early;
  for (std::uint64_t round = 1; round <= rounds; ++round) {
    server.reset();
    serve({}, store);
    for (const auto& client : all) {
      ASSERT_TRUE(eventually([&] { return rhox::client::connectionStatus(client->manager).connections == round + 1; }));
    }
    // Each is served as before.
    ASSERT_TRUE(eventually([&] {
      Dictionary details;
      details.set(rhox::kKeyDetails, Object(true));
      Object reply;
      rhox::client::PerformCommand(all[0]->manager, rhox::kCommandStatus, details, reply);
      const Object* told = reply.asDictionary() == nullptr ? nullptr : reply.asDictionary()->find(rhox::kKeyClients);
      if (told == nullptr || told->asArray()->size() != clients) return false;
      return std::all_of(told->asArray()->begin(), told->asArray()->end(), [](const Object& client) {
        return *client.asDictionary()->find(rhox::kKeyListening)->asBool();
      });
    }));
    control->deliver(rrcState, {0x10, static_cast<std::uint8_t>(round)});
    for (const auto& client : all) ASSERT_TRUE(eventually([&] { return client->metrics().size() == round; }));
    if (round == rounds / 4) early = Holdings::atRest();
  }
  const Holdings late = Holdings::atRest();
  EXPECT_EQ(late.descriptors, early.descriptors);
  EXPECT_EQ(late.threads, early.threads);
  if (!sanitized) {
    EXPECT_LT(late.memory - early.memory, 2048) << "KiB";
  }
}

TEST_F(PeerServer, EndsWithClientsConnected) {
  Client client(path, 2);
  client.listen(both);
  server.reset();
  EXPECT_GE(control->stops, 1);
  EXPECT_NE(::access(path.c_str(), F_OK), 0);
}

// Connects as the user nobody, in a child process, and waits for the other end to close; the exit status is the
// outcome.
enum Outcome { closed = 0, notConnected = 1, served = 2 };
int connectAsNobody(const std::string& path) {
  constexpr uid_t nobody = 65534;
  const pid_t child = ::fork();
  if (child == 0) {
    if (::setgid(nobody) != 0 || ::setuid(nobody) != 0) ::_exit(9);
    const int descriptor = connectTo(path);
    if (descriptor < 0) ::_exit(notConnected);
    pollfd ready{descriptor, POLLIN, 0};
    char byte = 0;
    ::_exit(::poll(&ready, 1, 5000) == 1 && ::recv(descriptor, &byte, 1, 0) <= 0 ? closed : served);
  }
  int status = 0;
  ::waitpid(child, &status, 0);
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

TEST_F(PeerServer, AnotherUserCannotConnect) {
  if (::geteuid() != 0) GTEST_SKIP() << "only the administrator can become another user";
  ASSERT_EQ(::chmod(folder.path().c_str(), 0755), 0);
  EXPECT_EQ(connectAsNobody(path), notConnected);
}

TEST_F(PeerServer, AnotherUserIsTurnedAwayEvenWhenTheSocketsFileIsOpenToAll) {
  if (::geteuid() != 0) GTEST_SKIP() << "only the administrator can become another user";
  const LoggedLines lines;
  ASSERT_EQ(::chmod(folder.path().c_str(), 0755), 0);
  ASSERT_EQ(::chmod(path.c_str(), 0666), 0);
  EXPECT_EQ(connectAsNobody(path), closed);
  EXPECT_THAT(lines.all(), ElementsAre("refused a connection of user 65534"));
}

}  // namespace
}  // namespace vespscope::test
