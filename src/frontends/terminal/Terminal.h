// The terminal itself, through curses: paints frames, reads keys and the mouse. The only user of curses.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "frontends/terminal/Frame.h"
#include "frontends/terminal/Input.h"
#include "values/Result.h"

namespace vespscope::terminal {

class Terminal {
 public:
  // Takes the terminal over; the reason says why there is none to take. Standard input and output are used if they
  // are terminals, else the controlling terminal, so that output may be redirected. One object at a time.
  static Result<std::unique_ptr<Terminal>> open(bool colours);
  virtual ~Terminal() = default;

  [[nodiscard]] virtual Size size() const = 0;
  // Paints what differs from what is there.
  virtual void paint(const Frame& frame) = 0;
  // Forgets what is there: the next frame is painted whole. After a resize, `size` tells the new one.
  virtual void forget() = 0;
  virtual void resized() = 0;

  [[nodiscard]] virtual int inputDescriptor() const = 0;
  // The next input that is there; empty when there is none.
  [[nodiscard]] virtual std::optional<Input> read() = 0;
  // Whether the terminal was hung up: it is readable for good, but nothing comes.
  [[nodiscard]] virtual bool isGone() const = 0;

  // Puts a text into the clipboard of the terminal's user (OSC 52); false for a terminal that has none.
  virtual bool copy(const std::string& text) = 0;

  // Gives the terminal back as it was found, and takes it over again.
  virtual void release() = 0;
  virtual void takeBack() = 0;
  // Gives it back for good, from whatever thread: nothing is painted any more. It does not wait for a terminal that
  // takes no output.
  virtual void abandon() = 0;

  // For a signal handler that asks the program to end: output that the terminal has not taken a second later is dropped
  // from then on, so that a thread that waits to paint continues.
  static void dropOutputSoon(int signal);
};

// Whether there is a terminal that `open` could take, known or not.
[[nodiscard]] bool hasTerminal();

// Whether the locale that is set has texts in UTF-8.
[[nodiscard]] bool localeIsUtf8();

}  // namespace vespscope::terminal
