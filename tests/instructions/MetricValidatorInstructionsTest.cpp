// Counts the instructions of an event and compares them with the recorded counts: a guard that does not depend on the
// clock. After an intended change of the cost, record them again:
//
//   VESPSCOPE_UPDATE_INSTRUCTIONS=1 ./dev test -- -R Instructions
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <map>
#include <optional>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

constexpr double mostGrowth = 1.03;

// The counts are those of one compiler and one build; others are not comparable.
std::optional<std::string> otherBuild() {
  if (std::string(VESPSCOPE_SANITIZE) != "") return "built with sanitizers: " VESPSCOPE_SANITIZE;
  if (std::string(VESPSCOPE_BUILD_TYPE) != "Release") return "a " VESPSCOPE_BUILD_TYPE " build, not a Release build";
#if !defined(__x86_64__)
  return "not an x86-64 processor";
#elif !defined(__GNUC__) || defined(__clang__) || __GNUC__ != 12
  return "not built with GCC 12";
#else
  return std::nullopt;
#endif
}

// Instructions per event processed by count_instructions.
double instructionsPerEvent(const std::string& work, const std::string& corpus) {
  const TemporaryFolder folder;
  // An empty environment, because searching a long one for TZ counts too. The C library selects its copying functions
  // by the processor; here it gets the plainest ones, which every x86-64 processor supports.
  Process valgrind("/usr/bin/env",
                   {"-i", "TZ=UTC",
                    "GLIBC_TUNABLES=glibc.cpu.hwcaps=-AVX512F,-AVX512VL,-AVX512BW,-AVX2,-AVX,-BMI2,-ERMS,-FSRM,-SSE4_1,"
                    "-SSE4_2,-SSSE3",
                    "/usr/bin/valgrind", "--tool=callgrind", "--toggle-collect=measured",
                    "--callgrind-out-file=" + (folder.path() / "profile").string(),
                    std::string(VESPSCOPE_BIN_DIR) + "/count_instructions", work, corpus});
  std::optional<ProcessEnd> end;
  for (int patience = 0; patience < 6 && !end; ++patience) end = valgrind.wait();
  EXPECT_EQ(end, (ProcessEnd{false, 0})) << valgrind.errors();
  const std::size_t found = valgrind.errors().find("Collected : ");
  EXPECT_NE(found, std::string::npos) << valgrind.errors();
  if (found == std::string::npos) return NAN;
  return std::stod(valgrind.errors().substr(found + 12)) / std::stod(valgrind.output());
}

std::map<std::string, double> recorded() {
  std::map<std::string, double> counts;
  std::ifstream file(VESPSCOPE_INSTRUCTION_COUNTS);
  for (std::string line; std::getline(file, line);) {
    if (line.empty() || line[0] == '#') continue;
    std::istringstream words(line);
    std::string work;
    std::string corpus;
    double count = 0;
    words >> work >> corpus >> count;
    counts[work + ' ' + corpus] = count;
  }
  return counts;
}

TEST(MetricValidatorInstructions, NoEventTakesThreePercentMoreThanRecorded) {
  if (const auto reason = otherBuild()) GTEST_SKIP() << *reason;
  const bool update = std::getenv("VESPSCOPE_UPDATE_INSTRUCTIONS") != nullptr;
  const std::map<std::string, double> before = recorded();
  std::ostringstream after;
  after
      << "# Instructions for each event, counted by callgrind: GCC 12, Release, Debian 12. Kept by InstructionsTest,\n"
         "# which says how to record them again.\n";
  for (const std::string corpus : {"mixed", "numbers", "lists"}) {
    for (const std::string work : {"decode", "event"}) {
      const std::string name = work + ' ' + corpus;
      const double count = instructionsPerEvent(work, corpus);
      after << name << ' ' << std::llround(count) << '\n';
      std::printf("%s: %.0f instructions\n", name.c_str(), count);
      if (update) continue;
      if (!before.contains(name)) {
        ADD_FAILURE() << name << " has no recorded count";
        continue;
      }
      EXPECT_LE(count, before.at(name) * mostGrowth) << name << " grew; recorded: " << before.at(name);
      if (count < before.at(name) / mostGrowth) {
        std::printf("  %.1f %% fewer than recorded: record them again to keep the guard tight\n",
                    100 * (1 - count / before.at(name)));
      }
    }
  }
  if (update) {
    std::ofstream file(VESPSCOPE_INSTRUCTION_COUNTS);
    file << after.str();
    ASSERT_TRUE(file.flush());
  }
}

}  // namespace
}  // namespace vespscope::test
