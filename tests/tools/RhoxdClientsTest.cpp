// The cost of several clients for a manager and for each other, its report about them, and rejected clients.
#include <fcntl.h>
#include <signal.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/un.h>
#include <unistd.h>

#include <chrono>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "manager/DeliveryQueue.h"
#include "manager/embedded/EmbeddedManagers.h"
#include "registry/MetricRows.h"
#include "support/Eventually.h"
#include "support/OtherUser.h"
#include "support/Process.h"
#include "support/ServiceBus.h"
#include "support/TemporaryFolder.h"
#include "values/Sanitized.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using nlohmann::json;
using ::testing::HasSubstr;

const std::filesystem::path programs = VESPSCOPE_BIN_DIR;

json statusOf(const std::string& address) {
  return json::parse(vespctl({"status", "--manager", address}).output, nullptr, false);
}

// The client of that name; null if there is none.
json clientOf(const json& status, int process) {
  for (const json& client : status.value("clients", json::array())) {
    if (client.value("process", 0) == process) return client;
  }
  return nullptr;
}

// In KiB.
long residentMemory(pid_t process) {
  std::ifstream file("/proc/" + std::to_string(process) + "/status");
  for (std::string word; file >> word;) {
    long size = 0;
    if (word == "VmRSS:" && file >> size) return size;
  }
  return 0;
}

std::string connectResult(const std::string& path) {
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, path.c_str(), sizeof name.sun_path - 1);
  if (::connect(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name) != 0) return std::strerror(errno);
  // The beginning of the protocol; a manager that serves this user answers.
  const std::string hello("\0AUTH EXTERNAL\r\nDATA\r\nBEGIN\r\n", 30);
  if (::send(descriptor, hello.data(), hello.size(), MSG_NOSIGNAL) < 0) return "closed";
  char answer = 0;
  return ::recv(descriptor, &answer, 1, 0) == 1 ? "answered" : "closed";
}

class RhoxdClients : public ::testing::Test {
 protected:
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  const std::string address = "unix:path=" + path;
};

TEST_F(RhoxdClients, AreListedByVespctlStatus) {
  Process daemon(programs / "rhoxd", {"--listen", address, "--source", "scenario:seed=3,speed=20", "--state", "none"});
  ASSERT_TRUE(daemon.waitForOutput("rhoxd: ")) << daemon.errors();
  Process screen(programs / "vespscope", {"--ui", "none", "--manager", address});
  ASSERT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR")) << screen.errors();
  const json status = statusOf(address);
  ASSERT_TRUE(status.is_object());
  EXPECT_EQ(status["source"], (json{{"label", "scenario seed=3"}, {"kind", "simulated"}}));
  EXPECT_GE(status["uptime_s"], 0);
  ASSERT_EQ(status["configurations"].size(), 1U);
  EXPECT_EQ(status["configurations"][0]["application"], 2);
  EXPECT_GT(status["configurations"][0]["metrics"], 20);
  ASSERT_EQ(status["clients"].size(), 2U);
  const json& viewer = status["clients"][0];
  EXPECT_EQ(viewer["name"], "vespscope");
  EXPECT_EQ(viewer["application"], 2);
  EXPECT_EQ(viewer["user"], ::geteuid());
  EXPECT_EQ(viewer["process"], screen.identifier());
  EXPECT_EQ(viewer["listening"], true);
  EXPECT_GT(viewer["delivered"], 0);
  EXPECT_EQ(viewer["lost"], 0);
  EXPECT_EQ(viewer.contains("bus_name"), false);
  EXPECT_EQ(status["clients"][1]["name"], "vespctl");
  EXPECT_EQ(status["clients"][1]["listening"], false);
}

TEST_F(RhoxdClients, AreNotAskedForWhereThereIsNoneToAsk) {
  const Outcome embedded = vespctl({"status", "--manager", "embedded:scenario"});
  EXPECT_EQ(embedded.status, 2);
  EXPECT_EQ(embedded.errors,
            "vespctl: an embedded manager serves its own program only: it cannot be queried from outside\n");
  const Outcome nowhere = vespctl({"status", "--manager", address});
  EXPECT_EQ(nowhere.status, 2);
  EXPECT_EQ(nowhere.errors,
            "vespctl: not connected to a baseband manager: no manager at " + path + ": No such file or directory\n");
}

// One client is stopped while the source delivers as fast as it can; another continues to read.
class RhoxdClientsStopped : public RhoxdClients {
 protected:
  void standsStill(const std::string& manager, pid_t daemon) {
    Process good(programs / "vespctl", {"record", "/dev/null", "--manager", manager});
    Process stopped(programs / "vespctl", {"record", "/dev/null", "--manager", manager});
    ASSERT_TRUE(eventually(
        [&] {
          const json status = statusOf(manager);
          return clientOf(status, good.identifier()).is_object() &&
                 clientOf(status, stopped.identifier()).is_object() &&
                 clientOf(status, stopped.identifier())["delivered"] > 20'000;
        },
        60s));
    stopped.signal(SIGSTOP);
    const long before = residentMemory(daemon);
    json first;
    ASSERT_TRUE(eventually(
        [&] {
          first = statusOf(manager);
          return clientOf(first, stopped.identifier())["lost"] > 0;
        },
        60s));
    const std::int64_t goodBefore = clientOf(first, good.identifier())["delivered"];
    const std::int64_t stoppedBefore = clientOf(first, stopped.identifier())["delivered"];
    // Several times the number of events that may wait for it, while the other client continues.
    constexpr std::size_t bound = manager::DeliveryQueue::Bounds{}.events;
    json last;
    ASSERT_TRUE(eventually(
        [&] {
          last = statusOf(manager);
          return clientOf(last, stopped.identifier())["lost"] > 4 * bound &&
                 clientOf(last, good.identifier())["delivered"] > goodBefore + 10'000;
        },
        120s));
    // It is sent only the events in transit when it stopped.
    EXPECT_LE(clientOf(last, stopped.identifier())["delivered"], stoppedBefore + 2048);
    EXPECT_LE(clientOf(last, stopped.identifier())["queued"], bound);
    const long cost = residentMemory(daemon) - before;
    RecordProperty("cost_KiB", static_cast<int>(cost));
    // A sanitizer keeps a shadow of touched memory, and released blocks.
    if (!sanitized) {
      EXPECT_LT(cost, 4096) << "KiB";
    }
    // After that it continues, and its lost events are counted.
    stopped.signal(SIGCONT);
    EXPECT_TRUE(eventually(
        [&] { return clientOf(statusOf(manager), stopped.identifier())["delivered"] > stoppedBefore + 1000; }, 60s));
  }
};

TEST_F(RhoxdClientsStopped, CostsAManagerOnASocketLittleAndOtherClientsNothing) {
  Process daemon(programs / "rhoxd",
                 {"--listen", address, "--source", "scenario:seed=3,speed=5000", "--state", "none"});
  ASSERT_TRUE(daemon.waitForOutput("rhoxd: ")) << daemon.errors();
  standsStill(address, daemon.identifier());
}

TEST_F(RhoxdClientsStopped, CostsAManagerOnTheSystemBusLittleAndOtherClientsNothing) {
  const ServiceBus bus;
  Process daemon(programs / "rhoxd", {"--system", "--source", "scenario:seed=3,speed=5000", "--state", "none"});
  ASSERT_TRUE(daemon.waitForOutput("rhoxd: ")) << daemon.errors();
  standsStill("system", daemon.identifier());
}

// A viewer that receives every event and is blocked in some way while they continue.
class RhoxdClientsBlockedViewer : public RhoxdClients {
 protected:
  RhoxdClientsBlockedViewer() {
    std::string toml = "[metrics]\n";
    for (const MetricRow& row : metricRows) toml += std::string(row.identifierName) + " = { on = \"event\" }\n";
    folder.write("ice_test_lte.deviceconfig", toml);
  }

  void losesTheOldestEventsAndKeepsItsMemory(const std::function<void(const Process&)>& stop,
                                             const std::function<void(const Process&)>& goOn) {
    Process daemon(programs / "rhoxd",
                   {"--listen", address, "--source", "scenario:seed=3,speed=2000", "--state", "none"});
    ASSERT_TRUE(daemon.waitForOutput("rhoxd: ")) << daemon.errors();
    Process viewer(programs / "vespscope", {"--ui", "none", "--manager", address},
                   {{"VESPSCOPE_RESOURCES", folder.path().string()}});
    ASSERT_TRUE(viewer.waitForOutput("Received RSRP RSRQ SINR")) << viewer.errors();
    stop(viewer);
    json status;
    ASSERT_TRUE(eventually(
        [&] {
          status = statusOf(address);
          return clientOf(status, viewer.identifier())["lost"] > 0;
        },
        60s));
    // By now it has reached its maximum memory.
    const long before = residentMemory(viewer.identifier());
    const std::int64_t delivered = clientOf(status, viewer.identifier())["delivered"];
    ASSERT_TRUE(eventually([&] { return clientOf(statusOf(address), viewer.identifier())["lost"] > 15'000; }, 120s));
    EXPECT_LE(clientOf(statusOf(address), viewer.identifier())["delivered"], delivered + 2048);
    if (!sanitized) {
      EXPECT_LT(residentMemory(viewer.identifier()) - before, 1024) << "KiB";
    }
    goOn(viewer);
    const std::size_t position = viewer.output().size();
    EXPECT_TRUE(viewer.waitForOutput("Received RSRP RSRQ SINR", position));
    EXPECT_TRUE(eventually(
        [&] {
          viewer.readFor(200ms);
          return clientOf(statusOf(address), viewer.identifier())["delivered"] > delivered + 5000;
        },
        60s));
  }
};

TEST_F(RhoxdClientsBlockedViewer, BecauseItIsStoppedLosesTheOldestEventsCountedAndContinues) {
  losesTheOldestEventsAndKeepsItsMemory([](const Process& viewer) { viewer.signal(SIGSTOP); },
                                        [](const Process& viewer) { viewer.signal(SIGCONT); });
}

TEST_F(RhoxdClientsBlockedViewer, BecauseNothingReadsItsOutputLosesTheOldestEventsCountedAndContinues) {
  losesTheOldestEventsAndKeepsItsMemory([](const Process& /*viewer*/) {}, [](const Process& /*viewer*/) {});
}

class RhoxdClientsOfAnotherUser : public RhoxdClients {
 protected:
  void SetUp() override {
    if (::geteuid() != 0) GTEST_SKIP() << "only the administrator can act as other users";
    ::chmod(folder.path().c_str(), 0755);
  }
};

TEST_F(RhoxdClientsOfAnotherUser, IsNotServedOnASocket) {
  Process daemon(programs / "rhoxd", {"--listen", address, "--source", "scenario", "--state", "none"});
  ASSERT_TRUE(daemon.waitForOutput("rhoxd: ")) << daemon.errors();
  EXPECT_EQ(connectResult(path), "answered");
  EXPECT_EQ(asUser(nobody, {}, [this] { return connectResult(path); }), "Permission denied");
  // Also not after the file's mode has been changed to allow access.
  ASSERT_EQ(::chmod(path.c_str(), 0777), 0);
  EXPECT_EQ(asUser(nobody, {}, [this] { return connectResult(path); }), "closed");
  EXPECT_EQ(connectResult(path), "answered");
}

TEST_F(RhoxdClientsOfAnotherUser, CannotTakeTheSocketOfAManagerInsideAViewer) {
  const manager::EmbeddedManagers managers;
  auto embedded = managers.factory()("scenario");
  ASSERT_TRUE(embedded.ok());
  const pid_t viewer = ::getpid();
  const int wanted = embedded->descriptor;
  const auto take = [viewer, wanted] {
    const auto process = static_cast<int>(::syscall(SYS_pidfd_open, viewer, 0));
    const long taken = ::syscall(SYS_pidfd_getfd, process, wanted, 0);
    return taken >= 0 ? std::string("taken") : std::string(std::strerror(errno));
  };
  EXPECT_EQ(asUser(0, {}, take), "taken");
  EXPECT_EQ(asUser(nobody, {}, take), "Operation not permitted");
  ::close(embedded->descriptor);
}

}  // namespace
}  // namespace vespscope::test
