#include "Dissection.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <map>

namespace vespscope::test {
namespace {

using rrc::Kind;
using rrc::Pdu;

const std::map<Pdu, std::string>& dissectors() {
  static const std::map<Pdu, std::string> names = {
      {Pdu::lteBcchBch, "lte-rrc.bcch.bch"},
      {Pdu::lteBcchDlSch, "lte-rrc.bcch.dl.sch"},
      {Pdu::lteMcch, "lte-rrc.mcch"},
      {Pdu::ltePcch, "lte-rrc.pcch"},
      {Pdu::lteDlCcch, "lte-rrc.dl.ccch"},
      {Pdu::lteDlDcch, "lte-rrc.dl.dcch"},
      {Pdu::lteUlCcch, "lte-rrc.ul.ccch"},
      {Pdu::lteUlDcch, "lte-rrc.ul.dcch"},
      {Pdu::nbBcchBch, "lte-rrc.bcch.bch.nb"},
      {Pdu::nbBcchDlSch, "lte-rrc.bcch.dl.sch.nb"},
      {Pdu::nbPcch, "lte-rrc.pcch.nb"},
      {Pdu::nbDlCcch, "lte-rrc.dl.ccch.nb"},
      {Pdu::nbDlDcch, "lte-rrc.dl.dcch.nb"},
      {Pdu::nbUlCcch, "lte-rrc.ul.ccch.nb"},
      {Pdu::nbUlDcch, "lte-rrc.ul.dcch.nb"},
      {Pdu::nrBcchBch, "nr-rrc.bcch.bch"},
      {Pdu::nrBcchDlSch, "nr-rrc.bcch.dl.sch"},
      {Pdu::nrPcch, "nr-rrc.pcch"},
      {Pdu::nrDlCcch, "nr-rrc.dl.ccch"},
      {Pdu::nrDlDcch, "nr-rrc.dl.dcch"},
      {Pdu::nrUlCcch, "nr-rrc.ul.ccch"},
      {Pdu::nrUlDcch, "nr-rrc.ul.dcch"},
      {Pdu::nrReconfiguration, "nr-rrc.rrc_reconf"},
      {Pdu::nrRadioBearerConfig, "nr-rrc.radiobearerconfig"},
      {Pdu::lteCapability, "lte-rrc.ue_eutra_cap"},
      {Pdu::nrCapability, "nr-rrc.ue_nr_cap"},
      {Pdu::nrDualCapability, "nr-rrc.ue_mrdc_cap"},
  };
  return names;
}

// The name of the dissector as a tag, with the closing tags.
std::string headOf(Pdu pdu) {
  constexpr std::size_t dissectorTag = 12;
  std::string name = dissectors().at(pdu);
  name.resize((name.size() + 4) / 4 * 4);
  std::string head;
  for (const std::size_t number : {dissectorTag, name.size()}) {
    head += static_cast<char>(number >> 8);
    head += static_cast<char>(number);
  }
  return head + name + std::string(4, '\0');
}

// Whether TShark derives the value from other values of the message.
bool isDerived(const std::string& name) {
  return name == "lte-rrc.sr_Periodicity" || name == "lte-rrc.sr_SubframeOffset";
}

// Accepts names that TShark spells differently from the definitions.
bool isSameName(const std::string& ours, const std::string& theirs) {
  return ours == "*" || ours == theirs || (ours == "partEARFCN-r17" && theirs == "partEARFCN-17");
}

std::string attribute(const std::string& line, const std::string& name) {
  const std::string start = " " + name + "=\"";
  const std::size_t from = line.find(start);
  if (from == std::string::npos) return "";
  const std::size_t begin = from + start.size();
  return line.substr(begin, line.find('"', begin) - begin);
}

// The name before the colon; for a boolean, after its pattern of bits.
std::string nameIn(const std::string& shown) {
  std::string name = shown.substr(0, shown.find(": "));
  if (const std::size_t space = name.rfind(' '); space != std::string::npos) name.erase(0, space + 1);
  return name;
}

std::string textIn(const std::string& line) {
  std::string text = attribute(line, "show");
  text.erase(std::remove(text.begin(), text.end(), ':'), text.end());
  if (text == "True") return "1";
  if (text == "False") return "0";
  if (text.starts_with("0x")) return std::to_string(std::strtoll(text.c_str(), nullptr, 16));
  return text;
}

std::string hexOf(const rrc::View& view) {
  std::string text;
  for (const std::uint8_t byte : view.bytes()) {
    text += "0123456789abcdef"[byte >> 4];
    text += "0123456789abcdef"[byte & 15];
  }
  return text;
}

// The content of a capability, by the type next to it.
std::optional<Pdu> capabilityOf(std::string_view technology) {
  if (technology == "eutra") return Pdu::lteCapability;
  if (technology == "nr") return Pdu::nrCapability;
  if (technology == "eutra-nr") return Pdu::nrDualCapability;
  return std::nullopt;
}

void addValues(const rrc::View& view, int depth, std::vector<Value>& values) {
  Value value{view.name().empty() ? "*" : std::string(view.name()), "", "", depth, false};
  switch (view.kind()) {
    case Kind::unknown:
      return;
    case Kind::null:
    case Kind::sequence:
      break;
    case Kind::boolean:
    case Kind::integer:
    case Kind::enumerated:
    case Kind::list:
    case Kind::choice:
      value.text = std::to_string(view.value());
      break;
    case Kind::bitString:
      if (const auto number = view.number()) value.other = std::to_string(*number);
      [[fallthrough]];
    case Kind::octetString:
      value.text = hexOf(view);
      value.opaque = !view.first();
      break;
  }
  values.push_back(std::move(value));
  for (const rrc::View child : view) addValues(child, depth + 1, values);
  const auto pdu = capabilityOf(view["rat-Type"].item());
  if (!pdu) return;
  const std::vector<std::uint8_t> bytes = view["ue-CapabilityRAT-Container"].bytes();
  rrc::Message capability;
  if (capability.read(*pdu, bytes)) return;
  values.back().opaque = false;
  addValues(capability.root(), depth + 2, values);
}

}  // namespace

bool isDissected(Pdu pdu) { return dissectors().contains(pdu); }

void writeCapture(const std::filesystem::path& path,
                  std::span<const std::pair<Pdu, std::vector<std::uint8_t>>> messages) {
  constexpr std::uint32_t exportedPdu = 252;
  std::ofstream file(path, std::ios::binary);
  const auto little = [&](std::uint64_t number, int width) {
    for (int index = 0; index < width; ++index) file.put(static_cast<char>(number >> (8 * index)));
  };
  little(0xA1B2C3D4, 4);
  little(0x00040002, 4);
  little(0, 8);
  little(262144, 4);
  little(exportedPdu, 4);
  for (const auto& [pdu, bytes] : messages) {
    const std::string head = headOf(pdu);
    little(0, 8);
    little(head.size() + bytes.size(), 4);
    little(head.size() + bytes.size(), 4);
    file << head << std::string(bytes.begin(), bytes.end());
  }
}

std::vector<Dissection> readPdml(const std::filesystem::path& path) {
  std::vector<Dissection> dissections;
  std::ifstream file(path);
  int depth = 0;
  for (std::string line; std::getline(file, line);) {
    if (line.starts_with("<packet>")) {
      dissections.emplace_back();
      depth = 0;
    } else if (line.find("<proto name=\"_ws.malformed\" showname=\"[Malformed") != std::string::npos ||
               line.find("Message: Malformed Packet") != std::string::npos) {
      dissections.back().complete = false;
    }
    if (line.find("</field>") != std::string::npos) --depth;
    if (line.find("<field ") == std::string::npos) continue;
    const std::string name = attribute(line, "name");
    if ((name.starts_with("lte-rrc.") || name.starts_with("nr-rrc.")) && !isDerived(name)) {
      dissections.back().values.push_back({nameIn(attribute(line, "showname")), textIn(line), "", depth, false});
    }
    if (!line.ends_with("/>")) ++depth;
  }
  return dissections;
}

std::vector<Value> valuesOf(const rrc::Message& message) {
  std::vector<Value> values;
  addValues(message.root(), 0, values);
  return values;
}

std::string difference(const std::vector<Value>& ours, const Dissection& theirs, std::size_t& compared) {
  std::size_t at = 0;
  for (const Value& value : ours) {
    if (at == theirs.values.size()) return theirs.complete ? value.name + " is missing in theirs" : "";
    const Value& other = theirs.values[at];
    if (!isSameName(value.name, other.name) || (value.text != other.text && value.other != other.text)) {
      return value.name + " = " + value.text + ", theirs " + other.name + " = " + other.text;
    }
    ++compared;
    ++at;
    // Skips TShark's values inside strings that this reader does not interpret.
    while (value.opaque && at < theirs.values.size() && theirs.values[at].depth > other.depth) ++at;
  }
  return at == theirs.values.size() ? "" : theirs.values[at].name + " is missing in ours";
}

}  // namespace vespscope::test
