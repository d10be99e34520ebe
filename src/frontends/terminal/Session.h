// A user's session with the screens: processes input, keeps the shown state, and lays out the next frame.
#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "frontends/terminal/Frame.h"
#include "frontends/terminal/Input.h"
#include "frontends/terminal/LogMailbox.h"
#include "frontends/terminal/LogPane.h"
#include "frontends/terminal/ScreenModel.h"
#include "frontends/terminal/TableScroll.h"
#include "platform/application/Application.h"

namespace vespscope::terminal {

class Session {
 public:
  // Puts a text into the user's clipboard; returns false if there is none.
  using Clipboard = std::function<bool(const std::string& text)>;
  // The longest text passed to `clipboard`, in bytes: terminals ignore longer ones.
  static constexpr std::size_t longestCopy = 70'000;

  // `application` has its navigation controller and must outlive the session, as must `mailbox`.
  Session(application::Application& application, LogMailbox& mailbox, bool utf8, Clipboard clipboard = {});

  enum class Wish { draw, drawAnew, quit };
  // Processes input for the frame drawn last. A filter being typed is applied when the next frame is drawn, once for
  // all characters typed meanwhile.
  Wish handle(const Input& input);

  // Whether a screen has reloaded, or the log pane has new lines, since the last frame.
  [[nodiscard]] bool isStale() const;

  // Valid until the next call.
  const Frame& draw(Size size, std::chrono::system_clock::time_point now);

 private:
  struct Open {
    std::shared_ptr<application::TableViewController> screen;
    ScreenModel model;
    std::uint64_t reloadCount = 0;
  };

  [[nodiscard]] Open& top() { return stack_.back(); }
  void followNavigation();
  void read(Open& open);

  Wish handleCharacter(char32_t character);
  Wish handlePrompt(const Input& input);
  void handleTable(Key key);
  void handleLog(Key key);
  void handleHelp(Key key);
  void handleClick(const Input& input);
  void toggle(Pane pane);
  void back();
  void escape();
  void showNextSim();
  void openSelected();
  void leaveTo(std::size_t depth);
  void type(char32_t character);
  void typePasted(char32_t character);
  void applyTyped();
  void setFilter(std::string filter);
  [[nodiscard]] const std::string& filter() const;
  void copyRow();
  void copyScreen();
  void copy(const std::string& text, const std::string& what);

  application::Application& application_;
  LogMailbox& mailbox_;
  bool utf8_;
  Clipboard clipboard_;
  std::vector<Open> stack_;  // same as the navigation controller's
  Pane pane_ = Pane::table;
  bool prompting_ = false;
  std::optional<std::string> typed_;  // the filter as it is typed, not yet applied
  bool lineBreakPasted_ = false;      // behind what the filter has of the pasted text
  std::string notice_;                // until the next input
  LogPane log_;
  int helpTop_ = 0;
  Size size_;    // of the last frame
  Frame frame_;  // the last one
};

}  // namespace vespscope::terminal
