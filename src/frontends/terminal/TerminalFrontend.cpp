#include "frontends/terminal/TerminalFrontend.h"

#include <signal.h>

#include <chrono>
#include <cstdlib>
#include <functional>
#include <utility>

#include "frontends/terminal/LogMailbox.h"
#include "frontends/terminal/Session.h"
#include "frontends/terminal/Terminal.h"
#include "platform/console/Console.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SignalWatch.h"
#include "platform/log/Log.h"

namespace vespscope::terminal {
namespace {

using dispatch::MainLoop;
using std::chrono::steady_clock;

constexpr std::chrono::milliseconds statusInterval{1000};
constexpr std::chrono::milliseconds frameInterval{50};  // between frames that no key requested
constexpr int inputsAtOnce = 4096;                      // keys and mouse events at once, for example of a long paste

// The signals of a run, which wait for its main loop. They are watched before the terminal is taken: a signal that
// ended the process in between would leave the terminal as the program needs it.
struct Signals {
  std::function<void(int signal)> act;
  // When a terminal closes, SIGHUP arrives twice, from its program and from the system.
  dispatch::SignalWatch watch{MainLoop::main(),
                              {{SIGINT, SIGTERM}, {SIGWINCH, SIGTSTP, SIGCONT, SIGHUP}, endSoon},
                              [this](int signal) { act(signal); }};

  // Called in the signal handler.
  static void endSoon(int signal) {
    if (signal == SIGINT || signal == SIGTERM || signal == SIGHUP) Terminal::dropOutputSoon(signal);
  }
};

// The state of one run of the main loop.
class Run {
 public:
  Run(application::Application& application, LogMailbox& mailbox, Terminal& terminal, Signals& signals, bool utf8)
      : terminal_(terminal),
        session_(application, mailbox, utf8, [&terminal](const std::string& text) { return terminal.copy(text); }),
        signals_(signals) {
    signals_.act = [this](int signal) { act(signal); };
    loop_.watch(terminal.inputDescriptor(), [this] { readInput(); });
    statusTimer_ = loop_.scheduleRepeating(statusInterval, [this] { drawn_ = false; });
  }

  Run(const Run&) = delete;
  Run& operator=(const Run&) = delete;

  ~Run() {
    forgetFrameTimer();
    loop_.cancel(statusTimer_);
    loop_.unwatch(terminal_.inputDescriptor());
  }

  int untilLeft() {
    draw();
    while (!left_) {
      loop_.runOnce(std::chrono::milliseconds(-1));
      if (const auto code = loop_.stopCode()) return *code;
      if (left_) break;
      if (!drawn_) {
        draw();
      } else if (session_.isStale()) {
        drawSoon();
      }
    }
    return 0;
  }

 private:
  void draw() {
    forgetFrameTimer();
    terminal_.paint(session_.draw(terminal_.size(), std::chrono::system_clock::now()));
    drawn_ = true;
    drawnAt_ = steady_clock::now();
  }

  // Draws now, or later if the last frame was drawn a moment ago: there may be thousands of events.
  void drawSoon() {
    const auto wait = std::chrono::ceil<std::chrono::milliseconds>(frameInterval - (steady_clock::now() - drawnAt_));
    if (wait <= std::chrono::milliseconds(0)) {
      draw();
    } else if (!frameTimer_) {
      frameTimer_ = loop_.scheduleRepeating(wait, [this] { drawn_ = false; });
    }
  }

  void forgetFrameTimer() {
    if (frameTimer_) loop_.cancel(*std::exchange(frameTimer_, std::nullopt));
  }

  void readInput() {
    bool any = false;
    for (int count = 0; !left_; ++count) {
      if (count == inputsAtOnce) {
        // Signals and events get their turn. Curses may hold input that no longer makes its descriptor readable.
        loop_.async([this, alive = std::weak_ptr(alive_)] {
          if (!alive.expired()) readInput();
        });
        return;
      }
      const std::optional<Input> input = terminal_.read();
      if (!input) break;
      any = true;
      // Keys may be typed faster than frames are drawn; a click refers to the frame that the user saw.
      const Session::Wish wish = session_.handle(*input);
      if (wish == Session::Wish::quit) left_ = true;
      if (wish == Session::Wish::drawAnew) terminal_.forget();
      drawn_ = false;
    }
    if (!any && terminal_.isGone()) left_ = true;
  }

  void act(int signal) {
    switch (signal) {
      case SIGWINCH:
        terminal_.resized();
        break;
      case SIGTSTP:
        suspend();
        break;
      case SIGCONT:
        terminal_.takeBack();
        break;
      default:
        left_ = true;
        return;
    }
    drawn_ = false;
  }

  // Log lines stay in the log pane meanwhile: other threads run again before the terminal is taken back.
  void suspend() {
    terminal_.release();
    signals_.watch.deliverAsBefore(SIGTSTP);
    terminal_.takeBack();
  }

  MainLoop& loop_ = MainLoop::main();
  Terminal& terminal_;
  Session session_;
  Signals& signals_;
  MainLoop::TimerIdentifier statusTimer_ = 0;
  std::optional<MainLoop::TimerIdentifier> frameTimer_;
  bool drawn_ = false;
  bool left_ = false;
  steady_clock::time_point drawnAt_;
  std::shared_ptr<bool> alive_ = std::make_shared<bool>(true);
};

class TerminalFrontend final : public application::Frontend {
 public:
  explicit TerminalFrontend(TerminalOptions options)
      : observation_([mailbox = mailbox_](log::Channel channel, std::string_view line) {
          mailbox->post(channel, line, std::chrono::system_clock::now());
        }) {
    utf8_ = options.utf8.value_or(localeIsUtf8());
    const char* noColour = std::getenv("NO_COLOR");
    colours_ = options.colours.value_or(noColour == nullptr || *noColour == '\0');
    log::setTerminalOwned(true);
  }

  ~TerminalFrontend() override { log::setTerminalOwned(false); }

  int run(application::Application& application) override {
    Signals signals;
    auto terminal = Terminal::open(colours_);
    if (!terminal) {
      console::error("vespscope: no terminal interface: " + terminal.reason() + "; --ui none does without");
      return 1;
    }
    // Set before anything else that may fail, because the terminal is in use.
    const log::FatalHook hook([&terminal] { (*terminal)->abandon(); });
    return Run(application, *mailbox_, **terminal, signals, utf8_).untilLeft();
  }

 private:
  // Shared with the observer, which may still run in another thread when this object is destroyed.
  std::shared_ptr<LogMailbox> mailbox_ = std::make_shared<LogMailbox>();
  log::Observation observation_;
  bool utf8_ = false;
  bool colours_ = false;
};

}  // namespace

bool isTerminalAvailable() { return hasTerminal(); }

std::unique_ptr<application::Frontend> makeTerminalFrontend(TerminalOptions options) {
  return std::make_unique<TerminalFrontend>(options);
}

}  // namespace vespscope::terminal
