// vespctl screens on real logs: which screens are filled, and that none mixes two SIM cards.
#include <filesystem>
#include <map>
#include <set>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "support/SharedCaptures.h"
#include "support/TemporaryFolder.h"
#include "support/WrittenLog.h"

namespace vespscope::test {
namespace {

using Json = nlohmann::ordered_json;

Json screensOf(const std::string& capture, const std::vector<std::string>& options) {
  std::vector<std::string> arguments = {"screens", capture, "LTE"};
  arguments.insert(arguments.end(), options.begin(), options.end());
  const Outcome outcome = vespctl(arguments);
  EXPECT_EQ(outcome.status, 0) << outcome.errors;
  return Json::parse(outcome.output, nullptr, false);
}

// The rows of the screens that show a value beside the time of the report.
std::set<std::string> filled(const Json& screens) {
  std::set<std::string> names;
  for (const Json& screen : screens) {
    for (const Json& section : screen["sections"]) {
      for (const Json& row : section["rows"]) {
        if (row[0] == "timestamp" || row[1].is_null() || row[1] == "") continue;
        // What a list shows before its first report.
        if (row[1] == "Waiting for Update") continue;
        names.insert(screen["row"].get<std::string>());
      }
    }
  }
  return names;
}

struct Case {
  std::string name;
  std::string log;
  std::string sim;
  std::map<std::string, std::string> empty;  // screens that stay empty, and why
};

const std::string noRecord = "the log has no record that reports it";

const std::map<std::string, std::string> neverInThese = {{"Tx Power", noRecord},
                                                         {"GSM Neighbor Cell Meas", "no report names a cell of GSM"}};

std::map<std::string, std::string> with(const std::map<std::string, std::string>& more) {
  std::map<std::string, std::string> all = neverInThese;
  all.insert(more.begin(), more.end());
  return all;
}

const Case cases[] = {
    {"Mobility", "lte-mobility.mi2log", "1", with({})},
    {"FirstPhoneSim1", "nsa-dual-sim-1.mi2log", "1",
     with({{"UMTS Neighbor Cell Meas", "no report names a cell of UMTS"},
           {"CA Status", "no message adds a secondary cell"}})},
    {"FirstPhoneSim2", "nsa-dual-sim-1.mi2log", "2",
     with({{"RRC State", "no dedicated message"},
           {"Serving Cell Meas", "no measurement record, and no report"},
           {"LTE Neighbor Cell Meas", "no measurement record, and no report"},
           {"UMTS Neighbor Cell Meas", "no report"},
           {"C-DRX", "no dedicated message"},
           {"CA Status", "no dedicated message"},
           {"Active Bearers", "no message of session management"}})},
    {"SecondPhoneSim1", "nsa-dual-sim-2.mi2log", "1",
     with({{"UMTS Neighbor Cell Meas", "no report names a cell of UMTS"},
           {"CA Status", "no message adds a secondary cell"}})},
    {"SecondPhoneSim2", "nsa-dual-sim-2.mi2log", "2",
     with({{"Serving Cell Meas", "no measurement record, and no report"},
           {"LTE Neighbor Cell Meas", "no measurement record, and no report"},
           {"UMTS Neighbor Cell Meas", "no report"},
           {"C-DRX", "no message sets it"},
           {"CA Status", "no message adds a secondary cell"},
           {"Active Bearers", "no message of session management"}})},
};

class VespctlScreensOfALog : public ::testing::TestWithParam<Case> {
 protected:
  std::string converted(const std::string& words) {
    const std::string file = folder_ / ("capture" + std::to_string(++count_) + ".pcap");
    const Outcome outcome = vespctl({"convert", words, file});
    EXPECT_EQ(outcome.status, 0) << outcome.errors;
    return file;
  }
  TemporaryFolder folder_;

 private:
  int count_ = 0;
};

TEST_P(VespctlScreensOfALog, AreFilledWhereItHasMessages) {
  const std::string log = sharedCapture(GetParam().log);
  SKIP_WITHOUT_CAPTURE(log);
  const bool several = GetParam().log != "lte-mobility.mi2log";
  const Json screens = screensOf(converted("diag:" + log), several ? std::vector<std::string>{"--sim", GetParam().sim}
                                                                   : std::vector<std::string>{});
  const std::set<std::string> shown = filled(screens);
  std::set<std::string> expected;
  for (const Json& screen : screens) {
    const std::string name = screen["row"];
    const auto empty = GetParam().empty.find(name);
    if (empty == GetParam().empty.end()) expected.insert(name);
  }
  EXPECT_EQ(shown, expected);
}

TEST_P(VespctlScreensOfALog, HoldNothingOfAnotherCard) {
  const std::string log = sharedCapture(GetParam().log);
  SKIP_WITHOUT_CAPTURE(log);
  if (GetParam().log == "lte-mobility.mi2log") GTEST_SKIP() << "not run: a phone with one card";
  const std::string both = converted("diag:" + log);
  const Json alone = screensOf(converted("diag:" + log + ",sim=" + GetParam().sim), {});
  EXPECT_EQ(screensOf(both, {"--sim", GetParam().sim}), alone);
  // Without a wish, the card with data bearers: the first one in both logs.
  const Json chosen = screensOf(both, {});
  EXPECT_EQ(chosen == alone, GetParam().sim == "1");
}

INSTANTIATE_TEST_SUITE_P(Of, VespctlScreensOfALog, ::testing::ValuesIn(cases),
                         [](const auto& tested) { return tested.param.name; });

TEST(VespctlScreens, ShowTheWantedCardOfAWrittenLogAndRefuseOneThatIsNotThere) {
  const TemporaryFolder folder;
  const Bytes bytes = writtenLogOfTwoSims();
  const std::string log = folder.write("two.mi2log", std::string(bytes.begin(), bytes.end()));
  ASSERT_EQ(vespctl({"convert", "diag:" + log, folder / "both.pcap"}).status, 0);
  const auto cellOf = [&](const std::vector<std::string>& options) {
    std::vector<std::string> arguments = {"screens", folder / "both.pcap", "LTE", "Serving Cell Info"};
    arguments.insert(arguments.end(), options.begin(), options.end());
    return vespctl(arguments).output;
  };
  const std::string first = "[\"cell_id\",\"" + std::to_string(twoSimsFirstCell) + "\"]";
  const std::string second = "[\"cell_id\",\"" + std::to_string(twoSimsSecondCell) + "\"]";
  EXPECT_THAT(cellOf({"--sim", "1"}), ::testing::HasSubstr(first));
  EXPECT_THAT(cellOf({"--sim", "2"}), ::testing::HasSubstr(second));
  EXPECT_THAT(cellOf({}), ::testing::HasSubstr(second)) << "the first card in the log";
  const Outcome absent = vespctl({"state", folder / "both.pcap", "--sim", "3"});
  EXPECT_EQ(absent.status, 2);
  EXPECT_EQ(absent.errors, "vespctl: " + (folder / "both.pcap") + ": has no event of SIM 3, only of SIM 1, 2\n");
  const Outcome wrong = vespctl({"state", folder / "both.pcap", "--sim", "5"});
  EXPECT_EQ(wrong.status, 2);
  EXPECT_THAT(wrong.errors, ::testing::HasSubstr("--sim"));
}

}  // namespace
}  // namespace vespscope::test
