// vespctl: decodes, inspects, converts and records captures of metric events, and asks the baseband manager.

#include <signal.h>

#include <chrono>
#include <functional>
#include <optional>
#include <string>

#include <CLI/CLI.hpp>

#include "platform/console/Console.h"
#include "platform/files/StandardDescriptors.h"
#include "platform/log/Log.h"
#include "tools/CommandLine.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Output.h"

namespace {

using vespscope::tools::Problem;
namespace tools = vespscope::tools;

constexpr int unusableStatus = 1;  // doctor found nothing that the viewer can show
constexpr int failureStatus = 2;

int fail(const std::string& reason) {
  vespscope::console::error("vespctl: " + reason);
  return failureStatus;
}

// Returns the first argument if it is not a command: the parser would only report that a command is missing.
std::optional<std::string> unknownCommand(const CLI::App& app, int count, const char* const* arguments) {
  if (count < 2 || *arguments[1] == '-') return std::nullopt;
  const std::string word = arguments[1];
  std::string known;
  for (const CLI::App* command : app.get_subcommands({})) {
    if (command->get_name() == word) return std::nullopt;
    known += (known.empty() ? "" : ", ") + command->get_name();
  }
  return "there is no command \"" + word + "\", only " + known;
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

  tools::Sim sim;
  const auto addSim = [&sim](CLI::App* subcommand, const char* help) {
    subcommand->add_option("--sim", sim, help)->check(CLI::Range(1, 4))->type_name("NUMBER");
  };

  CLI::App* decode = app.add_subcommand("decode", "Print one JSON object per packet: the decoded message");
  addFile(decode);
  addSim(decode, "only events of this SIM card (1 to 4)");
  decode->callback([&] { command = [&] { return tools::decode(file, sim); }; });

  CLI::App* state = app.add_subcommand("state", "Print one JSON object: the decoder's state after all events");
  addFile(state);
  const char* shown = "the SIM card to show (1 to 4; default: the one with data bearers, else the first)";
  addSim(state, shown);
  state->callback([&] { command = [&] { return tools::state(file, sim); }; });

  std::optional<std::string> launch;
  std::optional<std::string> row;
  CLI::App* screens = app.add_subcommand("screens", "Print a JSON array of the viewer's screens after all events");
  addFile(screens);
  addSim(screens, shown);
  screens->add_option("LAUNCH", launch, "only screens behind this launch row, such as LTE");
  screens->add_option("ROW", row, "only the screen behind this row, such as \"Serving Cell Info\"");
  screens->callback([&] { command = [&] { return tools::screens(file, launch, row, sim); }; });

  tools::Conversion conversion;
  std::optional<unsigned> seconds;
  CLI::App* convert = app.add_subcommand("convert", "Convert a source into a capture, as fast as possible");
  convert
      ->add_option("SOURCE", conversion.source,
                   "diag:FILE, replay:FILE or scenario[:seed=N], then start=SECONDS, loop after commas")
      ->required();
  convert->add_option("OUT.pcap", conversion.output,
                      "capture to write, - for standard output; may be omitted with --unread");
  convert->add_option("--seconds", seconds,
                      "stop after this much of the source's own time; required for an endless source");
  convert->add_flag(
      "--report", conversion.report,
      "for a modem log: print on standard error how frames and records were handled, and which screens they fill");
  convert
      ->add_option("--unread", conversion.unread,
                   "for a modem log: folder for one sample of each kind of record that is not read, to be shared: "
                   "identities, places and times are removed")
      ->type_name("FOLDER");
  convert->add_flag("--force", conversion.force, "replace OUT.pcap and samples that exist");
  addSim(convert, "only this SIM card (1 to 4); default: all of them");
  convert->callback([&] {
    conversion.sim = sim;
    if (conversion.output.empty() && !conversion.unread) throw CLI::RequiredError("OUT.pcap");
    if (seconds) conversion.limit = std::chrono::seconds(*seconds);
    command = [&] { return tools::convert(conversion); };
  });

  tools::RecordingWish wish;
  CLI::App* record = app.add_subcommand("record", "Record the baseband manager's events until interrupted");
  record->add_option("OUT.pcap", wish.output, "capture to write, - for standard output")->required();
  record->add_option("--manager", wish.address,
                     "where the manager is: system, unix:path=PATH, ssh:HOST, embedded:SOURCE or auto (default: "
                     "RHOX_ADDRESS, else auto)");
  record->add_flag("--force", wish.force, "replace OUT.pcap if it exists");
  addSim(record, "only this SIM card (1 to 4); default: all of them");
  record->callback([&] {
    wish.sim = sim;
    command = [&] { return tools::record(wish); };
  });

  tools::Examination examination;
  bool usable = true;
  CLI::App* doctor = app.add_subcommand("doctor", "Print what a recording or a port holds, and what to do next");
  doctor
      ->add_option("FILE|PORT", examination.subject,
                   "modem log, capture or folder of captures; /dev/NAME or tcp:ADDRESS:PORT for a modem's port")
      ->required();
  doctor->add_flag("--json", examination.json, "print one JSON object");
  doctor->callback([&] {
    command = [&]() -> Problem {
      const auto found = tools::doctor(examination);
      if (!found) return found.reason();
      usable = *found;
      return std::nullopt;
    };
  });

  std::optional<std::string> address;
  CLI::App* status = app.add_subcommand("status", "Print one JSON object: the baseband manager's source and clients");
  status->add_option("--manager", address,
                     "where the manager is: system, unix:path=PATH or ssh:HOST (default: RHOX_ADDRESS, else system)");
  status->callback([&] { command = [&] { return tools::status(address); }; });

  if (const auto problem = unknownCommand(app, count, arguments)) return vespscope::refusal(app, *problem).print();
  if (const auto ending = vespscope::parseArguments(app, count, arguments)) return ending->print();

  // Standard output is reserved for the command's result; the decoder's log lines are discarded.
  vespscope::log::discardOutputs();
  Problem problem = command();
  if (Problem unwritten = tools::flushOutput(); unwritten && !problem) problem = std::move(unwritten);
  if (problem) return fail(*problem);
  return usable ? 0 : unusableStatus;
}

}  // namespace

int main(int count, char** arguments) {
  vespscope::files::openStandardDescriptors();
  // A reader that closes its end of the pipe ends the program quietly, even if the parent process ignores SIGPIPE.
  ::signal(SIGPIPE, SIG_DFL);
  ::signal(SIGXFSZ, SIG_IGN);  // reported like a full disk
  return run(count, arguments);
}
