// vespctl convert --unread as its user runs it.
#include <filesystem>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Program.h"
#include "support/LogWriter.h"
#include "support/ScratchFile.h"

namespace vespscope::test {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::Not;

constexpr std::chrono::seconds now{1'700'000'000};
const std::string identity = "001010123456789";

Bytes withIdentity(Bytes head) {
  head.insert(head.end(), identity.begin(), identity.end());
  return head;
}

Bytes logWithUnreadRecords() {
  LogWriter log;
  log.record(0xB0C2, now, withIdentity({77}));
  log.record(0xB0C2, now, withIdentity({77}));
  log.record(0xB0C1, now, withIdentity({4}));
  log.record(0xB0C2, now, servingCellPayload(3, {}));
  return log.bytes();
}

std::vector<std::string> filesIn(const std::string& folder) {
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(folder)) names.push_back(entry.path().filename());
  std::sort(names.begin(), names.end());
  return names;
}

TEST(VespctlConvertUnread, WritesASampleOfEachKindWithoutIdentities) {
  const ScratchFile log("unread.mi2log", logWithUnreadRecords());
  const TemporaryFolder folder;
  const std::string samples = folder / "new/samples";
  const Outcome outcome = vespctl({"convert", "--unread", samples, "diag:" + log.path(), folder / "out.pcap"});
  EXPECT_EQ(outcome.status, 0) << outcome.errors;
  EXPECT_TRUE(std::filesystem::exists(folder / "out.pcap"));
  EXPECT_THAT(filesIn(samples), ElementsAre("B0C1-v4.mi2log", "B0C2-v77.mi2log"));
  for (const std::string& name : filesIn(samples)) {
    const std::string path = (std::filesystem::path(samples) / name).string();
    EXPECT_THAT(contentsOf(path), Not(HasSubstr(identity)));
    // Our own reader takes it for the log of one such record.
    const Outcome doctor = vespctl({"doctor", path});
    EXPECT_EQ(doctor.status, 1);
    EXPECT_THAT(doctor.output, HasSubstr("  1 record, 0 of them read"));
    EXPECT_THAT(doctor.output, HasSubstr(name.substr(0, 4)));
  }
}

TEST(VespctlConvertUnread, NeedsNoCapture) {
  const ScratchFile log("unread.mi2log", logWithUnreadRecords());
  const TemporaryFolder folder;
  EXPECT_EQ(vespctl({"convert", "--unread", folder / "samples", "diag:" + log.path()}).status, 0);
  EXPECT_THAT(filesIn(folder.path().string()), ElementsAre("samples"));
  EXPECT_THAT(filesIn(folder / "samples"), ElementsAre("B0C1-v4.mi2log", "B0C2-v77.mi2log"));
  const Outcome neither = vespctl({"convert", "diag:" + log.path()});
  EXPECT_EQ(neither.status, 2);
  EXPECT_EQ(neither.errors, "vespctl: OUT.pcap is required (see vespctl --help)\n");
}

TEST(VespctlConvertUnread, ReplacesNoFileWithoutForce) {
  const ScratchFile log("unread.mi2log", logWithUnreadRecords());
  const TemporaryFolder folder;
  const std::string precious = folder.write("B0C2-v77.mi2log", "precious");
  const std::vector<std::string> arguments = {"convert", "--unread", folder.path().string(), "diag:" + log.path()};
  const Outcome refused = vespctl(arguments);
  EXPECT_EQ(refused.status, 2);
  EXPECT_EQ(refused.errors, "vespctl: " + precious + ": exists already; --force replaces it\n");
  EXPECT_EQ(contentsOf(precious), "precious");
  EXPECT_THAT(filesIn(folder.path().string()), ElementsAre("B0C2-v77.mi2log"));
  std::vector<std::string> forced = arguments;
  forced.emplace_back("--force");
  EXPECT_EQ(vespctl(forced).status, 0);
  EXPECT_NE(contentsOf(precious), "precious");
  // A sample that is itself the source stays as it is.
  const std::string sample = contentsOf(precious);
  const Outcome itself = vespctl({"convert", "--force", "--unread", folder.path().string(), "diag:" + precious});
  EXPECT_EQ(itself.errors, "vespctl: " + precious + ": is the source itself\n");
  EXPECT_EQ(contentsOf(precious), sample);
}

TEST(VespctlConvertUnread, IsOfModemLogsOnly) {
  const TemporaryFolder folder;
  const Outcome outcome = vespctl({"convert", "--unread", folder / "samples", "scenario", "--seconds", "1"});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors, "vespctl: scenario: only a modem log has records that are not read\n");
  const ScratchFile log("unread.mi2log", logWithUnreadRecords());
  const Outcome file = vespctl({"convert", "--unread", log.path(), "diag:" + log.path()});
  EXPECT_EQ(file.status, 2);
  EXPECT_THAT(file.errors, HasSubstr(log.path() + ": "));
}

}  // namespace
}  // namespace vespscope::test
