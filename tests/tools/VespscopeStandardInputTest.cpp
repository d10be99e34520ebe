// Live recordings that the programs read from standard input.
#include <fcntl.h>
#include <signal.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "Program.h"
#include "sources/diag/Bytes.h"
#include "sources/diag/LiteralRecords.h"
#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

const std::filesystem::path programs = VESPSCOPE_BIN_DIR;

// A pipe whose reading end is the standard input of a process.
class LivePipe {
 public:
  LivePipe() { EXPECT_EQ(::pipe2(ends_.data(), O_CLOEXEC), 0); }
  LivePipe(const LivePipe&) = delete;
  LivePipe& operator=(const LivePipe&) = delete;
  ~LivePipe() {
    for (const int end : ends_) ::close(end);
  }
  [[nodiscard]] std::string path() const { return "/proc/self/fd/" + std::to_string(ends_[0]); }
  void write(const std::string& bytes) const {
    EXPECT_EQ(::write(ends_[1], bytes.data(), bytes.size()), static_cast<ssize_t>(bytes.size()));
  }

 private:
  std::array<int, 2> ends_{-1, -1};
};

std::string textOf(const Bytes& bytes) { return {bytes.begin(), bytes.end()}; }

// The number of events of a metric in the viewer's log lines.
std::size_t eventsIn(const std::string& output, const std::string& metric) {
  const std::string line = "Metric ID in Hex = " + metric + "\n";
  std::size_t count = 0;
  for (std::size_t at = output.find(line); at != std::string::npos; at = output.find(line, at + 1)) ++count;
  return count;
}

bool waitForEvents(Process& viewer, const std::string& metric, std::size_t count) {
  const auto begin = std::chrono::steady_clock::now();
  while (eventsIn(viewer.output(), metric) < count) {
    if (std::chrono::steady_clock::now() - begin > processPatience) return false;
    viewer.readFor(std::chrono::milliseconds(20));
  }
  return true;
}

std::string packetOf(std::uint8_t number) {
  // metric_id 0x3C4E04, and a payload that differs from event to event.
  const std::string whole =
      captureOf(std::vector<MetricEvent>{{0x3C4E04, 0, {0x10, number}, std::chrono::milliseconds(100 * number)}});
  return whole.substr(captureOf(std::vector<MetricEvent>{}).size());
}

TEST(VespscopeStandardInput, FeedsAnEmbeddedReplayFromALivePipe) {
  const LivePipe pipe;
  Process viewer(programs / "vespscope", {"--ui", "none", "--manager", "embedded:replay:-"}, {}, pipe.path());
  pipe.write(captureOf(std::vector<MetricEvent>{}));
  for (std::uint8_t number = 1; number <= 3; ++number) {
    pipe.write(packetOf(number));
    ASSERT_TRUE(waitForEvents(viewer, "3C4E04", number)) << viewer.output() << viewer.errors();
  }
  viewer.signal(SIGTERM);
  EXPECT_EQ(viewer.wait(), (ProcessEnd{false, 0}));
}

TEST(VespscopeStandardInput, FeedsAnEmbeddedLogFromALivePipeFromItsFirstRecordOn) {
  const LivePipe pipe;
  Process viewer(programs / "vespscope", {"--ui", "none", "--manager", "embedded:diag:-"}, {}, pipe.path());
  for (std::uint8_t number = 1; number <= 3; ++number) {
    Bytes cell = bytesOf(literal::servingCellV3);
    cell[1] = number;  // the physical identity
    pipe.write(textOf(frameOf(recordOf(0xB0C2, 1000 + 100ULL * number, cell))));
    ASSERT_TRUE(waitForEvents(viewer, "3C40C2", number)) << viewer.output() << viewer.errors();
  }
  viewer.signal(SIGTERM);
  EXPECT_EQ(viewer.wait(), (ProcessEnd{false, 0}));
}

// A program that waits on a pipe without a writer.
struct Waiting {
  std::string program;
  std::vector<std::string> arguments;
};

TEST(VespscopeStandardInput, KeepsNoProgramFromEndingWhileItIsSilent) {
  const std::vector<Waiting> table = {
      {"vespscope", {"--ui", "none", "--manager", "embedded:diag:-"}},
      {"vespscope", {"--ui", "none", "--manager", "embedded:replay:-"}},
      {"rhoxd", {"--state", "none", "--listen", "", "--source", "diag:-"}},
      {"rhoxd", {"--state", "none", "--listen", "", "--source", "replay:-"}},
  };
  for (const Waiting& waiting : table) {
    SCOPED_TRACE(waiting.program + " " + waiting.arguments.back());
    const TemporaryFolder folder;
    std::vector<std::string> arguments = waiting.arguments;
    if (waiting.program == "rhoxd") {
      arguments[3] = "unix:path=" + (folder / "socket");
      // A recorder starts the source without a client.
      arguments.insert(arguments.end(), {"--record", folder / "recordings"});
    }
    const LivePipe pipe;
    Process process(programs / waiting.program, arguments, {}, pipe.path());
    ASSERT_TRUE(waiting.program == "rhoxd" ? process.waitForOutput("rhoxd: ")
                                           : process.waitForErrors("listening for events"))
        << process.errors();
    process.readFor(std::chrono::milliseconds(100));
    const auto begin = std::chrono::steady_clock::now();
    process.signal(SIGTERM);
    EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(2));
  }
}

}  // namespace
}  // namespace vespscope::test
