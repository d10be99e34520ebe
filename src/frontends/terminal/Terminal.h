// The terminal, through curses: paints frames, reads keys and the mouse. Only this file includes curses.
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
  // Takes control of the terminal, or returns why that is not possible. Uses standard input and output if they are
  // terminals, else the controlling terminal, so that output may be redirected. At most one object exists at a time.
  static Result<std::unique_ptr<Terminal>> open(bool colours);
  virtual ~Terminal() = default;

  [[nodiscard]] virtual Size size() const = 0;
  // Paints the cells that differ from the terminal's contents.
  virtual void paint(const Frame& frame) = 0;
  // Forces the next frame to be painted completely. After a resize, `size` returns the new size.
  virtual void forget() = 0;
  virtual void resized() = 0;

  [[nodiscard]] virtual int inputDescriptor() const = 0;
  // The next available input; empty when there is none.
  [[nodiscard]] virtual std::optional<Input> read() = 0;
  // Whether the terminal was hung up: it stays readable, but no input comes.
  [[nodiscard]] virtual bool isGone() const = 0;

  // Puts a text into the clipboard of the terminal's user (OSC 52); returns false for a terminal without one.
  virtual bool copy(const std::string& text) = 0;

  // Restores the terminal's previous state, and takes control again.
  virtual void release() = 0;
  virtual void takeBack() = 0;
  // Restores the terminal permanently, from any thread: nothing is painted afterwards. Does not wait for a terminal
  // that accepts no output.
  virtual void abandon() = 0;

  // For a signal handler that ends the program: output that the terminal has not accepted after one second is discarded
  // from then on, so that a thread blocked in painting continues.
  static void dropOutputSoon(int signal);
};

// Whether there is a terminal that `open` could use, of known or unknown type.
[[nodiscard]] bool hasTerminal();

// Whether the current locale uses UTF-8.
[[nodiscard]] bool localeIsUtf8();

}  // namespace vespscope::terminal
