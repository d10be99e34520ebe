#include "tools/CommandLine.h"

#include <CLI/App.hpp>
#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>

#include "platform/console/Console.h"
#include "values/Text.h"

namespace vespscope {

int Ending::print() const {
  status == 0 ? console::outputText(text) : console::error(text);
  return status;
}

Ending refusal(const CLI::App& app, const std::string& why) {
  return {.text = app.get_name() + ": " + printable(why) + " (see " + app.get_name() + " --help)",
          .status = usageStatus};
}

std::optional<Ending> parseArguments(CLI::App& app, int argc, const char* const* argv) {
  try {
    app.parse(argc, argv);
  } catch (const CLI::CallForHelp&) {
    return Ending{.text = app.help()};
  } catch (const CLI::CallForVersion& version) {
    return Ending{.text = std::string(version.what()) + "\n"};
  } catch (const CLI::ParseError& error) {
    return refusal(app, error.what());
  }
  return std::nullopt;
}

}  // namespace vespscope
