#include "tools/rhoxdOptions.h"

#include <cstdlib>
#include <utility>

#include <CLI/App.hpp>
#include <CLI/Config.hpp>
#include <CLI/Formatter.hpp>

#include "rhoxlink/Address.h"
#include "tools/Quantities.h"

namespace vespscope {
namespace {

constexpr const char* footer = R"(SOURCE is where the metric events come from:
  scenario[:seed=N]  a simulated drive, the same for the same seed
  replay:FILE        a capture, or a folder of them
  diag:FILE          a modem's diagnostic log, - for standard input
  diag:PORT          the live log of a modem on a serial port (/dev/ttyUSB0) or
                     over TCP (tcp:127.0.0.1:5000)
  modemmanager       the modem of this machine
Options follow after commas: speed=10, speed=max, loop, start=SECONDS,
gaps=real. A comma in a file's name is written twice. start counts the
recording's own time from its first event; the state at that moment comes
first. A silence of more than 10 s, or time that runs backwards, is played as
10 s unless gaps=real.

Configurations are kept in DIR, so that they are active again after a restart:
the environment's STATE_DIRECTORY, else XDG_STATE_HOME/vespscope, else
~/.local/state/vespscope. --state none keeps nothing.

--record writes every event of the source into capture files of a folder, whether
or not a client asks for it, and starts the source at once. A new file begins when
one is full or old; then the oldest go that are over --record-total or not younger
than --record-keep. SIZE is in bytes, or with K, M or G; TIME is 90s, 15m, 1h or 7d.
vespctl and replay:DIR read such a folder as one capture.)";

std::optional<std::filesystem::path> folderIn(const char* variable, const char* below) {
  const char* value = std::getenv(variable);
  if (value == nullptr || *value != '/') return std::nullopt;  // a relative folder is ignored
  return std::filesystem::path(value) / below;
}

std::optional<std::filesystem::path> defaultState() {
  if (auto folder = folderIn("STATE_DIRECTORY", "")) return folder;
  if (auto folder = folderIn("XDG_STATE_HOME", "vespscope")) return folder;
  return folderIn("HOME", ".local/state/vespscope");
}

// The options of recording.
class RecordingWords {
 public:
  void addTo(CLI::App& app) {
    app.add_option("--record", folder_, "The folder in which the events are recorded")->option_text("DIR");
    app.add_option("--record-size", size_, "Size at which a new file begins (16M)")->option_text("SIZE");
    app.add_option("--record-age", age_, "Age at which a new file begins (1h)")->option_text("TIME");
    app.add_option("--record-total", total_, "Size of all files together (1G)")->option_text("SIZE");
    app.add_option("--record-keep", keep_, "How long files are kept (until the space is needed)")->option_text("TIME");
  }

  // Returns an error for invalid values or combinations.
  std::optional<std::string> readInto(DaemonOptions& options) const {
    manager::RecordingLimits& limits = options.recordingLimits;
    if (!folder_ && (size_ || age_ || total_ || keep_)) return "--record: no folder is named";
    if (!folder_) return std::nullopt;
    if (folder_->empty()) return "--record: no folder is named";
    options.record = *folder_;
    if (auto problem = readSize("--record-size", size_, limits.fileSize)) return problem;
    if (auto problem = readSize("--record-total", total_, limits.totalSize)) return problem;
    if (limits.totalSize < limits.fileSize) return "--record-total: less than one file (--record-size)";
    if (auto problem = readTime("--record-age", age_, limits.fileAge)) return problem;
    if (!keep_) return std::nullopt;
    return readTime("--record-keep", keep_, limits.keep.emplace());
  }

 private:
  using Words = std::optional<std::string>;

  static std::optional<std::string> readSize(const std::string& option, const Words& words, std::uint64_t& size) {
    if (!words) return std::nullopt;
    const auto read = parseSize(*words);
    if (!read) return option + ": \"" + *words + "\" is not a size: write 64M";
    size = *read;
    return std::nullopt;
  }
  static std::optional<std::string> readTime(const std::string& option, const Words& words,
                                             std::chrono::seconds& time) {
    if (!words) return std::nullopt;
    const auto read = parseDuration(*words);
    if (!read) return option + ": \"" + *words + "\" is not a time: write 15m";
    time = *read;
    return std::nullopt;
  }

  Words folder_;
  Words size_;
  Words age_;
  Words total_;
  Words keep_;
};

}  // namespace

DaemonCommandLine readDaemonCommandLine(int argc, const char* const* argv) {
  CLI::App app("The baseband manager: delivers a modem's metric events to its clients.", "rhoxd");
  std::string listen;
  std::string state;
  DaemonOptions options;
  app.add_flag("--system", options.system, "Serve clients on the system bus; the default without --listen");
  app.add_option("--listen", listen, "Serve clients that connect to this socket")->option_text("unix:path=PATH");
  app.add_flag("--stdio", options.stdio,
               "Serve one client on standard input and output, as ssh does for a viewer elsewhere. Without --source, "
               "the manager on the system bus serves it, if there is one");
  app.add_option("--source", options.source,
                 "The source of the metric events; by default modemmanager, the modem of this machine")
      ->option_text("SOURCE");
  app.add_option("--group", options.group,
                 "The group whose members may use it on the system bus; by default vespscope. The bus policy must "
                 "permit it too")
      ->option_text("NAME");
  app.add_option("--state", state, "The folder in which configurations are kept")->option_text("DIR");
  RecordingWords recording;
  recording.addTo(app);
  app.set_version_flag("--version", "rhoxd " VESPSCOPE_VERSION);
  app.footer(footer);
  if (auto ending = parseArguments(app, argc, argv)) return {.options = std::nullopt, .ending = std::move(*ending)};
  const auto refuse = [&app](const std::string& why) {
    return DaemonCommandLine{.options = std::nullopt, .ending = refusal(app, why)};
  };

  if (app.count("--listen") != 0) {
    const auto address = rhox::client::Address::parse(listen);
    // Rejects an invalid address, or one of another kind.
    if (!address || address->kind != rhox::client::Address::Kind::unixSocket) {
      return refuse("--listen takes a socket, unix:path=PATH, not \"" + listen +
                    "\"; clients of other machines come through ssh, which runs rhoxd --stdio");
    }
    options.socket = address->detail;
  } else if (!options.stdio) {
    options.system = true;
  }
  if (options.stdio && (options.system || options.socket)) {
    return refuse("--stdio serves one client only: it excludes --system and --listen");
  }
  options.relay = options.stdio && app.count("--source") == 0;
  if (const auto spec = sources::SourceSpec::parse(options.source); !spec) return refuse("--source: " + spec.reason());
  if (app.count("--state") == 0) {
    options.state = defaultState();
  } else if (state.empty()) {
    return refuse("--state: no folder is named");
  } else if (state != "none") {
    options.state = state;
  }
  if (const auto problem = recording.readInto(options)) return refuse(*problem);
  return {.options = std::move(options), .ending = {}};
}

}  // namespace vespscope
