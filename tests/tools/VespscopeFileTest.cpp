// vespscope FILE, as a user starts it from a desktop or a shell.
#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include "Program.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

TEST(VespscopeFile, PlaysACaptureByItsContentsWhateverItsName) {
  const TemporaryFolder folder;
  const std::string file = folder.write("drive,2.qmdl", captureOf(scriptedRun()));
  Process viewer(std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope", {"--ui", "none", file});
  EXPECT_TRUE(viewer.waitForOutput("Received")) << viewer.output() << viewer.errors();
  viewer.signal(SIGTERM);
  EXPECT_EQ(viewer.wait(), (ProcessEnd{false, 0}));
}

TEST(VespscopeFile, NamesAFileThatItCannotPlay) {
  const TemporaryFolder folder;
  const std::string letter = folder.write("\x1b[2Jletter.pcap", "Dear reader, this is no recording.");
  const Outcome outcome = runProgram("vespscope", {"--ui", "none", letter});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors,
            "vespscope: " + folder.path().string() +
                "/␛[2Jletter.pcap: neither a capture nor a modem log: it is text (see vespscope --help)\n");
  EXPECT_EQ(runProgram("vespscope", {"--ui", "none", folder.write("empty", "")}).errors,
            "vespscope: " + (folder / "empty") + ": is empty (see vespscope --help)\n");
  EXPECT_EQ(runProgram("vespscope", {"--manager", "auto", letter}).errors,
            "vespscope: FILE and --manager: a file is played by a manager of its own (see vespscope --help)\n");
}

}  // namespace
}  // namespace vespscope::test
