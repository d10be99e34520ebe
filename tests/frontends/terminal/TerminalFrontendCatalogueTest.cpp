// Every screen of the viewer in the terminal, compared with golden grids.
#include <filesystem>
#include <functional>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "capture/CaptureWriter.h"
#include "support/Golden.h"
#include "support/ScriptedRun.h"
#include "support/Tmux.h"

namespace vespscope::test {
namespace {

const std::filesystem::path goldens = VESPSCOPE_SOURCE_DIR "/tests/frontends/terminal/golden/catalogue";

// High enough for the longest screen of these runs, so that each is completely visible.
constexpr int width = 100;
constexpr int height = 64;

struct Branch {
  std::string name;
  int screens;
};
const std::vector<Branch> branches = {{"Device Info", 3}, {"LTE", 13}, {"UMTS", 15}, {"GSM", 11}};

std::vector<std::string> linesOf(const std::string& screen) {
  std::vector<std::string> lines;
  std::istringstream text(screen);
  for (std::string line; std::getline(text, line);) lines.push_back(line);
  return lines;
}

// A screen without its status line, which shows the time, and without the empty lines before it.
std::string contentOf(const std::string& screen) {
  std::vector<std::string> lines = linesOf(screen);
  if (lines.size() < 4) return screen;
  lines.erase(lines.end() - 2);
  for (std::size_t rule = lines.size() - 2; rule > 2 && lines[rule - 1].empty(); --rule) {
    lines.erase(lines.begin() + static_cast<std::ptrdiff_t>(rule) - 1);
  }
  std::string content;
  for (const std::string& line : lines) content += line + "\n";
  return content;
}

using Keys = std::vector<std::string>;

class TerminalFrontendCatalogue : public ::testing::Test {
 protected:
  void SetUp() override {
    if (!Tmux::available()) GTEST_SKIP() << "tmux is not installed";
    tmux_ = std::make_unique<Tmux>(width, height);
  }

  void start(const std::string& manager) {
    tmux_->command("exec " VESPSCOPE_BIN_DIR "/vespscope --ui terminal --manager " + manager);
    ASSERT_TRUE(tmux_->shows("▸  Device Info"));
  }

  // The screen whose path begins the first line, once it is completely drawn.
  std::string drawn(const std::string& path) {
    std::string content;
    EXPECT_TRUE(tmux_->becomes([&](const std::string& screen) {
      const std::string before = std::exchange(content, contentOf(screen));
      return content == before && (content.starts_with(path + "\n") || content.starts_with(path + "  "));
    })) << path;
    return content;
  }

  // Opens all screens behind the selected row of the launch list.
  std::string walk(const Branch& branch) {
    tmux_->press({"Enter"});
    const std::string path = "vespscope › " + branch.name;
    std::string all = drawn(path);
    const std::vector<std::string> list = linesOf(all);
    for (int screen = 0; screen < branch.screens; ++screen) {
      // A row of the list: marks, the name padded to the longest one, and the disclosure mark.
      std::string name = list.at(static_cast<std::size_t>(2 + screen)).substr(screen == 0 ? 5 : 3);
      name.erase(name.find("›"));
      name.erase(name.find_last_not_of(' ') + 1);
      tmux_->press(screen == 0 ? Keys{"Enter"} : Keys{"h", "j", "Enter"});
      all += "\n" + drawn(path + " › " + name);
    }
    EXPECT_EQ(list.at(static_cast<std::size_t>(2 + branch.screens)).substr(0, 3), "─");
    tmux_->press({"h", "h", "j"});
    return all;
  }

  void compareAll(const std::string& moment) {
    for (const Branch& branch : branches) {
      EXPECT_TRUE(matchesGolden(goldens / moment / (branch.name + ".txt"), walk(branch)));
    }
  }

  std::unique_ptr<Tmux> tmux_;
};

TEST_F(TerminalFrontendCatalogue, BeforeTheFirstEvent) {
  start("none");
  EXPECT_TRUE(tmux_->shows("SOURCE UNKNOWN · no manager"));
  compareAll("before");
}

TEST_F(TerminalFrontendCatalogue, AfterTheScriptedRun) {
  const std::string file = (tmux_->folder() / "run.pcap").string();
  auto writer = capture::CaptureWriter::create(file, capture::Flushing::inBlocks);
  ASSERT_TRUE(writer) << writer.reason();
  for (const MetricEvent& event : scriptedRun()) ASSERT_EQ(writer->write(event), std::nullopt);
  ASSERT_EQ(writer->flush(), std::nullopt);
  start("embedded:replay:" + file + ",speed=max");
  EXPECT_TRUE(tmux_->shows("PLAYBACK run.pcap · connected"));
  EXPECT_TRUE(tmux_->shows("30 events"));
  compareAll("after");
}

}  // namespace
}  // namespace vespscope::test
