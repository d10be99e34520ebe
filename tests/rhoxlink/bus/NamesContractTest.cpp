// docs/bus.md compared with the code in both directions: each lists exactly what the other has.
#include <chrono>
#include <cstdint>
#include <fstream>
#include <iterator>
#include <map>
#include <regex>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/CommandStatus.h"
#include "manager/Configuration.h"
#include "manager/Places.h"
#include "rhoxlink/EventInbox.h"
#include "rhoxlink/StatusReply.h"
#include "rhoxlink/bus/FrameChecker.h"
#include "rhoxlink/bus/MessageCodec.h"
#include "rhoxlink/bus/Names.h"

namespace vespscope::test {
namespace {

using Row = std::vector<std::string>;  // cells, without the code marks
using Pairs = std::map<std::string, std::string>;

std::string contentsOf(const std::string& path) {
  std::ifstream file(VESPSCOPE_SOURCE_DIR "/" + path);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

Row cellsOf(const std::string& line) {
  Row cells;
  std::istringstream text(line.substr(1));
  for (std::string cell; std::getline(text, cell, '|');) {
    std::erase(cell, '`');
    const std::size_t begin = cell.find_first_not_of(' ');
    cells.push_back(begin == std::string::npos ? "" : cell.substr(begin, cell.find_last_not_of(' ') - begin + 1));
  }
  return cells;
}

// The rows of the table whose first column has this heading.
std::vector<Row> tableOf(const std::string& head) {
  std::istringstream document(contentsOf("docs/bus.md"));
  std::vector<Row> rows;
  bool inside = false;
  for (std::string line; std::getline(document, line);) {
    if (!line.starts_with('|')) {
      inside = false;
    } else if (const Row cells = cellsOf(line); cells[0] == head) {
      inside = true;
    } else if (inside && !cells[0].starts_with("---")) {
      rows.push_back(cells);
    }
  }
  return rows;
}

std::set<std::string> firstsOf(const std::vector<Row>& rows) {
  std::set<std::string> firsts;
  for (const Row& row : rows) EXPECT_TRUE(firsts.insert(row[0]).second) << row[0] << " stands there twice";
  return firsts;
}

Pairs pairsOf(const std::vector<Row>& rows) {
  Pairs pairs;
  for (const Row& row : rows) pairs.emplace(row[0], row[1]);
  return pairs;
}

// Maps the second capture of each match of the pattern in the file to the first.
Pairs matchesIn(const std::string& path, const std::string& pattern) {
  const std::string text = contentsOf(path);
  const std::regex expression(pattern);
  Pairs found;
  for (std::sregex_iterator match(text.begin(), text.end(), expression), end; match != end; ++match) {
    found.emplace((*match)[2], (*match)[1]);
  }
  return found;
}

std::set<std::string> valuesNamed(const std::string& prefix) {
  std::set<std::string> values;
  for (const auto& [value, name] :
       matchesIn("src/rhoxlink/bus/Names.h", "std::string_view (" + prefix + "\\w+) =\\s*\"(\\w+)\"")) {
    values.insert(value);
  }
  return values;
}

TEST(NamesContract, NamesEveryCommand) { EXPECT_EQ(firstsOf(tableOf("command")), valuesNamed("kCommand")); }

TEST(NamesContract, NamesEveryKindOfEvent) { EXPECT_EQ(firstsOf(tableOf("kind")), valuesNamed("kEvent")); }

TEST(NamesContract, NamesEveryEntryOfRequestsRepliesAndEvents) {
  const std::set<std::string> entries = valuesNamed("kKey");
  EXPECT_GT(entries.size(), 30U);
  EXPECT_EQ(firstsOf(tableOf("entry")), entries);
}

TEST(NamesContract, GivesEachEntryATypeOfTheBus) {
  std::set<std::string> types;
  for (const Row& row : tableOf("signature")) types.insert(row[1]);
  EXPECT_EQ(types.size(), 9U);
  for (const Row& row : tableOf("entry")) EXPECT_EQ(types.count(row[1]), 1U) << row[0];
}

// The document's types compared with the comments of the names in the code.
TEST(NamesContract, GivesEachEntryTheTypeThatTheCodeGivesIt) {
  std::map<std::string, std::string> documented = pairsOf(tableOf("entry"));
  const std::string header = contentsOf("src/rhoxlink/bus/Names.h");
  const std::regex line("= \"(kKey\\w+)\"; +// (boolean|integer|real|text|data|array)\\b");
  std::size_t compared = 0;
  for (std::sregex_iterator match(header.begin(), header.end(), line), end; match != end; ++match, ++compared) {
    EXPECT_EQ(documented[(*match)[1]], (*match)[2]) << (*match)[1];
  }
  EXPECT_GT(compared, 25U);
}

TEST(NamesContract, NamesEveryStatusOfTheManagerWithItsSentence) {
  Pairs expected;
  for (const auto& [status, sentence] : manager::commandStatusTexts) {
    expected.emplace(std::to_string(static_cast<std::int32_t>(status)), std::string(sentence));
  }
  Pairs documented;
  for (const Row& row : tableOf("status")) {
    if (!row[0].starts_with("0x")) documented.emplace(row[0], row[1]);
  }
  EXPECT_EQ(documented, expected);
}

TEST(NamesContract, NamesEveryStatusOfTheClientLibrary) {
  const Pairs expected =
      matchesIn("src/rhoxlink/bus/Names.h", "(kStatus\\w+) =\\s*static_cast<std::int32_t>\\((0x[0-9A-F]+)\\)");
  EXPECT_GE(expected.size(), 8U);
  Pairs documented;
  for (const Row& row : tableOf("status")) {
    if (row[0].starts_with("0x")) documented.emplace(row[0], row[1]);
  }
  EXPECT_EQ(documented, expected);
}

TEST(NamesContract, NamesEveryMemberAsTheInterfaceHasIt) {
  const std::string xml = contentsOf("src/rhoxlink/bus/org.vespscope.BasebandManager1.xml");
  const std::regex element("<(method|signal) name=\"(\\w+)\">([\\s\\S]*?)</\\1>");
  const std::regex argument("type=\"([^\"]+)\" name=\"(\\w+)\"(?: direction=\"(in|out)\")?");
  std::map<std::string, Row> expected;
  for (std::sregex_iterator match(xml.begin(), xml.end(), element), end; match != end; ++match) {
    const std::string body = (*match)[3];
    Row row{(*match)[1], "", ""};
    for (std::sregex_iterator next(body.begin(), body.end(), argument); next != end; ++next) {
      std::string& cell = (*next)[3] == "in" ? row[1] : row[2];
      cell += (cell.empty() ? "" : ", ") + (*next)[1].str() + " " + (*next)[2].str();
    }
    expected.emplace((*match)[2], row);
  }
  std::map<std::string, Row> documented;
  for (const Row& row : tableOf("member")) documented.emplace(row[0], Row{row[1], row[2], row[3]});
  EXPECT_EQ(documented, expected);
}

TEST(NamesContract, StatesEveryLimitAtItsValue) {
  const bus::WireLimits wire;
  const auto bytes = [](std::size_t count) { return std::to_string(count) + " bytes"; };
  const auto time = [](std::chrono::milliseconds duration) { return std::to_string(duration.count()) + " ms"; };
  const Pairs expected = {
      {"message", bytes(wire.message)},
      {"fields of a message's header", bytes(wire.fields)},
      {"authentication", bytes(wire.authentication)},
      {"time of a client's authentication", time(wire.authenticationTime)},
      {"time of a message", time(wire.messageTime)},
      {"message that needs no room in the budget", bytes(wire.unbudgeted)},
      {"depth of objects", std::to_string(bus::depthLimit)},
      {"entries of a dictionary", std::to_string(bus::entryLimit)},
      {"objects of a message", std::to_string(bus::objectLimit)},
      {"text or key", bytes(bus::textLimit)},
      {"event that a client takes", bytes(rhox::client::EventInbox::eventLimit)},
      {"source label that a client keeps", bytes(rhox::client::longestLabel)},
      {"configuration", bytes(manager::Configuration::sizeLimit)},
      {"clients of a manager", std::to_string(manager::Places::all)},
  };
  EXPECT_EQ(pairsOf(tableOf("limit")), expected);
}

TEST(NamesContract, NamesEveryVersionOfTheProtocol) {
  std::set<std::string> expected;
  for (std::int64_t version = 1; version <= rhox::kProtocol; ++version) expected.insert(std::to_string(version));
  EXPECT_EQ(firstsOf(tableOf("version")), expected);
}

}  // namespace
}  // namespace vespscope::test
