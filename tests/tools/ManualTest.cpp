// The programs' manuals, compared with their help.
#include <filesystem>
#include <fstream>
#include <regex>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Help.h"
#include "Program.h"

namespace vespscope::test {
namespace {

struct Manual {
  std::string program;
  std::string file;
  std::vector<std::string> commands;  // each has its own help
};

void PrintTo(const Manual& manual, std::ostream* out) { *out << manual.program; }

std::string pathOf(const Manual& manual) { return VESPSCOPE_SOURCE_DIR "/packaging/man/" + manual.file; }

// The options with a paragraph of their own.
std::set<std::string> optionsIn(const std::string& manual) {
  std::set<std::string> options;
  const std::regex name("Fl \\\\(-[a-z][a-z-]*)");
  for (const std::string& line : linesOf(manual)) {
    if (!line.starts_with(".It Fl")) continue;
    for (std::sregex_iterator found(line.begin(), line.end(), name), end; found != end; ++found) {
      options.insert("-" + (*found)[1].str());
    }
  }
  return options;
}

class ManualPage : public ::testing::TestWithParam<Manual> {};

TEST_P(ManualPage, HasEveryOptionThatTheHelpHasAndNoOther) {
  std::set<std::string> told = optionsOf(runProgram(GetParam().program, {"--help"}).output);
  ASSERT_GT(told.size(), 0U);
  for (const std::string& command : GetParam().commands) {
    told.merge(optionsOf(runProgram(GetParam().program, {command, "--help"}).output));
  }
  EXPECT_EQ(optionsIn(contentsOf(pathOf(GetParam()))), told);
}

TEST_P(ManualPage, HasEveryCommandThatTheHelpHas) {
  const std::string manual = contentsOf(pathOf(GetParam()));
  std::vector<std::string> commands;
  const std::regex row("^  ([a-z]+) +[A-Z].*");
  bool listed = false;
  for (const std::string& line : linesOf(runProgram(GetParam().program, {"--help"}).output)) {
    if (line == "Subcommands:") listed = true;
    if (std::smatch found; listed && std::regex_match(line, found, row)) commands.push_back(found[1]);
  }
  EXPECT_EQ(commands, GetParam().commands);
  for (const std::string& command : commands) {
    EXPECT_THAT(manual, ::testing::HasSubstr("\n.It Cm " + command + "\n")) << command;
  }
}

INSTANTIATE_TEST_SUITE_P(Programs, ManualPage,
                         ::testing::Values(Manual{"vespscope", "vespscope.1", {}},
                                           Manual{
                                               "vespctl",
                                               "vespctl.1",
                                               {"decode", "state", "screens", "convert", "record", "doctor", "status"}},
                                           Manual{"rhoxd", "rhoxd.8", {}}),
                         [](const ::testing::TestParamInfo<Manual>& manual) { return manual.param.program; });

}  // namespace
}  // namespace vespscope::test
