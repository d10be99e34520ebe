// Draws trials.
#include <signal.h>

#include <cstdio>

#include "programs/Trial.h"

namespace vespscope::fuzz {
namespace {

using Words = std::vector<std::string>;

class Drawing {
 public:
  Drawing(const Ground& ground, std::uint64_t seed) : ground_(ground), random_(seed) {}

  std::uint64_t below(std::uint64_t bound) { return random_() % bound; }
  bool oneIn(std::uint64_t count) { return below(count) == 0; }
  const std::string& of(const Words& words) { return words[below(words.size())]; }

  std::string junk() {
    std::string bytes(below(oneIn(20) ? 100'000 : 40) + 1, 'x');
    for (char& byte : bytes) {
      byte = static_cast<char>(oneIn(4) ? below(255) + 1 : below(0x5F) + 0x20);
    }
    return bytes;
  }
  std::string number() {
    return of({"0", "1", "3", "-1", "1e9", "nan", "inf", "18446744073709551615", "99999999999999999999999", "0x10", "",
               "0.001", "max", " 7", "7 "});
  }
  std::string source() {
    std::string words;
    switch (below(8)) {
      case 0:
      case 1:
        words = "scenario";
        if (oneIn(2)) return words + ":seed=" + number() + (oneIn(2) ? ",speed=" + number() : "");
        return words;
      case 2:
      case 3:
        words = "replay:" + (oneIn(2) ? of(ground_.captures()) : of(ground_.inputs()));
        break;
      case 4:
        words = "diag:" + of(ground_.inputs());
        break;
      case 5:
        return "diag:tcp:127.0.0.1:" + (oneIn(3) ? number() : std::to_string(ground_.silentPort()));
      case 6:
        return "modemmanager";
      default:
        return junk();
    }
    static const Words options = {"loop", "speed=max", "speed=", "start=", "gaps=real", "sim=", "nonsense", ""};
    while (oneIn(2)) {
      const std::string& option = of(options);
      words += "," + option + (option.ends_with('=') ? number() : "");
    }
    return words;
  }
  std::string address() {
    switch (below(8)) {
      case 0:
        return "unix:path=" + ground_.silentSocket();
      case 1:
        return "unix:path=" + of(ground_.inputs());
      case 2:
        return "system";
      case 3:
        return "auto";
      case 4:
        return oneIn(3) ? "ssh:" + junk() : "ssh:host";
      case 5:
        return junk();
      default:
        return "embedded:" + source();
    }
  }
  std::string output() {
    // A source's own name now and then, which has to be refused.
    return of(ground_.outputs());
  }

  Words vespscopeWords() {
    Words words;
    if (oneIn(3)) {
      words.push_back(of(ground_.inputs()));
    } else if (!oneIn(5)) {
      words.insert(words.end(), {"--manager", address()});
    }
    words.insert(words.end(), {"--ui", oneIn(10) ? junk() : of({"none", "none", "terminal", "terminal", "quick"})});
    return words;
  }
  Words rhoxdWords() {
    Words words;
    switch (below(4)) {
      case 0:
        words.push_back("--stdio");
        break;
      case 1:
        words.push_back("--system");
        break;
      default:
        words.insert(words.end(), {"--listen", "unix:path=" + (oneIn(4) ? of(ground_.inputs())
                                                                        : (ground_.folder() / "out/socket").string())});
    }
    if (!oneIn(6)) words.insert(words.end(), {"--source", source()});
    const std::string out = (ground_.folder() / "out" / "").string();
    words.insert(words.end(), {"--state", oneIn(2) ? "none" : out + "state"});
    if (oneIn(2)) {
      words.insert(words.end(), {"--record", oneIn(4) ? out + "old.pcap" : out + "recordings"});
      if (oneIn(2)) words.insert(words.end(), {"--record-size", oneIn(2) ? number() : "4K"});
      if (oneIn(4)) words.insert(words.end(), {"--record-total", oneIn(2) ? number() : "64K"});
      if (oneIn(4)) words.insert(words.end(), {"--record-age", oneIn(2) ? number() : "1s"});
    }
    if (oneIn(8)) words.insert(words.end(), {"--group", junk()});
    return words;
  }
  Words vespctlWords() {
    switch (below(7)) {
      case 0:
        return {"decode", of(ground_.inputs())};
      case 1:
        return {"state", of(ground_.inputs())};
      case 2:
        return oneIn(2) ? Words{"screens", of(ground_.inputs())}
                        : Words{"screens", of(ground_.inputs()), "LTE", junk()};
      case 3:
        return {"status", "--manager", address()};
      case 4: {
        Words words = {"record", output(), "--manager", address()};
        if (oneIn(2)) words.emplace_back("--force");
        return words;
      }
      default: {
        // Every other time onto its own source, under its name or another one.
        const std::string& capture = of(ground_.captures());
        const std::string from = oneIn(2) ? "replay:" + doubled(capture) : source();
        Words words = {"convert", from, oneIn(4) ? capture : output()};
        // Replacing another capture is what this option is for.
        if (words[2] != capture || from == "replay:" + doubled(capture)) {
          if (oneIn(2)) words.emplace_back("--force");
        }
        if (oneIn(2)) words.insert(words.end(), {"--seconds", oneIn(2) ? number() : "60"});
        if (oneIn(4)) words.emplace_back("--report");
        return words;
      }
    }
  }
  // Drops, repeats or spoils a word.
  void spoil(Words& words) {
    const std::size_t place = below(words.size());
    switch (below(4)) {
      case 0:
        words.erase(words.begin() + static_cast<std::ptrdiff_t>(place));
        break;
      case 1:
        words.push_back(words[place]);
        break;
      case 2:
        words[place] = junk();
        break;
      default:
        words.insert(words.begin() + static_cast<std::ptrdiff_t>(place),
                     of({"--help", "--version", "--", "-", "-x", "--ui="}));
    }
    std::erase(words, "--force");
  }

  std::map<std::string, std::string> variables() {
    // The system bus of this machine is left alone.
    std::map<std::string, std::string> all = {
        {"PATH", (ground_.folder() / "bin").string() + ":/usr/bin:/bin"},
        {"DBUS_SYSTEM_BUS_ADDRESS", oneIn(2) ? "unix:path=" + ground_.silentSocket() : "unix:path=/absent/bus"},
        {"HOME", ground_.folder() / "out"},
        {"TERM", "xterm-256color"}};
    const auto set = [&](const char* name, const Words& usual) {
      if (oneIn(5)) all[name] = oneIn(5) ? junk() : of(usual);
    };
    set("TERM", {"", "dumb", "linux", "vt100", "screen", "xterm-direct", "../../etc/passwd"});
    set("LC_ALL", {"C", "C.UTF-8", "de_DE.UTF-8", "nonsense", ""});
    set("TZ", {"UTC", "Europe/Berlin", ":/etc/passwd", "../..", "X", ""});
    set("COLUMNS", {"0", "1", "-5", "99999999", "40"});
    set("LINES", {"0", "1", "-5", "99999999", "10"});
    set("ESCDELAY", {"0", "-1", "99999999999", "25"});
    set("NO_COLOR", {"", "1"});
    set("RHOX_ADDRESS", {"none", "auto", "embedded:scenario", "unix:path=/absent"});
    set("VESPSCOPE_RESOURCES", {"/absent", (ground_.folder() / "in").string(), "/dev/null"});
    set("XDG_STATE_HOME", {"relative", "/dev/null", "/proc"});
    set("STATE_DIRECTORY", {"relative:two", "/dev/null"});
    set("DISPLAY", {":99", "nonsense"});
    set("WAYLAND_DISPLAY", {"nonsense"});
    set("QT_QPA_PLATFORM", {"offscreen", "nonsense"});
    set("NOTIFY_SOCKET", {"/absent", "@nobody"});
    // The shell's own variables hold neither line ends nor NUL.
    return all;
  }

  Trial trial() {
    Trial trial;
    const Words programs = {"vespscope", "rhoxd", "vespctl"};
    trial.program = of(programs);
    trial.arguments = trial.program == "vespscope" ? vespscopeWords()
                      : trial.program == "rhoxd"   ? rhoxdWords()
                                                   : vespctlWords();
    if (oneIn(4)) spoil(trial.arguments);
    trial.variables = variables();
    constexpr std::array<End, 10> all = {End::nothing,    End::null, End::terminal, End::pipe,   End::silentPipe,
                                         End::brokenPipe, End::full, End::file,     End::folder, End::otherWay};
    constexpr std::array<End, 3> usual = {End::null, End::pipe, End::terminal};
    const bool onTerminal = oneIn(3);
    for (End& end : trial.ends) {
      end = onTerminal ? End::terminal : oneIn(2) ? usual[below(usual.size())] : all[below(all.size())];
    }
    if (oneIn(8)) trial.descriptors = static_cast<int>(below(28) + 4);
    if (oneIn(8)) trial.room = below(20'000) + 1;
    trial.time = std::chrono::milliseconds(below(300) + 5);
    constexpr std::array<int, 4> signals = {SIGTERM, SIGTERM, SIGINT, SIGHUP};
    trial.signal = signals[below(signals.size())];
    return trial;
  }

 private:
  static std::string doubled(const std::string& path) {
    std::string words;
    for (const char character : path) words.append(character == ',' ? 2 : 1, character);
    return words;
  }

  const Ground& ground_;
  std::mt19937_64 random_;
};

std::string quoted(const std::string& word) {
  std::string text;
  bool plain = !word.empty();
  constexpr std::size_t most = 300;
  for (const char character : word.substr(0, most)) {
    const auto byte = static_cast<unsigned char>(character);
    if (byte < 0x20 || byte >= 0x7F || character == '\'' || character == '\\') {
      std::array<char, 8> number{};
      std::snprintf(number.data(), number.size(), "\\x%02x", byte);
      text += number.data();
      plain = false;
    } else {
      text += character;
      plain =
          plain && (std::isalnum(byte) != 0 || std::string_view("-_./:=,+").find(character) != std::string_view::npos);
    }
  }
  if (word.size() > most) text += "...(" + std::to_string(word.size()) + " bytes)";
  return plain ? text : "$'" + text + "'";
}

}  // namespace

Trial Trial::draw(const Ground& ground, std::uint64_t seed) { return Drawing(ground, seed).trial(); }

std::string Trial::words() const {
  static const char* const names[] = {"closed",      "null", "terminal", "pipe",   "silent pipe",
                                      "broken pipe", "full", "file",     "folder", "the other way"};
  std::string text;
  for (const auto& [name, value] : variables) text += name + "=" + quoted(value) + " ";
  text += program;
  for (const std::string& word : arguments) text += " " + quoted(word);
  text += " [0, 1, 2:";
  for (const End end : ends) text += std::string(" ") + names[static_cast<std::size_t>(end)] + ",";
  if (descriptors != 0) text += " " + std::to_string(descriptors) + " descriptors,";
  if (room != 0) text += " files of " + std::to_string(room) + " bytes,";
  return text + " signal " + std::to_string(signal) + " after " + std::to_string(time.count()) + " ms]";
}

bool Trial::writesData() const {
  if (program == "vespscope") return false;
  for (const std::string& word : arguments) {
    if (word == "--stdio" || word == "-" || word == "/dev/stdout") return true;
  }
  return false;
}

}  // namespace vespscope::fuzz
