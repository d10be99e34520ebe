#include "tools/rhoxdOptions.h"

#include <cstdlib>

#include <CLI/App.hpp>
#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>

#include "rhoxlink/Address.h"
#include "values/Text.h"

namespace vespscope {
namespace {

constexpr int usageStatus = 2;  // after words that the program cannot follow

constexpr const char* footer = R"(SOURCE is where the metric events come from:
  scenario[:seed=N]  a simulated drive, the same for the same seed
  replay:FILE        a capture
  diag:FILE          a modem's diagnostic log
  modemmanager       the modem of this machine
Options follow after commas: speed=10, speed=max, loop, start=SECONDS,
gaps=real. A comma in a file's name is written twice.

Configurations are kept in DIR, so that they are active again after a restart:
the environment's STATE_DIRECTORY, else XDG_STATE_HOME/vespscope, else
~/.local/state/vespscope. --state none keeps nothing.)";

DaemonCommandLine refusal(const std::string& why) {
  return {.options = std::nullopt,
          .text = "rhoxd: " + printable(why) + " (rhoxd --help tells more)",
          .status = usageStatus};
}

std::optional<std::filesystem::path> folderIn(const char* variable, const char* below) {
  const char* value = std::getenv(variable);
  if (value == nullptr || *value != '/') return std::nullopt;  // a relative folder counts as none
  return std::filesystem::path(value) / below;
}

std::optional<std::filesystem::path> defaultState() {
  if (auto folder = folderIn("STATE_DIRECTORY", "")) return folder;
  if (auto folder = folderIn("XDG_STATE_HOME", "vespscope")) return folder;
  return folderIn("HOME", ".local/state/vespscope");
}

}  // namespace

DaemonCommandLine readDaemonCommandLine(int argc, const char* const* argv) {
  CLI::App app("The baseband manager: delivers a modem's metric events to its clients.", "rhoxd");
  std::string listen;
  std::string state;
  DaemonOptions options;
  app.add_option("--listen", listen, "The socket on which to serve clients")->required()->option_text("unix:path=PATH");
  app.add_option("--source", options.source, "Where the metric events come from")->required()->option_text("SOURCE");
  app.add_option("--state", state, "The folder in which configurations are kept")->option_text("DIR");
  app.set_version_flag("--version", "rhoxd " VESPSCOPE_VERSION);
  app.footer(footer);
  try {
    app.parse(argc, argv);
  } catch (const CLI::CallForHelp&) {
    return {.options = std::nullopt, .text = app.help()};
  } catch (const CLI::CallForVersion& version) {
    return {.options = std::nullopt, .text = std::string(version.what()) + "\n"};
  } catch (const CLI::ParseError& error) {
    return refusal(error.what());
  }

  const auto address = rhox::client::Address::parse(listen);
  if (!address) return refusal("--listen: " + address.reason());
  if (address->kind != rhox::client::Address::Kind::unixSocket) {
    return refusal("--listen: \"" + listen + "\" is no socket: write unix:path=PATH");
  }
  options.socket = address->detail;
  if (const auto spec = manager::SourceSpec::parse(options.source); !spec) return refusal("--source: " + spec.reason());
  if (app.count("--state") == 0) {
    options.state = defaultState();
  } else if (state.empty()) {
    return refusal("--state: no folder is named");
  } else if (state != "none") {
    options.state = state;
  }
  return {.options = std::move(options), .text = {}};
}

}  // namespace vespscope
