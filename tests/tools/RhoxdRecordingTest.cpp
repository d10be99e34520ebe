// Recordings as a user makes and replays them: a replay leads to the same state as the original.
#include <fcntl.h>
#include <signal.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Program.h"
#include "support/Eventually.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"
#include "support/SharedCaptures.h"
#include "support/WrittenLog.h"
#include "values/Sanitized.h"

namespace vespscope::test {
namespace {

using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::StartsWith;

const std::filesystem::path daemonProgram = std::filesystem::path(VESPSCOPE_BIN_DIR) / "rhoxd";
const std::filesystem::path tool = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl";

// The captures in a folder; a file without a header has another name.
std::vector<std::string> filesIn(const std::string& folder) {
  std::vector<std::string> files;
  std::error_code absent;
  for (const auto& entry : std::filesystem::directory_iterator(folder, absent)) {
    if (entry.path().extension() == ".pcap") files.push_back(entry.path().string());
  }
  std::sort(files.begin(), files.end());
  return files;
}

std::uintmax_t sizeOf(const std::string& folder) {
  std::uintmax_t size = 0;
  std::error_code gone;
  for (const std::string& file : filesIn(folder)) {
    const std::uintmax_t bytes = std::filesystem::file_size(file, gone);
    if (!gone) size += bytes;
  }
  return size;
}

std::string stateOf(const std::string& capture) {
  const Outcome outcome = vespctl({"state", capture});
  EXPECT_EQ(outcome.status, 0) << outcome.errors;
  return outcome.output;
}

// A recording manager without any client.
class Recorder {
 public:
  Recorder(const TemporaryFolder& folder, const std::string& source, const std::vector<std::string>& options = {})
      : process_(daemonProgram, arguments(folder, source, options)) {
    EXPECT_TRUE(process_.waitForOutput(", recording into " + (folder / "rec") + "\n")) << process_.errors();
  }
  Process& process() { return process_; }
  void end() {
    process_.signal(SIGTERM);
    EXPECT_EQ(process_.wait(), (ProcessEnd{false, 0})) << process_.errors();
  }

 private:
  static std::vector<std::string> arguments(const TemporaryFolder& folder, const std::string& source,
                                            const std::vector<std::string>& options) {
    std::vector<std::string> all = {
        "--listen",    "unix:path=" + (folder / "socket"), "--source", source, "--state", "none", "--record",
        folder / "rec"};
    all.insert(all.end(), options.begin(), options.end());
    return all;
  }
  Process process_;
};

// What is recorded and replayed: a source to convert, and its length.
struct Subject {
  std::string name;
  std::string source;
  std::vector<std::string> limit;
};

constexpr const char* written = "written";  // the log written by the tests

class RhoxdRecordingReplayed : public ::testing::TestWithParam<Subject> {
 protected:
  // The capture of the source; empty when the source is not available.
  std::string original() {
    std::string source = GetParam().source;
    if (source == written) {
      const Bytes log = writtenLog();
      source = "diag:" + folder_.write("written.mi2log", std::string(log.begin(), log.end()));
    }
    if (source.starts_with("diag:") && !std::filesystem::exists(source.substr(5))) return "";
    std::vector<std::string> arguments = {"convert", source, folder_ / "original.pcap"};
    arguments.insert(arguments.end(), GetParam().limit.begin(), GetParam().limit.end());
    const Outcome outcome = vespctl(arguments);
    EXPECT_EQ(outcome.status, 0) << outcome.errors;
    return folder_ / "original.pcap";
  }
  TemporaryFolder folder_;
};

TEST_P(RhoxdRecordingReplayed, ByTheManagerGivesTheSameBytesAndTheSameState) {
  const std::string first = original();
  if (first.empty())
    GTEST_SKIP() << "not run: no capture for " << GetParam().name << "; VESPSCOPE_CAPTURES names their folder";
  const std::string bytes = contentsOf(first);
  ASSERT_GT(bytes.size(), 1000U);
  {
    Recorder recorder(folder_, "replay:" + first + ",speed=max");
    ASSERT_TRUE(eventually([&] { return sizeOf(folder_ / "rec") >= bytes.size(); }));
    recorder.end();
  }
  const std::vector<std::string> files = filesIn(folder_ / "rec");
  ASSERT_EQ(files.size(), 1U);
  EXPECT_EQ(contentsOf(files[0]) == bytes, true);
  EXPECT_EQ(stateOf(folder_ / "rec"), stateOf(first));
}

TEST_P(RhoxdRecordingReplayed, InManySmallFilesGivesTheSameState) {
  const std::string first = original();
  if (first.empty())
    GTEST_SKIP() << "not run: no capture for " << GetParam().name << "; VESPSCOPE_CAPTURES names their folder";
  const std::uintmax_t size = std::filesystem::file_size(first);
  {
    Recorder recorder(folder_, "replay:" + first + ",speed=max", {"--record-size", "4K"});
    // Each file has a header of its own.
    ASSERT_TRUE(
        eventually([&] { return sizeOf(folder_ / "rec") >= size + 24 * (filesIn(folder_ / "rec").size() - 1); }));
    recorder.end();
  }
  EXPECT_GT(filesIn(folder_ / "rec").size(), 3U);
  const Outcome joined = vespctl({"convert", "replay:" + (folder_ / "rec"), folder_ / "joined.pcap"});
  EXPECT_EQ(joined.status, 0) << joined.errors;
  EXPECT_EQ(contentsOf(folder_ / "joined.pcap") == contentsOf(first), true);
  EXPECT_EQ(stateOf(folder_ / "rec"), stateOf(first));
}

// Over the bus every event has the time of its arrival; the decoder's state is the same.
TEST_P(RhoxdRecordingReplayed, ByTheToolThroughAManagerGivesTheSameState) {
  const std::string first = original();
  if (first.empty())
    GTEST_SKIP() << "not run: no capture for " << GetParam().name << "; VESPSCOPE_CAPTURES names their folder";
  const std::size_t events = linesOf(vespctl({"decode", first}).output).size();
  // No faster than a sanitized recorder, which would drop events otherwise.
  const std::string speed = sanitized ? "200" : "1000";
  Process process(tool, {"record", folder_ / "out.pcap", "--manager", "embedded:replay:" + first + ",speed=" + speed});
  // If the log has SIM card files, they occur a second time as the answer to a query.
  const std::string partial = folder_ / "out.partial.pcap";
  const auto recorded = [&] { return linesOf(vespctl({"decode", partial}).output).size(); };
  // Counting takes processor time from the programs, so it starts once there are about enough events.
  const std::uintmax_t size = std::filesystem::file_size(first);
  const auto nearlyAll = [&] {
    std::error_code absent;
    return std::filesystem::file_size(partial, absent) >= size / 10 * 9 && !absent;
  };
  ASSERT_TRUE(eventually([&] { return nearlyAll() && recorded() >= events; }, 6 * processPatience))
      << recorded() << " of " << events;
  process.signal(SIGINT);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(process.errors(), "");
  EXPECT_EQ(stateOf(folder_ / "out.pcap"), stateOf(first));
}

std::string logOf(const std::string& name) { return "diag:" + sharedCapture(name); }

INSTANTIATE_TEST_SUITE_P(Of, RhoxdRecordingReplayed,
                         ::testing::Values(Subject{"AnHourOfTheDrive", "scenario:seed=3", {"--seconds", "3600"}},
                                           Subject{"AnotherDrive", "scenario:seed=8", {"--seconds", "600"}},
                                           Subject{"AWrittenLog", written, {}},
                                           Subject{"ALogWithCarrierAggregation", logOf("lte-ca-drive.mi2log"), {}},
                                           Subject{"ALogOfMobility", logOf("lte-mobility.mi2log"), {}}),
                         [](const auto& parameter) { return parameter.param.name; });

TEST(RhoxdRecording, BeginsWithoutAClientAndServesThemAsEver) {
  const TemporaryFolder folder;
  Recorder recorder(folder, "scenario:seed=3,speed=100");
  ASSERT_TRUE(eventually([&] { return sizeOf(folder / "rec") > 1000; }));
  struct stat status {};
  ASSERT_EQ(::stat((folder / "rec").c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0700U);
  ASSERT_EQ(::stat(filesIn(folder / "rec").at(0).c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600U);
  Process client(tool, {"record", folder / "out.pcap", "--manager", "unix:path=" + (folder / "socket")});
  EXPECT_TRUE(eventually([&] {
    std::error_code absent;
    return std::filesystem::file_size(folder / "out.partial.pcap", absent) > 1000 && !absent;
  }));
  recorder.end();
}

TEST(RhoxdRecording, KeepsBothSimCardsOfALog) {
  const TemporaryFolder folder;
  const Bytes bytes = writtenLogOfTwoSims();
  const std::string log = "diag:" + folder.write("two.mi2log", std::string(bytes.begin(), bytes.end()));
  const Outcome converted = vespctl({"convert", log, folder / "converted.pcap"});
  ASSERT_EQ(converted.status, 0) << converted.errors;
  const std::string all = contentsOf(folder / "converted.pcap");
  Recorder recorder(folder, log + ",speed=max");
  EXPECT_TRUE(eventually([&] { return sizeOf(folder / "rec") >= all.size(); }));
  recorder.end();
  ASSERT_EQ(filesIn(folder / "rec").size(), 1U);
  EXPECT_EQ(contentsOf(filesIn(folder / "rec")[0]) == all, true);
  const std::string decoded = vespctl({"decode", folder / "rec"}).output;
  EXPECT_THAT(decoded, HasSubstr("\"profile_id\":1,"));
  EXPECT_THAT(decoded, HasSubstr("\"profile_id\":2,"));
}

TEST(RhoxdRecording, KeepsToTheSizesItIsGiven) {
  const TemporaryFolder folder;
  Recorder recorder(folder, "scenario:seed=3,speed=200", {"--record-size", "8K", "--record-total", "32K"});
  std::vector<std::string> first;
  ASSERT_TRUE(eventually([&] { return !(first = filesIn(folder / "rec")).empty(); }));
  ASSERT_TRUE(eventually([&] { return !std::filesystem::exists(first[0]); }, processPatience));
  recorder.end();
  EXPECT_LE(sizeOf(folder / "rec"), 32U * 1024);
  for (const std::string& file : filesIn(folder / "rec")) {
    EXPECT_LE(std::filesystem::file_size(file), 8U * 1024);
    EXPECT_EQ(vespctl({"decode", file}).status, 0);
  }
}

TEST(RhoxdRecording, KilledUnderLoadLeavesReadableFilesAndContinuesInNewOnes) {
  const TemporaryFolder folder;
  for (int run = 1; run <= 5; ++run) {
    Recorder recorder(folder, "scenario:seed=3,speed=max", {"--record-size", "256K", "--record-total", "4M"});
    ASSERT_TRUE(eventually([&] { return sizeOf(folder / "rec") > 1'000'000; }));
    recorder.process().signal(SIGKILL);
    EXPECT_EQ(recorder.process().wait(), (ProcessEnd{true, SIGKILL}));
    const std::vector<std::string> files = filesIn(folder / "rec");
    std::size_t all = 0;
    for (const std::string& file : files) {
      const Outcome outcome = vespctl({"decode", file});
      // Only the last file may end with an incomplete packet; everything before it is read.
      const std::size_t events = linesOf(outcome.output).size();
      if (outcome.status != 0) {
        EXPECT_EQ(file, files.back());
        EXPECT_THAT(outcome.errors, HasSubstr(": packet " + std::to_string(events) + ": truncated")) << run;
      }
      all += events;
    }
    EXPECT_GT(all, 5000U);
    ASSERT_TRUE(std::filesystem::remove(folder / "socket"));
  }
  // The next recorder repairs the truncated file.
  Recorder recorder(folder, "scenario:seed=3");
  EXPECT_EQ(vespctl({"decode", folder / "rec"}).status, 0);
  recorder.end();
}

TEST(RhoxdRecording, OnADiskThatIsFullSaysSoOnceServesOnAndRecordsAgainWhenThereIsRoom) {
  const TemporaryFolder folder;
  Recorder recorder(folder, "scenario:seed=3,speed=100");
  Process& process = recorder.process();
  ASSERT_TRUE(eventually([&] { return sizeOf(folder / "rec") > 0; }));
  const auto limit = [&process](rlim_t bytes) {
    const rlimit value{bytes, RLIM_INFINITY};
    return ::prlimit(process.identifier(), RLIMIT_FSIZE, &value, nullptr) == 0;
  };
  ASSERT_TRUE(limit(sizeOf(folder / "rec") + 5000));
  ASSERT_TRUE(process.waitForErrors("nothing is recorded: ")) << process.errors();
  EXPECT_THAT(process.errors(), EndsWith("cannot be written: File too large\n"));
  const std::string file = filesIn(folder / "rec").at(0);
  const Outcome meanwhile = vespctl({"decode", file});
  EXPECT_EQ(meanwhile.status, 0) << meanwhile.errors;
  const std::uintmax_t before = sizeOf(folder / "rec");
  // Delivery continues.
  {
    Process client(tool, {"record", folder / "out.pcap", "--manager", "unix:path=" + (folder / "socket")});
    EXPECT_TRUE(eventually([&] {
      std::error_code absent;
      return std::filesystem::file_size(folder / "out.partial.pcap", absent) > 1000 && !absent;
    }));
    EXPECT_EQ(sizeOf(folder / "rec"), before);
  }
  ASSERT_TRUE(limit(std::uint64_t{1} << 40));
  ASSERT_TRUE(process.waitForErrors("recording continues; ")) << process.errors();
  ASSERT_TRUE(eventually([&] { return sizeOf(folder / "rec") > before; }));
  EXPECT_EQ(process.errors().find("nothing is recorded"), process.errors().rfind("nothing is recorded"));
  recorder.end();
  const Outcome after = vespctl({"decode", file});
  EXPECT_EQ(after.status, 0) << after.errors;
  EXPECT_GT(linesOf(after.output).size(), linesOf(meanwhile.output).size());
}

TEST(RhoxdRecording, ContinuesInANewFolderWhenItsOwnIsRemoved) {
  const TemporaryFolder folder;
  Recorder recorder(folder, "scenario:seed=3,speed=100");
  ASSERT_TRUE(eventually([&] { return sizeOf(folder / "rec") > 0; }));
  std::filesystem::rename(folder / "rec", folder / "moved");
  ASSERT_TRUE(eventually([&] { return sizeOf(folder / "rec") > 1000; }));
  recorder.end();
  EXPECT_EQ(vespctl({"decode", folder / "rec"}).status, 0);
  EXPECT_EQ(vespctl({"decode", folder / "moved"}).status, 0);
}

TEST(RhoxdRecording, ReportsAFolderThatItCannotUse) {
  const TemporaryFolder folder;
  Process inFile(daemonProgram, {"--listen", "unix:path=" + (folder / "socket"), "--source", "scenario", "--record",
                                 folder.write("file", "")});
  EXPECT_EQ(inFile.wait(), (ProcessEnd{false, 1}));
  EXPECT_EQ(inFile.errors(), "rhoxd: " + (folder / "file") + ": cannot record into this folder: Not a directory\n");
  Recorder first(folder, "scenario");
  Process second(daemonProgram,
                 {"--listen", "unix:path=" + (folder / "other"), "--source", "scenario", "--record", folder / "rec"});
  EXPECT_EQ(second.wait(), (ProcessEnd{false, 1}));
  EXPECT_EQ(second.errors(), "rhoxd: " + (folder / "rec") + ": another program is recording into it\n");
  first.end();
}

TEST(RhoxdRecording, DoesNotRotateItsOwnSourceAway) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "rec");
  std::filesystem::create_directory(folder / "links");
  const std::string run = folder.write("rec/vespscope-20201121T132501.042Z.pcap", captureOf(scriptedRun()));
  std::filesystem::create_symlink(run, folder / "links/a.pcap");
  for (const std::string& source : {folder / "rec", run, folder / "links"}) {
    Process process(daemonProgram, {"--listen", "unix:path=" + (folder / "socket"), "--source", "replay:" + source,
                                    "--record", folder / "rec", "--record-size", "1K", "--record-total", "1K"});
    EXPECT_EQ(process.wait(), (ProcessEnd{false, 1}));
    EXPECT_EQ(process.errors(), "rhoxd: --record: " + (folder / "rec") + ": contains the source itself\n");
    EXPECT_EQ(contentsOf(run), captureOf(scriptedRun()));
  }
}

TEST(RhoxdRecordingStart, RefusesAPipeAsItsSourceAndEndsWhenAskedToDespiteASilentInput) {
  const TemporaryFolder folder;
  const std::string pipe = folder / "pipe";
  ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
  for (const std::string kind : {"replay:", "diag:"}) {
    Process refused(daemonProgram, {"--listen", "unix:path=" + (folder / "socket"), "--source", kind + pipe});
    EXPECT_EQ(refused.wait(), (ProcessEnd{false, 1}));
    EXPECT_THAT(refused.errors(), StartsWith("rhoxd: " + pipe + ": is a pipe, not a file"));
  }
  // Before the source is open, and while it is read.
  const int end = ::open(pipe.c_str(), O_RDWR | O_CLOEXEC);
  Process opening(daemonProgram, {"--listen", "unix:path=" + (folder / "a"), "--source", "diag:-"}, {}, pipe);
  opening.readFor(std::chrono::milliseconds(300));
  opening.signal(SIGTERM);
  EXPECT_TRUE(opening.wait().has_value());
  const std::string run = captureOf(scriptedRun());
  ASSERT_EQ(::write(end, run.data(), run.size()), static_cast<ssize_t>(run.size()));
  Process reading(daemonProgram,
                  {"--listen", "unix:path=" + (folder / "b"), "--source", "replay:-,speed=max", "--state", "none",
                   "--record", folder / "rec"},
                  {}, pipe);
  ASSERT_TRUE(eventually([&] { return sizeOf(folder / "rec") >= run.size(); }));
  reading.signal(SIGTERM);
  EXPECT_EQ(reading.wait(), (ProcessEnd{false, 0})) << reading.errors();
  ::close(end);
}

TEST(RhoxdRecording, RefusesLimitsThatSayNothing) {
  const std::vector<std::pair<std::vector<std::string>, std::string>> table = {
      {{"--record", ""}, "--record: no folder is named"},
      {{"--record-size", "1M"}, "--record: no folder is named"},
      {{"--record", "/r", "--record-size", "1T"}, "--record-size: \"1T\" is not a size: write 64M"},
      {{"--record", "/r", "--record-total", "0"}, "--record-total: \"0\" is not a size: write 64M"},
      {{"--record", "/r", "--record-age", "1"}, "--record-age: \"1\" is not a time: write 15m"},
      {{"--record", "/r", "--record-keep", "-1d"}, "--record-keep: \"-1d\" is not a time: write 15m"},
      {{"--record", "/r", "--record-total", "15M"}, "--record-total: less than one file (--record-size)"},
  };
  for (const auto& [options, message] : table) {
    std::vector<std::string> arguments = {"--listen", "unix:path=/nowhere/socket", "--source", "scenario"};
    arguments.insert(arguments.end(), options.begin(), options.end());
    Process process(daemonProgram, arguments);
    EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
    EXPECT_THAT(process.errors(), StartsWith("rhoxd: " + message + " (see rhoxd --help"));
  }
}

}  // namespace
}  // namespace vespscope::test
