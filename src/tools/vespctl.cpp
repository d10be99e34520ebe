// vespctl: decodes, inspects, converts and records captures of metric events, and asks the baseband manager.

#include <signal.h>

#include <chrono>
#include <cstdio>
#include <functional>
#include <optional>
#include <string>

#include <CLI/CLI.hpp>

#include "platform/log/Log.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Output.h"

namespace {

using vespscope::tools::Problem;
namespace tools = vespscope::tools;

constexpr int failureStatus = 2;

int fail(const std::string& reason) {
  std::fprintf(stderr, "vespctl: %s\n", reason.c_str());
  return failureStatus;
}

int run(int count, char** arguments) {
  CLI::App app("Decodes, inspects, converts and records captures of metric events.", "vespctl");
  app.require_subcommand(1);
  app.set_version_flag("--version", "vespctl " VESPSCOPE_VERSION);
  std::function<Problem()> command;

  std::string file;
  const auto addFile = [&file](CLI::App* subcommand) {
    subcommand->add_option("FILE", file, "capture or folder of captures to read, - for standard input")->required();
  };

  CLI::App* decode = app.add_subcommand("decode", "Print one JSON object per packet: the message as decoded");
  addFile(decode);
  decode->callback([&] { command = [&] { return tools::decode(file); }; });

  CLI::App* state = app.add_subcommand("state", "Print one JSON object: what the decoder holds after all events");
  addFile(state);
  state->callback([&] { command = [&] { return tools::state(file); }; });

  std::optional<std::string> launch;
  std::optional<std::string> row;
  CLI::App* screens = app.add_subcommand("screens", "Print a JSON array of the viewer's screens after all events");
  addFile(screens);
  screens->add_option("LAUNCH", launch, "only screens behind this launch row, such as LTE");
  screens->add_option("ROW", row, "only the screen behind this row, such as \"Serving Cell Info\"");
  screens->callback([&] { command = [&] { return tools::screens(file, launch, row); }; });

  std::string source;
  std::string output;
  std::optional<unsigned> seconds;
  CLI::App* convert = app.add_subcommand("convert", "Run a source as fast as it goes into a capture");
  convert
      ->add_option("SOURCE", source,
                   "diag:FILE, replay:FILE or scenario[:seed=N], then start=SECONDS, loop after commas")
      ->required();
  convert->add_option("OUT.pcap", output, "capture to write, - for standard output")->required();
  convert->add_option("--seconds", seconds, "stop after so much of what the source plays; an endless one needs it");
  bool report = false;
  convert->add_flag("--report", report,
                    "of a modem log: tell on standard error what became of each frame and each kind of record");
  convert->callback([&] {
    command = [&] {
      return tools::convert(source, output, seconds ? std::optional(std::chrono::seconds(*seconds)) : std::nullopt,
                            report);
    };
  });

  CLI::App* record = app.add_subcommand("record", "Write what the baseband manager delivers until interrupted");
  record->add_option("OUT.pcap", output, "capture to write, - for standard output")->required();
  std::optional<std::string> address;
  record->add_option("--manager", address,
                     "where the manager is: system, unix:path=PATH, ssh:HOST, embedded:SOURCE or auto (default: "
                     "RHOX_ADDRESS, else auto)");
  record->callback([&] { command = [&] { return tools::record(output, address); }; });

  CLI::App* status = app.add_subcommand("status", "Print one JSON object: the baseband manager's source and clients");
  status->add_option("--manager", address,
                     "where the manager is: system, unix:path=PATH or ssh:HOST (default: RHOX_ADDRESS, else system)");
  status->callback([&] { command = [&] { return tools::status(address); }; });

  try {
    app.parse(count, arguments);
  } catch (const CLI::Success& success) {
    return app.exit(success);
  } catch (const CLI::ParseError& error) {
    return fail(std::string(error.what()) + "; see vespctl --help");
  }

  // Standard output is the command's own; the decoder's log lines go nowhere.
  vespscope::log::discardOutputs();
  Problem problem = command();
  if (Problem unwritten = tools::flushOutput(); unwritten && !problem) problem = std::move(unwritten);
  return problem ? fail(*problem) : 0;
}

}  // namespace

int main(int count, char** arguments) {
  // Outputs that are closed or full are told as such.
  ::signal(SIGPIPE, SIG_IGN);
  ::signal(SIGXFSZ, SIG_IGN);
  return run(count, arguments);
}
