#include "tools/vespscopeOptions.h"

#include <utility>

#include <CLI/App.hpp>
#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>

#include "rhoxlink/Rhoxlink.h"
#include "sources/RecogniseFile.h"

namespace vespscope {
namespace {

constexpr const char* footer = R"(ADDRESS is where the baseband manager is found:
  system            the service on the system bus
  unix:path=PATH    the socket on which rhoxd listens
  ssh:HOST          rhoxd on another machine
  embedded:SOURCE   a manager inside this program; SOURCE is scenario[:seed=N],
                    replay:FILE, diag:FILE, diag:PORT (/dev/ttyUSB0 or
                    tcp:127.0.0.1:5000) or modemmanager, with options after
                    commas: speed=10, speed=max, loop, start=SECONDS (of the
                    recording's own time), gaps=real (a silence of more than
                    10 s is played as 10 s without it), sim=NUMBER (the SIM
                    card to show first)
  auto              system if the service is installed or runs, else embedded
Without --manager it is the environment's RHOX_ADDRESS, else auto.)";

Result<UserInterface> interfaceNamed(const std::string& name) {
  if (name == "terminal") return UserInterface::terminal;
  if (name == "none") return UserInterface::none;
  if (name == "quick") return UserInterface::quick;
  return Failure{"\"" + name + "\" is no interface"};
}

}  // namespace

ViewerCommandLine readViewerCommandLine(int argc, const char* const* argv) {
  CLI::App app("Shows what a phone's cellular modem is doing right now.", "vespscope");
  std::string file;
  std::string manager;
  std::string interface;
  app.add_option("FILE", file, "A capture, a folder of captures or a modem log (.pcap, .mi2log, .qmdl) to play")
      ->option_text(" ");
  app.add_option("--manager", manager, "Where the baseband manager is found")->option_text("ADDRESS");
  app.add_option("--ui", interface,
                 "quick, terminal or none; the default is quick where there is a display, else "
                 "terminal where there is one")
      ->option_text("INTERFACE");
  std::optional<std::int32_t> sim;
  app.add_option("--sim", sim,
                 "The SIM card to show first (1 to 4) of a phone with several; the default is the one with data "
                 "bearers, else the first")
      ->check(CLI::Range(1, 4))
      ->option_text("NUMBER");
  app.set_version_flag("--version", "vespscope " VESPSCOPE_VERSION);
  app.footer(footer);
  if (auto ending = parseArguments(app, argc, argv)) return {.options = std::nullopt, .ending = std::move(*ending)};
  const auto refuse = [&app](const std::string& why) {
    return ViewerCommandLine{.options = std::nullopt, .ending = refusal(app, why)};
  };

  ViewerOptions options;
  options.sim = sim;
  if (app.count("--ui") != 0) {
    const auto known = interfaceNamed(interface);
    if (!known) return refuse("--ui: " + known.reason());
    options.interface = known.value();
  }
  const bool given = app.count("--manager") != 0;
  if (app.count("FILE") != 0) {
    if (given) return refuse("FILE and --manager: a file is played by a manager of its own");
    if (file == "-") return refuse("standard input is not a FILE: use --manager embedded:replay:- or embedded:diag:-");
    const auto kind = sources::recogniseFile(file);
    if (!kind) return refuse(kind.reason());
    options.manager = {rhox::client::Address::Kind::embedded, sources::sourceWords(*kind, file)};
    return {.options = std::move(options), .ending = {}};
  }
  const auto address = given ? rhox::client::Address::parse(manager) : rhox::client::address();
  if (!address) return refuse((given ? "--manager: " : "") + address.reason());
  options.manager = address.value();
  return {.options = std::move(options), .ending = {}};
}

}  // namespace vespscope
