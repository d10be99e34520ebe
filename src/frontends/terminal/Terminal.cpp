#include "frontends/terminal/Terminal.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/ioctl.h>
#include <termios.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <cerrno>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <mutex>
#include <utility>

#include <langinfo.h>
#define NCURSES_NOMACROS 1
#include <curses.h>

#include <term.h>

#include "frontends/terminal/ClipboardSequence.h"
#include "frontends/terminal/TerminalEnvironment.h"
#include "values/Text.h"

namespace vespscope::terminal {
namespace {

constexpr wint_t escape = 27;

bool canPlaceCursor() {
  const char* capability = ::tigetstr("cup");
  return capability != nullptr && capability != reinterpret_cast<const char*>(-1);
}

// Bracketed paste: the terminal puts marks around pasted text. Curses reports the marks as keys of these codes, beyond
// those that it gives to the keys of terminal types.
constexpr const char* pasteMarksOn = "\x1b[?2004h";
constexpr const char* pasteMarksOff = "\x1b[?2004l";
constexpr int pasteBegins = KEY_MAX + 1000;
constexpr int pasteEnds = KEY_MAX + 1001;

// Colours with the terminal's own background, which suit light and dark ones.
enum Pair : short { plain = 0, green, magenta, blue, red, amber };

struct Look {
  attr_t attributes;
  short pair;
};

// Attributes alone distinguish roles; colours are added to them.
Look lookOf(Style style) {
  Look look{A_NORMAL, plain};
  switch (style.role) {
    case Role::text:
      break;
    case Role::title:
    case Role::header:
      look.attributes = A_BOLD;
      break;
    case Role::faint:
      look.attributes = A_DIM;
      break;
    case Role::changed:
      look = {A_BOLD, green};
      break;
    case Role::live:
      look = {A_BOLD | A_REVERSE, green};
      break;
    case Role::simulated:
      look = {A_BOLD | A_REVERSE, magenta};
      break;
    case Role::recorded:
      look = {A_BOLD | A_REVERSE, blue};
      break;
    case Role::unknownSource:
      look.attributes = A_BOLD | A_REVERSE;
      break;
    case Role::warning:
      look = {A_BOLD, red};
      break;
    case Role::old:
      look = {A_BOLD, amber};
      break;
  }
  if (style.selected) look = {A_REVERSE | (look.attributes & A_BOLD), plain};
  return look;
}

// Replaces the descriptor of a terminal that does not accept output by /dev/null. The numbers are for signal handlers.
std::atomic<int> outputNumber = -1;
std::atomic<int> nullNumber = -1;
std::atomic<bool> outputDropped = false;

extern "C" void dropOutput(int /*signal*/) {
  const int before = errno;
  if (outputNumber >= 0 && nullNumber >= 0 && ::dup2(nullNumber, outputNumber) >= 0) outputDropped = true;
  errno = before;
}

struct CloseDescriptor {
  int number = -1;
  explicit CloseDescriptor(int opened) : number(opened) {}
  CloseDescriptor(const CloseDescriptor&) = delete;
  CloseDescriptor& operator=(const CloseDescriptor&) = delete;
  ~CloseDescriptor() {
    if (number >= 0) ::close(number);
  }
};

// Returns a terminal capability as bytes, without the pauses ("$<2>") that only printing terminals need.
std::string capability(const char* name) {
  const char* text = ::tigetstr(name);
  if (text == nullptr || text == reinterpret_cast<const char*>(-1)) return {};
  std::string bytes = text;
  for (std::size_t pause = bytes.find("$<"); pause != std::string::npos; pause = bytes.find("$<")) {
    const std::size_t end = bytes.find('>', pause);
    bytes.erase(pause, end == std::string::npos ? end : end + 1 - pause);
  }
  return bytes;
}

class CursesTerminal final : public Terminal {
 public:
  CursesTerminal(File input, File output, SCREEN* screen, const termios& found, bool colours)
      : input_(std::move(input)),
        output_(std::move(output)),
        screen_(screen),
        found_(found),
        null_(::open("/dev/null", O_WRONLY | O_CLOEXEC)),
        // Opened again, so that O_NONBLOCK does not apply to other users of the terminal.
        direct_(::open(("/proc/self/fd/" + std::to_string(::fileno(output_.get()))).c_str(),
                       O_WRONLY | O_NOCTTY | O_NONBLOCK | O_CLOEXEC)),
        // CAN ends an incomplete sequence.
        restoring_("\x18" + capability("sgr0") + capability("rmkx") + "\x1b[?1000l" + pasteMarksOff +
                   capability("cnorm") + capability("rmcup")) {
    outputDropped = false;
    nullNumber = null_.number;
    outputNumber = ::fileno(output_.get());
    struct sigaction alarmed {};
    alarmed.sa_handler = dropOutput;
    alarmed.sa_flags = SA_RESTART;
    ::sigaction(SIGALRM, &alarmed, &alarmBefore_);
    ::cbreak();
    ::noecho();
    ::nonl();
    ::intrflush(stdscr, FALSE);
    ::keypad(stdscr, TRUE);
    ::nodelay(stdscr, TRUE);
    ::leaveok(stdscr, FALSE);
    ::curs_set(0);
    if (std::getenv("ESCDELAY") == nullptr) ::set_escdelay(25);
    if (colours && ::has_colors() && ::start_color() == OK && ::use_default_colors() == OK) {
      colours_ = true;
      ::init_pair(green, COLOR_GREEN, -1);
      ::init_pair(magenta, COLOR_MAGENTA, -1);
      ::init_pair(blue, COLOR_BLUE, -1);
      ::init_pair(red, COLOR_RED, -1);
      ::init_pair(amber, COLOR_YELLOW, -1);
    }
    ::mousemask(BUTTON1_PRESSED | BUTTON1_CLICKED | BUTTON4_PRESSED | BUTTON5_PRESSED, nullptr);
    ::mouseinterval(0);
    ::define_key("\x1b[200~", pasteBegins);
    ::define_key("\x1b[201~", pasteEnds);
    send(pasteMarksOn);
  }

  CursesTerminal(const CursesTerminal&) = delete;
  CursesTerminal& operator=(const CursesTerminal&) = delete;

  ~CursesTerminal() override {
    abandon();
    ::alarm(0);
    outputNumber = -1;
    ::sigaction(SIGALRM, &alarmBefore_, nullptr);
    ::delscreen(screen_);
  }

  [[nodiscard]] Size size() const override { return {::getmaxx(stdscr), ::getmaxy(stdscr)}; }

  void paint(const Frame& frame) override {
    const std::lock_guard lock(painting_);
    if (abandoned_) return;
    ::werase(stdscr);
    const Size size = frame.grid.size();
    for (int line = 0; line < size.height; ++line) paintLine(frame.grid, line);
    ::wattr_set(stdscr, A_NORMAL, plain, nullptr);
    ::curs_set(frame.cursor ? 1 : 0);
    if (frame.cursor) ::wmove(stdscr, frame.cursor->second, frame.cursor->first);
    ::wrefresh(stdscr);
  }

  void forget() override { ::clearok(curscr, TRUE); }

  void resized() override {
    winsize now{};
    if (::ioctl(::fileno(output_.get()), TIOCGWINSZ, &now) != 0 || now.ws_row == 0 || now.ws_col == 0) return;
    ::resizeterm(std::min<int>(now.ws_row, mostCells), std::min<int>(now.ws_col, mostCells));
    ::clearok(curscr, TRUE);
  }

  [[nodiscard]] int inputDescriptor() const override { return ::fileno(input_.get()); }

  [[nodiscard]] std::optional<Input> read() override {
    while (true) {
      wint_t character = 0;
      const int kind = ::wget_wch(stdscr, &character);
      if (kind == ERR) return std::nullopt;
      if (kind == KEY_CODE_YES && (character == pasteBegins || character == pasteEnds)) {
        pasting_ = character == pasteBegins;
        continue;
      }
      if (pasting_) {
        if (kind == KEY_CODE_YES) continue;
        if (character != escape) return Input{Key::pasted, static_cast<char32_t>(character), 0, 0};
        pasting_ = false;  // terminals remove it from pasted text: the mark of the end was lost
      }
      const std::optional<Input> input = kind == KEY_CODE_YES ? functionKey(character) : characterKey(character);
      if (input) return input;  // otherwise a key without a meaning here
    }
  }

  [[nodiscard]] bool isGone() const override {
    pollfd input{inputDescriptor(), POLLIN, 0};
    return ::poll(&input, 1, 0) > 0 && (input.revents & (POLLHUP | POLLERR | POLLNVAL)) != 0;
  }

  bool copy(const std::string& text) override {
    const std::lock_guard lock(painting_);
    if (abandoned_ || !ignoresUnknownSequences()) return false;
    const std::string sequence = clipboardSequence(text);
    std::string_view left = sequence;
    while (!left.empty()) {
      const ssize_t written = ::write(::fileno(output_.get()), left.data(), left.size());
      if (written < 0 && errno != EINTR) return false;
      if (written > 0) left.remove_prefix(static_cast<std::size_t>(written));
    }
    return true;
  }

  void release() override {
    if (!takesOutput()) dropOutput(0);
    ::curs_set(1);
    send(pasteMarksOff);
    ::endwin();
    if (outputDropped) restoreDirectly();
  }

  void takeBack() override {
    ::reset_prog_mode();
    send(pasteMarksOn);
    resized();
    ::clearok(curscr, TRUE);
  }

  void abandon() override {
    // If one thread fails while another one paints, it waits for a bounded time only: it may be the same thread.
    const std::unique_lock lock(painting_, std::chrono::milliseconds(200));
    if (abandoned_.exchange(true)) return;
    if (!lock) dropOutput(0);
    release();
  }

 private:
  // Sends a sequence that curses does not know, past its buffer, to terminals that ignore what they do not support.
  void send(const char* sequence) const {
    if (ignoresUnknownSequences() && std::fputs(sequence, output_.get()) >= 0) std::fflush(output_.get());
  }

  [[nodiscard]] bool takesOutput() const {
    pollfd output{::fileno(output_.get()), POLLOUT, 0};
    return ::poll(&output, 1, 0) > 0;
  }

  // Restores a terminal that accepts no output, because it was stopped (Ctrl-S) or nothing reads from it. Queued output
  // is discarded to make room for the sequences that restore it.
  void restoreDirectly() const {
    ::tcflush(direct_.number, TCOFLUSH);
    termios started = found_;
    started.c_iflag &= ~static_cast<tcflag_t>(IXON);  // continues a stopped terminal
    ::tcsetattr(direct_.number, TCSANOW, &started);
    [[maybe_unused]] const ssize_t ignored = ::write(direct_.number, restoring_.data(), restoring_.size());
    ::tcsetattr(direct_.number, TCSANOW, &found_);
  }

  // Neighbouring cells of the same look are written together.
  void paintLine(const Grid& grid, int line) {
    int column = 0;
    while (column < grid.size().width) {
      const Style style = grid.at(column, line).style;
      const int begin = column;
      std::string text;
      for (; column < grid.size().width && grid.at(column, line).style == style; ++column) {
        text += grid.at(column, line).glyph;
      }
      const Look look = lookOf(style);
      ::wattr_set(stdscr, look.attributes, colours_ ? look.pair : static_cast<short>(plain), nullptr);
      ::mvwaddstr(stdscr, line, begin, text.c_str());
    }
  }

  static std::optional<Input> functionKey(wint_t code) {
    constexpr std::array<std::pair<int, Key>, 11> keys = {{{KEY_UP, Key::up},
                                                           {KEY_DOWN, Key::down},
                                                           {KEY_LEFT, Key::left},
                                                           {KEY_RIGHT, Key::right},
                                                           {KEY_PPAGE, Key::pageUp},
                                                           {KEY_NPAGE, Key::pageDown},
                                                           {KEY_HOME, Key::home},
                                                           {KEY_END, Key::end},
                                                           {KEY_ENTER, Key::enter},
                                                           {KEY_BACKSPACE, Key::backspace},
                                                           {KEY_SF, Key::down}}};
    if (code == KEY_MOUSE) return mouse();
    for (const auto& [known, key] : keys) {
      if (static_cast<wint_t>(known) == code) return Input{key, 0, 0, 0};
    }
    return std::nullopt;
  }

  static std::optional<Input> mouse() {
    MEVENT event{};
    if (::getmouse(&event) != OK) return std::nullopt;
    if ((event.bstate & BUTTON4_PRESSED) != 0) return Input{Key::wheelUp, 0, event.x, event.y};
    if ((event.bstate & BUTTON5_PRESSED) != 0) return Input{Key::wheelDown, 0, event.x, event.y};
    if ((event.bstate & (BUTTON1_PRESSED | BUTTON1_CLICKED)) != 0) return Input{Key::click, 0, event.x, event.y};
    return std::nullopt;
  }

  static std::optional<Input> characterKey(wint_t character) {
    switch (character) {
      case '\r':
      case '\n':
        return Input{Key::enter, 0, 0, 0};
      case escape:
        return Input{Key::escape, 0, 0, 0};
      case 8:
      case 127:
        return Input{Key::backspace, 0, 0, 0};
      default:
        return Input{Key::character, static_cast<char32_t>(character), 0, 0};
    }
  }

  File input_;
  File output_;
  SCREEN* screen_;
  const termios found_;  // the terminal's modes before the program
  const CloseDescriptor null_;
  const CloseDescriptor direct_;  // the terminal
  const std::string restoring_;   // the sequences that restore the terminal's screen
  struct sigaction alarmBefore_ {};
  bool colours_ = false;
  bool pasting_ = false;  // between the marks of pasted text
  std::recursive_timed_mutex painting_;
  std::atomic<bool> abandoned_ = false;
};

}  // namespace

void Terminal::dropOutputSoon(int /*signal*/) { ::alarm(1); }

Result<std::unique_ptr<Terminal>> Terminal::open(bool colours) {
  File input = terminalFile(STDIN_FILENO, "r");
  File output = terminalFile(STDOUT_FILENO, "w");
  if (!input || !output) return Failure{std::string("there is no terminal")};
  const char* name = std::getenv("TERM");
  if (name == nullptr || *name == '\0') return Failure{std::string("TERM is not set")};
  const std::string type = "the terminal type \"" + printable(name) + "\"";
  int found = 0;
  if (::setupterm(nullptr, ::fileno(output.get()), &found) != OK) return Failure{type + " is not known"};
  ::del_curterm(::cur_term);
  for (const char* size : {"COLUMNS", "LINES"}) {
    if (auto obstacle = sizeObstacle(size)) return Failure{std::move(*obstacle)};
  }
  termios modes{};
  ::tcgetattr(::fileno(output.get()), &modes);
  SCREEN* screen = ::newterm(nullptr, output.get(), input.get());
  if (screen == nullptr) return Failure{std::string("the terminal cannot be set up")};
  ::set_term(screen);
  if (!canPlaceCursor()) {
    ::endwin();
    ::delscreen(screen);
    return Failure{type + " cannot place its cursor"};
  }
  return std::unique_ptr<Terminal>(
      std::make_unique<CursesTerminal>(std::move(input), std::move(output), screen, modes, colours));
}

bool hasTerminal() { return terminalFile(STDIN_FILENO, "r") && terminalFile(STDOUT_FILENO, "w"); }

bool localeIsUtf8() { return std::strcmp(::nl_langinfo(CODESET), "UTF-8") == 0; }

}  // namespace vespscope::terminal
