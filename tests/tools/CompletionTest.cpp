// The shells' completion of the programs' options, compared with the programs' own lists.
#include <filesystem>
#include <regex>
#include <set>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Help.h"
#include "Program.h"
#include "support/Process.h"

namespace vespscope::test {
namespace {

using Names = std::set<std::string>;

const std::vector<std::string> commands = {"decode", "state", "screens", "convert", "record", "doctor", "status"};
const std::string folder = VESPSCOPE_SOURCE_DIR "/packaging/completions/";

// The options of a program and all its commands.
Names allOptionsOf(const std::string& program) {
  Names options = optionsOf(runProgram(program, {"--help"}).output);
  if (program != "vespctl") return options;
  for (const std::string& command : commands) options.merge(optionsOf(runProgram(program, {command, "--help"}).output));
  return options;
}

// The completions that bash offers for the last of the words.
Names offeredByBash(const std::string& program, const std::string& words) {
  Process bash("/bin/bash", {"-c", "compopt() { :; }; . " + folder + program + ".bash; COMP_WORDS=(" + words +
                                       "); COMP_CWORD=$((${#COMP_WORDS[@]} - 1)); _" + program +
                                       "; printf '%s\\n' \"${COMPREPLY[@]}\""});
  EXPECT_EQ(bash.wait(), (ProcessEnd{false, 0})) << bash.errors();
  Names names;
  for (const std::string& line : linesOf(bash.output())) {
    if (!line.empty()) names.insert(line);
  }
  return names;
}

Names foundIn(const std::string& file, const std::string& pattern) {
  Names names;
  const std::string text = contentsOf(folder + file);
  const std::regex name(pattern);
  for (std::sregex_iterator found(text.begin(), text.end(), name), end; found != end; ++found) {
    names.insert("--" + (*found)[1].str());
  }
  return names;
}

class Completion : public ::testing::TestWithParam<std::string> {};

TEST_P(Completion, OffersEveryOptionOfTheHelpAndNoOther) {
  const std::string& program = GetParam();
  const Names options = allOptionsOf(program);
  ASSERT_GT(options.size(), 2U);
  EXPECT_EQ(foundIn("_" + program, R"(--([a-z][a-z-]*)\[)"), options);
  EXPECT_EQ(foundIn(program + ".fish", " -l ([a-z][a-z-]*)"), options);
  if (program != "vespctl") {
    EXPECT_EQ(offeredByBash(program, program + " --"), options);
    return;
  }
  for (const std::string& command : commands) {
    EXPECT_EQ(offeredByBash(program, "vespctl " + command + " --"),
              optionsOf(runProgram(program, {command, "--help"}).output))
        << command;
  }
}

INSTANTIATE_TEST_SUITE_P(Programs, Completion, ::testing::Values("vespscope", "vespctl", "rhoxd"),
                         [](const ::testing::TestParamInfo<std::string>& program) { return program.param; });

TEST(CompletionOfVespctl, OffersTheCommandsAndFilesBehindASource) {
  Names names(commands.begin(), commands.end());
  names.merge(optionsOf(runProgram("vespctl", {"--help"}).output));
  EXPECT_EQ(offeredByBash("vespctl", "vespctl ''"), names);
  for (const std::string& command : commands) {
    EXPECT_THAT(contentsOf(folder + "_vespctl"), ::testing::HasSubstr("'" + command + ":"));
    EXPECT_THAT(contentsOf(folder + "vespctl.fish"), ::testing::HasSubstr(" -a " + command + " "));
  }
  const std::string sources = std::string(VESPSCOPE_SOURCE_DIR) + "/LICEN";
  EXPECT_EQ(offeredByBash("vespctl", "vespctl convert diag : " + sources), (Names{sources + "SE"}));
  EXPECT_EQ(offeredByBash("vespctl", "vespctl convert ''"), (Names{"diag:", "replay:", "scenario"}));
}

}  // namespace
}  // namespace vespscope::test
