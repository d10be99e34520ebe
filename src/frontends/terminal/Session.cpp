#include "frontends/terminal/Session.h"

#include <algorithm>
#include <utility>

#include "frontends/terminal/HelpText.h"
#include "platform/application/StatusText.h"
#include "platform/log/Log.h"
#include "values/Utf8.h"

namespace vespscope::terminal {
namespace {

using application::TableViewController;

constexpr int wheelLines = 3;
constexpr char32_t controlL = 12;
constexpr char32_t controlU = 21;

// The actions of letters when no text is typed.
Key keyFor(char32_t character) {
  switch (character) {
    case 'k':
      return Key::up;
    case 'j':
      return Key::down;
    case 'h':
      return Key::left;
    case 'g':
      return Key::home;
    case 'G':
      return Key::end;
    case ' ':
      return Key::pageDown;
    default:
      return Key::character;
  }
}

// How far a key moves a view of some height, in lines; 0 for keys that do not move it.
int linesFor(Key key, int height, int all) {
  switch (key) {
    case Key::up:
      return -1;
    case Key::down:
      return 1;
    case Key::pageUp:
      return -std::max(height - 1, 1);
    case Key::pageDown:
      return std::max(height - 1, 1);
    case Key::home:
      return -all;
    case Key::end:
      return all;
    case Key::wheelUp:
      return -wheelLines;
    case Key::wheelDown:
      return wheelLines;
    default:
      return 0;
  }
}

}  // namespace

Session::Session(application::Application& application, LogMailbox& mailbox, bool utf8, Clipboard clipboard)
    : application_(application),
      mailbox_(mailbox),
      utf8_(utf8),
      clipboard_(std::move(clipboard)),
      frame_{Grid({}, utf8), {}, {}, {}} {
  followNavigation();
}

void Session::read(Open& open) {
  open.reloadCount = open.screen->tableView().reloadCount();
  open.model.reload(application::readTable(*open.screen));
}

// Follows screens that were pushed and popped; the remaining ones keep their positions.
void Session::followNavigation() {
  const auto& screens = application_.navigation->viewControllers();
  if (screens.empty()) log::fatal("the navigation controller has no screen");
  std::size_t same = 0;
  while (same < stack_.size() && same < screens.size() && stack_[same].screen == screens[same]) ++same;
  stack_.resize(same);
  for (std::size_t index = same; index < screens.size(); ++index) {
    auto screen = std::dynamic_pointer_cast<TableViewController>(screens[index]);
    if (!screen) log::fatal("a screen that is no table cannot be drawn");
    stack_.push_back({std::move(screen), {}, 0});
    read(stack_.back());
  }
  if (top().reloadCount != top().screen->tableView().reloadCount()) read(top());
}

bool Session::isStale() const {
  const auto& screens = application_.navigation->viewControllers();
  const Open& shown = stack_.back();
  return screens.size() != stack_.size() || screens.back() != shown.screen ||
         shown.reloadCount != shown.screen->tableView().reloadCount() || (pane_ == Pane::log && !mailbox_.empty());
}

const Frame& Session::draw(Size size, std::chrono::system_clock::time_point now) {
  followNavigation();
  applyTyped();
  size_ = size;
  log_.add(mailbox_.take());
  View view;
  for (const Open& open : stack_) view.path.push_back(open.screen->title());
  view.pane = pane_;
  view.prompting = prompting_;
  view.screen = &top().model;
  view.log = &log_;
  view.now = now;
  view.notice = notice_;
  if (application_.status) view.status = application_.status();
  if (application_.screenAge) view.age = application_.screenAge(*top().screen);
  if (isTooSmall(size)) {
    frame_ = layOutFrame(view, size, utf8_);
    return frame_;
  }
  const TableLines lines = layOutTable(top().model, size.width, utf8_);
  TableScroll scroll(top().model, lines, shapeOf(size).bodyHeight);
  scroll.settle();
  view.lines = &lines;
  view.top = scroll.top();
  if (pane_ == Pane::help) {
    const int all = static_cast<int>(helpLines(size.width, utf8_).size());
    helpTop_ = std::clamp(helpTop_, 0, std::max(all - shapeOf(size).bodyHeight, 0));
    view.top = helpTop_;
  }
  frame_ = layOutFrame(view, size, utf8_);
  return frame_;
}

Session::Wish Session::handle(const Input& input) {
  if (isTooSmall(size_)) return input.key == Key::character && input.character == 'q' ? Wish::quit : Wish::draw;
  followNavigation();
  notice_.clear();
  if (prompting_) return handlePrompt(input);
  if (input.key == Key::pasted) return Wish::draw;  // only a filter takes text
  if (input.key == Key::character && keyFor(input.character) == Key::character) return handleCharacter(input.character);
  const Key key = input.key == Key::character ? keyFor(input.character) : input.key;
  if (key == Key::escape) {
    escape();
  } else if (key == Key::left || key == Key::backspace) {
    back();
  } else if (key == Key::click) {
    handleClick(input);
  } else if (pane_ == Pane::table) {
    handleTable(key);
  } else if (pane_ == Pane::log) {
    handleLog(key);
  } else {
    handleHelp(key);
  }
  return Wish::draw;
}

Session::Wish Session::handleCharacter(char32_t character) {
  switch (character) {
    case 'q':
      return Wish::quit;
    case controlL:
      return Wish::drawAnew;
    case '/':
      if (pane_ == Pane::help) pane_ = Pane::table;
      prompting_ = true;
      break;
    case '?':
      toggle(Pane::help);
      break;
    case 'l':
      toggle(Pane::log);
      break;
    case 'r':
      read(top());
      break;
    case 's':
      showNextSim();
      break;
    case 'y':
      copyRow();
      break;
    case 'Y':
      copyScreen();
      break;
    default:
      break;
  }
  return Wish::draw;
}

Session::Wish Session::handlePrompt(const Input& input) {
  if (input.key == Key::pasted) {
    typePasted(input.character);
    return Wish::draw;
  }
  lineBreakPasted_ = false;
  if (input.key == Key::character && input.character != controlL && input.character != controlU) {
    type(input.character);
    return Wish::draw;
  }
  applyTyped();
  switch (input.key) {
    case Key::escape:
      setFilter("");
      prompting_ = false;
      return Wish::draw;
    case Key::enter:
      prompting_ = false;
      return Wish::draw;
    case Key::click:
      prompting_ = false;
      handleClick(input);
      return Wish::draw;
    case Key::backspace: {
      std::string shorter = filter();
      prompting_ = !shorter.empty();
      removeLastCharacter(shorter);
      setFilter(std::move(shorter));
      return Wish::draw;
    }
    case Key::left:
    case Key::right:
      return Wish::draw;
    case Key::character:
      break;
    default:
      pane_ == Pane::log ? handleLog(input.key) : handleTable(input.key);
      return Wish::draw;
  }
  if (input.character == controlL) return Wish::drawAnew;
  setFilter("");
  return Wish::draw;
}

// Control characters, and characters beyond the longest filter, are ignored.
void Session::type(char32_t character) {
  if (character < 0x20 || character == 0x7F) return;
  if (!typed_) typed_ = filter();
  const auto isFirstByte = [](char byte) { return (static_cast<unsigned char>(byte) & 0xC0) != 0x80; };
  const auto characters = static_cast<std::size_t>(std::count_if(typed_->begin(), typed_->end(), isFirstByte));
  if (characters < application::TextFilter::longestText) appendCodePoint(*typed_, character);
}

// A filter has one line: what separates words in the pasted text becomes a space, but not at its ends.
void Session::typePasted(char32_t character) {
  if (character < 0x20) {
    lineBreakPasted_ = true;
    return;
  }
  if (std::exchange(lineBreakPasted_, false) && !(typed_ ? *typed_ : filter()).empty()) type(' ');
  type(character);
}

void Session::applyTyped() {
  if (typed_) setFilter(*std::exchange(typed_, std::nullopt));
}

void Session::handleTable(Key key) {
  const TableLines lines = layOutTable(top().model, size_.width, utf8_);
  TableScroll scroll(top().model, lines, shapeOf(size_).bodyHeight);
  switch (key) {
    case Key::up:
      return scroll.up();
    case Key::down:
      return scroll.down();
    case Key::pageUp:
      return scroll.pageUp();
    case Key::pageDown:
      return scroll.pageDown();
    case Key::home:
      return scroll.home();
    case Key::end:
      return scroll.end();
    case Key::wheelUp:
      return scroll.scrollBy(-wheelLines);
    case Key::wheelDown:
      return scroll.scrollBy(wheelLines);
    case Key::enter:
    case Key::right:
      return openSelected();
    default:
      return;
  }
}

void Session::handleLog(Key key) {
  const int height = shapeOf(size_).bodyHeight;
  if (key == Key::home) return log_.home();
  if (key == Key::end) return log_.follow();
  if (const int count = linesFor(key, height, 0); count != 0) log_.scrollBy(count, {size_.width, height}, utf8_);
}

void Session::handleHelp(Key key) {
  if (key == Key::enter) return toggle(Pane::help);
  const int all = static_cast<int>(helpLines(size_.width, utf8_).size());
  helpTop_ += linesFor(key, shapeOf(size_).bodyHeight, all);  // drawing keeps it in range
}

void Session::handleClick(const Input& input) {
  if (input.line == 0) {
    for (const Frame::Crumb& crumb : frame_.crumbs) {
      if (input.column >= crumb.begin && input.column < crumb.end) return leaveTo(crumb.depth);
    }
  }
  if (input.line < 0 || static_cast<std::size_t>(input.line) >= frame_.rowAt.size()) return;
  const auto row = frame_.rowAt[static_cast<std::size_t>(input.line)];
  if (pane_ != Pane::table || !row || *row >= top().model.rows().size()) return;
  top().model.select(*row);
  openSelected();
}

void Session::toggle(Pane pane) {
  pane_ = pane_ == pane ? Pane::table : pane;
  helpTop_ = 0;
  if (pane_ == Pane::log) log_.follow();
}

void Session::back() {
  if (pane_ != Pane::table) {
    pane_ = Pane::table;
  } else {
    application_.navigation->pop();
    followNavigation();
  }
}

void Session::escape() {
  if (pane_ != Pane::help && !filter().empty()) {
    setFilter("");
  } else {
    back();
  }
}

void Session::leaveTo(std::size_t depth) {
  pane_ = Pane::table;
  while (application_.navigation->viewControllers().size() > depth + 1 && application_.navigation->pop()) {
  }
  followNavigation();
}

void Session::openSelected() {
  Open& open = top();
  const auto selected = open.model.selected();
  if (!selected || !open.model.row(open.model.rows()[*selected]).disclosure) return;
  // The screen's data may have changed since its last reload: the row is looked up in the current table.
  const ScreenModel::Place wanted = open.model.placeOf(*selected);
  read(open);
  const auto found = open.model.numberOf(wanted);
  if (!found || open.model.placeOf(*found).identity.label != wanted.identity.label) return;
  application_.navigation->selectRow(application_.interface, open.screen, open.model.rows()[*found]);
  followNavigation();
}

void Session::showNextSim() {
  const auto next = application_.status ? application::nextSim(application_.status().sims) : std::nullopt;
  if (next && application_.showNextSim) application_.showNextSim();
  notice_ = next ? "Showing SIM " + std::to_string(*next) : "No other SIM card reports";
}

void Session::copyRow() {
  const auto selected = top().model.selected();
  if (pane_ != Pane::table || !selected) return;
  const application::RowSnapshot& row = top().model.row(top().model.rows()[*selected]);
  copy(application::rowText(row), row.label);
}

void Session::copyScreen() {
  if (pane_ != Pane::table) return;
  const std::size_t count = top().model.rows().size();
  copy(application::tableText(top().screen->title(), top().model), application::countText(count, "row", "rows"));
}

void Session::copy(const std::string& text, const std::string& what) {
  if (text.size() > longestCopy) {
    notice_ = "Too long for a terminal's clipboard; filter the rows first";
  } else {
    notice_ = clipboard_ && clipboard_(text) ? "Copied " + what : "This terminal has no clipboard";
  }
}

const std::string& Session::filter() const { return pane_ == Pane::log ? log_.filter() : stack_.back().model.filter(); }

void Session::setFilter(std::string filter) {
  pane_ == Pane::log ? log_.setFilter(std::move(filter)) : top().model.setFilter(std::move(filter));
}

}  // namespace vespscope::terminal
