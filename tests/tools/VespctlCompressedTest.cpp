// Every command and source that reads a file takes it compressed with gzip or xz as well.
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Program.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"
#include "support/WrittenLog.h"

namespace vespscope::test {
namespace {

using ::testing::HasSubstr;

class VespctlCompressed : public ::testing::TestWithParam<const char*> {
 protected:
  // Writes the file, compressed, under a name that does not say so.
  std::string write(const std::string& name, const std::string& contents) {
    const std::string file = folder_.write(name, contents);
    const std::string command = std::string(GetParam()) + " -c " + file + " > " + file + ".packed";
    EXPECT_EQ(std::system(command.c_str()), 0);
    std::filesystem::rename(file + ".packed", file);
    return file;
  }

  TemporaryFolder folder_;
};

TEST_P(VespctlCompressed, CapturesGiveTheSameAsUnpackedOnes) {
  const std::string run = captureOf(scriptedRun());
  const std::string plain = folder_.write("plain.pcap", run);
  const std::string packed = write("packed.pcap", run);
  ASSERT_NE(contentsOf(packed), run);
  for (const char* command : {"decode", "state", "screens"}) {
    const Outcome expected = vespctl({command, plain});
    EXPECT_GT(expected.output.size(), 1000U);
    EXPECT_EQ(vespctl({command, packed}).output, expected.output) << command;
  }
  EXPECT_EQ(vespctl({"convert", "replay:" + packed, "-"}).output, run);
  EXPECT_THAT(vespctl({"doctor", packed}).output, HasSubstr(": a capture that plays for 28 s and"));
}

TEST_P(VespctlCompressed, ModemLogsGiveTheSameAsUnpackedOnes) {
  const Bytes log = writtenLog();
  const std::string packed = write("packed.mi2log", {log.begin(), log.end()});
  const std::string plain = folder_.write("plain.mi2log", {log.begin(), log.end()});
  const std::string expected = vespctl({"convert", "diag:" + plain, "-"}).output;
  EXPECT_GT(expected.size(), 10'000U);
  EXPECT_EQ(vespctl({"convert", "diag:" + packed, "-"}).output, expected);
  EXPECT_EQ(vespctl({"convert", "diag:-", "-"}, contentsOf(packed)).output, expected);
  EXPECT_THAT(vespctl({"doctor", packed}).output, HasSubstr(": a modem log that plays for 9 min 59 s and"));
  EXPECT_THAT(vespctl({"decode", packed}).errors, HasSubstr("is a modem log, not a capture"));
}

TEST_P(VespctlCompressed, RecordingsArePlayedByTheViewer) {
  const Bytes log = writtenLog();
  for (const std::string& file : {write("run", captureOf(scriptedRun())), write("log", {log.begin(), log.end()})}) {
    Process viewer(std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope", {"--ui", "none", file});
    EXPECT_TRUE(viewer.waitForOutput("Received")) << viewer.output() << viewer.errors();
    viewer.signal(SIGTERM);
    viewer.wait();
  }
}

INSTANTIATE_TEST_SUITE_P(Packers, VespctlCompressed, ::testing::Values("gzip", "xz"),
                         [](const auto& packer) { return std::string(packer.param) == "xz" ? "Xz" : "Gzip"; });

TEST(VespctlReplay, OfAModemLogNamesTheSourceThatPlaysIt) {
  const TemporaryFolder folder;
  const Bytes log = writtenLog();
  const std::string file = folder.write("drive.mi2log", {log.begin(), log.end()});
  EXPECT_EQ(vespctl({"convert", "replay:" + file, folder / "out.pcap"}).errors,
            "vespctl: " + file + ": is a modem log, not a capture; play it as diag:" + file + "\n");
}

TEST(VespctlReplay, NamesTheFormatOfAFileThatIsNoCapture) {
  const TemporaryFolder folder;
  const std::vector<std::pair<std::string, std::string>> table = {
      {std::string("\x7F"
                   "ELF\x02\x01",
                   6),
       "not a capture: it is a program"},
      {std::string("PK\x03\x04\x14", 5), "not a capture: it is a ZIP archive: unpack it first"},
      {std::string("SQLite format 3\0", 16), "not a capture: it is an SQLite database"},
      {"Dear diary", "not a capture: it is text"},
  };
  for (const auto& [contents, reason] : table) {
    const std::string file = folder.write("file", contents + std::string(40, contents[0] == 'D' ? ' ' : '\x80'));
    EXPECT_EQ(vespctl({"convert", "replay:" + file, folder / "out.pcap"}).errors,
              "vespctl: " + file + ": " + reason + "\n");
  }
  // A capture of another program: little-endian, microseconds, link type 1.
  const std::string ethernet("\xD4\xC3\xB2\xA1\x02\0\x04\0\0\0\0\0\0\0\0\0\0\0\x04\0\x01\0\0\0", 24);
  const std::string file = folder.write("file", ethernet);
  EXPECT_EQ(vespctl({"doctor", file}).errors,
            "vespctl: " + file + ": link type 1 (EN10MB) where 147 (USER0) is needed\n");
}

}  // namespace
}  // namespace vespscope::test
