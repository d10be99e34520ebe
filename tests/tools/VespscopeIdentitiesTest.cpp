// Where the identities of a SIM card are written: only in the lines and files intended for them.
#include <signal.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "Program.h"
#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

const std::filesystem::path programs = VESPSCOPE_BIN_DIR;

// The content of an elementary file in the viewer's line, without the brackets: "98 99 10".
std::string contentOf(const std::string& line, int file) {
  const std::string before = "ef_id: " + std::to_string(file) + ", content: <";
  const std::size_t begin = line.find(before);
  if (begin == std::string::npos) return {};
  const std::size_t start = begin + before.size();
  return line.substr(start, line.find('>', start) - start);
}

// The forms of an identity: bytes with or without blanks, and its digits, which are swapped in the bytes.
std::vector<std::string> formsOf(const std::string& content) {
  std::string plain = content;
  std::erase(plain, ' ');
  std::string digits;
  for (std::size_t index = 0; index + 1 < plain.size(); index += 2) digits += {plain[index + 1], plain[index]};
  std::erase(digits, 'f');
  // The IMSI's file begins with a length and a flag, which are not digits.
  return {content, plain, digits, digits.substr(3)};
}

struct Found {
  int among = 0;  // lines with a beginning or continuation that may contain them
  std::vector<std::string> elsewhere;
};

Found find(const std::string& text, const std::vector<std::string>& forms, const std::string& allowed) {
  Found found;
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) {
    const bool holds = std::any_of(forms.begin(), forms.end(),
                                   [&line](const std::string& form) { return line.find(form) != std::string::npos; });
    if (!holds) continue;
    if (line.find(allowed) != std::string::npos) {
      ++found.among;
    } else {
      found.elsewhere.push_back(line);
    }
  }
  return found;
}

TEST(VespscopeIdentitiesOfASimCard, AreInTheViewersLinesOfEventsAndInNoOtherLineOfAnyProgram) {
  const TemporaryFolder folder;
  const std::string address = "unix:path=" + (folder / "socket");
  Process daemon(programs / "rhoxd", {"--listen", address, "--source", "scenario:seed=3,speed=20", "--state",
                                      folder / "state", "--record", folder / "recordings"});
  ASSERT_TRUE(daemon.waitForOutput("rhoxd: ")) << daemon.errors();
  Process recorder(programs / "vespctl", {"record", folder / "drive.pcap", "--manager", address});
  Process viewer(programs / "vespscope", {"--ui", "none", "--manager", address});
  ASSERT_TRUE(viewer.waitForOutput("Received SIM Card File Info is "));
  ASSERT_TRUE(viewer.waitForOutput("Received MM Common Info Dict is "));
  const Outcome status = vespctl({"status", "--manager", address});
  for (const Process* process : {&viewer, &recorder, &daemon}) process->signal(SIGTERM);
  EXPECT_EQ(viewer.wait(), (ProcessEnd{false, 0}));
  EXPECT_TRUE(recorder.wait());
  EXPECT_TRUE(daemon.wait());

  for (const int file : {0x2FE2, 0x6F07}) {  // ICCID, IMSI
    const std::string content = contentOf(viewer.output(), file);
    ASSERT_GE(content.size(), 20U) << viewer.output();
    const std::vector<std::string> forms = formsOf(content);
    const Found shown = find(viewer.output(), forms, "Received ");
    EXPECT_GE(shown.among, 1);
    EXPECT_TRUE(shown.elsewhere.empty()) << shown.elsewhere.front();
    const Found logged = find(viewer.errors(), forms, "MetricsTrigger dict=");
    if (::access("/dev/log", F_OK) != 0) {
      EXPECT_GE(logged.among, 1);
    }
    EXPECT_TRUE(logged.elsewhere.empty()) << logged.elsewhere.front();
    for (const std::string& text :
         {daemon.output(), daemon.errors(), recorder.output(), recorder.errors(), status.output, status.errors}) {
      EXPECT_TRUE(find(text, forms, "\n").elsewhere.empty()) << text;
    }
  }
}

}  // namespace
}  // namespace vespscope::test
