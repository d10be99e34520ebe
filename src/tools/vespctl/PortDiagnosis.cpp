#include "tools/vespctl/PortDiagnosis.h"

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <system_error>
#include <utility>
#include <vector>

#include <grp.h>
#include <nlohmann/json.hpp>

#include "sources/diag/PortConnection.h"
#include "sources/playback/SourceSpec.h"
#include "tools/vespctl/Json.h"
#include "tools/vespctl/Paragraphs.h"

namespace vespscope::tools {
namespace {

namespace fs = std::filesystem;
using Kind = sources::diag::PortAnswer::Kind;
using sources::SourceSpec;

Result<SourceSpec> specOf(const std::string& words) {
  return SourceSpec::parse(words.starts_with("diag:") ? words : "diag:" + words);
}

std::string joined(const std::vector<std::string>& words) {
  std::string text;
  for (const std::string& word : words) text += (text.empty() ? "" : ", ") + word;
  return text;
}

// The ports that modems have on this machine.
std::vector<std::string> modemPorts() {
  std::vector<std::string> ports;
  std::error_code error;
  fs::directory_iterator entry("/dev", error);
  for (const fs::directory_iterator end; !error && entry != end; entry.increment(error)) {
    const std::string name = entry->path().filename().string();
    if (name.starts_with("ttyUSB") || name.starts_with("ttyACM") || name.starts_with("wwan")) {
      ports.push_back(entry->path().string());
    }
  }
  std::sort(ports.begin(), ports.end());
  return ports;
}

std::string groupOf(gid_t number) {
  const group* found = ::getgrgid(number);
  return found == nullptr ? std::to_string(number) : found->gr_name;
}

// The part that concerns a device, not a TCP connection.
std::optional<std::string> examineDevice(PortDiagnosis& diagnosis) {
  struct stat found {};
  if (::stat(diagnosis.name.c_str(), &found) != 0) {
    const std::vector<std::string> ports = modemPorts();
    return diagnosis.name + ": there is no such port; " +
           (ports.empty() ? "this machine has none of a modem" : "there are " + joined(ports));
  }
  diagnosis.holders = files::holdersOf(diagnosis.name);
  diagnosis.lock = files::lockOwnerOf(diagnosis.name);
  diagnosis.modemManager = sources::modemmanager::modemManagerPort(fs::path(diagnosis.name).filename().string());
  if (::access(diagnosis.name.c_str(), R_OK | W_OK) != 0) diagnosis.group = groupOf(found.st_gid);
  return std::nullopt;
}

std::string nameOf(const files::Holder& holder) {
  return (holder.program.empty() ? "a program" : holder.program) + " (process " + std::to_string(holder.process) + ")";
}

// Those that hold the port, by an open file or a lock file.
std::vector<files::Holder> holdersOf(const PortDiagnosis& diagnosis) {
  std::vector<files::Holder> all = diagnosis.holders.found;
  if (diagnosis.lock && std::find(all.begin(), all.end(), *diagnosis.lock) == all.end()) all.push_back(*diagnosis.lock);
  return all;
}

std::string holderNames(const PortDiagnosis& diagnosis) {
  std::vector<std::string> names;
  for (const files::Holder& holder : holdersOf(diagnosis)) names.push_back(nameOf(holder));
  return joined(names);
}

std::string answerText(const sources::diag::PortAnswer& answer) {
  switch (answer.kind) {
    case Kind::answers:
      return "a modem's log port that answers; its log is off";
    case Kind::logging:
      return "a modem's log port whose log is on (" + std::to_string(answer.records) + " records came)";
    case Kind::refuses:
      return "a modem's log port that refuses to turn its log on";
    case Kind::garbled:
      return "sends something else than a modem's log";
    case Kind::silent:
      return "does not answer like a log port";
    case Kind::failed:
      return "cannot be used: " + answer.reason;
  }
  return {};
}

std::string answerOf(const PortDiagnosis& diagnosis) {
  std::string text = diagnosis.name + ": ";
  if (!holdersOf(diagnosis).empty()) return text + "in use by " + holderNames(diagnosis);
  if (diagnosis.group) return text + "this user may not open it";
  return diagnosis.answer ? text + answerText(*diagnosis.answer) : text;
}

using Step = std::pair<std::string, std::string>;

void addHolderSteps(const PortDiagnosis& diagnosis, std::vector<Step>& next) {
  const auto holders = holdersOf(diagnosis);
  const bool manager = std::any_of(holders.begin(), holders.end(),
                                   [](const files::Holder& each) { return each.program == "ModemManager"; });
  if (!manager) {
    next.emplace_back("", "End " + holderNames(diagnosis) + ", then run this again");
  } else if (diagnosis.modemManager.device) {
    next.emplace_back("mmcli --inhibit-device=" + *diagnosis.modemManager.device,
                      "makes ModemManager leave the modem alone while it runs");
  } else {
    next.emplace_back("systemctl stop ModemManager", "makes ModemManager leave the port alone");
  }
}

std::vector<Step> nextOf(const PortDiagnosis& diagnosis) {
  std::vector<Step> next;
  if (!holdersOf(diagnosis).empty()) {
    addHolderSteps(diagnosis, next);
  } else if (diagnosis.group) {
    next.emplace_back("sudo adduser $USER " + *diagnosis.group, "lets this user open it, from the next login on");
  } else if (diagnosis.usable()) {
    next.emplace_back("vespscope --manager embedded:diag:" + diagnosis.name, "turns the log on and shows it");
  } else if (diagnosis.answer && (diagnosis.answer->kind == Kind::silent || diagnosis.answer->kind == Kind::garbled)) {
    std::vector<std::string> others = modemPorts();
    others.erase(std::remove(others.begin(), others.end(), diagnosis.name), others.end());
    next.emplace_back(
        "", "A modem has several ports, for AT commands, positions and its log. " +
                (others.empty() ? "Its log port may have to be turned on first" : "Try the others: " + joined(others)));
  }
  return next;
}

std::string managerText(const sources::modemmanager::ModemManagerPort& port) {
  if (!port.running) return "ModemManager does not run, or does not answer";
  if (!port.modem) return "ModemManager runs, and does not use this port for any modem";
  return "ModemManager lists this port as one of modem " + *port.modem;
}

const char* stateOf(const PortDiagnosis& diagnosis) {
  if (!holdersOf(diagnosis).empty()) return "held";
  if (!diagnosis.answer) return "not permitted";
  switch (diagnosis.answer->kind) {
    case Kind::answers:
      return "answers";
    case Kind::logging:
      return "logging";
    case Kind::refuses:
      return "refuses";
    case Kind::garbled:
      return "garbled";
    case Kind::silent:
      return "silent";
    case Kind::failed:
      return "failed";
  }
  return "failed";
}

}  // namespace

bool PortDiagnosis::usable() const {
  return answer && (answer->kind == Kind::answers || answer->kind == Kind::logging);
}

bool isPort(const std::string& words) {
  const auto spec = specOf(words);
  return spec && spec->kind == SourceSpec::Kind::diagPort;
}

Result<PortDiagnosis> diagnosePort(const std::string& words) {
  const auto spec = specOf(words);
  if (!spec) return Failure{spec.reason()};
  PortDiagnosis diagnosis;
  diagnosis.name = spec->file;
  if (diagnosis.name.starts_with("tcp:")) {
    if (const auto problem = sources::diag::problemWithTcpPort(diagnosis.name)) {
      return Failure{diagnosis.name + ": " + *problem};
    }
  } else if (const auto problem = examineDevice(diagnosis)) {
    return Failure{*problem};
  }
  if (holdersOf(diagnosis).empty() && !diagnosis.group) diagnosis.answer = sources::diag::askPort(diagnosis.name);
  return diagnosis;
}

std::string textOf(const PortDiagnosis& diagnosis) {
  Paragraphs out;
  out.line(answerOf(diagnosis));
  if (!diagnosis.name.starts_with("tcp:")) {
    out.heading("Programs");
    if (holdersOf(diagnosis).empty()) {
      out.item("no program holds the port");
    } else {
      out.item(holderNames(diagnosis) + " holds the port, which was not opened: two readers take each other's bytes");
    }
    if (!diagnosis.holders.complete) out.item("processes of other users were not examined; as root, all are");
    out.item(managerText(diagnosis.modemManager));
  }
  out.heading("Next");
  for (const auto& [command, purpose] : nextOf(diagnosis)) {
    if (!command.empty()) out.verbatim(command);
    out.item((command.empty() ? "" : "  ") + purpose);
  }
  return out.text();
}

std::string jsonOf(const PortDiagnosis& diagnosis) {
  Json holders = Json::array();
  for (const files::Holder& holder : holdersOf(diagnosis)) {
    holders.push_back({{"process", holder.process}, {"program", holder.program}});
  }
  Json next = Json::array();
  for (const auto& [command, purpose] : nextOf(diagnosis)) next.push_back({{"command", command}, {"purpose", purpose}});
  const auto& manager = diagnosis.modemManager;
  const Json json = {
      {"name", diagnosis.name},
      {"kind", "port"},
      {"answer", answerOf(diagnosis)},
      {"state", stateOf(diagnosis)},
      {"records", diagnosis.answer ? diagnosis.answer->records : 0},
      {"holders", std::move(holders)},
      {"holders_complete", diagnosis.holders.complete},
      {"modemmanager", {{"running", manager.running}, {"modem", manager.modem ? Json(*manager.modem) : Json(nullptr)}}},
      {"next", std::move(next)}};
  return write(json, 2);
}

}  // namespace vespscope::tools
