// Reads a modem's state out of ModemManager's properties and answers.
#pragma once

#include <optional>
#include <string>

#include "platform/ipc/IpcObject.h"
#include "sources/modemmanager/ModemState.h"
#include "sources/modemmanager/ObjectTree.h"

namespace vespscope::sources::modemmanager {

// The modem's last answers to requests; empty without an answer.
struct Answers {
  std::optional<std::string> location;  // "MCC,MNC,LAC,CI,TAC", the last three in hexadecimal digits
  ipc::Array cells;                     // of GetCellInfo
};

[[nodiscard]] ModemState readModem(const ObjectTree& tree, const std::string& modem, const Answers& answers);

// Returns the paths of the modem's bearers, and of its SIM card if it has one.
[[nodiscard]] std::vector<std::string> bearersOf(const ObjectTree& tree, const std::string& modem);
[[nodiscard]] std::optional<std::string> simOf(const ObjectTree& tree, const std::string& modem);

// Returns country and network code from the five or six digits of an operator.
[[nodiscard]] std::optional<radio::Plmn> networkOf(std::string_view operatorCode);

}  // namespace vespscope::sources::modemmanager
