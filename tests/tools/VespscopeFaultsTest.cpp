// The viewer when its outputs or its manager fail, and with oversized texts and lists.
#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <filesystem>
#include <memory>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "messages/lte/EgwErrcNbrEutraMeas.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"
#include "rhoxlink/bus/Names.h"
#include "support/Eventually.h"
#include "support/FakeManager.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using ::testing::HasSubstr;
using ::testing::StartsWith;

const std::filesystem::path viewer = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope";

std::size_t countOf(const std::string& text, const std::string& part) {
  std::size_t count = 0;
  for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + part.size())) ++count;
  return count;
}

class VespscopeFaults : public ::testing::Test {
 protected:
  VespscopeFaults() { folder_.write("ice_test_lte.deviceconfig", "any"); }

  // Returns true when all calls of the start-up have arrived.
  [[nodiscard]] bool started() const { return manager_.waitForCalls(7) && manager_.eventsOn(); }
  // The viewer with its outputs redirected as in `words`.
  [[nodiscard]] Process redirected(const std::string& words) {
    return {"/bin/sh",
            {"-c", "exec " + viewer.string() + " --ui none --manager " + manager_.address() + " " + words},
            variables_};
  }

  TemporaryFolder folder_;
  FakeManager manager_{folder_ / "manager.socket"};
  std::map<std::string, std::string> variables_{{"VESPSCOPE_RESOURCES", folder_.path().string()}, {"TZ", "UTC"}};
  const std::vector<std::string> arguments_ = {"--ui", "none", "--manager", manager_.address()};
  const MetricEvent event_ = scriptedRun().front();
};

// A pipe at `path` that accepts only as much as it holds, because nothing reads it until a test does.
struct StuckPipe {
  explicit StuckPipe(std::string where)
      : path(std::move(where)),
        end(::mkfifo(path.c_str(), 0600) == 0 ? ::open(path.c_str(), O_RDWR | O_CLOEXEC) : -1) {}
  StuckPipe(const StuckPipe&) = delete;
  StuckPipe& operator=(const StuckPipe&) = delete;
  ~StuckPipe() {
    if (end >= 0) ::close(end);
  }

  const std::string path;
  const int end;  // negative if there is none
};

TEST_F(VespscopeFaults, WithAFullStandardOutputContinuesAndEndsNormally) {
  Process process = redirected(">/dev/full");
  ASSERT_TRUE(started());
  manager_.sendMetric(event_.metricID, event_.payload);
  if (::access("/dev/log", F_OK) != 0) {
    ASSERT_TRUE(process.waitForErrors("MetricsTrigger dict=[kKeyMetricID: 3952132"));
  }
  manager_.disconnect();
  EXPECT_TRUE(manager_.waitForConnections(2));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

TEST_F(VespscopeFaults, IsNotDelayedByAStuckSystemLogWhichReportsLaterWhatIsMissing) {
  if (::access("/dev/log", F_OK) == 0) GTEST_SKIP() << "this machine has a log daemon";
  const StuckPipe log(folder_ / "stuck");
  ASSERT_GE(log.end, 0);
  Process process = redirected("2>" + log.path);
  ASSERT_TRUE(started());
  // More than the pipe and the queue hold.
  constexpr std::size_t sent = 20'000;
  for (std::size_t count = 0; count < sent; ++count) manager_.sendMetric(event_.metricID, event_.payload);
  manager_.sendTrigger("last");
  ASSERT_TRUE(process.waitForOutput("I dont care for events\n"));
  EXPECT_EQ(countOf(process.output(), "Received Valid Metric\n"), sent);

  // When it is read again, the log has whole lines, and reports how many are missing.
  ASSERT_EQ(::fcntl(log.end, F_SETFL, O_NONBLOCK), 0);
  std::string text;
  const auto readOn = [&] {
    std::array<char, 65536> piece{};
    const ssize_t size = ::read(log.end, piece.data(), piece.size());
    if (size > 0) text.append(piece.data(), static_cast<std::size_t>(size));
    return size > 0;
  };
  const std::string told = "the system log did not keep up: ";
  ASSERT_TRUE(
      eventually([&] { return !readOn() && text.find(told) != std::string::npos && text.back() == '\n'; }, 20s));
  const std::size_t missing = std::stoul(text.substr(text.find(told) + told.size()));
  const std::string line = "-[RhoxWrapper listen]_block_invoke: ";
  EXPECT_EQ(countOf(text, told), 1U);
  EXPECT_EQ(countOf(text, "\n" + line) + missing, sent + 1);
  manager_.sendTrigger("after");
  EXPECT_TRUE(eventually([&] { return readOn() && text.find("after") != std::string::npos; }));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

TEST_F(VespscopeFaults, EndsInOrderWhileItsSystemLogIsStuck) {
  if (::access("/dev/log", F_OK) == 0) GTEST_SKIP() << "this machine has a log daemon";
  const StuckPipe log(folder_ / "stuck");
  ASSERT_GE(log.end, 0);
  Process process = redirected("2>" + log.path);
  ASSERT_TRUE(started());
  for (int count = 0; count < 2000; ++count) manager_.sendMetric(event_.metricID, event_.payload);
  manager_.sendTrigger("last");
  ASSERT_TRUE(process.waitForOutput("I dont care for events\n"));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

TEST_F(VespscopeFaults, WhoseManagerIsLateWithAnAnswerSaysSoAndShowsItsEventsAllTheSame) {
  manager_.answer(rhox::kCommandAddConfiguration, {FakeManager::Answer::Manner::silence, 0, ""});
  Process process(viewer, arguments_, variables_);
  // Without an accepted configuration it sends no further requests.
  ASSERT_TRUE(manager_.waitForCalls(4));
  manager_.sendMetric(event_.metricID, event_.payload);
  EXPECT_TRUE(process.waitForOutput("Received Valid Metric\n"));
  EXPECT_THAT(process.output(), StartsWith("pushing metric file\nMetric ID in Hex = 3C4E04\n"));
  if (::access("/dev/log", F_OK) != 0) {
    EXPECT_TRUE(process.waitForErrors("msg=the baseband manager did not answer within 2000 ms\n"));
  }
}

TEST_F(VespscopeFaults, PrintsFifteenThousandBytesOfTextWholeAndNothingOfThemActsOnATerminal) {
  // Colours, a title, a C1 control, DEL, a directional override, and a byte that is not text.
  const std::string hostile = "\x1b[31m\x1b]0;title\x07\u009b2J\x7f\u202e\xff\r\n";
  std::string name;
  while (name.size() < 15'000) name += hostile;
  const std::size_t repeats = name.size() / hostile.size();
  KCellularActivatedBearerContexts message;
  const auto bearer = std::make_shared<BearerContext>();
  bearer->setApn(name);
  message.addBearerContexts(bearer);
  Process process(viewer, arguments_, variables_);
  ASSERT_TRUE(started());
  manager_.sendMetric(metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), message.encoded());
  manager_.sendTrigger("last");
  ASSERT_TRUE(process.waitForOutput("I dont care for events\n"));
  const std::string shown = "␛[31m␛]0;title␇\uFFFD2J␡\uFFFD\uFFFD␍␊";
  EXPECT_EQ(countOf(process.output(), shown), repeats);
  for (const std::string& text : {process.output(), process.errors()}) {
    EXPECT_EQ(text.find_first_of(std::string("\x1b\x07\x7f\r\xff")), std::string::npos);
    EXPECT_EQ(text.find("\u009b"), std::string::npos);
    EXPECT_EQ(text.find("\u202e"), std::string::npos);
  }
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

TEST_F(VespscopeFaults, TakesAListOfTwoThousandNeighbours) {
  constexpr std::uint32_t count = 2048;
  KCellularLteNbrEutraCellMeas message;
  for (std::uint32_t number = 0; number < count; ++number) {
    const auto carrier = std::make_shared<EgwErrcNbrEutraMeas>();
    carrier->setNbrEarfcn(number);
    message.addMeasNbrEutra(carrier);
  }
  Process process(viewer, arguments_, variables_);
  ASSERT_TRUE(started());
  manager_.sendMetric(metricIdentifier("K_LTE_INTRARAT_MEAS"), message.encoded());
  ASSERT_TRUE(process.waitForOutput("Received Valid Metric\n"));
  EXPECT_GE(countOf(process.output(), "[nbr_earfcn: "), count);
  EXPECT_THAT(process.output(), HasSubstr("[nbr_earfcn: 2047]"));
}

}  // namespace
}  // namespace vespscope::test
