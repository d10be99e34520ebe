// How the manager answers a command: status 0 and nothing, or a number and a sentence.
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
};

inline constexpr std::array<std::pair<CommandStatus, std::string_view>, 9> commandStatusTexts = {{
    {CommandStatus::ok, ""},
    {CommandStatus::unknownCommand, "there is no such command"},
    {CommandStatus::badRequest, "the request is not complete"},
    {CommandStatus::badConfiguration, "the configuration is refused"},
    {CommandStatus::unknownTrigger, "nothing answers this trigger"},
    {CommandStatus::noSimCardFiles, "the source has no SIM card files"},
    {CommandStatus::deliveryOff, "delivery of events is off, so the answer cannot be delivered"},
    {CommandStatus::tooManyApplications, "as many applications have a configuration as there can be"},
    {CommandStatus::tooManyQueries, "as many queries wait for the SIM card files as there can be"},
}};

// The status's sentence, followed by what is particular to this case.
[[nodiscard]] inline std::string messageOf(CommandStatus status, std::string_view detail = {}) {
  for (const auto& [candidate, text] : commandStatusTexts) {
    if (candidate != status) continue;
    return detail.empty() ? std::string(text) : std::string(text) + ": " + std::string(detail);
  }
  return std::string(detail);
}

}  // namespace vespscope::manager
