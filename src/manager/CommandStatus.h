// The manager's answer to a command: status 0, or a number and a sentence.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>

namespace vespscope::manager {

enum class CommandStatus : std::int32_t {
  ok = 0,
  unknownCommand = 1,
  badRequest = 2,
  badConfiguration = 3,
  unknownTrigger = 4,
  noSimCardFiles = 5,
  deliveryOff = 6,
  tooManyApplications = 7,
  tooManyQueries = 8,
  tooManyCommands = 9,
  noPlace = 10,  // rhox::kStatusNoPlace
};

inline constexpr std::array<std::pair<CommandStatus, std::string_view>, 11> commandStatusTexts = {{
    {CommandStatus::ok, ""},
    {CommandStatus::unknownCommand, "there is no such command"},
    {CommandStatus::badRequest, "the request is incomplete"},
    {CommandStatus::badConfiguration, "the configuration is refused"},
    {CommandStatus::unknownTrigger, "nothing answers this trigger"},
    {CommandStatus::noSimCardFiles, "the source has no SIM card files"},
    {CommandStatus::deliveryOff, "delivery of events is off, so the answer cannot be delivered"},
    {CommandStatus::tooManyApplications, "too many applications have a configuration"},
    {CommandStatus::tooManyQueries, "too many pending SIM card file queries"},
    {CommandStatus::tooManyCommands, "too many pending commands of this client"},
    {CommandStatus::noPlace, "the manager has no free place"},
}};

// The status's sentence, followed by the details of this case.
[[nodiscard]] inline std::string messageOf(CommandStatus status, std::string_view detail = {}) {
  for (const auto& [candidate, text] : commandStatusTexts) {
    if (candidate != status) continue;
    return detail.empty() ? std::string(text) : std::string(text) + ": " + std::string(detail);
  }
  return std::string(detail);
}

}  // namespace vespscope::manager
