#include <array>
#include <string>
#include <string_view>
#include <utility>

#include <nlohmann/json.hpp>

#include "rhoxlink/Rhoxlink.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Json.h"
#include "tools/vespctl/Output.h"

namespace vespscope::tools {
namespace {

constexpr int indentation = 2;

// An entry's name in the output and in the manager's answer; the order is the order of the output.
using Names = std::pair<std::string_view, const char*>;

constexpr std::array<Names, 4> managerNames = {{{rhox::kKeySeconds, "uptime_s"},
                                                {rhox::kKeyEventsRecorded, "recorded"},
                                                {rhox::kKeyRecordingLost, "recording_lost"},
                                                {rhox::kKeyRecordingProblem, "recording_problem"}}};
constexpr std::array<Names, 2> sourceNames = {{{rhox::kKeySourceLabel, "label"}, {rhox::kKeySourceKind, "kind"}}};
constexpr std::array<Names, 2> configurationNames = {
    {{rhox::kKeyAppID, "application"}, {rhox::kKeyMetrics, "metrics"}}};
constexpr std::array<Names, 10> clientNames = {{{rhox::kKeyClientName, "name"},
                                                {rhox::kKeyAppID, "application"},
                                                {rhox::kKeyUser, "user"},
                                                {rhox::kKeyProcess, "process"},
                                                {rhox::kKeyBusName, "bus_name"},
                                                {rhox::kKeySeconds, "connected_s"},
                                                {rhox::kKeyListening, "listening"},
                                                {rhox::kKeyEventsDelivered, "delivered"},
                                                {rhox::kKeyEventsLost, "lost"},
                                                {rhox::kKeyEventsQueued, "queued"}}};

// Returns the entries under their names in the output, without those that the manager does not report.
Json renamed(const ipc::Dictionary& entries, const auto& names) {
  Json json = Json::object();
  const Record record = ipc::toRecord(entries);
  for (const auto& [key, name] : names) {
    if (const Value* value = record.find(key)) json[name] = toJson(*value);
  }
  return json;
}

Json list(const ipc::Dictionary& reply, std::string_view key, const auto& names) {
  Json json = Json::array();
  const ipc::Object* entries = reply.find(key);
  if (entries == nullptr || entries->asArray() == nullptr) return json;
  for (const ipc::Object& entry : *entries->asArray()) {
    if (entry.asDictionary() != nullptr) json.push_back(renamed(*entry.asDictionary(), names));
  }
  return json;
}

// The address of a manager that may have other clients; one inside this process would have none.
Result<rhox::client::Address> managerAddress(const std::optional<std::string>& words) {
  using Kind = rhox::client::Address::Kind;
  Result<rhox::client::Address> address = words ? rhox::client::Address::parse(*words) : rhox::client::address();
  if (address && address->kind == Kind::automatic) address->kind = Kind::system;
  if (address && address->kind == Kind::embedded) {
    return Failure{std::string("an embedded manager serves its own program only: it cannot be queried from outside")};
  }
  return address;
}

}  // namespace

Problem status(const std::optional<std::string>& words) {
  Result<rhox::client::Address> address = managerAddress(words);
  if (!address) return address.reason();
  rhox::client::setAddress(*address);
  const auto manager = rhox::client::CreateManager("vespctl", nullptr);
  ipc::Dictionary request;
  request.set(rhox::kKeyDetails, ipc::Object(true));
  ipc::Object reply;
  const rhox::client::Result asked = PerformCommand(manager, rhox::kCommandStatus, request, reply);
  if (asked.status != 0) return asked.message;
  const ipc::Dictionary* told = reply.asDictionary();
  if (told == nullptr || told->find(rhox::kKeyClients) == nullptr) {
    return "the manager does not report its clients";
  }
  Json json = Json::object();
  json["source"] = renamed(*told, sourceNames);
  json.update(renamed(*told, managerNames));
  json["configurations"] = list(*told, rhox::kKeyConfigurations, configurationNames);
  json["clients"] = list(*told, rhox::kKeyClients, clientNames);
  return writeLine(write(json, indentation));
}

}  // namespace vespscope::tools
