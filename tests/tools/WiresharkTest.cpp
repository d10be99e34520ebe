// TShark's output for our captures, with the files in integrations/wireshark, compared with that of vespctl.
#include <algorithm>
#include <filesystem>
#include <optional>
#include <regex>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "registry/MetricRows.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

using Json = nlohmann::ordered_json;
using ::testing::HasSubstr;

const std::filesystem::path shim = std::filesystem::path(VESPSCOPE_SOURCE_DIR) / "integrations" / "wireshark";

// The contents of one packet: its metric, its message, and its fields as lines "ef_list.ef_id: 12258".
struct Packet {
  std::string metric;
  std::string message;
  std::vector<std::string> fields;
};

// Runs TShark with a separate configuration folder, so that no user's settings interfere.
std::string tshark(const TemporaryFolder& folder, std::vector<std::string> arguments) {
  arguments.insert(arguments.begin(), "tshark");
  Process process(shim / "run", arguments,
                  {{"WIRESHARK_CONFIG_DIR", folder / "settings"}, {"TZ", "UTC"}, {"LC_ALL", "C.UTF-8"}});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0})) << process.errors();
  return process.output();
}

// The value of an attribute in a line of PDML.
std::string attribute(const std::string& line, const std::string& name) {
  const std::string start = " " + name + "=\"";
  const std::size_t from = line.find(start);
  if (from == std::string::npos) return "";
  const std::size_t begin = from + start.size();
  std::string text = line.substr(begin, line.find('"', begin) - begin);
  for (const auto& [entity, letter] : std::vector<std::pair<std::string, std::string>>{
           {"&lt;", "<"}, {"&gt;", ">"}, {"&quot;", "\""}, {"&#x27;", "'"}, {"&amp;", "&"}}) {
    for (std::size_t at = 0; (at = text.find(entity, at)) != std::string::npos; at += letter.size()) {
      text.replace(at, entity.size(), letter);
    }
  }
  return text;
}

// The value in the line of a field, in the form that vespctl writes.
std::string shownValue(const std::string& line, const std::string& field) {
  std::string text = attribute(line, "showname").substr(field.size() + 2);
  if (const std::size_t lineEnd = text.find("\\n"); lineEnd != std::string::npos) text.replace(lineEnd, 2, "\n");
  static const std::regex length("\\(\\d+ bytes\\)");
  static const std::regex enumerator("(\\w+) \\((-?\\d+)\\)");
  if (std::regex_match(text, length)) return attribute(line, "value");
  std::smatch name;
  if (std::regex_match(text, name, enumerator)) {
    return name[1] == "Unknown" ? "(unknown: " + name[2].str() + ")" : name[1].str();
  }
  if (text == "True") return "true";
  if (text == "False") return "false";
  return text;
}

// The packets in TShark's PDML, one element per line.
std::vector<Packet> packetsOf(const std::string& pdml) {
  std::vector<Packet> packets;
  std::vector<std::string> path;  // of the open elements, the field's name or nothing
  std::string line;
  for (const std::string& piece : linesOf(pdml)) {
    // A text that contains a line end continues in the next line.
    line = line.empty() ? piece : line + "\n" + piece;
    if (!line.ends_with('>')) continue;
    const std::string element = std::exchange(line, "");
    const std::size_t start = element.find_first_not_of(' ');
    if (start == std::string::npos) continue;
    if (element.compare(start, 8, "<packet>") == 0) packets.emplace_back();
    if (element.compare(start, 2, "</") == 0) {
      if (!path.empty()) path.pop_back();
      continue;
    }
    if (packets.empty() || element[start + 1] == '?' || element[start + 1] == '!') continue;
    const bool leaf = element.ends_with("/>");
    const std::string name = attribute(element, "name");
    if (name == "vespscope.metric") packets.back().metric = attribute(element, "show");
    if (name == "vespscope.message") packets.back().message = attribute(element, "show");
    std::string field;
    if (name.starts_with("pbf.vespscope.") && !name.starts_with("pbf.vespscope.MetricEvent.")) {
      field = name.substr(name.rfind('.') + 1);
      std::string outside;
      for (const std::string& outer : path) outside += outer.empty() ? "" : outer + ".";
      // The number of the SIM card files metric: the decoder stores it in no message, on purpose.
      const bool neverStored = field == "Thresh_serving_lowQ" || field == "cr_offset";
      if (leaf && !neverStored) packets.back().fields.push_back(outside + field + ": " + shownValue(element, field));
    }
    if (!leaf) path.push_back(field);
  }
  return packets;
}

void flatten(const Json& value, const std::string& path, std::vector<std::string>& lines) {
  if (value.is_object()) {
    for (const auto& [key, inner] : value.items()) flatten(inner, path.empty() ? key : path + "." + key, lines);
  } else if (value.is_array()) {
    for (const Json& element : value) flatten(element, path, lines);
  } else {
    lines.push_back(path + ": " + (value.is_string() ? value.get<std::string>() : value.dump()));
  }
}

std::string metricName(std::int64_t identifier) {
  const auto* const row = std::find_if(metricRows.begin(), metricRows.end(),
                                       [&](const MetricRow& each) { return each.identifier() == identifier; });
  return row == metricRows.end() ? "" : std::string(row->identifierName);
}

// Compares every packet of the capture; returns the messages that occurred.
std::set<std::string> compare(const TemporaryFolder& folder, const std::string& capture) {
  std::set<std::string> messages;
  const std::vector<Packet> found = packetsOf(tshark(folder, {"-r", capture, "-T", "pdml"}));
  const std::vector<std::string> lines = linesOf(vespctl({"decode", capture}).output);
  EXPECT_EQ(found.size(), lines.size());
  for (std::size_t index = 0; index < std::min(found.size(), lines.size()); ++index) {
    SCOPED_TRACE("packet " + std::to_string(index));
    const Json packet = Json::parse(lines[index]);
    EXPECT_EQ(found[index].metric, metricName(packet["metric_id"]));
    if (packet["message"].is_null()) continue;
    EXPECT_EQ(found[index].message, packet["message"].get<std::string>());
    std::vector<std::string> expected;
    flatten(packet["record"], "", expected);
    EXPECT_EQ(found[index].fields, expected) << found[index].message;
    if (::testing::Test::HasFailure()) break;
    messages.insert(found[index].message);
  }
  return messages;
}

TEST(Wireshark, ShowsEveryMetricAsVespctlDecodesIt) {
  const TemporaryFolder folder;
  const std::string capture = folder.write("run.pcap", captureOf(scriptedRun()));
  EXPECT_EQ(compare(folder, capture).size(), 29U);
}

TEST(Wireshark, ShowsADriveAsVespctlDecodesIt) {
  const TemporaryFolder folder;
  ASSERT_EQ(vespctl({"convert", "scenario:seed=5", folder / "drive.pcap", "--seconds", "300"}).status, 0);
  EXPECT_GT(compare(folder, folder / "drive.pcap").size(), 15U);
}

TEST(Wireshark, ListsTheMetricsAndFiltersByTheirFields) {
  const TemporaryFolder folder;
  const std::string capture = folder.write("run.pcap", captureOf(scriptedRun()));
  const std::string all = tshark(folder, {"-r", capture});
  for (const MetricEvent& event : scriptedRun()) EXPECT_THAT(all, HasSubstr(metricName(event.metricID) + " "));
  const std::string some = tshark(folder, {"-r", capture, "-Y", "pbf.vespscope.KCellularLteRrcState.state == 3"});
  EXPECT_EQ(linesOf(some).size(), 1U);
  EXPECT_THAT(some, HasSubstr("K_LTE_RRC_STATE KCellularLteRrcState"));
}

TEST(Wireshark, KnowsNoMetricThatTheRegistryDoesNotHave) {
  const std::string script = contentsOf(shim / "vespscope.lua");
  const std::regex row(R"re(\[0x([0-9A-F]{6})\] = \{ "(\w+)", "(\w+)" \})re");
  std::size_t count = 0;
  for (std::sregex_iterator found(script.begin(), script.end(), row), end; found != end; ++found, ++count) {
    EXPECT_EQ(metricName(std::stol((*found)[1], nullptr, 16)), (*found)[2]) << (*found)[0];
  }
  EXPECT_EQ(count, 30U);  // of the 31, the radio link failure has no message of its own
}

TEST(Wireshark, LeavesAloneWhatItCannotRead) {
  const TemporaryFolder folder;
  // An unknown metric, a packet that is not an event, one truncated within a varint, and an empty one.
  const std::string capture =
      folder.write("odd.pcap", captureOf({packetAt(1, 0, binary("08 01 1a 01 00")), packetAt(1, 0, binary("ff ff ff")),
                                          packetAt(1, 0, binary("08 84 9c")), packetAt(1, 0, "")}));
  const std::vector<Packet> packets = packetsOf(tshark(folder, {"-r", capture, "-T", "pdml"}));
  ASSERT_EQ(packets.size(), 4U);
  for (const Packet& packet : packets) {
    EXPECT_EQ(packet.metric, "");
    EXPECT_TRUE(packet.fields.empty());
  }
  EXPECT_THAT(tshark(folder, {"-r", capture}), HasSubstr("a metric without a message"));
}

}  // namespace
}  // namespace vespscope::test
