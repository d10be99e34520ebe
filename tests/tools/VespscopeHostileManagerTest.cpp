// The memory that a hostile manager costs the viewer, and the viewer's state after a manager was restarted without its
// own.
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "registry/MetricRows.h"
#include "support/Eventually.h"
#include "support/FakeManager.h"
#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

const std::filesystem::path viewer = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope";

constexpr long bar = 32 * 1024;  // KiB that a hostile manager may cost

// A line of /proc/PID/status in KiB: "VmRSS" is the current memory, "VmHWM" the maximum.
long memoryOf(const Process& process, const std::string& name) {
  std::ifstream file("/proc/" + std::to_string(process.identifier()) + "/status");
  for (std::string line; std::getline(file, line);) {
    if (line.starts_with(name + ":")) return std::stol(line.substr(name.size() + 1));
  }
  return -1;
}

class VespscopeHostileManager : public ::testing::Test {
 protected:
  VespscopeHostileManager() {
    folder_.write("ice_test_lte.deviceconfig", "any");
    if (std::string(VESPSCOPE_SANITIZE) != "") return;
    process_ =
        std::make_unique<Process>(viewer, std::vector<std::string>{"--ui", "none", "--manager", manager_.address()},
                                  std::map<std::string, std::string>{{"VESPSCOPE_RESOURCES", folder_.path().string()}});
  }
  void SetUp() override {
    if (!process_) GTEST_SKIP() << "memory is not measured under sanitizers";
    ASSERT_TRUE(manager_.waitForCalls(7));
    ASSERT_TRUE(eventually([this] { return manager_.eventsOn(); }));
    manager_.sendTrigger("first");
    ASSERT_TRUE(process_->waitForOutput("I dont care for events\n"));
    idle_ = memoryOf(*process_, "VmRSS");
    ASSERT_GT(idle_, 0);
  }
  // The viewer is running, still accepts events, and has never exceeded the limit.
  void TearDown() override {
    if (!process_) return;
    const std::size_t before = process_->output().size();
    EXPECT_TRUE(eventually([this] { return manager_.eventsOn(); }));
    manager_.sendTrigger("last");
    EXPECT_TRUE(process_->waitForOutput("I dont care for events\n", before));
    const long cost = memoryOf(*process_, "VmHWM") - idle_;
    RecordProperty("cost_kib", static_cast<int>(cost));
    EXPECT_LE(cost, bar);
    process_->signal(SIGTERM);
    EXPECT_EQ(process_->wait(), (ProcessEnd{false, 0}));
  }

  TemporaryFolder folder_;
  FakeManager manager_{folder_ / "socket"};
  std::unique_ptr<Process> process_;
  long idle_ = 0;
};

TEST_F(VespscopeHostileManager, CostsLittleByHugeEvents) {
  const Bytes huge(std::size_t{16} << 20, 0x10);
  for (std::size_t round = 1; round <= 4; ++round) {
    manager_.sendMetric(3952132, huge);
    ASSERT_TRUE(manager_.waitForConnections(round + 1));
    ASSERT_TRUE(eventually([this] { return manager_.eventsOn(); }));
  }
}

TEST_F(VespscopeHostileManager, CostsLittleByAHugeLabel) {
  manager_.setSource(std::string(std::size_t{30} << 20, 'x'), "live");
  manager_.disconnect();
  ASSERT_TRUE(manager_.waitForConnections(3));
  manager_.setSource("sane", "live");
}

TEST_F(VespscopeHostileManager, CostsLittleByTheLargestEventsOfEveryMetric) {
  // Each field in turn, repeatedly: two bytes make an element of a list.
  for (std::uint8_t field = 2; field <= 15; ++field) {
    Bytes payload;
    while (payload.size() < 16'000) payload.insert(payload.end(), {static_cast<std::uint8_t>(field << 3 | 2), 0});
    for (const MetricRow& row : metricRows) manager_.sendMetric(row.identifier(), payload);
    manager_.sendTrigger("round");
    const std::size_t before = process_->output().size();
    ASSERT_TRUE(process_->waitForOutput("I dont care for events\n", before));
  }
}

TEST_F(VespscopeHostileManager, CostsLittleByAFloodOfEvents) {
  for (int number = 0; number < 50'000; ++number) manager_.sendMetric(3952132, Bytes(200, 0x10));
  ASSERT_TRUE(eventually([this] {
    process_->readFor(1ms);
    return process_->output().size() > 1'000'000;
  }));
}

}  // namespace
}  // namespace vespscope::test
